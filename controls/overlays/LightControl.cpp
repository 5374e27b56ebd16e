#include "overlays/LightControl.h"

#include "framework/CameraTags.h"
#include "framework/Overlay3D.h"
#include "framework/OverlayValue.h"
#include "overlays/RectangleControl.h"

#include "orbane/GPainter.h"
#include "orbane/PreviewInfo.h"
#include "orbane/ScriptVal.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

using Graphics::GPainter;

namespace {

constexpr int32 kTargetIndex = 1, kConeIndex = 2;
// Sizes of the drawing in world units: the star's rays, the rays' spread.
constexpr float64 kStar = 0.06, kSpread = 0.04;
constexpr int32 kConeLines = 8;
// The spot's cone is kept inside a half turn so it stays a cone.
constexpr float64 kMaxCone = 170.0;

} // namespace

LightControl::LightControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : AimedControl(reg, args, tags)
{
    LightControl::SetAttrsTagList(nullptr, tags);
}

bool LightControl::GetAttrsTagList(TagList &tags) const
{
    tags.Set(LC_LightType, mType);
    return true;
}

void LightControl::GetState(ScriptVal &state) const
{
    AimedControl::GetState(state);
    state.SetKey(ScriptVal("lightType"), ScriptVal(mType));
    state.SetKey(ScriptVal("cone"), ScriptVal(mCone));
}

bool LightControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    const int32 type = tags.GetInt(LC_LightType, mType);
    if (type >= LT_Directional && type <= LT_Spot)
        mType = type;
    UpdateDisplay(nullptr, nullptr);
    return HandleOverlay::SetAttrsTagList(input, tags);
}

bool LightControl::StoreMore(int32 index, const Parameter *value)
{
    if (index == kTargetIndex) {
        const bool moved = Overlay3D::TakePoint(mTarget, value) || !mHasTarget;
        mHasTarget = mHasTarget || Overlay3D::ReadPoint(value, mTarget);
        return moved;
    }
    float64 cone = mCone;
    if (index == kConeIndex && OverlayValue::ReadNumber(value, cone))
        return OverlayValue::Take(mCone, std::clamp(cone, 0.0, kMaxCone));
    return false;
}

OrbVec3 LightControl::AimPoint() const
{
    return mHasTarget ? mTarget : Position() + OrbVec3(0.0, 0.0, -0.5);
}

bool LightControl::CanAim() const
{
    return mType != LT_Point && mHasTarget;
}

void LightControl::WriteAim(OrbVec3 to)
{
    Overlay3D::WritePoint(*this, to, kTargetIndex);
}

void LightControl::Across(OrbVec3 direction, OrbVec3 &u, OrbVec3 &v) const
{
    const OrbVec3 d = direction.Normalized();
    const OrbVec3 helper = std::fabs(d.y) < 0.9 ? OrbVec3(0.0, 1.0, 0.0) : OrbVec3(1.0, 0.0, 0.0);
    u = d.Cross(helper).Normalized();
    v = d.Cross(u).Normalized();
}

void LightControl::DrawGizmo(GPainter &p, const PreviewInfo &info, const ViewCamera &view) const
{
    if (!Position().IsFinite())
        return;
    RectangleControl::ApplyPen(p, 0, 1.0);
    p.Color(info.GetColor(OrbColor()), info.GetShadow(OrbColor()));
    p.Begin(Graphics::GP_Lines);
    DrawStar(p, info, view);
    if (mType == LT_Directional)
        DrawRays(p, info, view);
    else if (mType == LT_Spot)
        DrawCone(p, info, view);
    p.End();
}

// Six short rays about the position, along the world's axes.
void LightControl::DrawStar(GPainter &p, const PreviewInfo &info, const ViewCamera &view) const
{
    const OrbVec3 at = Position();
    const float64 r = mType == LT_Point ? kStar : kStar / 2.0;
    for (const OrbVec3 d : {OrbVec3(1, 0, 0), OrbVec3(0, 1, 0), OrbVec3(0, 0, 1)})
        Overlay3D::Segment(p, info, view, at - d * r, at + d * r);
}

// Parallel rays towards the aim: the middle one to it, four around.
void LightControl::DrawRays(GPainter &p, const PreviewInfo &info, const ViewCamera &view) const
{
    const OrbVec3 from = Position(), to = AimPoint();
    OrbVec3 u, v;
    Across(to - from, u, v);
    Overlay3D::Segment(p, info, view, from, to);
    for (const OrbVec3 off : {u, u * -1.0, v, v * -1.0})
        Overlay3D::Segment(p, info, view, from + off * kSpread, to + off * kSpread);
}

// Lines from the light to a ring about the aim, the cone's angle across.
void LightControl::DrawCone(GPainter &p, const PreviewInfo &info, const ViewCamera &view) const
{
    const OrbVec3 from = Position(), to = AimPoint();
    const float64 length = (to - from).Length();
    const float64 radius = length * std::tan(mCone * M_PI / 360.0);
    OrbVec3 u, v;
    Across(to - from, u, v);
    OrbVec3 ring[kConeLines];
    for (int32 i = 0; i < kConeLines; ++i) {
        const float64 a = 2.0 * M_PI * i / kConeLines;
        ring[i] = to + (u * std::cos(a) + v * std::sin(a)) * radius;
    }
    for (int32 i = 0; i < kConeLines; ++i) {
        Overlay3D::Segment(p, info, view, from, ring[i]);
        Overlay3D::Segment(p, info, view, ring[i], ring[(i + 1) % kConeLines]);
    }
}

} // namespace Orbane
