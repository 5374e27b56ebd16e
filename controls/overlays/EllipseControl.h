#pragma once

#include "framework/HandleOverlay.h"
#include "framework/LinkedInput.h"

#include <string>
#include <utility>
#include <vector>

namespace Orbane {

namespace Graphics {
class GPainter;
} // namespace Graphics

// An ellipse by its centre (the main Input, a Point), two radii and an
// angle, with an optional soft edge drawn as an inner and an outer
// ellipse. Knobs on the axes resize it (Shift: both radii alike; Ctrl:
// about the opposite knob), a knob beyond the +X axis turns it, one off
// the +Y edge sets the softness, the centre moves it. Which Inputs hold the
// radii, angle and softness the _Input tags say; a drag is one undo step.
class EllipseControl : public HandleOverlay
{
public:
    enum Role : int32
    {
        ER_RadiusX,
        ER_RadiusY,
        ER_Angle,
        ER_Soft,
        ER_Count,
    };
    enum Part : uint32
    {
        EPART_Center = 1,
        EPART_PlusX = 2,
        EPART_MinusX = 3,
        EPART_PlusY = 4,
        EPART_MinusY = 5,
        EPART_Rotate = 6,
        EPART_Soft = 7,
    };
    // The ellipse as drawn: centre (image coordinates), radii and softness
    // (image widths as displayed), angle (degrees).
    struct Shape
    {
        OrbPoint center;
        OrbPoint radius;
        float64 angle = 0.0;
        float64 soft = 0.0;
    };

    EllipseControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~EllipseControl() override;

    std::size_t SizeOf() const override { return sizeof(EllipseControl); }
    bool CopyAttr(Tag tag, void *out) override;
    bool GetAttrsTagList(TagList &tags) const override;
    // Adds the shape as drawn: `centerX`, `centerY`, `radiusX`, `radiusY`,
    // `angle`, `soft`; and `dragPart`.
    void GetState(ScriptVal &state) const override;

    using PreviewControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool AddInput(Input *input, const TagList *tags) override;
    bool RemoveInput(Input *input, const TagList *tags) override;
    void NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    void DrawControls(PreviewInfo *info, const TagList *tags) override;
    DragType ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    uint64 ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags) override;

    Shape Drawn() const;
    bool HasRole(Role role) const;

    // Frees the outline's unit circle, shared by every ellipse, then the base's.
    static bool RegCleanup(Registry *reg);

protected:
    void BuildHandles(const PreviewInfo &info, HandleSet &handles) const override;

private:
    static const LinkedInput<EllipseControl> Links[];
    static const std::pair<Tag, bool EllipseControl::*> BoolAttrs[];
    static const std::pair<Tag, int32 EllipseControl::*> IntAttrs[];
    static const std::pair<Tag, float64 EllipseControl::*> DoubleAttrs[];
    static const std::pair<Tag, OrbColor EllipseControl::*> ColorAttrs[];

    void ReadAttrs(const TagList &tags);
    void Store(int32 index, const Parameter *value, bool &moved);
    bool StoreLinked(const Input *input, const Parameter *value);
    float64 Value(Role role) const { return HasRole(role) ? mInput[role] : mSet[role]; }
    bool Shown() const { return mVisible; }
    // Local (aspect units about the centre, the ellipse upright) to image
    // coordinates, for `shape` in a view of `yPerX`; and back.
    static OrbPoint ToImage(const Shape &shape, OrbPoint local, float64 yPerX);
    static OrbPoint ToLocal(const Shape &shape, OrbPoint image, float64 yPerX);
    float64 SoftFactor() const;
    float64 Reach(const PreviewInfo &info, float64 handlePixels) const;
    OrbPoint Clamped(OrbPoint radius, int axis, bool both) const;

    void DragCenter(const PreviewInfo &info, OrbPoint to);
    void DragAxis(const PreviewInfo &info, OrbPoint to);
    void DragRotate(const PreviewInfo &info);
    void DragSoft(const PreviewInfo &info, OrbPoint to);
    void WriteRadii(OrbPoint radius);
    void WriteRole(Role role, float64 value);
    bool KeyResize(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags, uint64 &result);

    std::vector<OrbPoint> Outline(const Shape &shape, float64 grow, const PreviewInfo &info) const;
    void DrawCurve(Graphics::GPainter &p, const std::vector<OrbPoint> &points, int32 mode) const;
    void DrawLook(Graphics::GPainter &p, const PreviewInfo &info, const Shape &shape) const;
    void DrawKnobs(Graphics::GPainter &p, const PreviewInfo &info, const Shape &shape) const;

    Input *mVisibleInput = nullptr, *mLockInput = nullptr, *mSizeInput = nullptr, *mOffsetInput = nullptr;
    int32 mRoleIndex[ER_Count] = {1, 2, 3, 4};
    float64 mInput[ER_Count] = {0.2, 0.1, 0.0, 0.0}; // copies of the role Inputs
    float64 mSet[ER_Count] = {0.2, 0.1, 0.0, 0.0};   // the Set tags
    OrbPoint mCenter{0.5, 0.5};
    bool mVisible = true, mLocked = false;
    float64 mSizeMul = 1.0;
    OrbPoint mOffset;
    // Tags.
    int32 mSoftMode = 0, mSegments = 64, mPenStyle = 0, mSoftPenStyle = 2;
    bool mKeepAspect = false, mCircle = false, mShowAxes = false, mShowCenter = true, mShowRotate = true;
    bool mShowSoft = true, mFillInside = false, mHideWhileDragging = false, mAboutOpposite = false;
    bool mKeysResize = false;
    OrbColor mColor, mSoftColor, mFillColor;
    float64 mMinRadius = 0.0, mMaxRadius = 0.0, mAngleStep = 0.0, mRotateReach = 24.0;
    float64 mLineWidth = 1.0, mSoftLineWidth = 1.0, mRadiusScale = 1.0, mSoftScale = 1.0;
    float64 mFillOpacity = 0.25, mKnobSize = 4.0, mCenterSize = 6.0, mSoftReach = 12.0;
    float64 mAspectLock = 0.0, mMinSoft = 0.0, mMaxSoft = 0.0, mAngleOffset = 0.0;
    std::string mLabel;
    // The drag.
    uint32 mDragPart = 0;
    Shape mAtPress;
    float64 mTurn = 0.0;      // the angle as turned so far, before snapping
    float64 mGrabAngle = 0.0; // degrees from the angle to the grabbed direction
};

} // namespace Orbane
