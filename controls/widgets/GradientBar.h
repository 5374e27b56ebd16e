#pragma once

#include "widgets/CustomControl.h"
#include "widgets/GradientStops.h"

#include <algorithm>

namespace Orbane {

// A painted gradient: the ramp over a checkerboard, and under it a marker
// per stop, the selected one lit. A click on the ramp or the marker row
// away from any marker adds a stop there; a marker dragged sideways moves
// its stop; dragged more than kDeleteDistance pixels off the bar it is shown
// crossed out and a release there deletes it (not the last two); a double
// click on a marker asks for its colour. The widget edits its own copy and
// says so (Edited during a gesture, GestureEnded at its end); the owner
// writes the value.
class GradientBar : public CustomControl
{
    Q_OBJECT
public:
    static constexpr int32 kMarkerRow = 10; // height of the markers' row, logical pixels
    static constexpr int32 kMargin = 6;     // room for a marker at each end
    static constexpr int32 kDeleteDistance = 20;

    GradientBar();
    ~GradientBar() override;

    std::size_t SizeOf() const override { return sizeof(GradientBar); }

    void SetStops(const GradientStops &stops);
    const GradientStops &Stops() const noexcept { return mStops; }
    int32 Selected() const noexcept { return mSelected; }
    // Clicks add stops only while there are fewer than this.
    void SetMaxStops(int32 count) { mMaxStops = std::max(GradientStops::kMinStops, count); }
    void Select(int32 index);

    // Position 0..1 to widget x and back, on a bar `width` wide: pure.
    static float64 PosToX(float64 pos, int32 width);
    static float64 XToPos(float64 x, int32 width);
    // The stop whose marker is nearest `x` within a marker's half width, or -1.
    int32 MarkerAt(float64 x) const;

signals:
    void Edited();
    void GestureEnded();
    void SelectionChanged(int index);
    void ColorAsked(int index);

protected:
    void paintEvent(QPaintEvent *event) override;
    void mousePressEvent(QMouseEvent *event) override;
    void mouseMoveEvent(QMouseEvent *event) override;
    void mouseReleaseEvent(QMouseEvent *event) override;
    void mouseDoubleClickEvent(QMouseEvent *event) override;

private:
    bool IsOffBar(float64 y) const;
    void PaintMarker(QPainter &p, int32 index);

    GradientStops mStops = GradientStops::Default();
    int32 mSelected = 0;
    int32 mMaxStops = 16;
    bool mDragging = false;
    bool mOff = false; // the dragged marker is off the bar: a release deletes it
    bool mChanged = false;
};

} // namespace Orbane
