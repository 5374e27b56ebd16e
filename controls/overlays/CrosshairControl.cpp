#include "overlays/CrosshairControl.h"

#include "framework/CrosshairTags.h"

#include "orbane/AutoParam.h"
#include "orbane/GPainter.h"
#include "orbane/Input.h"
#include "orbane/Point.h"
#include "orbane/PreviewInfo.h"
#include "orbane/ScriptVal.h"

namespace Orbane {

using Graphics::GPainter;

CrosshairControl::CrosshairControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : HandleOverlay(reg, args, tags)
{
    EnableFade();
    CrosshairControl::SetAttrsTagList(nullptr, tags);
}

CrosshairControl::~CrosshairControl() = default;

bool CrosshairControl::CopyAttr(Tag tag, void *out)
{
    float64 value = 0.0;
    switch (tag) {
    case CHCD_CurrentX:
        value = mDrawnPoint.x;
        break;
    case CHCD_CurrentY:
        value = mDrawnPoint.y;
        break;
    default:
        return HandleOverlay::CopyAttr(tag, out);
    }
    if (!out)
        return true;
    *static_cast<float64 *>(out) = value;
    // False: the value was supplied.
    return false;
}

void CrosshairControl::GetState(ScriptVal &state) const
{
    HandleOverlay::GetState(state);
    state.SetKey(ScriptVal("dragPart"), ScriptVal(int64(Handles().PickedHit().part)));
    state.SetKey(ScriptVal("followCursor"), ScriptVal(mFollowCursor != 0));
}

bool CrosshairControl::GetAttrsTagList(TagList &tags) const
{
    tags.Set(CHC_Style, mStyle);
    tags.Set(CHCD_FollowX, mFollow.x);
    tags.Set(CHCD_FollowY, mFollow.y);
    tags.Set(CHCD_FollowOrigX, mFollowOrig.x);
    tags.Set(CHCD_FollowOrigY, mFollowOrig.y);
    tags.Set(CHCD_CurrentX, mDrawnPoint.x);
    tags.Set(CHCD_CurrentY, mDrawnPoint.y);
    tags.Set(PCA_FollowCursor, mFollowCursor);
    tags.Set(PCA_HideWhileDragging, mHideWhileDragging);
    return true;
}

bool CrosshairControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    mStyle = tags.GetInt(CHC_Style, mStyle);
    mFollowCursor = tags.GetInt(PCA_FollowCursor, mFollowCursor);
    mFollow.x = tags.GetDouble(CHCD_FollowX, mFollow.x);
    mFollow.y = tags.GetDouble(CHCD_FollowY, mFollow.y);
    mFollowOrig.x = tags.GetDouble(CHCD_FollowOrigX, mFollowOrig.x);
    mFollowOrig.y = tags.GetDouble(CHCD_FollowOrigY, mFollowOrig.y);
    ReadGrabOffset(tags);
    mHideWhileDragging = tags.GetInt(PCA_HideWhileDragging, mHideWhileDragging);
    UpdateDisplay(nullptr, nullptr);
    return HandleOverlay::SetAttrsTagList(input, tags);
}

void CrosshairControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return;
    if (input && input == GetMainInput()) {
        const auto *point = dynamic_cast<const Point *>(value);
        if (!point || (!Moved(point->X, mValue.x) && !Moved(point->Y, mValue.y)))
            return;
        mValue = OrbPoint(point->X, point->Y);
    }
    HandleOverlay::NotifyChanged(input, value, tags);
}

bool CrosshairControl::OnDisconnect(Input *input, const TagList *tags)
{
    return HandleOverlay::OnDisconnect(input, tags);
}

void CrosshairControl::DrawControls(PreviewInfo *info, const TagList *tags)
{
    SettleFade(*info);
    mDrawnPoint = mValue;
    GPainter *p = info->GetPainter();
    if (p && (info->DrawPass == 1 || info->DrawPass == 2) && mStyle < 5) {
        const OrbPoint at = info->TransformOut(Handle());
        DrawCrosshair(*p, *info, at);
        if (info->ShowDrag && info->HotControl == this && mStartGrab != OrbPoint())
            DrawCrosshair(*p, *info, at - mStartGrab);
    }
    HandleOverlay::DrawControls(info, tags);
}

DragType CrosshairControl::ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    if (!info->HotControl && mStyle < 5) {
        mGrabOffset = HandleOffset(*info);
        if (tags && (tags->GetLong(PCA_EventFlags, 0) & PEF_StartGrab) && mStartGrab == OrbPoint())
            mStartGrab = mGrabOffset;
        const HandleHit hit = PressHit(*info);
        Pick(hit);
        if (hit) {
            mFollowOrig = mDrawnPoint;
            mDragType = DRAG_Handle;
            mPressPoint = info->TransformOut(Handle());
        }
    }
    return HandleOverlay::ControlDown(info, mouse, tags);
}

void CrosshairControl::ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    HandleOverlay::ControlMove(info, mouse, tags);
    const OrbPoint pointer(info->MouseX - mDisplayOffsetX, info->MouseY - mDisplayOffsetY);
    OrbPoint to = info->TransformIn(info->TransformOut(pointer) + mGrabOffset);
    const bool following = mFollowCursor && mDragType == DRAG_Linked;
    if (following)
        to = pointer - mFollow + mFollowOrig;
    if (!Moved(to.x, mValue.x) && !Moved(to.y, mValue.y))
        return;
    if (mDragType == DRAG_Handle) {
        // An arm moves its own axis only.
        const Zone dragged = Dragged();
        if (!dragged.x)
            to.x = mFollowOrig.x;
        if (!dragged.y)
            to.y = mFollowOrig.y;
        Write(to, tags);
        // What follows the mouse sees it held at its grab offset to the point.
        const OrbPoint held =
            info->TransformIn(info->TransformOut(to.x + mDisplayOffsetX, to.y + mDisplayOffsetY) - mGrabOffset);
        info->MouseX = held.x;
        info->MouseY = held.y;
    } else if (following) {
        Write(to, tags);
    }
}

uint64 CrosshairControl::ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags)
{
    // One image pixel on each axis: the width's on X, the height's on Y.
    uint64 result = 0;
    if (NudgeCommand(info, command, data, tags, mValue, 1.0 / info->ImageHeight, result))
        return result;
    return HandleOverlay::ControlCommand(info, command, data, tags);
}

void CrosshairControl::BuildHandles(const PreviewInfo &info, HandleSet &handles) const
{
    handles.Clear();
    if (mStyle >= 5)
        return;
    const OrbPoint at = info.TransformOut(Handle());
    handles.AddBox(at, {}, {}, PART_Centre, HP_Point);
    if (mStyle != 0)
        return;
    // The arms' far ends take the tolerance only for hover.
    handles.AddBox(at, {}, {0.0, ArmReach}, PART_Y, HP_Edge, HG_Left | HG_Right | HG_Bottom);
    handles.AddBox(at, {}, {ArmReach, 0.0}, PART_X, HP_Edge, HG_Left | HG_Bottom | HG_Top);
}

// Every hover outside a claimed spot also takes the grab offset, as a press
// there would.
HandleHit CrosshairControl::HoverHit(PreviewInfo &info)
{
    if (mStyle < 5)
        mGrabOffset = HandleOffset(info);
    return HandleOverlay::HoverHit(info);
}

float64 CrosshairControl::FadeDistance(const PreviewInfo &info) const
{
    return HandleOffset(info).Length();
}

OrbPoint CrosshairControl::HandleOffset(const PreviewInfo &info) const
{
    return info.TransformOut(Handle()) - info.TransformOut(info.MouseX, info.MouseY);
}

void CrosshairControl::Write(OrbPoint to, const TagList *tags)
{
    TagList valueTags = tags ? *tags : TagList();
    valueTags.Set(PCA_ValueFlags, 0);
    AutoPoint value(to.x, to.y, 0.0);
    SetInputs(value.get(), GetCurrentTime(), 0, &valueTags);
}

void CrosshairControl::DrawCrosshair(GPainter &p, const PreviewInfo &info, OrbPoint at)
{
    if (mDragType == DRAG_Handle && mHideWhileDragging)
        return;
    const CrosshairGeometry::PartFills fills{HandleFill(info, PART_Centre), HandleFill(info, PART_X),
                                             HandleFill(info, PART_Y)};
    mGeometry.Build(mStyle);
    mGeometry.SetColors(fills, info.GetColor(OrbColor()).Faded(Fade()), HandleShadow(info));
    mGeometry.Bind(p);
    p.PushMatrix();
    p.Translate(at.x, at.y);
    p.Scale(info.HandleScale, info.HandleScale, 1.0);
    mGeometry.Draw(p);
    p.PopMatrix();
    const Zone dragged = Dragged();
    if (mDragType == DRAG_Handle && dragged.Hit()) {
        p.PushMatrix();
        p.Translate(mPressPoint.x, mPressPoint.y);
        p.Scale(info.HandleScale, info.HandleScale, 1.0);
        mGeometry.DrawFeedback(p, dragged.x, dragged.y);
        p.PopMatrix();
    }
    CrosshairGeometry::Unbind(p);
}

} // namespace Orbane
