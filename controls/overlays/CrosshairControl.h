#pragma once

#include "overlays/CrosshairGeometry.h"

#include "orbane/PreviewControl.h"

namespace Orbane {

namespace Graphics {
class GPainter;
} // namespace Graphics

// The handle of tool centres: a crosshair in one of five styles (CHC_Style).
// Style 0 has an X arm and a Y arm that drag along one axis only. The
// crosshair fades with the mouse's distance, can follow the cursor, and can
// hide while it is dragged.
class CrosshairControl : public PreviewControl
{
public:
    // The parts of the crosshair a mouse position is over.
    struct Zone
    {
        bool x = false;
        bool y = false;
        bool Hit() const noexcept { return x || y; }
    };

    CrosshairControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~CrosshairControl() override;

    std::size_t SizeOf() const override { return sizeof(CrosshairControl); }
    bool CopyAttr(Tag tag, void *out) override;
    bool GetAttrsTagList(TagList &tags) const override;

    using PreviewControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    void NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;
    void DrawControls(PreviewInfo *info, const TagList *tags) override;
    DragType ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlUp(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    uint64 ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags) override;

    int32 Style() const { return mStyle; }
    bool FollowsCursor() const { return mFollowCursor != 0; }
    OrbPoint Value() const { return mValue; }
    OrbPoint DrawnPoint() const { return mDrawnPoint; }
    OrbPoint FollowOrig() const { return mFollowOrig; }
    OrbPoint StartGrab() const { return mStartGrab; }
    Zone Dragged() const { return {mDragX != 0, mDragY != 0}; }
    Zone Hovered() const { return {mHoverX != 0, mHoverY != 0}; }
    float32 Fade() const { return mFade; }

    // How far the arms reach from the centre, in handle pixels.
    static constexpr float64 ArmReach = 23.0;
    // The part hit at `offset` (handle minus mouse, viewer units): the
    // centre within `tolerance` on both axes; with `arms`, the Y arm up to
    // `reach` above it and the X arm up to `reach` to its right.
    static Zone HitZone(OrbPoint offset, float64 tolerance, float64 reach, bool arms) noexcept;
    // Opacity at `distance` viewer units from the mouse: full within 10,
    // half from 60 on.
    static float32 FadeAt(float64 distance) noexcept;

private:
    OrbPoint Handle() const { return {mValue.x + mDisplayOffsetX, mValue.y + mDisplayOffsetY}; }
    OrbPoint HandleOffset(const PreviewInfo &info) const;
    void Write(OrbPoint to, const TagList *tags);
    uint64 HitTest(PreviewInfo &info, uint64 data);
    void DrawCrosshair(Graphics::GPainter &p, const PreviewInfo &info, OrbPoint at);

    OrbPoint mValue{0.5, 0.5};
    OrbPoint mDrawnPoint{0.5, 0.5};
    int32 mStyle = 0;
    int32 mFollowCursor = 0;
    int32 mHideWhileDragging = 0;
    OrbPoint mFollow;
    OrbPoint mFollowOrig;
    OrbPoint mGrabOffset;
    OrbPoint mStartGrab;
    uint8 mDragX = 0, mDragY = 0;
    uint8 mHoverX = 0, mHoverY = 0;
    OrbPoint mPressPoint;
    float32 mFade = 0.5f, mDrawnFade = 0.5f;

    CrosshairGeometry mGeometry;
};

} // namespace Orbane
