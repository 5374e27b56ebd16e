#pragma once

#include "framework/HandleOverlay.h"
#include "framework/LinkedInput.h"

namespace Orbane {

namespace Graphics {
class GPainter;
} // namespace Graphics

// An offset drawn as an arrow from a centre: its main Input is the offset
// (a Point, in image units), the centre another Point Input it only reads.
// The arrow's tip is the one handle; a drag or an arrow key moves it.
class XYOffsetControl : public HandleOverlay
{
public:
    XYOffsetControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~XYOffsetControl() override;

    std::size_t SizeOf() const override { return sizeof(XYOffsetControl); }
    // Adds `centerX`, `centerY`, `offsetX`, `offsetY`.
    void GetState(ScriptVal &state) const override;

    using PreviewControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool RemoveInput(Input *input, const TagList *tags) override;
    void NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    void DrawControls(PreviewInfo *info, const TagList *tags) override;
    DragType ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    uint64 ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags) override;

    // The arrow's tip, in image coordinates.
    OrbPoint Tip() const { return mCenter + mOffset; }

protected:
    void BuildHandles(const PreviewInfo &info, HandleSet &handles) const override;

private:
    static const LinkedInput<XYOffsetControl> Links[];

    void DrawArrow(Graphics::GPainter &p, const PreviewInfo &info) const;

    Input *mCenterInput = nullptr;
    OrbPoint mCenter{0.5, 0.5};
    OrbPoint mOffset;
};

} // namespace Orbane
