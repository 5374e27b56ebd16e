#include "overlays/CrosshairControl.h"

#include "framework/CrosshairTags.h"

#include "orbane/AutoParam.h"
#include "orbane/ControlCommands.h"
#include "orbane/GPainter.h"
#include "orbane/Input.h"
#include "orbane/Point.h"
#include "orbane/PreviewInfo.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

using Graphics::GPainter;

CrosshairControl::CrosshairControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : PreviewControl(reg, args, tags)
{
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
    case PCA_GrabOffsetX:
        value = mGrabOffset.x;
        break;
    case PCA_GrabOffsetY:
        value = mGrabOffset.y;
        break;
    default:
        return PreviewControl::CopyAttr(tag, out);
    }
    if (!out)
        return true;
    *static_cast<float64 *>(out) = value;
    // False: the value was supplied.
    return false;
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
    mGrabOffset.x = tags.GetDouble(PCA_GrabOffsetX, mGrabOffset.x);
    mGrabOffset.y = tags.GetDouble(PCA_GrabOffsetY, mGrabOffset.y);
    mHideWhileDragging = tags.GetInt(PCA_HideWhileDragging, mHideWhileDragging);
    UpdateDisplay(nullptr, nullptr);
    return PreviewControl::SetAttrsTagList(input, tags);
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
    PreviewControl::NotifyChanged(input, value, tags);
}

bool CrosshairControl::OnDisconnect(Input *input, const TagList *tags)
{
    return PreviewControl::OnDisconnect(input, tags);
}

void CrosshairControl::DrawControls(PreviewInfo *info, const TagList *tags)
{
    if (info->Highlight || mDragType == DRAG_Handle)
        mFade = mDrawnFade = 1.0f;
    mDrawnPoint = mValue;
    GPainter *p = info->GetPainter();
    if (p && (info->DrawPass == 1 || info->DrawPass == 2) && mStyle < 5) {
        const OrbPoint at = info->TransformOut(Handle());
        DrawCrosshair(*p, *info, at);
        if (info->ShowDrag && info->HotControl == this && mStartGrab != OrbPoint())
            DrawCrosshair(*p, *info, at - mStartGrab);
    }
    PreviewControl::DrawControls(info, tags);
}

DragType CrosshairControl::ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    if (!info->HotControl && mStyle < 5) {
        mGrabOffset = HandleOffset(*info);
        if (tags && (tags->GetLong(PCA_EventFlags, 0) & PEF_StartGrab) && mStartGrab == OrbPoint())
            mStartGrab = mGrabOffset;
        const Zone zone = HitZone(mGrabOffset, info->PickTolerance, ArmReach * info->HandleScale, mStyle == 0);
        mDragX = zone.x;
        mDragY = zone.y;
        if (zone.Hit()) {
            mFollowOrig = mDrawnPoint;
            mDragType = DRAG_Handle;
            mPressPoint = info->TransformOut(Handle());
        }
    }
    return PreviewControl::ControlDown(info, mouse, tags);
}

void CrosshairControl::ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    PreviewControl::ControlMove(info, mouse, tags);
    const OrbPoint pointer(info->MouseX - mDisplayOffsetX, info->MouseY - mDisplayOffsetY);
    OrbPoint to = info->TransformIn(info->TransformOut(pointer) + mGrabOffset);
    const bool following = mFollowCursor && mDragType == DRAG_Linked;
    if (following)
        to = pointer - mFollow + mFollowOrig;
    if (!Moved(to.x, mValue.x) && !Moved(to.y, mValue.y))
        return;
    if (mDragType == DRAG_Handle) {
        // An arm moves its own axis only.
        if (!mDragX)
            to.x = mFollowOrig.x;
        if (!mDragY)
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

void CrosshairControl::ControlUp(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    if (mFollowCursor && mDragType == DRAG_Linked) {
        mDragType = DRAG_None;
        SetAttrsTagList(TagList{{PCA_FollowCursor, 0}});
    }
    mStartGrab = OrbPoint();
    PreviewControl::ControlUp(info, mouse, tags);
    mDragX = mDragY = 0;
}

uint64 CrosshairControl::ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags)
{
    uint64 result = 0;
    if (NudgeCommand(info, command, data, tags, mValue, 1.0 / info->ImageHeight, result))
        return result;
    if (command == CCMD_GetInputAt) {
        const Zone zone = HitZone(HandleOffset(*info), info->PickTolerance, ArmReach * info->HandleScale, mStyle == 0);
        if (GetMainInput() && mStyle < 5 && zone.Hit())
            return uint64(reinterpret_cast<uintptr_t>(GetMainInput()));
    } else if (command == CCMD_HitTest) {
        return HitTest(*info, data);
    }
    return PreviewControl::ControlCommand(info, command, data, tags);
}

CrosshairControl::Zone CrosshairControl::HitZone(OrbPoint d, float64 t, float64 reach, bool arms) noexcept
{
    const bool inX = std::fabs(d.x) < t, inY = std::fabs(d.y) < t;
    if (inX && inY)
        return {true, true};
    if (arms && inX && -reach < d.y && d.y < t)
        return {false, true};
    if (arms && inY && -reach < d.x && d.x < t)
        return {true, false};
    return {};
}

float32 CrosshairControl::FadeAt(float64 distance) noexcept
{
    return float32(std::clamp(1.0 - (distance - 10.0) / 100.0, 0.5, 1.0));
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

// One image pixel on each axis: the width's on X, the height's on Y.
uint64 CrosshairControl::HitTest(PreviewInfo &info, uint64 data)
{
    const uint8 oldX = mHoverX, oldY = mHoverY;
    mHoverX = mHoverY = 0;
    if (!(data & 1) && mStyle < 5) {
        mGrabOffset = HandleOffset(info);
        const float64 reach = ArmReach * info.HandleScale + info.PickTolerance;
        const Zone zone = HitZone(mGrabOffset, info.PickTolerance, reach, mStyle == 0);
        mHoverX = zone.x;
        mHoverY = zone.y;
        if (zone.Hit())
            data |= 1;
    }
    if (!info.Highlight && mDragType != DRAG_Handle) {
        mFade = FadeAt(HandleOffset(info).Length());
        if (std::fabs(mFade - mDrawnFade) > 0.05f) {
            mDrawnFade = mFade;
            data |= 2;
        }
    } else {
        if (mDrawnFade != 1.0f)
            data |= 2;
        mFade = mDrawnFade = 1.0f;
    }
    if (mHoverX != oldX || mHoverY != oldY)
        data |= 2;
    return data;
}

void CrosshairControl::DrawCrosshair(GPainter &p, const PreviewInfo &info, OrbPoint at)
{
    if (mDragType == DRAG_Handle && mHideWhileDragging)
        return;
    const bool dragging = mDragType == DRAG_Handle;
    CrosshairGeometry::Hot hot;
    hot.centre = (mHoverX && mHoverY) || (dragging && mDragX && mDragY);
    hot.xArm = (mHoverX && !mHoverY) || (dragging && mDragX && !mDragY);
    hot.yArm = (mHoverY && !mHoverX) || (dragging && mDragY && !mDragX);
    mGeometry.Build(mStyle);
    mGeometry.SetColors(info.GetColor(OrbColor()).Faded(mFade), info.GetShadow(OrbColor()).Faded(mFade), hot);
    mGeometry.Bind(p);
    p.PushMatrix();
    p.Translate(at.x, at.y);
    p.Scale(info.HandleScale, info.HandleScale, 1.0);
    mGeometry.Draw(p);
    p.PopMatrix();
    if (dragging && (mDragX || mDragY)) {
        p.PushMatrix();
        p.Translate(mPressPoint.x, mPressPoint.y);
        p.Scale(info.HandleScale, info.HandleScale, 1.0);
        mGeometry.DrawFeedback(p, mDragX, mDragY);
        p.PopMatrix();
    }
    CrosshairGeometry::Unbind(p);
}

} // namespace Orbane
