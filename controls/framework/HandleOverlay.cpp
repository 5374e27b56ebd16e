#include "framework/HandleOverlay.h"

#include "orbane/AutoParam.h"
#include "orbane/ControlCommands.h"
#include "orbane/GPainter.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/OverlayControl.h"
#include "orbane/PreviewInfo.h"
#include "orbane/ScriptVal.h"

#include <QGuiApplication>

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

// A fade that moves less than this is not worth a repaint.
constexpr float32 kFadeStep = 0.05f;

} // namespace

template <class Base> HandleOverlayOn<Base>::~HandleOverlayOn()
{
    CloseGesture();
}

template <class Base>
void HandleOverlayOn<Base>::ControlUp(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    // A follow drag ends with the release: the overlay stops following.
    if (mFollowCursor && this->mDragType == DRAG_Linked) {
        this->mDragType = DRAG_None;
        this->SetAttrsTagList(TagList{{PCA_FollowCursor, 0}});
    }
    mStartGrab = OrbPoint();
    CloseGesture();
    Base::ControlUp(info, mouse, tags);
    Pick({});
}

template <class Base>
uint64 HandleOverlayOn<Base>::ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags)
{
    if (command == CCMD_HitTest)
        return HitTest(*info, data);
    if (command == CCMD_GetInputAt && this->GetMainInput() && PressHit(*info))
        return uint64(reinterpret_cast<uintptr_t>(this->GetMainInput()));
    return Base::ControlCommand(info, command, data, tags);
}

template <class Base> bool HandleOverlayOn<Base>::HoverBounds(const PreviewInfo &info, OrbRect &bounds) const
{
    if (mFades)
        return false;
    HandleSet handles;
    BuildHandles(info, handles);
    handles.Bounds(info.HandleScale, info.PickTolerance, bounds);
    return true;
}

template <class Base> void HandleOverlayOn<Base>::GetState(ScriptVal &state) const
{
    Base::GetState(state);
    const HandleHit poised = mHandles.PoisedHit();
    state.SetKey(ScriptVal("hover"), ScriptVal(bool(poised)));
    state.SetKey(ScriptVal("hoverPart"), ScriptVal(int64(poised.part)));
    if (mFades) {
        state.SetKey(ScriptVal("fade"), ScriptVal(float64(mFade)));
        state.SetKey(ScriptVal("drawnFade"), ScriptVal(float64(mDrawnFade)));
    }
}

template <class Base> float32 HandleOverlayOn<Base>::FadeAt(float64 distance) noexcept
{
    return float32(std::clamp(1.0 - (distance - 10.0) / 100.0, 0.5, 1.0));
}

template <class Base> HandleHit HandleOverlayOn<Base>::HoverHit(PreviewInfo &info)
{
    BuildHandles(info, mHandles);
    return mHandles.HitTest(info.MouseInViewer(), info.HandleScale, info.PickTolerance, HandleGeometry::Hover);
}

template <class Base> float64 HandleOverlayOn<Base>::FadeDistance(const PreviewInfo &) const
{
    return 0.0;
}

template <class Base> HandleHit HandleOverlayOn<Base>::PressHit(const PreviewInfo &info)
{
    BuildHandles(info, mHandles);
    return mHandles.HitTest(info.MouseInViewer(), info.HandleScale, info.PickTolerance, HandleGeometry::Press);
}

template <class Base> void HandleOverlayOn<Base>::Pick(HandleHit hit)
{
    mHandles.SetPicked(hit);
    UpdateHighlight();
}

template <class Base> void HandleOverlayOn<Base>::UpdateHighlight()
{
    this->mHighlighted = bool(mHandles.PoisedHit()) || bool(mHandles.PickedHit());
}

template <class Base> void HandleOverlayOn<Base>::EnableFade()
{
    mFades = true;
    mFade = mDrawnFade = 0.5f;
}

template <class Base> void HandleOverlayOn<Base>::SettleFade(const PreviewInfo &info)
{
    if (info.Highlight || this->mDragType == DRAG_Handle)
        mFade = mDrawnFade = 1.0f;
}

template <class Base>
Graphics::GColor HandleOverlayOn<Base>::HandleFill(const PreviewInfo &info, uint32 part, int32 item) const
{
    return mHandles.FillOf(info.GetColor(OrbColor()).Faded(mFade), part, item);
}

template <class Base> Graphics::GColor HandleOverlayOn<Base>::HandleShadow(const PreviewInfo &info) const
{
    return info.GetShadow(OrbColor()).Faded(mFade);
}

template <class Base>
void HandleOverlayOn<Base>::BeginHandle(Graphics::GPainter &p, const PreviewInfo &info, OrbPoint at, uint32 part,
                                        int32 item) const
{
    p.Color(HandleFill(info, part, item), HandleShadow(info));
    p.PushMatrix();
    p.Translate(at.x, at.y);
    p.Scale(info.HandleScale, info.HandleScale, 1.0);
}

template <class Base> void HandleOverlayOn<Base>::EndHandle(Graphics::GPainter &p)
{
    p.PopMatrix();
}

template <class Base>
void HandleOverlayOn<Base>::DrawSquareKnob(Graphics::GPainter &p, const PreviewInfo &info, OrbPoint at, uint32 part,
                                           float64 half, bool cross) const
{
    BeginHandle(p, info, at, part);
    p.Begin(Graphics::GP_LineLoop);
    p.Vertex(-half, -half);
    p.Vertex(half, -half);
    p.Vertex(half, half);
    p.Vertex(-half, half);
    p.End();
    if (cross) {
        p.Begin(Graphics::GP_Lines);
        p.Vertex(-2 * half, 0);
        p.Vertex(2 * half, 0);
        p.Vertex(0, -2 * half);
        p.Vertex(0, 2 * half);
        p.End();
    }
    EndHandle(p);
}

template <class Base>
bool HandleOverlayOn<Base>::NudgeCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags,
                                         OrbPoint point, float64 stepY, uint64 &result)
{
    if (command == CCMD_NeedsKey) {
        result = IsArrowKey(data) ? 1 : 0;
    } else if (command == CCMD_KeyDown) {
        const bool arrow = IsArrowKey(data);
        if (arrow) {
            WritePoint(point + NudgeOffset(data, 1.0 / info->ImageWidth, stepY, KeyModifiers()), 0);
        }
        Base::ControlCommand(info, command, data, tags);
        result = arrow ? 1 : 0;
    } else if (command == CCMD_KeyUpAll) {
        // Ends the one undo step of a run of nudges.
        this->ResetUndo(nullptr);
        result = Base::ControlCommand(info, command, data, tags);
    } else {
        return false;
    }
    return true;
}

template <class Base> bool HandleOverlayOn<Base>::IsArrowKey(uint64 key) noexcept
{
    return key == Qt::Key_Left || key == Qt::Key_Up || key == Qt::Key_Right || key == Qt::Key_Down;
}

template <class Base>
OrbPoint HandleOverlayOn<Base>::NudgeOffset(uint64 key, float64 stepX, float64 stepY,
                                            Qt::KeyboardModifiers mods) noexcept
{
    float64 factor = 1.0;
    if (mods & Qt::ShiftModifier)
        factor *= 10.0;
    if (mods & Qt::ControlModifier)
        factor /= 10.0;
    switch (key) {
    case Qt::Key_Left:
        return {-stepX * factor, 0.0};
    case Qt::Key_Right:
        return {stepX * factor, 0.0};
    case Qt::Key_Up:
        return {0.0, stepY * factor};
    case Qt::Key_Down:
        return {0.0, -stepY * factor};
    default:
        return {};
    }
}

template <class Base> Qt::KeyboardModifiers HandleOverlayOn<Base>::KeyModifiers()
{
    return qGuiApp ? QGuiApplication::queryKeyboardModifiers() : Qt::NoModifier;
}

// Claims the mouse only where no overlay above has; the hover may still
// move (off this overlay) and the fade change, each asking for a redraw.
template <class Base> uint64 HandleOverlayOn<Base>::HitTest(PreviewInfo &info, uint64 data)
{
    HandleHit hit;
    if (!(data & 1)) {
        hit = HoverHit(info);
        if (hit)
            data |= 1;
    }
    bool changed = mHandles.SetPoised(hit);
    UpdateHighlight();
    if (mFades)
        changed = UpdateFade(info) || changed;
    return changed ? data | 2 : data;
}

template <class Base> bool HandleOverlayOn<Base>::UpdateFade(const PreviewInfo &info)
{
    if (!info.Highlight && this->mDragType != DRAG_Handle) {
        mFade = FadeAt(FadeDistance(info));
        if (std::fabs(mFade - mDrawnFade) <= kFadeStep)
            return false;
        mDrawnFade = mFade;
        return true;
    }
    const bool changed = mDrawnFade != 1.0f;
    mFade = mDrawnFade = 1.0f;
    return changed;
}

template <class Base> bool HandleOverlayOn<Base>::CopyAttr(Tag tag, void *out)
{
    if (!out || (tag != PCA_GrabOffsetX && tag != PCA_GrabOffsetY))
        return Base::CopyAttr(tag, out);
    *static_cast<float64 *>(out) = tag == PCA_GrabOffsetX ? mGrabOffset.x : mGrabOffset.y;
    // False: the value was supplied.
    return false;
}

template <class Base> void HandleOverlayOn<Base>::OpenGesture(const char *name)
{
    if (mGestureOpen)
        return;
    if (OrbaneDoc *doc = this->GetDoc()) {
        doc->StartUndo(name);
        mGestureOpen = true;
    }
}

template <class Base> void HandleOverlayOn<Base>::CloseGesture()
{
    if (!mGestureOpen)
        return;
    mGestureOpen = false;
    if (OrbaneDoc *doc = this->GetDoc())
        doc->EndUndo(true);
}

template <class Base> bool HandleOverlayOn<Base>::WriteNumber(float64 value, uint32 index)
{
    if (!std::isfinite(value) || index >= this->Inputs().size())
        return false;
    AutoNumber number(value);
    return this->SetInputs(number.get(), this->GetCurrentTime(), index, nullptr);
}

template <class Base> bool HandleOverlayOn<Base>::WritePoint(OrbPoint value, uint32 index)
{
    if (!std::isfinite(value.x) || !std::isfinite(value.y) || index >= this->Inputs().size())
        return false;
    AutoPoint point(value.x, value.y, 0.0);
    return this->SetInputs(point.get(), this->GetCurrentTime(), index, nullptr);
}

template <class Base> bool HandleOverlayOn<Base>::HoldsRole(const int32 *indexes, int32 role) const
{
    for (int32 r = 0; r < role; ++r)
        if (indexes[r] == indexes[role])
            return false;
    return indexes[role] > 0 && indexes[role] < int32(this->Inputs().size());
}

template <class Base> void HandleOverlayOn<Base>::ReadGrabOffset(const TagList &tags)
{
    mGrabOffset.x = tags.GetDouble(PCA_GrabOffsetX, mGrabOffset.x);
    mGrabOffset.y = tags.GetDouble(PCA_GrabOffsetY, mGrabOffset.y);
}

template class HandleOverlayOn<PreviewControl>;
template class HandleOverlayOn<OverlayControl>;

} // namespace Orbane
