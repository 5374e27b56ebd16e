#include "overlays/XYOffsetControl.h"

#include "framework/OverlayValue.h"
#include "framework/XYOffsetTags.h"

#include "orbane/AutoParam.h"
#include "orbane/GPainter.h"
#include "orbane/Input.h"
#include "orbane/PreviewInfo.h"
#include "orbane/ScriptVal.h"

#include <cmath>

namespace Orbane {

using Graphics::GPainter;
using OV = OverlayValue;

namespace {

// The tip's disc and the arrowhead's barbs, in handle pixels.
constexpr float64 kTipDisc = 5.0;
constexpr float64 kBarb = 10.0;

} // namespace

// The centre is linked by pointer only: a tool names it by its id string,
// which the tool loader turns into the Input itself.
const LinkedInput<XYOffsetControl> XYOffsetControl::Links[] = {
    {XOP_Center, 0, &XYOffsetControl::mCenterInput},
};

XYOffsetControl::XYOffsetControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : HandleOverlay(reg, args, tags)
{
    XYOffsetControl::SetAttrsTagList(nullptr, tags);
}

XYOffsetControl::~XYOffsetControl()
{
    DetachLinkedInputs(*this, Links);
}

void XYOffsetControl::GetState(ScriptVal &state) const
{
    HandleOverlay::GetState(state);
    state.SetKey(ScriptVal("centerX"), ScriptVal(mCenter.x));
    state.SetKey(ScriptVal("centerY"), ScriptVal(mCenter.y));
    state.SetKey(ScriptVal("offsetX"), ScriptVal(mOffset.x));
    state.SetKey(ScriptVal("offsetY"), ScriptVal(mOffset.y));
}

bool XYOffsetControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    PullLinkedInputs(*this, Links, AttachLinkedInputs(*this, Links, GetOperator(nullptr), tags));
    return HandleOverlay::SetAttrsTagList(input, tags);
}

bool XYOffsetControl::RemoveInput(Input *input, const TagList *tags)
{
    const bool linked = DetachLinkedInput(*this, Links, input);
    return HandleOverlay::RemoveInput(input, tags) || linked;
}

void XYOffsetControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return;
    bool moved = true;
    if (input && input == mCenterInput)
        moved = OV::TakePoint(mCenter, value);
    else if (input && input == GetMainInput())
        moved = OV::TakePoint(mOffset, value);
    if (moved)
        HandleOverlay::NotifyChanged(input, value, tags);
}

void XYOffsetControl::BuildHandles(const PreviewInfo &info, HandleSet &handles) const
{
    handles.Clear();
    const OrbPoint tip = info.TransformOut(Tip());
    if (OV::OnScreen(tip))
        handles.AddDisc(tip, kTipDisc, 1);
}

DragType XYOffsetControl::ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    if (info->HotControl) {
        // The centre's own overlay is dragged: the arrow goes with it.
        if (mCenterInput && info->HotControl->GetMainInput() == mCenterInput)
            mDragType = DRAG_Linked;
        return HandleOverlay::ControlDown(info, mouse, tags);
    }
    if (const HandleHit hit = PressHit(*info)) {
        mDragType = DRAG_Handle;
        mGrabOffset = info->TransformOut(Tip()) - info->MouseInViewer();
        Pick(hit);
    }
    return HandleOverlay::ControlDown(info, mouse, tags);
}

void XYOffsetControl::ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    HandleOverlay::ControlMove(info, mouse, tags);
    if (mDragType != DRAG_Handle)
        return;
    const OrbPoint offset = info->TransformIn(info->MouseInViewer() + mGrabOffset) - mCenter;
    if (!OV::Finite(offset) || !(Moved(offset.x, mOffset.x) || Moved(offset.y, mOffset.y)))
        return;
    OpenGesture("Move Offset");
    WritePoint(offset, 0);
}

uint64 XYOffsetControl::ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags)
{
    uint64 result = 0;
    if (NudgeCommand(info, command, data, tags, mOffset, 1.0 / info->ImageHeight, result))
        return result;
    return HandleOverlay::ControlCommand(info, command, data, tags);
}

void XYOffsetControl::DrawControls(PreviewInfo *info, const TagList *tags)
{
    GPainter *p = info->GetPainter();
    if (p && info->DrawPass != 3) {
        p->PushAttrib();
        DrawArrow(*p, *info);
        p->PopAttrib();
    }
    HandleOverlay::DrawControls(info, tags);
}

// The shaft in viewer units, the head and the tip's disc in handle pixels
// turned along the shaft.
void XYOffsetControl::DrawArrow(GPainter &p, const PreviewInfo &info) const
{
    const OrbPoint from = info.TransformOut(mCenter), to = info.TransformOut(Tip());
    if (!OV::OnScreen(from) || !OV::OnScreen(to))
        return;
    p.Color(info.GetColor(OrbColor()), info.GetShadow(OrbColor()));
    p.Begin(Graphics::GP_Lines);
    p.Vertex(from.x, from.y);
    p.Vertex(to.x, to.y);
    p.End();
    const OrbPoint shaft = to - from;
    const float64 length = shaft.Length();
    const OrbPoint u = length > 0.0 ? shaft / length : OrbPoint(1.0, 0.0);
    BeginHandle(p, info, to, 1);
    p.Begin(Graphics::GP_Lines);
    for (const float64 side : {-0.5, 0.5}) {
        p.Vertex(0.0, 0.0);
        p.Vertex(-kBarb * (u.x + side * u.y), -kBarb * (u.y - side * u.x));
    }
    p.End();
    p.Begin(Graphics::GP_LineLoop);
    for (int i = 0; i < 12; ++i)
        p.Vertex(kTipDisc * std::cos(i * M_PI / 6), kTipDisc * std::sin(i * M_PI / 6));
    p.End();
    EndHandle(p);
}

} // namespace Orbane
