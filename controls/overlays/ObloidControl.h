#pragma once

#include "framework/HandleOverlay.h"
#include "framework/LinkedInput.h"
#include "overlays/BoxGeometry.h"

#include "orbane/ScriptVal.h"
#include "orbane/ViewCamera.h"

#include <string>
#include <utility>

namespace Orbane {

namespace Graphics {
class GPainter;
} // namespace Graphics

// A box in the viewer's 3D space (class ID "CubeControl"), drawn in
// perspective through the viewer's camera (or a camera Input): its centre
// (the main Input, a Point X, Y, Z) moves it, a knob on each face moves that
// face along its axis (Shift: all sizes alike; Ctrl: the opposite face too).
// Edges hidden behind the box are dashed. Which Inputs hold the sizes and
// turns the _Input tags say; a drag is one undo step.
class ObloidControl : public HandleOverlay
{
public:
    enum Role : int32
    {
        OR_SizeX,
        OR_SizeY,
        OR_SizeZ,
        OR_RotX,
        OR_RotY,
        OR_RotZ,
        OR_Count,
    };
    // The centre is part 1; face f (+X, -X, +Y, -Y, +Z, -Z) is part 2 + f.
    enum Part : uint32
    {
        OPART_Center = 1,
        OPART_Face = 2,
    };

    ObloidControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~ObloidControl() override;

    std::size_t SizeOf() const override { return sizeof(ObloidControl); }
    bool CopyAttr(Tag tag, void *out) override;
    bool GetAttrsTagList(TagList &tags) const override;
    // Adds the box as drawn (`centerX`, `centerY`, `centerZ`, `sizeX`,
    // `sizeY`, `sizeZ`, `rotX`, `rotY`, `rotZ`), `dragPart`, `frontFaces`
    // (how many faces face the camera) and `handles` (part -> { ix, iy },
    // the image coordinates of each handle that can be grabbed).
    void GetState(ScriptVal &state) const override;

    using PreviewControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool AddInput(Input *input, const TagList *tags) override;
    bool RemoveInput(Input *input, const TagList *tags) override;
    // Keeps the view and the camera, for the handles GetState reports.
    void SetView(PreviewInfo *info, const TagList *tags) override;
    void NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    void DrawControls(PreviewInfo *info, const TagList *tags) override;
    DragType ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    uint64 ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags) override;

    Box3 Drawn() const;
    bool HasRole(Role role) const;

protected:
    void BuildHandles(const PreviewInfo &info, HandleSet &handles) const override;

private:
    static const LinkedInput<ObloidControl> Links[];
    static const std::pair<Tag, bool ObloidControl::*> BoolAttrs[];
    static const std::pair<Tag, int32 ObloidControl::*> IntAttrs[];
    static const std::pair<Tag, float64 ObloidControl::*> DoubleAttrs[];
    static const std::pair<Tag, OrbColor ObloidControl::*> ColorAttrs[];

    void ReadAttrs(const TagList &tags);
    void ReadInputs();
    void Store(int32 index, const Parameter *value, bool &moved);
    bool StoreLinked(const Input *input, const Parameter *value);
    float64 Value(Role role) const { return HasRole(role) ? mInput[role] : mSet[role]; }
    // The camera the box is seen through: the camera Input's, else the viewer's.
    ViewCamera CameraOf(const PreviewInfo &info) const;
    float64 SizeFactor() const { return mSizeScale * mSizeMul; }
    bool Grabbable() const { return mVisible && !mLocked; }

    void DragCenter(const PreviewInfo &info);
    void DragFace(const PreviewInfo &info);
    // The centre's drag: where the mouse is on the drag's plane or line.
    bool CenterTarget(const PreviewInfo &info, OrbVec3 &at) const;
    void WriteBox(const Box3 &box);
    void WriteRole(Role role, float64 value);

    void DrawBox(Graphics::GPainter &p, const PreviewInfo &info, const ViewCamera &camera, const Box3 &box) const;
    void DrawFill(Graphics::GPainter &p, const PreviewInfo &info, const ViewCamera &camera, const Box3 &box) const;
    void DrawAxes(Graphics::GPainter &p, const PreviewInfo &info, const ViewCamera &camera, const Box3 &box) const;
    void DrawKnobs(Graphics::GPainter &p, const PreviewInfo &info) const;

    Input *mVisibleInput = nullptr, *mLockInput = nullptr, *mSizeInput = nullptr, *mCameraInput = nullptr;
    int32 mRoleIndex[OR_Count] = {1, 2, 3, 4, 5, 6};
    float64 mInput[OR_Count] = {0.5, 0.5, 0.5, 0.0, 0.0, 0.0}; // copies of the role Inputs
    float64 mSet[OR_Count] = {0.5, 0.5, 0.5, 0.0, 0.0, 0.0};   // the Set tags
    OrbVec3 mCenter;
    bool mVisible = true, mLocked = false;
    float64 mSizeMul = 1.0;
    ScriptVal mCameraTable;   // the camera Input's table, nil for none
    ViewMapping mViewMapping; // the viewer's view and camera as last set
    ViewCamera mViewCamera = ViewCamera::Default();
    // Tags.
    bool mUniform = false, mAboutCenter = false, mCube = false, mShowFaces = true, mShowCenter = true;
    bool mShowAxes = false, mShowHidden = true, mFillFaces = false, mHideWhileDragging = false, mKeysDepth = false;
    int32 mPenStyle = 0, mAxisMove = 0;
    OrbColor mColor, mFillColor;
    float64 mMinSize = 0.0, mMaxSize = 0.0, mSizeScale = 1.0, mLineWidth = 1.0, mFillOpacity = 0.2;
    float64 mKnobSize = 4.0, mCenterSize = 6.0, mSizeStep = 0.0;
    std::string mLabel;
    // The drag.
    uint32 mDragPart = 0;
    Box3 mAtPress;
    OrbVec3 mGrab;        // centre minus the grabbed world point
    float64 mGrabT = 0.0; // where along the dragged line the press was
};

} // namespace Orbane
