#include "overlays/CameraControl.h"

#include "framework/CameraTags.h"
#include "framework/LinkedInput.h"
#include "framework/Overlay3D.h"
#include "framework/OverlayValue.h"
#include "overlays/BoxGeometry.h"
#include "overlays/RectangleControl.h"

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

constexpr Tag kRoleTags[CameraControl::CR_Count] = {CC_RotXInput,  CC_RotYInput,     CC_RotZInput,
                                                    CC_FocalInput, CC_ApertureInput, CC_TargetInput};
// The body's shape as shares of its length; the up triangle above it.
constexpr float64 kBodyWide = 0.6, kBodyHigh = 0.45;
// A near plane drawn closer than this would divide by nothing.
constexpr float64 kLeastNear = 1e-4;

// `to` moved by whole turns to lie nearest `near`, so an aim drag never
// jumps by 360 degrees.
float64 NearestTurn(float64 to, float64 near)
{
    return to + 360.0 * std::round((near - to) / 360.0);
}

} // namespace

const std::pair<Tag, bool CameraControl::*> CameraControl::BoolAttrs[] = {
    {CC_ShowFrustum, &CameraControl::mShowFrustum}, {CC_ShowBody, &CameraControl::mShowBody},
    {CC_ShowTarget, &CameraControl::mShowTarget},   {CC_ShowNearFar, &CameraControl::mShowNearFar},
    {CC_KeysAim, &CameraControl::mKeysAim},
};
const std::pair<Tag, float64 CameraControl::*> CameraControl::DoubleAttrs[] = {
    {CCD_Focal, &CameraControl::mFocal},
    {CCD_Aperture, &CameraControl::mAperture},
    {CCD_Near, &CameraControl::mNear},
    {CCD_Far, &CameraControl::mFar},
    {CCD_FilmAspect, &CameraControl::mFilmAspect},
    {CCD_AimDistance, &CameraControl::mAimDistance},
    {CCD_BodySize, &CameraControl::mBodySize},
    {CCD_LineWidth, &CameraControl::mLineWidth},
    {CCD_KnobSize, &CameraControl::mAimKnob},
};
const std::pair<Tag, OrbColor CameraControl::*> CameraControl::ColorAttrs[] = {
    {CC_Color, &CameraControl::mColor},
    {CC_FrustumColor, &CameraControl::mFrustumColor},
};

CameraControl::CameraControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : AimedControl(reg, args, tags)
{
    CameraControl::SetAttrsTagList(nullptr, tags);
}

CameraControl::~CameraControl()
{
    DetachFromInput(mVisibleInput);
}

bool CameraControl::GetAttrsTagList(TagList &tags) const
{
    for (int32 r = 0; r < CR_Count; ++r)
        tags.Set(kRoleTags[r], mRoleIndex[r]);
    for (const auto &[tag, field] : BoolAttrs)
        tags.Set(tag, this->*field);
    tags.Set(CC_PenStyle, mPenStyle);
    for (const auto &[tag, field] : DoubleAttrs)
        tags.Set(tag, this->*field);
    for (const auto &[tag, field] : ColorAttrs)
        tags.Set(tag, int64((this->*field).Packed()));
    tags.Set(CCS_Label, mLabel.c_str());
    if (mVisibleInput)
        tags.Set(CCID_Visible, mVisibleInput->GetID());
    return true;
}

void CameraControl::GetState(ScriptVal &state) const
{
    AimedControl::GetState(state);
    const ViewCamera own = Own();
    const std::pair<const char *, float64> fields[] = {{"rotX", own.rotation.x},   {"rotY", own.rotation.y},
                                                       {"rotZ", own.rotation.z},   {"focal", own.focal},
                                                       {"aperture", own.aperture}, {"fov", own.FieldOfView()}};
    for (const auto &[key, value] : fields)
        state.SetKey(ScriptVal(key), ScriptVal(value));
}

bool CameraControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    const Input *was = mVisibleInput;
    AttachToInput(mVisibleInput, GetOperator(nullptr), tags, CCP_Visible, CCID_Visible, ATTACH_Watch, ATTACH_Watch);
    ReadAttrs(tags);
    if (mVisibleInput && mVisibleInput != was) {
        const AutoParameter value(mVisibleInput->GetValue(GetCurrentTime()));
        NotifyChanged(mVisibleInput, value.get(), nullptr);
    }
    ReadInputs();
    UpdateDisplay(nullptr, nullptr);
    return HandleOverlay::SetAttrsTagList(input, tags);
}

// Every tag keeps the field as it is where it is absent; numbers that are
// not finite are refused.
void CameraControl::ReadAttrs(const TagList &tags)
{
    for (int32 r = 0; r < CR_Count; ++r)
        mRoleIndex[r] = tags.GetInt(kRoleTags[r], mRoleIndex[r]);
    for (const auto &[tag, field] : BoolAttrs)
        this->*field = tags.GetBool(tag, this->*field);
    mPenStyle = tags.GetInt(CC_PenStyle, mPenStyle);
    for (const auto &[tag, field] : DoubleAttrs) {
        const float64 to = tags.GetDouble(tag, this->*field);
        if (std::isfinite(to))
            this->*field = to;
    }
    for (const auto &[tag, field] : ColorAttrs)
        this->*field = OrbColor(uint32(tags.GetLong(tag, int64((this->*field).Packed()))));
    if (const char *label = tags.GetString(CCS_Label))
        mLabel = label;
}

bool CameraControl::RemoveInput(Input *input, const TagList *tags)
{
    const bool linked = input && input == mVisibleInput;
    if (linked)
        DetachFromInput(mVisibleInput);
    return AimedControl::RemoveInput(input, tags) || linked;
}

void CameraControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (value && input && input == mVisibleInput) {
        if (OV::TakeFlag(mVisible, value))
            HandleOverlay::NotifyChanged(input, value, tags);
        return;
    }
    AimedControl::NotifyChanged(input, value, tags);
}

bool CameraControl::HasRole(Role role) const
{
    return HoldsRole(mRoleIndex, role);
}

bool CameraControl::StoreMore(int32 index, const Parameter *value)
{
    bool moved = false;
    for (int32 r = 0; r < CR_Count; ++r)
        if (index == mRoleIndex[r] && HasRole(Role(r)))
            moved = (r == CR_Target ? Overlay3D::TakePoint(mTarget, value) : OV::TakeNumber(mInput[r], value)) || moved;
    return moved;
}

ViewCamera CameraControl::Own() const
{
    ViewCamera c;
    c.position = Position();
    const float64 roll = Value(CR_RotZ, 0.0);
    c.rotation = HasRole(CR_Target) ? ViewCamera::AimAt(c.position, mTarget, roll)
                                    : OrbVec3(Value(CR_RotX, 0.0), Value(CR_RotY, 0.0), roll);
    c.focal = Value(CR_Focal, mFocal);
    c.aperture = Value(CR_Aperture, mAperture);
    c.nearPlane = std::max(mNear, kLeastNear);
    return c;
}

OrbVec3 CameraControl::AimPoint() const
{
    if (HasRole(CR_Target))
        return mTarget;
    const ViewCamera own = Own();
    return own.position + own.Forward() * mAimDistance;
}

bool CameraControl::CanAim() const
{
    return mShowTarget && (HasRole(CR_Target) || HasRole(CR_RotX) || HasRole(CR_RotY));
}

// A target moves to the mouse; otherwise the tilt and pan turn so that the
// camera looks at it, the roll kept.
void CameraControl::WriteAim(OrbVec3 to)
{
    if (HasRole(CR_Target)) {
        Overlay3D::WritePoint(*this, to, uint32(mRoleIndex[CR_Target]));
        return;
    }
    const OrbVec3 turn = ViewCamera::AimAt(Position(), to, Value(CR_RotZ, 0.0));
    const float64 x = NearestTurn(turn.x, mInput[CR_RotX]), y = NearestTurn(turn.y, mInput[CR_RotY]);
    if (HasRole(CR_RotX) && Moved(x, mInput[CR_RotX]))
        WriteNumber(x, uint32(mRoleIndex[CR_RotX]));
    if (HasRole(CR_RotY) && Moved(y, mInput[CR_RotY]))
        WriteNumber(y, uint32(mRoleIndex[CR_RotY]));
}

// With CC_KeysAim, Left and Right pan by a degree, Up and Down tilt (Shift
// ten, Ctrl a tenth), one undo step while keys are held.
bool CameraControl::KeyAim(const PreviewInfo &, uint64 key)
{
    if (!mKeysAim || HasRole(CR_Target))
        return false;
    const OrbPoint step = NudgeOffset(key, 1.0, 1.0, KeyModifiers());
    if (HasRole(CR_RotY) && step.x != 0.0)
        WriteNumber(mInput[CR_RotY] - step.x, uint32(mRoleIndex[CR_RotY]));
    if (HasRole(CR_RotX) && step.y != 0.0)
        WriteNumber(mInput[CR_RotX] + step.y, uint32(mRoleIndex[CR_RotX]));
    return true;
}

void CameraControl::FilmCorners(const ViewCamera &own, const PreviewInfo &info, float64 distance,
                                OrbVec3 (&out)[4]) const
{
    const float64 w = distance * own.aperture / (2.0 * own.focal);
    const float64 aspect = mFilmAspect > 0.0 ? mFilmAspect : info.AspectScaleYIn(1.0);
    const float64 h = w * aspect;
    const OrbVec3 local[4] = {{-w, -h, -distance}, {w, -h, -distance}, {w, h, -distance}, {-w, h, -distance}};
    for (int32 i = 0; i < 4; ++i)
        out[i] = own.ToWorld(local[i]);
}

void CameraControl::DrawGizmo(GPainter &p, const PreviewInfo &info, const ViewCamera &view) const
{
    const ViewCamera own = Own();
    if (!own.IsValid())
        return;
    RectangleControl::ApplyPen(p, 0, mLineWidth);
    if (mShowBody)
        DrawBody(p, info, view, own);
    if (mShowFrustum)
        DrawFrustum(p, info, view, own);
    if (CanAim()) {
        p.Color(info.GetColor(mColor), info.GetShadow(mColor));
        p.PushAttrib();
        RectangleControl::ApplyPen(p, 2, mLineWidth);
        p.Begin(Graphics::GP_Lines);
        Overlay3D::Segment(p, info, view, own.position, AimPoint());
        p.End();
        p.PopAttrib();
    }
    OrbPoint at;
    if (!mLabel.empty() && Overlay3D::ToViewer(info, view, own.position, at))
        p.Text(at.x + 10.0, at.y + 10.0, mLabel.c_str());
}

// Lines from the lens to the far film's corners, the far frame, and the
// near frame where asked.
void CameraControl::DrawFrustum(GPainter &p, const PreviewInfo &info, const ViewCamera &view,
                                const ViewCamera &own) const
{
    OrbVec3 far[4], near[4];
    FilmCorners(own, info, mFar, far);
    FilmCorners(own, info, own.nearPlane, near);
    p.PushAttrib();
    RectangleControl::ApplyPen(p, mPenStyle, mLineWidth);
    p.Color(info.GetColor(mFrustumColor), info.GetShadow(mFrustumColor));
    p.Begin(Graphics::GP_Lines);
    for (int32 i = 0; i < 4; ++i) {
        Overlay3D::Segment(p, info, view, own.position, far[i]);
        Overlay3D::Segment(p, info, view, far[i], far[(i + 1) % 4]);
        if (mShowNearFar)
            Overlay3D::Segment(p, info, view, near[i], near[(i + 1) % 4]);
    }
    p.End();
    p.PopAttrib();
}

// A box behind the lens, turned as the camera is, with a triangle on top
// that shows which way is up.
void CameraControl::DrawBody(GPainter &p, const PreviewInfo &info, const ViewCamera &view, const ViewCamera &own) const
{
    const float64 b = std::fabs(mBodySize);
    Box3 body;
    body.center = own.ToWorld({0.0, 0.0, b / 2.0});
    body.size = OrbVec3(kBodyWide * b, kBodyHigh * b, b);
    body.rotation = own.rotation;
    const auto corners = BoxGeometry::Corners(body);
    const OrbVec3 up[3] = {own.ToWorld({-0.2 * b, kBodyHigh * b / 2, 0.0}),
                           own.ToWorld({0.2 * b, kBodyHigh * b / 2, 0.0}), own.ToWorld({0.0, kBodyHigh * b, 0.0})};
    p.Color(info.GetColor(mColor), info.GetShadow(mColor));
    p.Begin(Graphics::GP_Lines);
    for (const auto &edge : BoxGeometry::Edges())
        Overlay3D::Segment(p, info, view, corners[std::size_t(edge[0])], corners[std::size_t(edge[1])]);
    for (int32 i = 0; i < 3; ++i)
        Overlay3D::Segment(p, info, view, up[i], up[(i + 1) % 3]);
    p.End();
}

} // namespace Orbane
