#pragma once

#include "framework/HandleOverlay.h"

#include "orbane/OverlayControl.h"

namespace Orbane {

namespace Graphics {
class GPainter;
} // namespace Graphics

// A number slider drawn in the viewer, for quick adjustments of a Number
// Input without the inspector: a track at the viewer's bottom left (one row
// per Input of the tool, in the tool's order, so that several stack), its
// knob at the value within the Input's slider range (its SLA_MinScale and
// SLA_MaxScale attributes, 0..1 by default). Drag the knob (Ctrl: ten
// times finer) or click the track; Left and Right step by a hundredth of
// the range. It keeps its place and size on screen at any zoom.
class SliderOverlay : public HandleOverlayOn<OverlayControl>
{
public:
    enum Part : uint32
    {
        SPART_Knob = 1,
        SPART_Track = 2,
    };
    // Track length, the knob's half size, the margin to the viewer's edges
    // and the height of a row, in handle pixels.
    static constexpr float64 TrackLength = 200.0;
    static constexpr float64 KnobHalf = 6.0;
    static constexpr float64 Margin = 20.0;
    static constexpr float64 RowHeight = 28.0;

    SliderOverlay(const Registry *reg, const ScriptVal &args, const TagList &tags);

    std::size_t SizeOf() const override { return sizeof(SliderOverlay); }
    // Adds `value`, `minimum`, `maximum`.
    void GetState(ScriptVal &state) const override;

    bool AddInput(Input *input, const TagList *tags) override;
    void NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    void DrawControls(PreviewInfo *info, const TagList *tags) override;
    DragType ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    uint64 ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags) override;

    // Where the value sits along a track of `length` (0..length, clamped),
    // and the value at `along`; a range of no width puts it at the start.
    static float64 PositionOf(float64 value, float64 low, float64 high, float64 length) noexcept;
    static float64 ValueAt(float64 along, float64 low, float64 high, float64 length) noexcept;

protected:
    void BuildHandles(const PreviewInfo &info, HandleSet &handles) const override;

private:
    // The track's left end in viewer units.
    OrbPoint TrackStart(const PreviewInfo &info) const;
    void Slide(float64 value);
    void ReadRange();
    void DrawSlider(Graphics::GPainter &p, const PreviewInfo &info) const;

    float64 mValue = 0.0;
    float64 mLow = 0.0, mHigh = 1.0;
    int32 mRow = 0;
    // The drag: the value and mouse X (viewer units) at the press.
    float64 mPressValue = 0.0, mPressX = 0.0;
};

} // namespace Orbane
