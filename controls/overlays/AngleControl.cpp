#include "overlays/AngleControl.h"

#include "framework/AngleTags.h"
#include "overlays/AngleGeometry.h"

#include "orbane/AutoParam.h"
#include "orbane/ControlCommands.h"
#include "orbane/GPainter.h"
#include "orbane/Input.h"
#include "orbane/Number.h"
#include "orbane/Point.h"
#include "orbane/PreviewInfo.h"

#include <algorithm>
#include <cmath>
#include <iterator>
#include <limits>
#include <optional>
#include <utility>

namespace Orbane {

using Geo = AngleGeometry;
using Graphics::GPainter;

namespace {

// The ring is the same for every dial: made at the first draw, freed at
// unload by RegCleanup. A plain pointer, so that no static destructor can
// run before the registration's clean-up reaches it.
std::vector<OrbPoint> *gRing = nullptr;

const std::vector<OrbPoint> &Ring()
{
    if (!gRing)
        gRing = new std::vector<OrbPoint>(Geo::RingLoop());
    return *gRing;
}

bool IsFinite(OrbPoint p)
{
    return std::isfinite(p.x) && std::isfinite(p.y);
}

} // namespace

// The optional Inputs: the centre as a point or as numbers, and the radius.
const LinkedInput<AngleControl> AngleControl::Links[] = {
    {ACP_Center, ACID_Center, &AngleControl::mCenterInput},
    {ACP_CenterX, ACID_CenterX, &AngleControl::mCenterXInput},
    {ACP_CenterY, ACID_CenterY, &AngleControl::mCenterYInput},
    {ACP_CenterZ, ACID_CenterZ, &AngleControl::mCenterZInput},
    {ACP_Radius, ACID_Radius, &AngleControl::mRadiusInput},
};
// The centre Z is linked but never pulled: its value would land in the angle.
constexpr uint32 kCenterZRow = 1u << 3;

AngleControl::AngleControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : HandleOverlay(reg, args, tags)
{
    EnableFade();
    // A script's creation tags: Inputs passed as objects, radius and follow state.
    AngleControl::SetAttrsTagList(nullptr, tags);
}

AngleControl::~AngleControl()
{
    DetachLinkedInputs(*this, Links);
}

bool AngleControl::CopyAttr(Tag tag, void *out)
{
    float64 value = 0.0;
    switch (tag) {
    case ACD_CurrentAngle:
        value = mAngle;
        break;
    case ACD_MinRadius:
        value = mMinRadius;
        break;
    case ACD_RadiusScale:
        value = mRadiusScale;
        break;
    case ACD_FollowX:
        value = mFollow.x;
        break;
    case ACD_FollowY:
        value = mFollow.y;
        break;
    case ACD_FollowAngle:
        value = mFollowAngle;
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

bool AngleControl::GetAttrsTagList(TagList &tags) const
{
    WriteLinkedInputIds(*this, Links, tags);
    tags.Set(ACD_MinRadius, mMinRadius);
    tags.Set(ACD_RadiusScale, mRadiusScale);
    tags.Set(ACD_FollowX, mFollow.x);
    tags.Set(ACD_FollowY, mFollow.y);
    tags.Set(ACD_FollowAngle, mFollowAngle);
    tags.Set(ACD_CurrentAngle, mAngle);
    tags.Set(PCA_FollowCursor, int32(mFollowCursor));
    tags.Set(AC_DialStyle, mDialStyle);
    return true;
}

void AngleControl::GetState(ScriptVal &state) const
{
    HandleOverlay::GetState(state);
    state.SetKey(ScriptVal("centerX"), ScriptVal(mCenter.x));
    state.SetKey(ScriptVal("centerY"), ScriptVal(mCenter.y));
    state.SetKey(ScriptVal("radius"), ScriptVal(mRadius));
    state.SetKey(ScriptVal("followCursor"), ScriptVal(mFollowCursor != 0));
    state.SetKey(ScriptVal("startGrabX"), ScriptVal(mStartGrab.x));
    state.SetKey(ScriptVal("startGrabY"), ScriptVal(mStartGrab.y));
}

bool AngleControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    AttachInputs(tags);
    mMinRadius = tags.GetDouble(ACD_MinRadius, mMinRadius);
    mRadiusScale = tags.GetDouble(ACD_RadiusScale, mRadiusScale);
    mRadius = Geo::Radius(mMinRadius, mRadiusValue, mRadiusScale);
    mFollowCursor = tags.GetInt(PCA_FollowCursor, mFollowCursor) != 0;
    mFollow.x = tags.GetDouble(ACD_FollowX, mFollow.x);
    mFollow.y = tags.GetDouble(ACD_FollowY, mFollow.y);
    mFollowAngle = tags.GetDouble(ACD_FollowAngle, mFollowAngle);
    ReadGrabOffset(tags);
    mDialStyle = tags.GetInt(AC_DialStyle, mDialStyle);
    UpdateDisplay(nullptr, nullptr);
    return HandleOverlay::SetAttrsTagList(input, tags);
}

// A newly linked centre or radius is drawn as it is now, not only after its
// next change.
void AngleControl::AttachInputs(const TagList &tags)
{
    PullLinkedInputs(*this, Links, AttachLinkedInputs(*this, Links, GetOperator(nullptr), tags) & ~kCenterZRow);
}

bool AngleControl::RemoveInput(Input *input, const TagList *tags)
{
    const bool linked = DetachLinkedInput(*this, Links, input);
    return HandleOverlay::RemoveInput(input, tags) || linked;
}

// Copies take finite values only: an Input that holds no number leaves the
// dial where it was, so nothing that is not a number is drawn or written.
void AngleControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return;
    bool moved = false;
    if (input && input == mCenterInput) {
        const auto *point = dynamic_cast<const Point *>(value);
        if (point && IsFinite({point->X, point->Y}) && (Moved(point->X, mCenter.x) || Moved(point->Y, mCenter.y))) {
            mCenter = OrbPoint(point->X, point->Y);
            moved = true;
        }
    } else if (input && input == mCenterXInput) {
        moved = Store(mCenter.x, value);
    } else if (input && input == mCenterYInput) {
        moved = Store(mCenter.y, value);
    } else if (input && input == mRadiusInput) {
        const auto *number = dynamic_cast<const Number *>(value);
        moved = number && StoreRadius(number->Value);
    } else if (!input || IndexOf(input) > 0) {
        moved = true;
    } else {
        // The main Input, and any other that reaches here: the centre Z
        // Input's value lands in the angle, as it always has.
        moved = Store(mAngle, value);
    }
    if (moved)
        HandleOverlay::NotifyChanged(input, value, tags);
}

bool AngleControl::Store(float64 &copy, const Parameter *value)
{
    const auto *number = dynamic_cast<const Number *>(value);
    if (!number || !std::isfinite(number->Value) || !Moved(number->Value, copy))
        return false;
    copy = number->Value;
    return true;
}

bool AngleControl::StoreRadius(float64 value)
{
    if (!std::isfinite(value))
        return false;
    mRadiusValue = value;
    const float64 radius = Geo::Radius(mMinRadius, value, mRadiusScale);
    if (!Geo::Differs(radius, mRadius, Geo::RadiusThreshold))
        return false;
    mRadius = radius;
    return true;
}

void AngleControl::DrawControls(PreviewInfo *info, const TagList *tags)
{
    SettleFade(*info);
    GPainter *p = info->GetPainter();
    if (p && (info->DrawPass == 1 || info->DrawPass == 2)) {
        mDrawnAngle = mAngle;
        mDrawnCenter = mCenter;
        mDrawnRadius = mRadius;
        const OrbPoint at(mDrawnCenter.x + mDisplayOffsetX, mDrawnCenter.y + mDisplayOffsetY);
        DrawDial(*p, *info, info->TransformOut(at));
        // Where the press began: the viewer asks for it with PEF_StartGrab.
        if (mDragType == DRAG_Handle && info->ShowDrag && mStartGrab != OrbPoint())
            DrawDial(*p, *info, mStartGrab);
    }
    HandleOverlay::DrawControls(info, tags);
}

DragType AngleControl::ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    mAngleAtPress = mAngle;
    if (info->HotControl) {
        // Pressed on another overlay: linked when it edits our centre or radius.
        if (IsLinked(info->HotControl->GetMainInput()))
            mDragType = DRAG_Linked;
    } else {
        Grab(*info, OrbPoint(mouse), tags);
        if (mDragType == DRAG_Handle)
            Pick({1});
    }
    return HandleOverlay::ControlDown(info, mouse, tags);
}

// The grab offset, the angle offset and, for a press flagged PEF_StartGrab,
// where it began; a press within the tolerance of what the style grabs (a
// circle, not the square of point handles) starts the drag.
void AngleControl::Grab(const PreviewInfo &info, OrbPoint mouse, const TagList *tags)
{
    const OrbPoint centre = info.TransformOut(DialCentre());
    const OrbPoint arm = Geo::UnitAt(mAngle) * (Geo::RingRadius * info.HandleScale);
    if (tags && (tags->GetLong(PCA_EventFlags, 0) & PEF_StartGrab)) {
        mGrabOffset = centre - mouse + arm;
        mAngleOffset = 0.0;
        if (mStartGrab == OrbPoint())
            mStartGrab = mouse - arm;
    } else if (Geo::DrawsDial(mDialStyle)) {
        mGrabOffset = Geo::RingGrab(mouse, centre, Geo::RingRadius * info.HandleScale);
        const OrbPoint d = info.TransformIn(mouse) - DialCentre();
        mAngleOffset = Geo::PressDirection({info.AspectScaleXIn(d.x), info.AspectScaleYIn(d.y)}) - mAngle;
    } else {
        mGrabOffset = info.TransformOut(ArmEnd(info)) - mouse;
        mAngleOffset = 0.0;
    }
    if (mGrabOffset.Length() <= Geo::PressTolerance(info.PickTolerance, info.HandleScale))
        mDragType = DRAG_Handle;
}

void AngleControl::ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    HandleOverlay::ControlMove(info, mouse, tags);
    const bool following = Follows(*info);
    if (mDragType != DRAG_Handle && !following)
        return;
    const OrbPoint p(mGrabOffset.x / info->ViewWidth + info->MouseX - mDisplayOffsetX,
                     mGrabOffset.y / info->ViewHeight + info->MouseY - mDisplayOffsetY);
    const OrbPoint d = p - (following ? mFollow : mCenter);
    const float64 grabbed = mAngleOffset + mAngle + (following ? mFollowAngle : 0.0);
    const float64 target = Geo::DragDirection({info->AspectScaleXIn(d.x), info->AspectScaleYIn(d.y)});
    if (const std::optional<float64> to = Geo::Dragged(mAngle, target, grabbed))
        Write(*to);
}

// A follow drag turns the angle about the followed point. The viewer names
// no hot overlay while one follows the cursor: the follower is then ours.
bool AngleControl::Follows(const PreviewInfo &info) const
{
    const PreviewControl *hot = info.HotControl ? info.HotControl : this;
    return mDragType == DRAG_Linked && mFollowCursor && dynamic_cast<const AngleControl *>(hot);
}

uint64 AngleControl::ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags)
{
    uint64 result = 0;
    if (KeyCommand(info, command, data, tags, result))
        return result;
    return HandleOverlay::ControlCommand(info, command, data, tags);
}

// Left and Right turn the angle; Up and Down are left to others. A run of
// turns is one undo step: the first write opens it, the release of every
// key closes it.
bool AngleControl::KeyCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags, uint64 &result)
{
    if (command == CCMD_NeedsKey) {
        result = Geo::IsAngleKey(data) ? 1 : 0;
    } else if (command == CCMD_KeyDown) {
        const float64 step = Geo::KeyStep(int(data), KeyModifiers());
        if (step != 0.0 && std::isfinite(mAngle + step))
            Write(mAngle + step);
        HandleOverlay::ControlCommand(info, command, data, tags);
        result = step != 0.0 ? 1 : 0;
    } else if (command == CCMD_KeyUpAll) {
        ResetUndo(nullptr);
        result = HandleOverlay::ControlCommand(info, command, data, tags);
    } else {
        return false;
    }
    return true;
}

bool AngleControl::IsLinked(const Input *input) const
{
    return FindLinkedInput(*this, Links, input) != nullptr;
}

OrbPoint AngleControl::ArmEnd(const PreviewInfo &info) const
{
    return Geo::ArmEnd(DialCentre(), mAngle, mRadius, info.AspectScaleYOut(1.0));
}

// One handle: the ring of dial style 1, the arm's end otherwise, each
// reaching as far as the pick tolerance, at least GrabReach handle pixels.
void AngleControl::BuildHandles(const PreviewInfo &info, HandleSet &handles) const
{
    handles.Clear();
    Orbane::Handle &h = Geo::DrawsDial(mDialStyle)
                            ? handles.AddRing(info.TransformOut(DialCentre()), Geo::RingRadius, 1)
                            : handles.AddDisc(info.TransformOut(ArmEnd(info)), 0.0, 1);
    h.tolerance = Geo::HoverTolerance(info.PickTolerance, info.HandleScale);
}

// The dial fades with the mouse's distance from its ring, whatever its style.
float64 AngleControl::FadeDistance(const PreviewInfo &info) const
{
    const float64 d =
        Geo::RingDistance(info.MouseInViewer(), info.TransformOut(DialCentre()), Geo::RingRadius * info.HandleScale);
    return std::isnan(d) ? std::numeric_limits<float64>::infinity() : d;
}

void AngleControl::Write(float64 angle)
{
    AutoNumber value(angle);
    SetInputs(value.get(), GetCurrentTime(), 0, nullptr);
}

void AngleControl::DrawDial(GPainter &p, const PreviewInfo &info, OrbPoint at) const
{
    if (!Geo::DrawsDial(mDialStyle) || !IsFinite(at))
        return;
    BeginHandle(p, info, at, 1);
    p.Begin(Graphics::GP_LineLoop);
    for (const OrbPoint v : Ring())
        p.Vertex(v.x, v.y);
    p.End();
    p.Begin(Graphics::GP_Lines);
    for (const OrbPoint v : Geo::DialLines(mDialStyle, mDrawnAngle))
        p.Vertex(v.x, v.y);
    p.End();
    EndHandle(p);
}

bool AngleControl::RegCleanup(Registry *reg)
{
    delete std::exchange(gRing, nullptr);
    return HandleOverlay::RegCleanup(reg);
}

} // namespace Orbane
