#pragma once

#include "framework/HandleOverlay.h"
#include "framework/LinkedInput.h"

namespace Orbane {

namespace Graphics {
class GPainter;
} // namespace Graphics

// A placement handle for a layer: its main Input is the layer's position
// (a Point); the layer's bounding box is drawn about it, turned and sized
// by tags or by Number Inputs it only reads. A press on the centre or
// anywhere inside the box drags the position, along one axis or snapped to
// whole image pixels where the tags say.
class PositionerControl : public HandleOverlay
{
public:
    enum Part : uint32
    {
        PPART_Center = 1,
        PPART_Box = 2,
    };

    PositionerControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~PositionerControl() override;

    std::size_t SizeOf() const override { return sizeof(PositionerControl); }
    bool GetAttrsTagList(TagList &tags) const override;
    // Adds `x`, `y` (the position) and the box as drawn: `width`, `height`
    // (image widths, size applied) and `angle`.
    void GetState(ScriptVal &state) const override;

    using PreviewControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool RemoveInput(Input *input, const TagList *tags) override;
    void NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    void DrawControls(PreviewInfo *info, const TagList *tags) override;
    DragType ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    uint64 ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags) override;

protected:
    void BuildHandles(const PreviewInfo &info, HandleSet &handles) const override;

private:
    static const LinkedInput<PositionerControl> Links[];

    // The box in viewer units: its middle, its X side's direction and its
    // half sides.
    struct Box
    {
        OrbPoint middle, unitX, half;
    };
    Box BoxIn(const PreviewInfo &info) const;
    OrbPoint Placed(const PreviewInfo &info, OrbPoint to) const;
    void DrawBox(Graphics::GPainter &p, const PreviewInfo &info, const Box &box) const;

    Input *mWidthInput = nullptr, *mHeightInput = nullptr, *mAngleInput = nullptr, *mSizeInput = nullptr;
    OrbPoint mPosition{0.5, 0.5};
    float64 mWidth = 0.25, mHeight = 0.25, mAngle = 0.0, mSize = 1.0;
    OrbPoint mAnchor{0.5, 0.5};
    bool mShowBox = true;
    bool mSnap = false;
    int32 mAxis = 0;
    OrbPoint mPressPosition;
};

} // namespace Orbane
