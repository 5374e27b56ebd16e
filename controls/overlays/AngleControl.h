#pragma once

#include "framework/HandleOverlay.h"
#include "framework/LinkedInput.h"

namespace Orbane {

namespace Graphics {
class GPainter;
} // namespace Graphics

// Edits a Number Input that holds an angle in degrees by dragging around a
// centre: a dial at the centre (dial style 1, the ring grabs) or the end of
// a radius arm (style 0, nothing drawn). The centre and the radius may come
// from other Inputs. The angle is continuous: a drag across 0 keeps counting
// turns instead of jumping by 360. Left and Right turn it by a degree. Its
// one handle is the ring (or the arm's end); it fades with the mouse's
// distance from the ring.
class AngleControl : public HandleOverlay
{
public:
    AngleControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~AngleControl() override;

    std::size_t SizeOf() const override { return sizeof(AngleControl); }
    bool CopyAttr(Tag tag, void *out) override;
    bool GetAttrsTagList(TagList &tags) const override;
    // Adds where the dial sits and how long its arm is (`centerX`,
    // `centerY`, `radius`), `followCursor`, `startGrabX` and `startGrabY`.
    void GetState(ScriptVal &state) const override;

    using PreviewControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool RemoveInput(Input *input, const TagList *tags) override;
    void NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    void DrawControls(PreviewInfo *info, const TagList *tags) override;
    DragType ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    uint64 ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags) override;

    // Frees the dial's ring, shared by every angle overlay, then the base's.
    static bool RegCleanup(Registry *reg);

protected:
    void BuildHandles(const PreviewInfo &info, HandleSet &handles) const override;
    float64 FadeDistance(const PreviewInfo &info) const override;

private:
    static const LinkedInput<AngleControl> Links[];

    void AttachInputs(const TagList &tags);
    bool IsLinked(const Input *input) const;
    bool StoreRadius(float64 value);
    OrbPoint DialCentre() const { return {mCenter.x + mDisplayOffsetX, mCenter.y + mDisplayOffsetY}; }
    OrbPoint ArmEnd(const PreviewInfo &info) const;
    void Grab(const PreviewInfo &info, OrbPoint mouse, const TagList *tags);
    bool Store(float64 &copy, const Parameter *value);
    bool Follows(const PreviewInfo &info) const;
    void Write(float64 angle);
    bool KeyCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags, uint64 &result);
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
    OrbPoint mFollow;
    float64 mFollowAngle = 0.0;
    float64 mAngleAtPress = 0.0;
    float64 mAngleOffset = 0.0;
    // For a press flagged PEF_StartGrab: the centre of a dial whose arm
    // reaches where the press began (viewer units). The dial is drawn there
    // a second time while the drag lasts; 0, 0 when none.
    int32 mDialStyle = 1;
    // As last drawn.
    float64 mDrawnAngle = 0.0;
    OrbPoint mDrawnCenter{0.5, 0.5};
    float64 mDrawnRadius = 0.1;
};

} // namespace Orbane
