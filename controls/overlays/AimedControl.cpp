#include "overlays/AimedControl.h"

#include "framework/Overlay3D.h"
#include "framework/TransformTags.h"

#include "orbane/AutoParam.h"
#include "orbane/ControlCommands.h"
#include "orbane/GPainter.h"
#include "orbane/Input.h"
#include "orbane/PreviewInfo.h"

namespace Orbane {

using Graphics::GPainter;

namespace {

// The position knob's size, handle pixels: the transform's centre.
constexpr float64 kPositionKnob = 6.0;

// The transform's own roles name none of a camera's or light's Inputs: its
// frame, ring and knobs stay away.
TagList NoTransformRoles()
{
    return TagList{{TC_AngleInput, -1}, {TC_XSizeInput, -1}, {TC_YSizeInput, -1},
                   {TC_PivotInput, -1}, {TC_ShearInput, -1}, {TC_ShowFrame, 0}};
}

} // namespace

AimedControl::AimedControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : TransformControl(reg, args, tags)
{
    TransformControl::SetAttrsTagList(nullptr, NoTransformRoles());
}

void AimedControl::GetState(ScriptVal &state) const
{
    HandleOverlay::GetState(state);
    const OrbVec3 aim = AimPoint();
    const std::pair<const char *, float64> fields[] = {
        {"posX", mPosition.x}, {"posY", mPosition.y}, {"posZ", mPosition.z},       {"aimX", aim.x},
        {"aimY", aim.y},       {"aimZ", aim.z},       {"dragPart", float64(mPart)}};
    for (const auto &[key, value] : fields)
        state.SetKey(ScriptVal(key), ScriptVal(value));
    PreviewInfo info;
    info.SetMapping(mViewMapping);
    info.SetCamera(mViewCamera);
    HandleSet built;
    BuildHandles(info, built);
    ScriptVal handles = ScriptVal::NewTable();
    for (const Handle &h : built.Handles()) {
        ScriptVal at = ScriptVal::NewTable();
        const OrbPoint image = info.TransformIn(h.at);
        at.SetKey(ScriptVal("ix"), ScriptVal(image.x));
        at.SetKey(ScriptVal("iy"), ScriptVal(image.y));
        handles.SetKey(ScriptVal(int64(h.part)), at);
    }
    state.SetKey(ScriptVal("handles"), handles);
}

bool AimedControl::AddInput(Input *input, const TagList *tags)
{
    return AddInputTaking(input, tags, [this](int32 index, const Parameter *value, bool &moved) {
        moved = Store(index, value) || moved;
    });
}

void AimedControl::ReadInputs()
{
    for (std::size_t i = 0; i < Inputs().size(); ++i) {
        const AutoParameter value(Inputs()[i]->GetValue(GetCurrentTime()));
        Store(int32(i), value.get());
    }
}

bool AimedControl::Store(int32 index, const Parameter *value)
{
    if (index == 0)
        return Overlay3D::TakePoint(mPosition, value);
    return index > 0 && StoreMore(index, value);
}

void AimedControl::SetView(PreviewInfo *info, const TagList *tags)
{
    if (info) {
        mViewMapping = info->Mapping();
        mViewCamera = info->Camera();
    }
    TransformControl::SetView(info, tags);
}

void AimedControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return;
    const int32 index = IndexOf(input);
    if (index < 0 || Store(index, value))
        HandleOverlay::NotifyChanged(input, value, tags);
}

// The position above the aim; nothing where the thing is hidden or its
// point lies behind the viewer's camera.
void AimedControl::BuildHandles(const PreviewInfo &info, HandleSet &handles) const
{
    handles.Clear();
    if (!Shown())
        return;
    OrbPoint at;
    if (Overlay3D::ToViewer(info, info.Camera(), mPosition, at))
        handles.AddDisc(at, kPositionKnob, TPART_Center, HP_Point);
    if (CanAim() && Overlay3D::ToViewer(info, info.Camera(), AimPoint(), at))
        handles.AddBox(at, {-mAimKnob, -mAimKnob}, {mAimKnob, mAimKnob}, APART_Aim, HP_Corner);
}

DragType AimedControl::ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    if (info->HotControl)
        return HandleOverlay::ControlDown(info, mouse, tags);
    const HandleHit hit = PressHit(*info);
    OrbVec3 under;
    if (hit) {
        mGrabbedAt = hit.part == TPART_Center ? mPosition : AimPoint();
        // Taken only where the mouse meets the knob's plane.
        if (Overlay3D::MouseOnViewPlane(*info, info->Camera(), mGrabbedAt, under)) {
            mGrab = mGrabbedAt - under;
            mDragType = DRAG_Handle;
            mPart = hit.part;
            Pick(hit);
        }
    }
    return HandleOverlay::ControlDown(info, mouse, tags);
}

void AimedControl::ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    HandleOverlay::ControlMove(info, mouse, tags);
    OrbVec3 under;
    if (mDragType != DRAG_Handle || !Overlay3D::MouseOnViewPlane(*info, info->Camera(), mGrabbedAt, under))
        return;
    const OrbVec3 to = under + mGrab;
    if (!to.IsFinite())
        return;
    if (mPart == TPART_Center) {
        if (!Overlay3D::Moved(to, mPosition))
            return;
        OpenGesture(MoveName());
        Overlay3D::WritePoint(*this, to, 0);
    } else if (mPart == APART_Aim && Overlay3D::Moved(to, AimPoint())) {
        OpenGesture(AimName());
        WriteAim(to);
    }
}

// Skips the transform's own commands (its nudges are 2D): arrows move the
// position in X and Y, or whatever the kind does with them.
uint64 AimedControl::ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags)
{
    if (command == CCMD_NeedsKey)
        return IsArrowKey(data) ? 1 : 0;
    if (command == CCMD_KeyDown && IsArrowKey(data)) {
        if (Shown() && !KeyAim(*info, data))
            Overlay3D::WritePoint(*this, mPosition + Overlay3D::Nudge(*info, data, KeyModifiers(), false), 0);
        HandleOverlay::ControlCommand(info, command, data, tags);
        return 1;
    }
    if (command == CCMD_KeyUpAll)
        ResetUndo(nullptr);
    return HandleOverlay::ControlCommand(info, command, data, tags);
}

void AimedControl::ControlUp(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    mPart = 0;
    TransformControl::ControlUp(info, mouse, tags);
}

void AimedControl::DrawControls(PreviewInfo *info, const TagList *tags)
{
    GPainter *p = info->GetPainter();
    if (p && info->DrawPass != 3 && Shown()) {
        p->PushAttrib();
        DrawGizmo(*p, *info, info->Camera());
        HandleSet built;
        BuildHandles(*info, built);
        for (const Handle &h : built.Handles())
            DrawSquareKnob(*p, *info, h.at, h.part, h.part == TPART_Center ? kPositionKnob : mAimKnob,
                           h.part == TPART_Center);
        p->PopAttrib();
    }
    HandleOverlay::DrawControls(info, tags);
}

} // namespace Orbane
