#include "overlays/EllipseControl.h"

#include "framework/EllipseTags.h"
#include "framework/OverlayValue.h"
#include "overlays/AngleGeometry.h"
#include "overlays/RectangleControl.h"

#include "orbane/AutoParam.h"
#include "orbane/ControlCommands.h"
#include "orbane/GPainter.h"
#include "orbane/Input.h"
#include "orbane/PreviewInfo.h"
#include "orbane/ScriptVal.h"

#include <algorithm>
#include <cmath>
#include <iterator>
#include <utility>

namespace Orbane {

using Graphics::GColor;
using Graphics::GPainter;
using OV = OverlayValue;

namespace {

constexpr int32 kMaxSegments = 1024;
constexpr Tag kRoleTags[EllipseControl::ER_Count] = {EC_RadiusXInput, EC_RadiusYInput, EC_AngleInput, EC_SoftInput};
constexpr Tag kSetTags[EllipseControl::ER_Count] = {ECD_SetRadiusX, ECD_SetRadiusY, ECD_SetAngle, ECD_SetSoft};

// The unit circle the outlines are drawn from, shared by every ellipse and
// made again only when a different number of pieces is asked for; freed at
// unload by RegCleanup.
std::vector<OrbPoint> *gCircle = nullptr;

const std::vector<OrbPoint> &UnitCircle(int32 segments)
{
    segments = std::clamp(segments, 8, kMaxSegments);
    if (!gCircle)
        gCircle = new std::vector<OrbPoint>;
    if (int32(gCircle->size()) != segments) {
        gCircle->clear();
        for (int32 i = 0; i < segments; ++i)
            gCircle->emplace_back(std::cos(2 * M_PI * i / segments), std::sin(2 * M_PI * i / segments));
    }
    return *gCircle;
}

} // namespace

const LinkedInput<EllipseControl> EllipseControl::Links[] = {
    {ECP_Visible, ECID_Visible, &EllipseControl::mVisibleInput},
    {ECP_Lock, ECID_Lock, &EllipseControl::mLockInput},
    {ECP_Size, ECID_Size, &EllipseControl::mSizeInput},
    {ECP_Offset, ECID_Offset, &EllipseControl::mOffsetInput},
};

// The plain attributes, read and reported alike by these tables.
const std::pair<Tag, bool EllipseControl::*> EllipseControl::BoolAttrs[] = {
    {EC_KeepAspect, &EllipseControl::mKeepAspect},       {EC_Circle, &EllipseControl::mCircle},
    {EC_ShowAxes, &EllipseControl::mShowAxes},           {EC_ShowCenter, &EllipseControl::mShowCenter},
    {EC_ShowRotate, &EllipseControl::mShowRotate},       {EC_ShowSoft, &EllipseControl::mShowSoft},
    {EC_FillInside, &EllipseControl::mFillInside},       {EC_HideWhileDragging, &EllipseControl::mHideWhileDragging},
    {EC_AboutOpposite, &EllipseControl::mAboutOpposite}, {EC_KeysResize, &EllipseControl::mKeysResize},
};
const std::pair<Tag, int32 EllipseControl::*> EllipseControl::IntAttrs[] = {
    {EC_SoftMode, &EllipseControl::mSoftMode},
    {EC_Segments, &EllipseControl::mSegments},
    {EC_PenStyle, &EllipseControl::mPenStyle},
    {EC_SoftPenStyle, &EllipseControl::mSoftPenStyle},
};
const std::pair<Tag, float64 EllipseControl::*> EllipseControl::DoubleAttrs[] = {
    {ECD_MinRadius, &EllipseControl::mMinRadius},     {ECD_MaxRadius, &EllipseControl::mMaxRadius},
    {ECD_AngleStep, &EllipseControl::mAngleStep},     {ECD_RotateReach, &EllipseControl::mRotateReach},
    {ECD_LineWidth, &EllipseControl::mLineWidth},     {ECD_SoftLineWidth, &EllipseControl::mSoftLineWidth},
    {ECD_RadiusScale, &EllipseControl::mRadiusScale}, {ECD_SoftScale, &EllipseControl::mSoftScale},
    {ECD_FillOpacity, &EllipseControl::mFillOpacity}, {ECD_KnobSize, &EllipseControl::mKnobSize},
    {ECD_CenterSize, &EllipseControl::mCenterSize},   {ECD_SoftReach, &EllipseControl::mSoftReach},
    {ECD_AspectLock, &EllipseControl::mAspectLock},   {ECD_MinSoft, &EllipseControl::mMinSoft},
    {ECD_MaxSoft, &EllipseControl::mMaxSoft},         {ECD_AngleOffset, &EllipseControl::mAngleOffset},
};
const std::pair<Tag, OrbColor EllipseControl::*> EllipseControl::ColorAttrs[] = {
    {EC_Color, &EllipseControl::mColor},
    {EC_SoftColor, &EllipseControl::mSoftColor},
    {EC_FillColor, &EllipseControl::mFillColor},
};

EllipseControl::EllipseControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : HandleOverlay(reg, args, tags)
{
    EllipseControl::SetAttrsTagList(nullptr, tags);
}

EllipseControl::~EllipseControl()
{
    DetachLinkedInputs(*this, Links);
}

bool EllipseControl::CopyAttr(Tag tag, void *out)
{
    const Shape s = Drawn();
    const float64 *value = tag == ECD_CurrentRadiusX   ? &s.radius.x
                           : tag == ECD_CurrentRadiusY ? &s.radius.y
                           : tag == ECD_CurrentAngle   ? &s.angle
                                                       : nullptr;
    if (!value)
        return HandleOverlay::CopyAttr(tag, out);
    if (out)
        *static_cast<float64 *>(out) = *value;
    // False: the value was supplied.
    return !out;
}

bool EllipseControl::GetAttrsTagList(TagList &tags) const
{
    WriteLinkedInputIds(*this, Links, tags);
    for (int32 r = 0; r < ER_Count; ++r) {
        tags.Set(kRoleTags[r], mRoleIndex[r]);
        tags.Set(kSetTags[r], mSet[r]);
    }
    for (const auto &[tag, field] : BoolAttrs)
        tags.Set(tag, this->*field);
    for (const auto &[tag, field] : IntAttrs)
        tags.Set(tag, this->*field);
    for (const auto &[tag, field] : DoubleAttrs)
        tags.Set(tag, this->*field);
    for (const auto &[tag, field] : ColorAttrs)
        tags.Set(tag, int64((this->*field).Packed()));
    const Shape s = Drawn();
    tags.Set(ECD_CurrentRadiusX, s.radius.x);
    tags.Set(ECD_CurrentRadiusY, s.radius.y);
    tags.Set(ECD_CurrentAngle, s.angle);
    tags.Set(ECS_Label, mLabel.c_str());
    return true;
}

void EllipseControl::GetState(ScriptVal &state) const
{
    HandleOverlay::GetState(state);
    const Shape s = Drawn();
    const std::pair<const char *, float64> fields[] = {
        {"centerX", s.center.x}, {"centerY", s.center.y}, {"radiusX", s.radius.x},         {"radiusY", s.radius.y},
        {"angle", s.angle},      {"soft", s.soft},        {"dragPart", float64(mDragPart)}};
    for (const auto &[key, value] : fields)
        state.SetKey(ScriptVal(key), ScriptVal(value));
}

bool EllipseControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    const uint32 linked = AttachLinkedInputs(*this, Links, GetOperator(nullptr), tags);
    ReadAttrs(tags);
    PullLinkedInputs(*this, Links, linked);
    // A role that moved to another Input shows that Input's value.
    bool moved = false;
    for (std::size_t i = 0; i < Inputs().size(); ++i) {
        const AutoParameter value(Inputs()[i]->GetValue(GetCurrentTime()));
        Store(int32(i), value.get(), moved);
    }
    UpdateDisplay(nullptr, nullptr);
    return HandleOverlay::SetAttrsTagList(input, tags);
}

// Every tag keeps the field as it is where it is absent; numbers that are
// not finite are refused.
void EllipseControl::ReadAttrs(const TagList &tags)
{
    for (int32 r = 0; r < ER_Count; ++r) {
        mRoleIndex[r] = tags.GetInt(kRoleTags[r], mRoleIndex[r]);
        const float64 set = tags.GetDouble(kSetTags[r], mSet[r]);
        if (std::isfinite(set))
            mSet[r] = set;
    }
    for (const auto &[tag, field] : BoolAttrs)
        this->*field = tags.GetBool(tag, this->*field);
    for (const auto &[tag, field] : IntAttrs)
        this->*field = tags.GetInt(tag, this->*field);
    for (const auto &[tag, field] : DoubleAttrs) {
        const float64 to = tags.GetDouble(tag, this->*field);
        if (std::isfinite(to))
            this->*field = to;
    }
    for (const auto &[tag, field] : ColorAttrs)
        this->*field = OrbColor(uint32(tags.GetLong(tag, int64((this->*field).Packed()))));
    if (const char *label = tags.GetString(ECS_Label))
        mLabel = label;
}

bool EllipseControl::AddInput(Input *input, const TagList *tags)
{
    return AddInputTaking(input, tags,
                          [this](int32 index, const Parameter *value, bool &moved) { Store(index, value, moved); });
}

bool EllipseControl::RemoveInput(Input *input, const TagList *tags)
{
    const bool linked = DetachLinkedInput(*this, Links, input);
    return HandleOverlay::RemoveInput(input, tags) || linked;
}

bool EllipseControl::HasRole(Role role) const
{
    return HoldsRole(mRoleIndex, role);
}

void EllipseControl::Store(int32 index, const Parameter *value, bool &moved)
{
    if (index == 0)
        moved = OV::TakePoint(mCenter, value) || moved;
    for (int32 r = 0; index > 0 && r < ER_Count; ++r)
        if (index == mRoleIndex[r] && HasRole(Role(r)))
            moved = OV::TakeNumber(mInput[r], value) || moved;
}

bool EllipseControl::StoreLinked(const Input *input, const Parameter *value)
{
    bool moved = false;
    if (input == mVisibleInput)
        moved = OV::TakeFlag(mVisible, value) || moved;
    if (input == mLockInput)
        moved = OV::TakeFlag(mLocked, value) || moved;
    if (input == mSizeInput)
        moved = OV::TakeNumber(mSizeMul, value) || moved;
    if (input == mOffsetInput)
        moved = OV::TakePoint(mOffset, value) || moved;
    return moved;
}

void EllipseControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return;
    bool moved = false;
    if (FindLinkedInput(*this, Links, input))
        moved = StoreLinked(input, value);
    else if (IndexOf(input) >= 0)
        Store(IndexOf(input), value, moved);
    else
        moved = true;
    if (moved)
        HandleOverlay::NotifyChanged(input, value, tags);
}

EllipseControl::Shape EllipseControl::Drawn() const
{
    Shape s;
    s.center = mCenter + mOffset;
    const float64 k = mRadiusScale * mSizeMul;
    s.radius.x = Value(ER_RadiusX) * k;
    s.radius.y = mCircle ? s.radius.x : Value(ER_RadiusY) * k;
    s.angle = Value(ER_Angle) + mAngleOffset;
    s.soft = Value(ER_Soft) * mSoftScale;
    return s;
}

OrbPoint EllipseControl::ToImage(const Shape &shape, OrbPoint local, float64 yPerX)
{
    const OrbPoint u = AngleGeometry::UnitAt(shape.angle);
    return {shape.center.x + local.x * u.x - local.y * u.y, shape.center.y + (local.x * u.y + local.y * u.x) * yPerX};
}

OrbPoint EllipseControl::ToLocal(const Shape &shape, OrbPoint image, float64 yPerX)
{
    const OrbPoint u = AngleGeometry::UnitAt(shape.angle);
    const OrbPoint d(image.x - shape.center.x, (image.y - shape.center.y) / yPerX);
    return {d.x * u.x + d.y * u.y, -d.x * u.y + d.y * u.x};
}

// How the soft knob moves with the softness: by half of it for an edge
// across the outline, back inwards for one inside it, fully outwards.
float64 EllipseControl::SoftFactor() const
{
    return mSoftMode == 1 ? -1.0 : mSoftMode == 2 ? 1.0 : 0.5;
}

// `handlePixels` in aspect-corrected image units.
float64 EllipseControl::Reach(const PreviewInfo &info, float64 handlePixels) const
{
    return handlePixels * info.HandleScale / info.Mapping().SpanX();
}

// The knobs where the ellipse is drawn: the centre above all, the axis
// knobs, the rotation and soft knobs. A locked or hidden ellipse has none.
void EllipseControl::BuildHandles(const PreviewInfo &info, HandleSet &handles) const
{
    handles.Clear();
    const Shape s = Drawn();
    const float64 yPerX = info.AspectScaleYOut(1.0);
    if (!mVisible || mLocked || !OV::OnScreen(info.TransformOut(s.center)) || !OV::Finite(s.radius))
        return;
    const OrbPoint knob(mKnobSize, mKnobSize);
    auto add = [&](OrbPoint local, uint32 part, int32 priority) {
        const OrbPoint at = info.TransformOut(ToImage(s, local, yPerX));
        if (OV::OnScreen(at))
            handles.AddBox(at, knob * -1.0, knob, part, priority);
    };
    if (mShowCenter)
        handles.AddDisc(info.TransformOut(s.center), mCenterSize, EPART_Center, HP_Point);
    const bool yKnobs = mCircle ? HasRole(ER_RadiusX) : HasRole(ER_RadiusY);
    if (HasRole(ER_RadiusX)) {
        add({s.radius.x, 0.0}, EPART_PlusX, HP_Edge);
        add({-s.radius.x, 0.0}, EPART_MinusX, HP_Edge);
    }
    if (yKnobs) {
        add({0.0, s.radius.y}, EPART_PlusY, HP_Edge);
        add({0.0, -s.radius.y}, EPART_MinusY, HP_Edge);
    }
    if (HasRole(ER_Angle) && mShowRotate)
        add({std::fabs(s.radius.x) + Reach(info, mRotateReach), 0.0}, EPART_Rotate, HP_Corner);
    if (HasRole(ER_Soft) && mShowSoft)
        add({0.0, std::fabs(s.radius.y) + s.soft * SoftFactor() + Reach(info, mSoftReach)}, EPART_Soft, HP_Corner);
}

DragType EllipseControl::ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    if (!info->HotControl)
        if (const HandleHit hit = PressHit(*info)) {
            mDragType = DRAG_Handle;
            mDragPart = hit.part;
            mAtPress = Drawn();
            const Handle *h = Handles().Find(hit.part);
            mGrabOffset = h ? h->at - info->MouseInViewer() : OrbPoint();
            mTurn = mAtPress.angle;
            mGrabAngle =
                AngleGeometry::PressDirection(info->MouseInViewer() - info->TransformOut(mAtPress.center)) - mTurn;
            Pick(hit);
        }
    return HandleOverlay::ControlDown(info, mouse, tags);
}

void EllipseControl::ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    HandleOverlay::ControlMove(info, mouse, tags);
    if (mDragType != DRAG_Handle)
        return;
    const OrbPoint to = info->TransformIn(info->MouseInViewer() + mGrabOffset);
    if (!OV::Finite(to))
        return;
    if (mDragPart == EPART_Center)
        DragCenter(*info, to);
    else if (mDragPart == EPART_Rotate)
        DragRotate(*info);
    else if (mDragPart == EPART_Soft)
        DragSoft(*info, to);
    else
        DragAxis(*info, to);
}

void EllipseControl::DragCenter(const PreviewInfo &, OrbPoint to)
{
    const OrbPoint center = to - mOffset;
    if (!Moved(center.x, mCenter.x) && !Moved(center.y, mCenter.y))
        return;
    OpenGesture("Move Ellipse");
    WritePoint(center, 0);
}

// The dragged radius (`axis`; both with `both`) within the limits, 0 for
// a limit meaning none above; the other follows the aspect lock if any.
OrbPoint EllipseControl::Clamped(OrbPoint radius, int axis, bool both) const
{
    auto clamp = [this](float64 r) {
        r = std::max(r, mMinRadius);
        return mMaxRadius > 0.0 ? std::min(r, mMaxRadius) : r;
    };
    if (mAspectLock > 0.0)
        return axis == 0 ? OrbPoint(clamp(radius.x), clamp(radius.x) / mAspectLock)
                         : OrbPoint(clamp(radius.y) * mAspectLock, clamp(radius.y));
    return {axis == 0 || both ? clamp(radius.x) : radius.x, axis == 1 || both ? clamp(radius.y) : radius.y};
}

// The grabbed knob follows the mouse along its axis; about the opposite
// knob the centre moves by half of what the radius changed.
void EllipseControl::DragAxis(const PreviewInfo &info, OrbPoint to)
{
    const float64 yPerX = info.AspectScaleYOut(1.0);
    const int axis = mDragPart == EPART_PlusX || mDragPart == EPART_MinusX ? 0 : 1;
    const float64 sign = mDragPart == EPART_PlusX || mDragPart == EPART_PlusY ? 1.0 : -1.0;
    const OrbPoint local = ToLocal(mAtPress, to, yPerX);
    const Qt::KeyboardModifiers mods = KeyModifiers();
    const bool opposite = mAboutOpposite || (mods & Qt::ControlModifier);
    const float64 was = axis == 0 ? mAtPress.radius.x : mAtPress.radius.y;
    const float64 along = sign * (axis == 0 ? local.x : local.y);
    float64 now = opposite ? (along + was) / 2.0 : std::fabs(along);
    OrbPoint radius = mAtPress.radius;
    const bool uniform = (mKeepAspect || (mods & Qt::ShiftModifier)) && was != 0.0;
    if (uniform)
        radius = radius * (std::fabs(now) / was);
    else if (mCircle)
        radius.x = radius.y = std::fabs(now);
    else if (axis == 0)
        radius.x = std::fabs(now);
    else
        radius.y = std::fabs(now);
    radius = Clamped(radius, axis, uniform || mCircle);
    if (!OV::Finite(radius))
        return;
    OpenGesture("Resize Ellipse");
    WriteRadii(radius);
    if (opposite) {
        now = axis == 0 ? radius.x : radius.y;
        const OrbPoint shift = axis == 0 ? OrbPoint(sign * (now - was), 0.0) : OrbPoint(0.0, sign * (now - was));
        const OrbPoint center = ToImage(mAtPress, shift, yPerX) - mOffset;
        if (Moved(center.x, mCenter.x) || Moved(center.y, mCenter.y))
            WritePoint(center, 0);
    }
}

// Drawn radii back to values: the scale and the size Input divided out.
void EllipseControl::WriteRadii(OrbPoint radius)
{
    const float64 k = mRadiusScale * mSizeMul;
    if (k == 0.0 || !std::isfinite(k))
        return;
    const Shape s = Drawn();
    if (Moved(radius.x, s.radius.x))
        WriteRole(ER_RadiusX, radius.x / k);
    if (!mCircle && Moved(radius.y, s.radius.y))
        WriteRole(ER_RadiusY, radius.y / k);
}

void EllipseControl::WriteRole(Role role, float64 value)
{
    if (HasRole(role))
        WriteNumber(value, uint32(mRoleIndex[role]));
}

// Turns as the angle overlay does, by the shortest turn each move, then
// snaps to the angle step.
void EllipseControl::DragRotate(const PreviewInfo &info)
{
    const OrbPoint d = info.MouseInViewer() - info.TransformOut(mAtPress.center);
    const auto turned = AngleGeometry::Dragged(mTurn, AngleGeometry::DragDirection(d), mGrabAngle + mTurn);
    if (!OV::Finite(d) || !turned)
        return;
    mTurn = *turned;
    const float64 angle = mAngleStep > 0.0 ? std::round(mTurn / mAngleStep) * mAngleStep : mTurn;
    if (!Moved(angle, Drawn().angle))
        return;
    OpenGesture("Rotate Ellipse");
    WriteRole(ER_Angle, angle - mAngleOffset);
}

void EllipseControl::DragSoft(const PreviewInfo &info, OrbPoint to)
{
    const OrbPoint local = ToLocal(mAtPress, to, info.AspectScaleYOut(1.0));
    float64 soft = (local.y - std::fabs(mAtPress.radius.y) - Reach(info, mSoftReach)) / SoftFactor();
    soft = std::max(soft, mMinSoft);
    if (mMaxSoft > 0.0)
        soft = std::min(soft, mMaxSoft);
    if (!std::isfinite(soft) || mSoftScale == 0.0 || !Moved(soft, Drawn().soft))
        return;
    OpenGesture("Soften Ellipse");
    WriteRole(ER_Soft, soft / mSoftScale);
}

uint64 EllipseControl::ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags)
{
    uint64 result = 0;
    if (mKeysResize ? KeyResize(info, command, data, tags, result)
                    : NudgeCommand(info, command, data, tags, mCenter, 1.0 / info->ImageHeight, result))
        return result;
    return HandleOverlay::ControlCommand(info, command, data, tags);
}

// Arrows change the radii by an image pixel: Left and Right the X radius,
// Up and Down the Y radius; the modifiers as for every nudge.
bool EllipseControl::KeyResize(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags,
                               uint64 &result)
{
    if (command != CCMD_KeyDown || !IsArrowKey(data))
        return NudgeCommand(info, command, data, tags, mCenter, 1.0 / info->ImageHeight, result);
    const OrbPoint step =
        NudgeOffset(data, 1.0 / info->ImageWidth, info->AspectScaleYIn(1.0 / info->ImageHeight), KeyModifiers());
    const Shape s = Drawn();
    WriteRadii(Clamped(s.radius + step, step.x != 0.0 ? 0 : 1, false));
    PreviewControl::ControlCommand(info, command, data, tags);
    result = 1;
    return true;
}

// The outline grown by `grow` on both radii, in viewer units.
std::vector<OrbPoint> EllipseControl::Outline(const Shape &shape, float64 grow, const PreviewInfo &info) const
{
    std::vector<OrbPoint> points;
    const float64 yPerX = info.AspectScaleYOut(1.0);
    const OrbPoint r(std::max(std::fabs(shape.radius.x) + grow, 0.0), std::max(std::fabs(shape.radius.y) + grow, 0.0));
    for (const OrbPoint c : UnitCircle(mSegments)) {
        const OrbPoint at = info.TransformOut(ToImage(shape, OrbPoint(c.x * r.x, c.y * r.y), yPerX));
        if (!OV::OnScreen(at))
            return {};
        points.push_back(at);
    }
    return points;
}

void EllipseControl::DrawCurve(GPainter &p, const std::vector<OrbPoint> &points, int32 mode) const
{
    p.Begin(mode);
    for (const OrbPoint v : points)
        p.Vertex(v.x, v.y);
    p.End();
}

void EllipseControl::DrawControls(PreviewInfo *info, const TagList *tags)
{
    GPainter *p = info->GetPainter();
    const Shape s = Drawn();
    if (p && info->DrawPass != 3 && mVisible && OV::OnScreen(info->TransformOut(s.center)) && OV::Finite(s.radius) &&
        std::isfinite(s.angle)) {
        p->PushAttrib();
        DrawLook(*p, *info, s);
        DrawKnobs(*p, *info, s);
        p->PopAttrib();
    }
    HandleOverlay::DrawControls(info, tags);
}

// The shade, the soft edge's two ellipses, the ellipse and its axes.
void EllipseControl::DrawLook(GPainter &p, const PreviewInfo &info, const Shape &s) const
{
    const bool dragged = mDragType == DRAG_Handle;
    if (mFillInside) {
        GColor fill = info.GetColor(mFillColor);
        fill.a = float32(std::clamp(mFillOpacity, 0.0, 1.0));
        p.Color(fill, GColor(0.0f, 0.0f, 0.0f, 0.0f));
        DrawCurve(p, Outline(s, 0.0, info), Graphics::GP_Polygon);
    }
    if (s.soft != 0.0 && mShowSoft) {
        p.PushAttrib();
        RectangleControl::ApplyPen(p, mSoftPenStyle, mSoftLineWidth);
        p.Color(info.GetColor(mSoftColor), info.GetShadow(mSoftColor));
        const float64 in = mSoftMode == 2 ? 0.0 : mSoftMode == 1 ? 1.0 : 0.5;
        DrawCurve(p, Outline(s, -s.soft * in, info), Graphics::GP_LineLoop);
        DrawCurve(p, Outline(s, s.soft * (1.0 - in), info), Graphics::GP_LineLoop);
        p.PopAttrib();
    }
    if (!(mHideWhileDragging && dragged)) {
        p.PushAttrib();
        RectangleControl::ApplyPen(p, mPenStyle, mLineWidth);
        p.Color(info.GetColor(mColor), info.GetShadow(mColor));
        DrawCurve(p, Outline(s, 0.0, info), Graphics::GP_LineLoop);
        p.PopAttrib();
    }
    if (mShowAxes) {
        const float64 yPerX = info.AspectScaleYOut(1.0);
        p.Color(info.GetColor(mColor), info.GetShadow(mColor));
        p.Begin(Graphics::GP_Lines);
        for (const OrbPoint l : {OrbPoint(-s.radius.x, 0.0), OrbPoint(s.radius.x, 0.0), OrbPoint(0.0, -s.radius.y),
                                 OrbPoint(0.0, s.radius.y)}) {
            const OrbPoint at = info.TransformOut(ToImage(s, l, yPerX));
            p.Vertex(at.x, at.y);
        }
        p.End();
    }
}

// Each knob where its handle is, highlighted under the mouse; the label
// beside the +X knob.
void EllipseControl::DrawKnobs(GPainter &p, const PreviewInfo &info, const Shape &s) const
{
    HandleSet built;
    BuildHandles(info, built);
    for (const Handle &h : built.Handles()) {
        BeginHandle(p, info, h.at, h.part);
        const float64 k = h.part == EPART_Center ? mCenterSize : mKnobSize;
        // Squares; the rotation knob a diamond, so that it reads apart.
        const bool diamond = h.part == EPART_Rotate;
        p.Begin(Graphics::GP_LineLoop);
        for (const OrbPoint c : {OrbPoint(-1, -1), OrbPoint(1, -1), OrbPoint(1, 1), OrbPoint(-1, 1)})
            p.Vertex(diamond ? (c.x - c.y) * k / 2 * M_SQRT2 : c.x * k,
                     diamond ? (c.x + c.y) * k / 2 * M_SQRT2 : c.y * k);
        p.End();
        EndHandle(p);
    }
    if (!mLabel.empty()) {
        const OrbPoint at = info.TransformOut(ToImage(s, {std::fabs(s.radius.x), 0.0}, info.AspectScaleYOut(1.0)));
        if (OV::OnScreen(at)) {
            p.Color(info.GetColor(mColor), info.GetShadow(mColor));
            p.Text(at.x + 8, at.y + 8, mLabel.c_str());
        }
    }
}

bool EllipseControl::RegCleanup(Registry *reg)
{
    delete std::exchange(gCircle, nullptr);
    return HandleOverlay::RegCleanup(reg);
}

} // namespace Orbane
