#include "overlays/TransformControl.h"

#include "framework/OverlayValue.h"
#include "framework/TransformTags.h"
#include "overlays/AngleGeometry.h"

#include "orbane/AutoParam.h"
#include "orbane/ControlCommands.h"
#include "orbane/GPainter.h"
#include "orbane/Input.h"
#include "orbane/PreviewInfo.h"
#include "orbane/ScriptVal.h"

#include <cmath>

namespace Orbane {

using Graphics::GPainter;
using OV = OverlayValue;

namespace {

// Handle sizes in handle pixels: the knobs' half side, the centre's disc,
// how far the shear bar stands above the top edge.
constexpr float64 kKnob = 4.0;
constexpr float64 kCenterDisc = 6.0;
constexpr float64 kShearBar = 30.0;

constexpr Tag kRoleTags[TransformControl::TR_Count] = {TC_AngleInput, TC_XSizeInput, TC_YSizeInput, TC_PivotInput,
                                                       TC_ShearInput};

// The side bits of a side or corner (as the rectangle numbers them) and
// the layer point it sits on.
OrbPointI SideOf(int32 code) noexcept
{
    return {(code & 1) ? 1 : (code & 4) ? -1 : 0, (code & 2) ? 1 : (code & 8) ? -1 : 0};
}

OrbPoint LayerPoint(OrbPointI side) noexcept
{
    return {(1.0 + side.x) / 2.0, (1.0 + side.y) / 2.0};
}

constexpr int32 kSideCodes[8] = {1, 2, 4, 8, 3, 6, 12, 9};

} // namespace

TransformControl::TransformControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : HandleOverlay(reg, args, tags)
{
    TransformControl::SetAttrsTagList(nullptr, tags);
}

bool TransformControl::GetAttrsTagList(TagList &tags) const
{
    for (int32 r = 0; r < TR_Count; ++r)
        tags.Set(kRoleTags[r], mRoleIndex[r]);
    tags.Set(TC_KeepAspect, mKeepAspect);
    tags.Set(TC_ShowFrame, mShowFrame);
    tags.Set(TCD_FrameWidth, mFrameWidth);
    tags.Set(TCD_FrameHeight, mFrameHeight);
    tags.Set(TCD_RingRadius, mRingRadius);
    return true;
}

void TransformControl::GetState(ScriptVal &state) const
{
    HandleOverlay::GetState(state);
    const float64 sizeY = HasRole(TR_YSize) ? mShape.size.y : mShape.size.x;
    const std::pair<const char *, float64> fields[] = {{"centerX", mShape.center.x},
                                                       {"centerY", mShape.center.y},
                                                       {"angle", mShape.angle},
                                                       {"sizeX", mShape.size.x},
                                                       {"sizeY", sizeY},
                                                       {"pivotX", mShape.pivot.x},
                                                       {"pivotY", mShape.pivot.y},
                                                       {"shear", mShape.shear},
                                                       {"dragPart", float64(mDragPart)}};
    for (const auto &[key, value] : fields)
        state.SetKey(ScriptVal(key), ScriptVal(value));
}

bool TransformControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    for (int32 r = 0; r < TR_Count; ++r)
        mRoleIndex[r] = tags.GetInt(kRoleTags[r], mRoleIndex[r]);
    mKeepAspect = tags.GetBool(TC_KeepAspect, mKeepAspect);
    mShowFrame = tags.GetBool(TC_ShowFrame, mShowFrame);
    for (auto [tag, field] :
         {std::pair{TCD_FrameWidth, &mFrameWidth}, {TCD_FrameHeight, &mFrameHeight}, {TCD_RingRadius, &mRingRadius}}) {
        const float64 to = tags.GetDouble(tag, *field);
        if (std::isfinite(to))
            *field = to;
    }
    // A role that moved to another Input shows that Input's value.
    ReadInputs();
    UpdateDisplay(nullptr, nullptr);
    return HandleOverlay::SetAttrsTagList(input, tags);
}

bool TransformControl::AddInput(Input *input, const TagList *tags)
{
    return AddInputTaking(input, tags,
                          [this](int32 index, const Parameter *value, bool &moved) { Store(index, value, moved); });
}

void TransformControl::ReadInputs()
{
    bool moved = false;
    for (std::size_t i = 0; i < Inputs().size(); ++i) {
        const AutoParameter value(Inputs()[i]->GetValue(GetCurrentTime()));
        Store(int32(i), value.get(), moved);
    }
}

bool TransformControl::HasRole(Role role) const
{
    return HoldsRole(mRoleIndex, role);
}

// The copy of the value at `index`; without a Y size the X size scales both.
void TransformControl::Store(int32 index, const Parameter *value, bool &moved)
{
    if (index == 0)
        moved = OV::TakePoint(mShape.center, value) || moved;
    if (index <= 0)
        return;
    if (index == mRoleIndex[TR_Angle] && HasRole(TR_Angle))
        moved = OV::TakeNumber(mShape.angle, value) || moved;
    if (index == mRoleIndex[TR_XSize] && HasRole(TR_XSize))
        moved = OV::TakeNumber(mShape.size.x, value) || moved;
    if (index == mRoleIndex[TR_YSize] && HasRole(TR_YSize))
        moved = OV::TakeNumber(mShape.size.y, value) || moved;
    if (index == mRoleIndex[TR_Pivot] && HasRole(TR_Pivot))
        moved = OV::TakePoint(mShape.pivot, value) || moved;
    if (index == mRoleIndex[TR_Shear] && HasRole(TR_Shear))
        moved = OV::TakeNumber(mShape.shear, value) || moved;
}

void TransformControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return;
    bool moved = false;
    const int32 index = IndexOf(input);
    if (index >= 0)
        Store(index, value, moved);
    else
        moved = true;
    if (moved)
        HandleOverlay::NotifyChanged(input, value, tags);
}

TransformFrame TransformControl::FrameIn(const PreviewInfo &info, const TransformShape &shape) const
{
    const float64 yPerX = info.AspectScaleYOut(1.0);
    TransformShape s = shape;
    if (!HasRole(TR_YSize))
        s.size.y = s.size.x;
    s.frame = OrbPoint(mFrameWidth, mFrameHeight > 0.0 ? mFrameHeight : 1.0 / yPerX);
    return TransformFrame(s, yPerX);
}

// The centre above everything, the knobs above the frame's ring; the ring
// lowest, so that a knob that lies on it is still found.
void TransformControl::BuildHandles(const PreviewInfo &info, HandleSet &handles) const
{
    handles.Clear();
    const TransformFrame frame = FrameIn(info, mShape);
    const OrbPoint center = info.TransformOut(mShape.center);
    if (!frame.IsValid() || !OV::OnScreen(center))
        return;
    handles.AddDisc(center, kCenterDisc, TPART_Center, HP_Point);
    if (HasRole(TR_Angle))
        handles.AddRing(center, mRingRadius, TPART_Ring, HP_Body);
    if (HasRole(TR_XSize) || HasRole(TR_YSize))
        for (const int32 code : kSideCodes) {
            const OrbPointI side = SideOf(code);
            const OrbPoint at = info.TransformOut(frame.ToImage(LayerPoint(side)));
            if (OV::OnScreen(at))
                handles.AddBox(at, {-kKnob, -kKnob}, {kKnob, kKnob}, SidePart(code),
                               side.x && side.y ? HP_Corner : HP_Edge);
        }
    if (HasRole(TR_Shear)) {
        const OrbPoint knob = info.TransformOut(frame.ShearKnob(kShearBar * info.HandleScale / info.Mapping().SpanX()));
        if (OV::OnScreen(knob))
            handles.AddBox(knob, {-kKnob, -kKnob}, {kKnob, kKnob}, TPART_Shear, HP_Corner);
    }
}

DragType TransformControl::ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    if (info->HotControl)
        return HandleOverlay::ControlDown(info, mouse, tags);
    const HandleHit hit = PressHit(*info);
    if (hit) {
        mDragType = DRAG_Handle;
        mDragPart = hit.part;
        mAtPress = mShape;
        mMovePivot = hit.part == TPART_Center && HasRole(TR_Pivot) && (KeyModifiers() & Qt::ControlModifier);
        const Handle *h = Handles().Find(hit.part);
        mGrabOffset = h ? h->at - info->MouseInViewer() : OrbPoint();
        const OrbPoint d = info->MouseInViewer() - info->TransformOut(mShape.center);
        mAngleOffset = AngleGeometry::PressDirection(d) - mShape.angle;
        Pick(hit);
    }
    return HandleOverlay::ControlDown(info, mouse, tags);
}

// Where the grabbed handle goes: the mouse, kept as far from it as at the press.
OrbPoint TransformControl::DragTarget(const PreviewInfo &info) const
{
    return info.TransformIn(info.MouseInViewer() + mGrabOffset);
}

void TransformControl::ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    HandleOverlay::ControlMove(info, mouse, tags);
    if (mDragType != DRAG_Handle)
        return;
    if (mDragPart == TPART_Center)
        DragCenter(*info);
    else if (mDragPart == TPART_Ring)
        DragRing(*info);
    else if (mDragPart == TPART_Shear)
        DragShear(*info);
    else
        DragScale(*info);
}

void TransformControl::DragCenter(const PreviewInfo &info)
{
    const OrbPoint to = DragTarget(info);
    if (!OV::Finite(to) || !(Moved(to.x, mShape.center.x) || Moved(to.y, mShape.center.y)))
        return;
    if (!mMovePivot) {
        OpenGesture("Move Transform");
        WritePoint(to, 0);
        return;
    }
    // The layer stays where it is: the pivot becomes the layer's point
    // under the new centre.
    const OrbPoint pivot = FrameIn(info, mAtPress).PivotAt(to);
    if (!OV::Finite(pivot))
        return;
    OpenGesture("Move Pivot");
    WritePoint(to, 0);
    WritePoint(pivot, uint32(mRoleIndex[TR_Pivot]));
}

// Turns like the angle overlay: by the shortest turn each move, so that
// turns accumulate and 0 is crossed without a jump.
void TransformControl::DragRing(const PreviewInfo &info)
{
    const OrbPoint d = info.MouseInViewer() - info.TransformOut(mShape.center);
    if (!OV::Finite(d))
        return;
    const auto angle =
        AngleGeometry::Dragged(mShape.angle, AngleGeometry::DragDirection(d), mAngleOffset + mShape.angle);
    if (!angle)
        return;
    OpenGesture("Rotate Transform");
    WriteRole(TR_Angle, *angle);
}

void TransformControl::DragScale(const PreviewInfo &info)
{
    const Qt::KeyboardModifiers mods = KeyModifiers();
    const bool ySize = HasRole(TR_YSize);
    const bool uniform = mKeepAspect || !ySize || (mods & Qt::ShiftModifier);
    const TransformFrame frame = FrameIn(info, mAtPress);
    const TransformScale s = frame.Scaled(DragTarget(info), SideOf(int32(mDragPart >> TPART_SideShift)), uniform,
                                          mods & Qt::ControlModifier);
    const bool x = Moved(s.size.x, mShape.size.x), y = ySize && Moved(s.size.y, mShape.size.y);
    const bool c = Moved(s.center.x, mShape.center.x) || Moved(s.center.y, mShape.center.y);
    if (!x && !y && !c)
        return;
    OpenGesture("Scale Transform");
    if (x)
        WriteRole(TR_XSize, s.size.x);
    if (y)
        WriteRole(TR_YSize, s.size.y);
    if (c)
        WritePoint(s.center, 0);
}

void TransformControl::DragShear(const PreviewInfo &info)
{
    const float64 shear = FrameIn(info, mAtPress).Sheared(DragTarget(info));
    if (!Moved(shear, mShape.shear))
        return;
    OpenGesture("Shear Transform");
    WriteRole(TR_Shear, shear);
}

void TransformControl::WriteRole(Role role, float64 value)
{
    if (HasRole(role))
        WriteNumber(value, uint32(mRoleIndex[role]));
}

// The arrows move the centre by an image pixel.
uint64 TransformControl::ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags)
{
    uint64 result = 0;
    if (NudgeCommand(info, command, data, tags, mShape.center, 1.0 / info->ImageHeight, result))
        return result;
    return HandleOverlay::ControlCommand(info, command, data, tags);
}

void TransformControl::DrawControls(PreviewInfo *info, const TagList *tags)
{
    GPainter *p = info->GetPainter();
    if (p && info->DrawPass != 3) {
        p->PushAttrib();
        DrawTransform(*p, *info);
        p->PopAttrib();
    }
    HandleOverlay::DrawControls(info, tags);
}

void TransformControl::DrawTransform(GPainter &p, const PreviewInfo &info) const
{
    const TransformFrame frame = FrameIn(info, mShape);
    const OrbPoint center = info.TransformOut(mShape.center);
    if (!frame.IsValid() || !OV::OnScreen(center))
        return;
    if (mShowFrame)
        DrawFrame(p, info, frame);
    if (HasRole(TR_Angle))
        DrawRing(p, info, center);
    HandleSet built;
    BuildHandles(info, built);
    for (const Handle &h : built.Handles())
        if (h.part != TPART_Ring)
            DrawKnob(p, info, h.at, h.part);
    if (HasRole(TR_Shear)) {
        const OrbPoint top = info.TransformOut(frame.ToImage(OrbPoint(0.5, 1.0)));
        const OrbPoint knob = info.TransformOut(frame.ShearKnob(kShearBar * info.HandleScale / info.Mapping().SpanX()));
        if (OV::OnScreen(top) && OV::OnScreen(knob)) {
            p.Color(HandleFill(info, TPART_Shear), HandleShadow(info));
            p.Begin(Graphics::GP_Lines);
            p.Vertex(top.x, top.y);
            p.Vertex(knob.x, knob.y);
            p.End();
        }
    }
}

void TransformControl::DrawFrame(GPainter &p, const PreviewInfo &info, const TransformFrame &frame) const
{
    const OrbPoint corners[4] = {{0, 0}, {1, 0}, {1, 1}, {0, 1}};
    p.Color(info.GetColor(mFrameColor), info.GetShadow(mFrameColor));
    p.Begin(Graphics::GP_LineLoop);
    for (const OrbPoint c : corners) {
        const OrbPoint at = info.TransformOut(frame.ToImage(c));
        if (OV::OnScreen(at))
            p.Vertex(at.x, at.y);
    }
    p.End();
}

// Knobs are squares; the centre is a cross in a small square.
void TransformControl::DrawKnob(GPainter &p, const PreviewInfo &info, OrbPoint at, uint32 part) const
{
    DrawSquareKnob(p, info, at, part, part == TPART_Center ? kCenterDisc : kKnob, part == TPART_Center);
}

// The ring with a tick where the angle points.
void TransformControl::DrawRing(GPainter &p, const PreviewInfo &info, OrbPoint at) const
{
    const float64 k = mRingRadius / AngleGeometry::RingRadius;
    BeginHandle(p, info, at, TPART_Ring);
    p.Begin(Graphics::GP_LineLoop);
    for (const OrbPoint v : AngleGeometry::RingLoop())
        p.Vertex(v.x * k, v.y * k);
    p.End();
    const OrbPoint u = AngleGeometry::UnitAt(mShape.angle);
    p.Begin(Graphics::GP_Lines);
    p.Vertex(u.x * (mRingRadius - 8), u.y * (mRingRadius - 8));
    p.Vertex(u.x * (mRingRadius + 8), u.y * (mRingRadius + 8));
    p.End();
    EndHandle(p);
}

} // namespace Orbane
