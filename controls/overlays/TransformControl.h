#pragma once

#include "framework/HandleOverlay.h"
#include "overlays/TransformGeometry.h"

namespace Orbane {

namespace Graphics {
class GPainter;
} // namespace Graphics

// The transform handle: a layer's frame over the image with a centre to
// move (Ctrl: move the pivot, the layer staying put), a ring to turn,
// side and corner handles to scale (Shift: both axes alike; Ctrl: about the
// opposite side) and a shear bar above the top edge. Its main Input is the
// centre (a Point); the angle, sizes, pivot and shear are further Inputs,
// which ones the _Input tags say. Each drag is one undo step. The camera
// and light overlays build on it.
class TransformControl : public HandleOverlay
{
public:
    // Which values the overlay edits besides the centre.
    enum Role : int32
    {
        TR_Angle,
        TR_XSize,
        TR_YSize,
        TR_Pivot,
        TR_Shear,
        TR_Count,
    };
    // Part codes: the centre, the ring, the shear bar; a side or corner is
    // 16 times its side bits (1 +X, 2 +Y, 4 -X, 8 -Y; a corner has two).
    enum Part : uint32
    {
        TPART_Center = 1,
        TPART_Ring = 2,
        TPART_Shear = 3,
        TPART_SideShift = 4,
    };

    TransformControl(const Registry *reg, const ScriptVal &args, const TagList &tags);

    std::size_t SizeOf() const override { return sizeof(TransformControl); }
    bool GetAttrsTagList(TagList &tags) const override;
    // Adds the values as drawn (`centerX`, `centerY`, `angle`, `sizeX`,
    // `sizeY`, `pivotX`, `pivotY`, `shear`) and `dragPart`.
    void GetState(ScriptVal &state) const override;

    using PreviewControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    // A bound Input is shown from the moment it is bound.
    bool AddInput(Input *input, const TagList *tags) override;
    void NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    void DrawControls(PreviewInfo *info, const TagList *tags) override;
    DragType ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    void ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags) override;
    uint64 ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags) override;

    const TransformShape &Shape() const { return mShape; }
    uint32 DragPart() const { return mDragPart; }
    // Does an Input hold `role`?
    bool HasRole(Role role) const;
    // The part code of the side or corner with side bits `code`.
    static uint32 SidePart(int32 code) noexcept { return uint32(code) << TPART_SideShift; }

protected:
    void BuildHandles(const PreviewInfo &info, HandleSet &handles) const override;
    // The layer's frame in `info`'s view; derived overlays may place it
    // otherwise.
    virtual TransformFrame FrameIn(const PreviewInfo &info, const TransformShape &shape) const;
    // Draws the frame and the handles; derived overlays add theirs.
    virtual void DrawTransform(Graphics::GPainter &p, const PreviewInfo &info) const;
    // The frame's outline, in the frame colour.
    virtual void DrawFrame(Graphics::GPainter &p, const PreviewInfo &info, const TransformFrame &frame) const;

    // A knob at `at` (viewer units): the centre's cross in a square for
    // TPART_Center, a small square for any other part.
    void DrawKnob(Graphics::GPainter &p, const PreviewInfo &info, OrbPoint at, uint32 part) const;

    // The frame's colour; "no colour" draws it in the overlay colour.
    OrbColor mFrameColor;

private:
    void ReadInputs();
    void Store(int32 index, const Parameter *value, bool &moved);
    OrbPoint DragTarget(const PreviewInfo &info) const;
    void DragCenter(const PreviewInfo &info);
    void DragRing(const PreviewInfo &info);
    void DragScale(const PreviewInfo &info);
    void DragShear(const PreviewInfo &info);
    void WriteRole(Role role, float64 value);
    void DrawRing(Graphics::GPainter &p, const PreviewInfo &info, OrbPoint at) const;

    int32 mRoleIndex[TR_Count] = {1, 2, 3, 4, 5};
    TransformShape mShape;
    bool mKeepAspect = false;
    bool mShowFrame = true;
    float64 mFrameWidth = 1.0, mFrameHeight = 0.0;
    float64 mRingRadius = 70.0;
    uint32 mDragPart = 0;
    bool mMovePivot = false;    // the centre drag moves the pivot
    TransformShape mAtPress;    // the shape when the drag began
    float64 mAngleOffset = 0.0; // degrees from the angle to the grabbed direction
};

} // namespace Orbane
