#include "overlays/PositionerControl.h"

#include "framework/OverlayValue.h"
#include "framework/PositionerTags.h"
#include "overlays/AngleGeometry.h"

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

constexpr float64 kCenterDisc = 6.0; // handle pixels

} // namespace

const LinkedInput<PositionerControl> PositionerControl::Links[] = {
    {PSP_Width, PSID_Width, &PositionerControl::mWidthInput},
    {PSP_Height, PSID_Height, &PositionerControl::mHeightInput},
    {PSP_Angle, PSID_Angle, &PositionerControl::mAngleInput},
    {PSP_Size, PSID_Size, &PositionerControl::mSizeInput},
};

PositionerControl::PositionerControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : HandleOverlay(reg, args, tags)
{
    PositionerControl::SetAttrsTagList(nullptr, tags);
}

PositionerControl::~PositionerControl()
{
    DetachLinkedInputs(*this, Links);
}

bool PositionerControl::GetAttrsTagList(TagList &tags) const
{
    WriteLinkedInputIds(*this, Links, tags);
    tags.Set(PS_ShowBox, mShowBox);
    tags.Set(PS_SnapToPixels, mSnap);
    tags.Set(PS_Axis, mAxis);
    tags.Set(PSD_Width, mWidth);
    tags.Set(PSD_Height, mHeight);
    tags.Set(PSD_AnchorX, mAnchor.x);
    tags.Set(PSD_AnchorY, mAnchor.y);
    tags.Set(PSD_Angle, mAngle);
    return true;
}

void PositionerControl::GetState(ScriptVal &state) const
{
    HandleOverlay::GetState(state);
    const std::pair<const char *, float64> fields[] = {{"x", mPosition.x},
                                                       {"y", mPosition.y},
                                                       {"width", mWidth * mSize},
                                                       {"height", mHeight * mSize},
                                                       {"angle", mAngle}};
    for (const auto &[key, value] : fields)
        state.SetKey(ScriptVal(key), ScriptVal(value));
}

// Plain tags give what no linked Input gives; a linked Input's value shows
// from the moment it is linked.
bool PositionerControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    const uint32 linked = AttachLinkedInputs(*this, Links, GetOperator(nullptr), tags);
    mShowBox = tags.GetBool(PS_ShowBox, mShowBox);
    mSnap = tags.GetBool(PS_SnapToPixels, mSnap);
    mAxis = tags.GetInt(PS_Axis, mAxis);
    for (auto [tag, field, from] : {std::tuple{PSD_Width, &mWidth, mWidthInput},
                                    {PSD_Height, &mHeight, mHeightInput},
                                    {PSD_Angle, &mAngle, mAngleInput},
                                    {PSD_AnchorX, &mAnchor.x, nullptr},
                                    {PSD_AnchorY, &mAnchor.y, nullptr}}) {
        const float64 to = tags.GetDouble(tag, *field);
        if (!from && std::isfinite(to))
            *field = to;
    }
    PullLinkedInputs(*this, Links, linked);
    UpdateDisplay(nullptr, nullptr);
    return HandleOverlay::SetAttrsTagList(input, tags);
}

bool PositionerControl::RemoveInput(Input *input, const TagList *tags)
{
    const bool linked = DetachLinkedInput(*this, Links, input);
    return HandleOverlay::RemoveInput(input, tags) || linked;
}

void PositionerControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return;
    bool moved = false;
    if (input && input == GetMainInput())
        moved = OV::TakePoint(mPosition, value);
    else if (input && input == mWidthInput)
        moved = OV::TakeNumber(mWidth, value);
    else if (input && input == mHeightInput)
        moved = OV::TakeNumber(mHeight, value);
    else if (input && input == mAngleInput)
        moved = OV::TakeNumber(mAngle, value);
    else if (input && input == mSizeInput)
        moved = OV::TakeNumber(mSize, value);
    else
        moved = true;
    if (moved)
        HandleOverlay::NotifyChanged(input, value, tags);
}

// Lengths in image widths as displayed span SpanX viewer units on either
// axis, so the box turns rigidly on screen.
PositionerControl::Box PositionerControl::BoxIn(const PreviewInfo &info) const
{
    const float64 span = info.Mapping().SpanX();
    const OrbPoint half(std::fabs(mWidth * mSize) * span / 2.0, std::fabs(mHeight * mSize) * span / 2.0);
    const OrbPoint u = AngleGeometry::UnitAt(mAngle);
    const OrbPoint off((1.0 - 2.0 * mAnchor.x) * half.x, (1.0 - 2.0 * mAnchor.y) * half.y);
    const OrbPoint at = info.TransformOut(mPosition);
    return {OrbPoint(at.x + off.x * u.x - off.y * u.y, at.y + off.x * u.y + off.y * u.x), u, half};
}

void PositionerControl::BuildHandles(const PreviewInfo &info, HandleSet &handles) const
{
    handles.Clear();
    const OrbPoint at = info.TransformOut(mPosition);
    if (!OV::OnScreen(at))
        return;
    handles.AddDisc(at, kCenterDisc, PPART_Center, HP_Point);
    const Box box = BoxIn(info);
    if (mShowBox && OV::OnScreen(box.middle) && OV::OnScreen(box.half))
        handles.AddBoxPart(box.middle, box.unitX, box.half, 0.0, {0, 0}, PPART_Box, HP_Body);
}

DragType PositionerControl::ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    if (!info->HotControl)
        if (const HandleHit hit = PressHit(*info)) {
            mDragType = DRAG_Handle;
            mGrabOffset = info->TransformOut(mPosition) - info->MouseInViewer();
            mPressPosition = mPosition;
            Pick(hit);
        }
    return HandleOverlay::ControlDown(info, mouse, tags);
}

// Where a drag to `to` puts the position: held on its line for a one-axis
// positioner, then on the nearest whole image pixel where it snaps.
OrbPoint PositionerControl::Placed(const PreviewInfo &info, OrbPoint to) const
{
    if (mAxis == 1)
        to.y = mPressPosition.y;
    else if (mAxis == 2)
        to.x = mPressPosition.x;
    if (mSnap) {
        to.x = std::round(to.x * info.ImageWidth) / info.ImageWidth;
        to.y = std::round(to.y * info.ImageHeight) / info.ImageHeight;
    }
    return to;
}

void PositionerControl::ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    HandleOverlay::ControlMove(info, mouse, tags);
    if (mDragType != DRAG_Handle)
        return;
    const OrbPoint to = Placed(*info, info->TransformIn(info->MouseInViewer() + mGrabOffset));
    if (!OV::Finite(to) || !(Moved(to.x, mPosition.x) || Moved(to.y, mPosition.y)))
        return;
    OpenGesture("Move Layer");
    WritePoint(to, 0);
}

uint64 PositionerControl::ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags)
{
    uint64 result = 0;
    if (NudgeCommand(info, command, data, tags, mPosition, 1.0 / info->ImageHeight, result))
        return result;
    return HandleOverlay::ControlCommand(info, command, data, tags);
}

void PositionerControl::DrawControls(PreviewInfo *info, const TagList *tags)
{
    GPainter *p = info->GetPainter();
    const OrbPoint at = info->TransformOut(mPosition);
    if (p && info->DrawPass != 3 && OV::OnScreen(at)) {
        p->PushAttrib();
        const Box box = BoxIn(*info);
        if (mShowBox && OV::OnScreen(box.middle) && OV::OnScreen(box.half))
            DrawBox(*p, *info, box);
        BeginHandle(*p, *info, at, PPART_Center);
        p->Begin(Graphics::GP_Lines);
        for (const OrbPoint v : {OrbPoint(-2 * kCenterDisc, 0), OrbPoint(2 * kCenterDisc, 0),
                                 OrbPoint(0, -2 * kCenterDisc), OrbPoint(0, 2 * kCenterDisc)})
            p->Vertex(v.x, v.y);
        p->End();
        EndHandle(*p);
        p->PopAttrib();
    }
    HandleOverlay::DrawControls(info, tags);
}

// The box's outline, highlighted while the box is under the mouse or dragged.
void PositionerControl::DrawBox(GPainter &p, const PreviewInfo &info, const Box &box) const
{
    p.Color(HandleFill(info, PPART_Box), HandleShadow(info));
    const OrbPoint ux = box.unitX * box.half.x, uy = OrbPoint(-box.unitX.y, box.unitX.x) * box.half.y;
    p.Begin(Graphics::GP_LineLoop);
    for (const OrbPoint c : {box.middle - ux - uy, box.middle + ux - uy, box.middle + ux + uy, box.middle - ux + uy})
        p.Vertex(c.x, c.y);
    p.End();
}

} // namespace Orbane
