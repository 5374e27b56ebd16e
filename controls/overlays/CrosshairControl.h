#pragma once

#include "overlays/CrosshairGeometry.h"

#include "framework/HandleOverlay.h"

namespace Orbane {

namespace Graphics {
class GPainter;
} // namespace Graphics

// The handle of tool centres: a crosshair in one of five styles (CHC_Style).
// Style 0 has an X arm and a Y arm that drag along one axis only. The
// crosshair fades with the mouse's distance, can follow the cursor, and can
// hide while it is dragged. Its handles are the centre (both axes) and, in
// style 0, the two arms; a hover reaches a tolerance further along an arm
// than a press does.
class CrosshairControl : public HandleOverlay
{
public:
    // Part bits of the handles: an arm moves its own axis, the centre both.
    enum Part : uint32
    {
        PART_X = 1,
        PART_Y = 2,
        PART_Centre = PART_X | PART_Y,
    };
    // The parts of the crosshair a mouse position is over.
    struct Zone
    {
        bool x = false;
        bool y = false;
        bool Hit() const noexcept { return x || y; }
        static Zone Of(HandleHit hit) noexcept { return {(hit.part & PART_X) != 0, (hit.part & PART_Y) != 0}; }
    };

    CrosshairControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~CrosshairControl() override;

    std::size_t SizeOf() const override { return sizeof(CrosshairControl); }
    bool CopyAttr(Tag tag, void *out) override;
    bool GetAttrsTagList(TagList &tags) const override;
    // Adds `dragPart` (the part being dragged, 0 for none) and `followCursor`.
    void GetState(ScriptVal &state) const override;

    using HandleOverlay::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    void NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;
    void DrawControls(PreviewInfo *info, const TagList *tags) override;
    DragType ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    uint64 ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags) override;

    int32 Style() const { return mStyle; }
    bool FollowsCursor() const { return mFollowCursor != 0; }
    OrbPoint Value() const { return mValue; }
    OrbPoint DrawnPoint() const { return mDrawnPoint; }
    OrbPoint FollowOrig() const { return mFollowOrig; }
    OrbPoint StartGrab() const { return mStartGrab; }
    Zone Dragged() const { return Zone::Of(Handles().PickedHit()); }
    Zone Hovered() const { return Zone::Of(Handles().PoisedHit()); }

    // How far the arms reach from the centre, in handle pixels.
    static constexpr float64 ArmReach = 23.0;

protected:
    // The centre: within the tolerance on both axes. In style 0 the Y arm
    // reaches ArmReach above it and the X arm ArmReach to its right.
    void BuildHandles(const PreviewInfo &info, HandleSet &handles) const override;
    HandleHit HoverHit(PreviewInfo &info) override;
    float64 FadeDistance(const PreviewInfo &info) const override;

private:
    OrbPoint Handle() const { return {mValue.x + mDisplayOffsetX, mValue.y + mDisplayOffsetY}; }
    OrbPoint HandleOffset(const PreviewInfo &info) const;
    void Write(OrbPoint to, const TagList *tags);
    void DrawCrosshair(Graphics::GPainter &p, const PreviewInfo &info, OrbPoint at);

    OrbPoint mValue{0.5, 0.5};
    OrbPoint mDrawnPoint{0.5, 0.5};
    int32 mStyle = 0;
    int32 mHideWhileDragging = 0;
    OrbPoint mFollow;
    OrbPoint mFollowOrig;
    OrbPoint mPressPoint;

    CrosshairGeometry mGeometry;
};

} // namespace Orbane
