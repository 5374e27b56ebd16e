#pragma once

#include "orbane/Types.h"

#include <QWidget>

namespace Orbane {

// The painted track of a range: a groove over the scale, the bar of the
// span between two knobs, and ticks under it. Dragging a knob moves that
// end, dragging the bar moves both, a press elsewhere brings the nearer end
// there; Ctrl drags ten times finer. It writes nothing: it tells its control
// the ends the user asks for (Moved), which the control constrains, writes
// and hands back (SetValues). A low end above the high one shows red.
class RangeTrack : public QWidget
{
    Q_OBJECT
public:
    enum Part : int32
    {
        Part_None = 0,
        Part_Low = 1,
        Part_High = 2,
        Part_Span = 3,
    };
    // Room kept at each end, so a knob at the scale's end is whole.
    static constexpr int32 kMargin = 6;
    // How near a knob a press takes it, in pixels.
    static constexpr float64 kPickTolerance = 6.0;
    static constexpr float64 kFineFactor = 0.1;

    explicit RangeTrack(QWidget *parent = nullptr);

    void SetScale(float64 low, float64 high);
    void SetValues(float64 low, float64 high);
    void SetHasHigh(bool on);
    void SetTickCount(int32 count);

    // Mappings between values and x across a track `width` pixels wide.
    static float64 ValueToPixel(float64 value, float64 scaleLow, float64 scaleHigh, int32 width);
    static float64 PixelToValue(float64 x, float64 scaleLow, float64 scaleHigh, int32 width);
    // The part a press at `x` takes, given the knobs' x.
    static Part HitPart(float64 x, float64 lowX, float64 highX, bool hasHigh);

    QSize sizeHint() const override;

signals:
    void Pressed();
    void Moved(float64 low, float64 high, int part);
    void Released();
    void ResetAsked();

protected:
    void paintEvent(QPaintEvent *event) override;
    void mousePressEvent(QMouseEvent *event) override;
    void mouseMoveEvent(QMouseEvent *event) override;
    void mouseReleaseEvent(QMouseEvent *event) override;
    void mouseDoubleClickEvent(QMouseEvent *event) override;

private:
    float64 XOf(float64 value) const;
    float64 ValueAt(float64 x) const;
    void Anchor(float64 x, bool fine);

    float64 mScaleLow = 0.0;
    float64 mScaleHigh = 1.0;
    float64 mLow = 0.0;
    float64 mHigh = 1.0;
    bool mHasHigh = true;
    int32 mTicks = 0;
    Part mDragged = Part_None;
    bool mFine = false;
    float64 mAnchorX = 0.0;
    float64 mAnchorLow = 0.0;
    float64 mAnchorHigh = 0.0;
};

} // namespace Orbane
