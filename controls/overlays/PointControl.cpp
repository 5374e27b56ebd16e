#include "overlays/PointControl.h"

#include "framework/PointTags.h"

#include "orbane/AutoParam.h"
#include "orbane/GPainter.h"
#include "orbane/Input.h"
#include "orbane/Point.h"
#include "orbane/PreviewInfo.h"

namespace Orbane {

const LinkedInput<PointControl> PointControl::Links[] = {
    {PCP_PrevPoint, PCID_PrevPoint, &PointControl::mPrevInput},
};

PointControl::PointControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : HandleOverlay(reg, args, tags)
{
    // A script's creation tags: the previous point and the grab offset.
    PointControl::SetAttrsTagList(nullptr, tags);
}

PointControl::~PointControl()
{
    DetachLinkedInputs(*this, Links);
}

bool PointControl::GetAttrsTagList(TagList &tags) const
{
    WriteLinkedInputIds(*this, Links, tags);
    tags.Set(PCD_SetPrevPointX, mPrevValue.x);
    tags.Set(PCD_SetPrevPointY, mPrevValue.y);
    return true;
}

bool PointControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    const Input *main = GetMainInput();
    const uint32 linked = AttachLinkedInputs(*this, Links, main ? main->GetOperator() : nullptr, tags);
    if (!mPrevInput) {
        mPrevValue.x = tags.GetDouble(PCD_SetPrevPointX, mDrawnPrev.x);
        mPrevValue.y = tags.GetDouble(PCD_SetPrevPointY, mDrawnPrev.y);
    } else if (linked) {
        // The line is drawn to the linked point as it is now, not as it
        // will be after its next change.
        const AutoParameter prev(mPrevInput->GetValue(GetCurrentTime()));
        NotifyChanged(mPrevInput, prev.get(), nullptr);
    }
    ReadGrabOffset(tags);
    UpdateDisplay(nullptr, nullptr);
    return HandleOverlay::SetAttrsTagList(input, tags);
}

bool PointControl::RemoveInput(Input *input, const TagList *tags)
{
    const bool wasPrev = FindLinkedInput(*this, Links, input) != nullptr;
    if (wasPrev)
        DetachFromInput(mPrevInput);
    return HandleOverlay::RemoveInput(input, tags) || wasPrev;
}

void PointControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return;
    bool moved = false;
    if (input && input == mPrevInput)
        moved = Store(mPrevValue, value);
    if (input && input == GetMainInput())
        moved = Store(mValue, value) || moved;
    else if (input != mPrevInput)
        moved = true;
    if (moved)
        HandleOverlay::NotifyChanged(input, value, tags);
}

void PointControl::SetActive(int32 active, const TagList *tags)
{
    HandleOverlay::SetActive(active, tags);
    if (active)
        ActivateOverlaysOf(mPrevInput);
}

void PointControl::DrawControls(PreviewInfo *info, const TagList *tags)
{
    mDrawnPoint = mValue;
    mDrawnPrev = mPrevValue;
    if (info->DrawPass == 3)
        return;
    if (Graphics::GPainter *p = info->GetPainter()) {
        const OrbPoint at = info->TransformOut(mDrawnPoint);
        BeginHandle(*p, *info, at, 1);
        p->Begin(Graphics::GP_LineLoop);
        p->Vertex(-HalfSize, -HalfSize);
        p->Vertex(HalfSize, -HalfSize);
        p->Vertex(HalfSize, HalfSize);
        p->Vertex(-HalfSize, HalfSize);
        p->End();
        EndHandle(*p);
        // A previous point given by tags alone has no handle to join.
        if (mPrevInput) {
            const OrbPoint prev = info->TransformOut(mDrawnPrev);
            p->Begin(Graphics::GP_Lines);
            p->Vertex(at.x, at.y);
            p->Vertex(prev.x, prev.y);
            p->End();
        }
    }
    HandleOverlay::DrawControls(info, tags);
}

DragType PointControl::ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    if (info->HotControl) {
        // Pressed on another overlay: linked when that one edits our
        // previous point.
        if (mPrevInput && info->HotControl->GetMainInput() == mPrevInput)
            mDragType = DRAG_Linked;
    } else {
        const HandleHit hit = PressHit(*info);
        if (hit) {
            mGrabOffset = HandleOffset(*info);
            mDragType = DRAG_Handle;
            Pick(hit);
        }
    }
    return HandleOverlay::ControlDown(info, mouse, tags);
}

void PointControl::ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    HandleOverlay::ControlMove(info, mouse, tags);
    if (mDragType != DRAG_Handle)
        return;
    const OrbPoint to(mGrabOffset.x / info->ViewWidth + info->MouseX, mGrabOffset.y / info->ViewHeight + info->MouseY);
    if (!Moved(to.x, mValue.x) && !Moved(to.y, mValue.y))
        return;
    AutoPoint value(to.x, to.y, 0.0);
    SetInputs(value.get(), GetCurrentTime(), 0, nullptr);
}

uint64 PointControl::ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags)
{
    // One image pixel of the width on both axes, also for non-square images.
    uint64 result = 0;
    if (NudgeCommand(info, command, data, tags, mValue, 1.0 / info->ImageWidth, result))
        return result;
    return HandleOverlay::ControlCommand(info, command, data, tags);
}

void PointControl::BuildHandles(const PreviewInfo &info, HandleSet &handles) const
{
    handles.Clear();
    handles.AddPixelSquare(info.TransformOut(mValue), 1);
}

OrbPoint PointControl::HandleOffset(const PreviewInfo &info) const
{
    return info.TransformOut(mValue) - info.TransformOut(info.MouseX, info.MouseY);
}

// Takes the point's X and Y when either moved beyond the threshold.
bool PointControl::Store(OrbPoint &copy, const Parameter *value)
{
    const auto *point = dynamic_cast<const Point *>(value);
    if (!point || (!Moved(point->X, copy.x) && !Moved(point->Y, copy.y)))
        return false;
    copy = OrbPoint(point->X, point->Y);
    return true;
}

} // namespace Orbane
