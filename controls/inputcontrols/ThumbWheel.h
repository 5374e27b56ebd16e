#pragma once

#include "orbane/Types.h"

#include <QWidget>

namespace Orbane {

// An endless thumbwheel: dragging it sideways turns it, each pixel one step
// (Ctrl a tenth of one, Shift ten), and each notch of the mouse wheel turns
// it kNotchSteps steps. It holds no value: it reports turns, and its ridges
// follow the total so that the hand sees it move.
class ThumbWheel : public QWidget
{
    Q_OBJECT
public:
    // Steps one notch of the mouse wheel turns.
    static constexpr float64 kNotchSteps = 10.0;
    // Pixels between two ridges.
    static constexpr int32 kRidgeSpacing = 6;

    explicit ThumbWheel(QWidget *parent = nullptr);

    // The steps a move of `pixels` makes with `modifiers` held.
    static float64 StepsFor(float64 pixels, Qt::KeyboardModifiers modifiers);
    // How far the wheel has turned since it was made, in steps.
    float64 Turned() const { return mTurned; }

    QSize sizeHint() const override;

signals:
    void Turn(float64 steps);
    // The gesture (a drag, a run of wheel notches) ended.
    void TurnEnded();

protected:
    void paintEvent(QPaintEvent *event) override;
    void mousePressEvent(QMouseEvent *event) override;
    void mouseMoveEvent(QMouseEvent *event) override;
    void mouseReleaseEvent(QMouseEvent *event) override;
    void wheelEvent(QWheelEvent *event) override;

private:
    void TurnBy(float64 steps);

    float64 mTurned = 0.0;
    int32 mLastX = 0;
    bool mDragging = false;
};

} // namespace Orbane
