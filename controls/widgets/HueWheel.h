#pragma once

#include "widgets/CustomControl.h"

#include "orbane/OrbPointT.h"

#include <QImage>

namespace Orbane {

// A painted hue and saturation disc with a puck. The puck is a point of the
// colour plane: its angle the hue (0 degrees, red, to the right, turning
// anticlockwise through yellow and green), its distance from the centre the
// saturation, 1 at the rim. A drag moves the puck relative to where it was
// (Ctrl: ten times finer; Shift: along the first direction moved, either the
// hue round the centre or the saturation along the radius); a double click
// asks for the reset. The widget never writes Inputs: its owner does, on
// PuckMoved, Released and ResetAsked.
class HueWheel : public CustomControl
{
    Q_OBJECT
public:
    static constexpr float64 kFine = 0.1;
    // Pixels moved before a Shift drag picks its direction.
    static constexpr int32 kConstrainAfter = 3;

    HueWheel();
    ~HueWheel() override;

    std::size_t SizeOf() const override { return sizeof(HueWheel); }

    void SetPuck(OrbPoint puck);
    OrbPoint Puck() const noexcept { return mPuck; }
    // The rim's saturation; the puck stays inside it.
    void SetRim(float64 rim);

    // The disc's geometry in this widget: its centre and radius in pixels.
    QPointF Centre() const;
    float64 Radius() const;
    // Puck to widget pixel and back, for a disc at `centre` of `radius`
    // whose rim is saturation `rim`: pure, so they are tested alone.
    static QPointF ToPixel(OrbPoint puck, QPointF centre, float64 radius, float64 rim);
    static OrbPoint FromPixel(QPointF pixel, QPointF centre, float64 radius, float64 rim);
    // Where a drag from `start` by `delta` (colour-plane units) puts the
    // puck: kept inside `rim`; with `constrain` 1 only the hue changes,
    // with 2 only the saturation.
    static OrbPoint Dragged(OrbPoint start, OrbPoint delta, float64 rim, int32 constrain);

signals:
    void Pressed();
    void PuckMoved(float64 x, float64 y);
    void Released();
    void ResetAsked();

protected:
    void paintEvent(QPaintEvent *event) override;
    void mousePressEvent(QMouseEvent *event) override;
    void mouseMoveEvent(QMouseEvent *event) override;
    void mouseReleaseEvent(QMouseEvent *event) override;
    void mouseDoubleClickEvent(QMouseEvent *event) override;

private:
    const QImage &Disc(int32 side, qreal ratio);
    int32 ConstraintFor(QPointF moved) const;

    OrbPoint mPuck{0.0, 0.0};
    float64 mRim = 1.0;
    bool mDragging = false;
    QPointF mPressAt;
    OrbPoint mPressPuck{0.0, 0.0};
    int32 mConstraint = 0; // 0 none yet, 1 hue, 2 saturation
    QImage mDisc;          // the painted disc, kept while its size stays
};

} // namespace Orbane
