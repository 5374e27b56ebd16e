#pragma once

#include "overlays/AimedControl.h"

#include <string>
#include <utility>

namespace Orbane {

// A scene camera seen through the viewer's camera: its body, its view's
// pyramid (frustum) out to a far distance, and an aim knob ahead of it (or
// on its target). The position knob moves it ("Move Camera"); the aim knob
// turns it to look at the mouse ("Aim Camera"), writing its tilt and pan,
// or moves its target where it has one. Its turns, lens and target are
// further Inputs, which ones the CC_ tags say.
class CameraControl : public AimedControl
{
public:
    enum Role : int32
    {
        CR_RotX,
        CR_RotY,
        CR_RotZ,
        CR_Focal,
        CR_Aperture,
        CR_Target,
        CR_Count,
    };

    CameraControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~CameraControl() override;

    std::size_t SizeOf() const override { return sizeof(CameraControl); }
    bool GetAttrsTagList(TagList &tags) const override;
    // Adds `rotX`, `rotY`, `rotZ` (as drawn: a target's aim), `focal`,
    // `aperture` and `fov` (degrees across).
    void GetState(ScriptVal &state) const override;

    using PreviewControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool RemoveInput(Input *input, const TagList *tags) override;
    void NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;

    // The camera as the tool's Inputs make it.
    ViewCamera Own() const;
    bool HasRole(Role role) const;

protected:
    OrbVec3 AimPoint() const override;
    bool CanAim() const override;
    void WriteAim(OrbVec3 to) override;
    void DrawGizmo(Graphics::GPainter &p, const PreviewInfo &info, const ViewCamera &view) const override;
    bool Shown() const override { return mVisible; }
    const char *MoveName() const override { return "Move Camera"; }
    const char *AimName() const override { return "Aim Camera"; }
    bool KeyAim(const PreviewInfo &info, uint64 key) override;
    bool StoreMore(int32 index, const Parameter *value) override;

private:
    static const std::pair<Tag, bool CameraControl::*> BoolAttrs[];
    static const std::pair<Tag, float64 CameraControl::*> DoubleAttrs[];
    static const std::pair<Tag, OrbColor CameraControl::*> ColorAttrs[];

    void ReadAttrs(const TagList &tags);
    float64 Value(Role role, float64 set) const { return HasRole(role) ? mInput[role] : set; }
    // The film's corners at `distance` ahead, in world space.
    void FilmCorners(const ViewCamera &own, const PreviewInfo &info, float64 distance, OrbVec3 (&out)[4]) const;
    void DrawFrustum(Graphics::GPainter &p, const PreviewInfo &info, const ViewCamera &view,
                     const ViewCamera &own) const;
    void DrawBody(Graphics::GPainter &p, const PreviewInfo &info, const ViewCamera &view, const ViewCamera &own) const;

    Input *mVisibleInput = nullptr;
    int32 mRoleIndex[CR_Count] = {1, 2, 3, 4, -1, -1};
    float64 mInput[CR_Count] = {0.0, 0.0, 0.0, 50.0, 36.0, 0.0}; // copies of the Number roles
    OrbVec3 mTarget;
    bool mVisible = true;
    // Tags.
    bool mShowFrustum = true, mShowBody = true, mShowTarget = true, mShowNearFar = false, mKeysAim = false;
    int32 mPenStyle = 0;
    OrbColor mColor, mFrustumColor;
    float64 mFocal = 50.0, mAperture = 36.0, mNear = 0.1, mFar = 1.0, mFilmAspect = 0.0, mAimDistance = 1.0;
    float64 mBodySize = 0.1, mLineWidth = 1.0;
    std::string mLabel;
};

} // namespace Orbane
