#pragma once

#include "widgets/CustomControl.h"

#include <QColor>

#include <vector>

namespace Orbane {

// The painted strip of the levels controls: a histogram (or a ramp between
// two colours) across 0..1, with triangular handles under it. A press near
// a handle takes it and a drag moves it (Ctrl ten times finer); a double
// click asks for the handle's default. It writes nothing: it tells its
// owner where the user asks the handle to be (Moved), and the owner
// constrains the values and hands the handles back (SetHandles).
class LevelsBar : public CustomControl
{
    Q_OBJECT
public:
    struct Handle
    {
        float64 x = 0.0;
        QColor colour;
    };
    static constexpr int32 kMargin = 6;
    static constexpr int32 kHandleHeight = 9;
    static constexpr float64 kPickTolerance = 7.0;
    static constexpr float64 kFineFactor = 0.1;

    explicit LevelsBar(QWidget *parent = nullptr);

    void SetHistogram(std::vector<float> heights, QColor colour);
    void SetRamp(QColor from, QColor to);
    void SetHandles(std::vector<Handle> handles);
    const std::vector<Handle> &Handles() const noexcept { return mHandles; }

    // Mappings between 0..1 and x across a strip `width` pixels wide.
    static float64 ToPixel(float64 value, int32 width);
    static float64 ToValue(float64 x, int32 width);
    // The handle a press at `x` takes: the nearest within the tolerance,
    // the later one where two lie on each other; -1 where none.
    static int32 HandleAt(const std::vector<Handle> &handles, float64 x, int32 width);

    QSize sizeHint() const override;

signals:
    void Moved(int handle, double value);
    void Released();
    void ResetAsked(int handle);

protected:
    void paintEvent(QPaintEvent *event) override;
    void mousePressEvent(QMouseEvent *event) override;
    void mouseMoveEvent(QMouseEvent *event) override;
    void mouseReleaseEvent(QMouseEvent *event) override;
    void mouseDoubleClickEvent(QMouseEvent *event) override;

private:
    void PaintBackdrop(QPainter &painter, const QRectF &area);
    void PaintHandle(QPainter &painter, const Handle &handle, float64 top);

    std::vector<float> mHeights;
    QColor mHistogramColour;
    QColor mRampFrom;
    QColor mRampTo;
    bool mRamp = false;
    std::vector<Handle> mHandles;
    int32 mPicked = -1;
    float64 mDragValue = 0.0;
    float64 mLastX = 0.0;
};

} // namespace Orbane
