#pragma once

#include "orbane/PreviewControl.h"

namespace Orbane {

namespace Graphics {
class GPainter;
} // namespace Graphics

// Edits a Number Input that holds an angle in degrees by dragging around a
// centre: a dial at the centre (dial style 1, the ring grabs) or the end of
// a radius arm (style 0, nothing drawn). The centre and the radius may come
// from other Inputs. The angle is continuous: a drag across 0 keeps counting
// turns instead of jumping by 360. Left and Right turn it by a degree.
class AngleControl : public PreviewControl
{
public:
    AngleControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~AngleControl() override;

    std::size_t SizeOf() const override { return sizeof(AngleControl); }
    bool CopyAttr(Tag tag, void *out) override;
    bool GetAttrsTagList(TagList &tags) const override;

    using PreviewControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool RemoveInput(Input *input, const TagList *tags) override;
    void NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    void DrawControls(PreviewInfo *info, const TagList *tags) override;
    DragType ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlUp(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    uint64 ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags) override;

    // What the user sees.
    float64 Angle() const { return mAngle; }
    float64 DrawnAngle() const { return mDrawnAngle; }
    float64 DrawnRadius() const { return mDrawnRadius; }
    OrbPoint Center() const { return mCenter; }
    float64 Radius() const { return mRadius; }
    int32 DialStyle() const { return mDialStyle; }
    float32 Fade() const { return mFade; }
    float32 DrawnFade() const { return mDrawnFade; }
    bool Hovered() const { return mHover; }
    bool FollowsCursor() const { return mFollowCursor != 0; }
    // For a press flagged PEF_StartGrab: the centre of a dial whose arm
    // reaches where the press began (viewer units). The dial is drawn there
    // a second time while the drag lasts; 0, 0 when none.
    OrbPoint StartGrab() const { return mStartGrab; }
    OrbPoint GrabOffset() const { return mGrabOffset; }
    float64 AngleAtPress() const { return mAngleAtPress; }
    Input *CenterInput() const { return mCenterInput; }
    Input *RadiusInput() const { return mRadiusInput; }

    // Frees the dial's ring, shared by every angle overlay, then the base's.
    static bool RegCleanup(Registry *reg);

private:
    void AttachInputs(const TagList &tags);
    void PullLinked(Input *const (&before)[5]);
    bool IsLinked(const Input *input) const;
    bool StoreRadius(float64 value);
    OrbPoint Handle() const { return {mCenter.x + mDisplayOffsetX, mCenter.y + mDisplayOffsetY}; }
    OrbPoint ArmEnd(const PreviewInfo &info) const;
    float64 GrabDistance(const PreviewInfo &info, OrbPoint mouse) const;
    void Grab(const PreviewInfo &info, OrbPoint mouse, const TagList *tags);
    bool Store(float64 &copy, const Parameter *value);
    bool Follows(const PreviewInfo &info) const;
    void Write(float64 angle);
    bool KeyCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags, uint64 &result);
    uint64 HitTest(const PreviewInfo &info, uint64 data);
    void DrawDial(Graphics::GPainter &p, const PreviewInfo &info, OrbPoint at) const;

    Input *mCenterInput = nullptr; // one reference each, watched
    Input *mCenterXInput = nullptr;
    Input *mCenterYInput = nullptr;
    Input *mCenterZInput = nullptr;
    Input *mRadiusInput = nullptr;
    float64 mAngle = 0.0;
    OrbPoint mCenter{0.5, 0.5};
    float64 mMinRadius = 0.0;
    float64 mRadiusScale = 0.5;
    float64 mRadiusValue = 0.1;
    float64 mRadius = 0.1;
    uint8 mFollowCursor = 0;
    OrbPoint mFollow;
    float64 mFollowAngle = 0.0;
    OrbPoint mGrabOffset;
    float64 mAngleAtPress = 0.0;
    float64 mAngleOffset = 0.0;
    OrbPoint mStartGrab;
    int32 mDialStyle = 1;
    float32 mFade = 0.5f, mDrawnFade = 0.5f;
    bool mHover = false;
    // As last drawn.
    float64 mDrawnAngle = 0.0;
    OrbPoint mDrawnCenter{0.5, 0.5};
    float64 mDrawnRadius = 0.1;
};

} // namespace Orbane
