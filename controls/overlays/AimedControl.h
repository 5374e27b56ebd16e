#pragma once

#include "overlays/TransformControl.h"

#include "orbane/OrbVec3.h"
#include "orbane/ViewCamera.h"

namespace Orbane {

// The shared part of the camera and light overlays: a thing at a position in
// the viewer's 3D space (the main Input, a Point X, Y, Z) that points at an
// aim. Both are transform controls in the registry; of the transform they
// keep the knobs' look (the centre's cross, the square knob) and the
// hover and undo machinery, and put their handles in 3D, seen through the
// viewer's camera: the position knob moves it on the plane that faces the
// viewer's camera; the aim knob turns it towards the mouse. Arrows move the
// position by an image pixel.
class AimedControl : public TransformControl
{
public:
    // The position is TPART_Center; the aim knob is its own part.
    enum AimPart : uint32
    {
        APART_Aim = 5,
    };

    AimedControl(const Registry *reg, const ScriptVal &args, const TagList &tags);

    std::size_t SizeOf() const override { return sizeof(AimedControl); }
    // Adds `posX`, `posY`, `posZ`, `aimX`, `aimY`, `aimZ` (the aim knob's
    // world point), `dragPart` and `handles` (part -> { ix, iy }).
    void GetState(ScriptVal &state) const override;

    bool AddInput(Input *input, const TagList *tags) override;
    void SetView(PreviewInfo *info, const TagList *tags) override;
    void NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    void DrawControls(PreviewInfo *info, const TagList *tags) override;
    DragType ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlUp(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    uint64 ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags) override;

    OrbVec3 Position() const { return mPosition; }

protected:
    void BuildHandles(const PreviewInfo &info, HandleSet &handles) const override;

    // What each kind says.
    // The world point the aim knob sits on.
    virtual OrbVec3 AimPoint() const = 0;
    // Is there an aim to drag (an Input that takes it)?
    virtual bool CanAim() const = 0;
    // Turns the thing so that it points at `to`.
    virtual void WriteAim(OrbVec3 to) = 0;
    virtual void DrawGizmo(Graphics::GPainter &p, const PreviewInfo &info, const ViewCamera &view) const = 0;
    virtual bool Shown() const { return true; }
    virtual const char *MoveName() const = 0;
    virtual const char *AimName() const = 0;
    // The arrow keys' own use (the camera may turn with them); false: they
    // move the position.
    virtual bool KeyAim(const PreviewInfo &, uint64) { return false; }
    // Stores the value of Input `index` (> 0), as the kind uses it.
    virtual bool StoreMore(int32 index, const Parameter *value) = 0;

    // Reads every Input again (after the roles changed).
    void ReadInputs();
    // The knob's size for the aim, handle pixels.
    float64 mAimKnob = 4.0;

private:
    bool Store(int32 index, const Parameter *value);
    OrbVec3 mPosition;
    ViewMapping mViewMapping; // the viewer's view and camera as last set
    ViewCamera mViewCamera = ViewCamera::Default();
    uint32 mPart = 0;   // the part being dragged
    OrbVec3 mGrab;      // the grabbed knob minus the point under the mouse
    OrbVec3 mGrabbedAt; // the knob's world point at the press
};

} // namespace Orbane
