#pragma once

#include "framework/HandleOverlay.h"

namespace Orbane {

namespace Graphics {
class GPainter;
} // namespace Graphics

// A crop box over the image, the image outside it darkened. Input 0 is
// the box's lower-left corner and Input 1 its size (Points, image
// coordinates); a third Input, a Number, locks the box's aspect while it is
// not 0, as Shift held during a drag does. Edges and corners resize it, the
// inside moves it; the arrows move it by an image pixel.
class CropControl : public HandleOverlay
{
public:
    // Parts: an edge or corner by its side bits (1 +X, 2 +Y, 4 -X, 8 -Y),
    // the inside as 16.
    static constexpr uint32 CropInside = 16;

    CropControl(const Registry *reg, const ScriptVal &args, const TagList &tags);

    std::size_t SizeOf() const override { return sizeof(CropControl); }
    // Adds `left`, `bottom`, `right`, `top` (image coordinates), `locked`
    // and `dragPart`.
    void GetState(ScriptVal &state) const override;

    bool AddInput(Input *input, const TagList *tags) override;
    void NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    void DrawControls(PreviewInfo *info, const TagList *tags) override;
    DragType ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    uint64 ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags) override;

    // The box's lower-left and upper-right corners, however its size is signed.
    OrbPoint Low() const;
    OrbPoint High() const;

    // The box after dragging `part` by `delta` (image units) from
    // `low`..`high`; with `lockRatio` (width over height in image pixels,
    // 0 for none) the box keeps that shape: an edge drag about the other
    // axis's middle, a corner drag about the opposite corner.
    static void Dragged(uint32 part, OrbPoint delta, float64 lockRatio, OrbPoint pixels, OrbPoint &low,
                        OrbPoint &high) noexcept;

protected:
    void BuildHandles(const PreviewInfo &info, HandleSet &handles) const override;

private:
    void Store(int32 index, const Parameter *value, bool &moved);
    void DrawShade(Graphics::GPainter &p, const PreviewInfo &info, OrbPoint lo, OrbPoint hi) const;
    void DrawBox(Graphics::GPainter &p, const PreviewInfo &info, OrbPoint lo, OrbPoint hi) const;

    OrbPoint mCorner{0.25, 0.25};
    OrbPoint mSize{0.5, 0.5};
    bool mLocked = false;
    uint32 mDragPart = 0;
    OrbPoint mPressMouse; // image coordinates
    OrbPoint mPressLow, mPressHigh;
};

} // namespace Orbane
