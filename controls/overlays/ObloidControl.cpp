#include "overlays/ObloidControl.h"

#include "framework/ObloidTags.h"
#include "framework/Overlay3D.h"
#include "framework/OverlayValue.h"
#include "overlays/RectangleControl.h"

#include "orbane/AutoParam.h"
#include "orbane/ControlCommands.h"
#include "orbane/GPainter.h"
#include "orbane/Input.h"
#include "orbane/PreviewInfo.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

using Graphics::GColor;
using Graphics::GPainter;
using OV = OverlayValue;

namespace {

constexpr Tag kRoleTags[ObloidControl::OR_Count] = {OBC_SizeXInput, OBC_SizeYInput, OBC_SizeZInput,
                                                    OBC_RotXInput,  OBC_RotYInput,  OBC_RotZInput};
constexpr Tag kSetTags[ObloidControl::OR_Count] = {OBCD_SetSizeX, OBCD_SetSizeY, OBCD_SetSizeZ,
                                                   OBCD_SetRotX,  OBCD_SetRotY,  OBCD_SetRotZ};
// The pen of edges hidden behind the box: the rectangle's short dashes.
constexpr int32 kHiddenPen = 2;
// The box's own axes drawn this long, as a share of its largest size.
constexpr float64 kAxisLength = 0.75;

float64 Component(OrbVec3 v, int32 axis) noexcept
{
    return axis == 0 ? v.x : axis == 1 ? v.y : v.z;
}

} // namespace

const LinkedInput<ObloidControl> ObloidControl::Links[] = {
    {OBCP_Visible, OBCID_Visible, &ObloidControl::mVisibleInput},
    {OBCP_Lock, OBCID_Lock, &ObloidControl::mLockInput},
    {OBCP_Size, OBCID_Size, &ObloidControl::mSizeInput},
    {OBCP_Camera, OBCID_Camera, &ObloidControl::mCameraInput},
};

const std::pair<Tag, bool ObloidControl::*> ObloidControl::BoolAttrs[] = {
    {OBC_Uniform, &ObloidControl::mUniform},
    {OBC_AboutCenter, &ObloidControl::mAboutCenter},
    {OBC_Cube, &ObloidControl::mCube},
    {OBC_ShowFaces, &ObloidControl::mShowFaces},
    {OBC_ShowCenter, &ObloidControl::mShowCenter},
    {OBC_ShowAxes, &ObloidControl::mShowAxes},
    {OBC_ShowHidden, &ObloidControl::mShowHidden},
    {OBC_FillFaces, &ObloidControl::mFillFaces},
    {OBC_HideWhileDragging, &ObloidControl::mHideWhileDragging},
    {OBC_KeysDepth, &ObloidControl::mKeysDepth},
};
const std::pair<Tag, int32 ObloidControl::*> ObloidControl::IntAttrs[] = {
    {OBC_PenStyle, &ObloidControl::mPenStyle},
    {OBC_AxisMove, &ObloidControl::mAxisMove},
};
const std::pair<Tag, float64 ObloidControl::*> ObloidControl::DoubleAttrs[] = {
    {OBCD_MinSize, &ObloidControl::mMinSize},         {OBCD_MaxSize, &ObloidControl::mMaxSize},
    {OBCD_SizeScale, &ObloidControl::mSizeScale},     {OBCD_LineWidth, &ObloidControl::mLineWidth},
    {OBCD_FillOpacity, &ObloidControl::mFillOpacity}, {OBCD_KnobSize, &ObloidControl::mKnobSize},
    {OBCD_CenterSize, &ObloidControl::mCenterSize},   {OBCD_SizeStep, &ObloidControl::mSizeStep},
};
const std::pair<Tag, OrbColor ObloidControl::*> ObloidControl::ColorAttrs[] = {
    {OBC_Color, &ObloidControl::mColor},
    {OBC_FillColor, &ObloidControl::mFillColor},
};

ObloidControl::ObloidControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : HandleOverlay(reg, args, tags)
{
    ObloidControl::SetAttrsTagList(nullptr, tags);
}

ObloidControl::~ObloidControl()
{
    DetachLinkedInputs(*this, Links);
}

bool ObloidControl::CopyAttr(Tag tag, void *out)
{
    const Box3 b = Drawn();
    const float64 *value = tag == OBCD_CurrentSizeX   ? &b.size.x
                           : tag == OBCD_CurrentSizeY ? &b.size.y
                           : tag == OBCD_CurrentSizeZ ? &b.size.z
                                                      : nullptr;
    if (!value)
        return HandleOverlay::CopyAttr(tag, out);
    if (out)
        *static_cast<float64 *>(out) = *value;
    // False: the value was supplied.
    return !out;
}

bool ObloidControl::GetAttrsTagList(TagList &tags) const
{
    WriteLinkedInputIds(*this, Links, tags);
    for (int32 r = 0; r < OR_Count; ++r) {
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
    const Box3 b = Drawn();
    tags.Set(OBCD_CurrentSizeX, b.size.x);
    tags.Set(OBCD_CurrentSizeY, b.size.y);
    tags.Set(OBCD_CurrentSizeZ, b.size.z);
    tags.Set(OBCS_Label, mLabel.c_str());
    return true;
}

void ObloidControl::GetState(ScriptVal &state) const
{
    HandleOverlay::GetState(state);
    const Box3 b = Drawn();
    const std::pair<const char *, float64> fields[] = {{"centerX", b.center.x}, {"centerY", b.center.y},
                                                       {"centerZ", b.center.z}, {"sizeX", b.size.x},
                                                       {"sizeY", b.size.y},     {"sizeZ", b.size.z},
                                                       {"rotX", b.rotation.x},  {"rotY", b.rotation.y},
                                                       {"rotZ", b.rotation.z},  {"dragPart", float64(mDragPart)}};
    for (const auto &[key, value] : fields)
        state.SetKey(ScriptVal(key), ScriptVal(value));
    // Where each handle was last put, for scripts that grab them.
    PreviewInfo info;
    info.SetMapping(mViewMapping);
    info.SetCamera(mViewCamera);
    HandleSet built;
    BuildHandles(info, built);
    ScriptVal handles = ScriptVal::NewTable();
    for (const Handle &h : built.Handles()) {
        ScriptVal at = ScriptVal::NewTable();
        const OrbPoint image = info.TransformIn(h.at);
        at.SetKey(ScriptVal("ix"), ScriptVal(image.x));
        at.SetKey(ScriptVal("iy"), ScriptVal(image.y));
        handles.SetKey(ScriptVal(int64(h.part)), at);
    }
    const ViewCamera camera = CameraOf(info);
    int32 front = 0;
    for (int32 f = 0; f < BoxGeometry::Faces; ++f)
        front += BoxGeometry::FacesEye(b, f, camera.position) ? 1 : 0;
    state.SetKey(ScriptVal("frontFaces"), ScriptVal(front));
    state.SetKey(ScriptVal("handles"), handles);
}

bool ObloidControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    const uint32 linked = AttachLinkedInputs(*this, Links, GetOperator(nullptr), tags);
    ReadAttrs(tags);
    PullLinkedInputs(*this, Links, linked);
    // A role that moved to another Input shows that Input's value.
    ReadInputs();
    UpdateDisplay(nullptr, nullptr);
    return HandleOverlay::SetAttrsTagList(input, tags);
}

// Every tag keeps the field as it is where it is absent; numbers that are
// not finite are refused.
void ObloidControl::ReadAttrs(const TagList &tags)
{
    for (int32 r = 0; r < OR_Count; ++r) {
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
    if (const char *label = tags.GetString(OBCS_Label))
        mLabel = label;
}

void ObloidControl::ReadInputs()
{
    bool moved = false;
    for (std::size_t i = 0; i < Inputs().size(); ++i) {
        const AutoParameter value(Inputs()[i]->GetValue(GetCurrentTime()));
        Store(int32(i), value.get(), moved);
    }
}

bool ObloidControl::AddInput(Input *input, const TagList *tags)
{
    return AddInputTaking(input, tags,
                          [this](int32 index, const Parameter *value, bool &moved) { Store(index, value, moved); });
}

bool ObloidControl::RemoveInput(Input *input, const TagList *tags)
{
    const bool linked = DetachLinkedInput(*this, Links, input);
    if (linked && !mCameraInput)
        mCameraTable = ScriptVal();
    return HandleOverlay::RemoveInput(input, tags) || linked;
}

bool ObloidControl::HasRole(Role role) const
{
    return HoldsRole(mRoleIndex, role);
}

void ObloidControl::Store(int32 index, const Parameter *value, bool &moved)
{
    if (index == 0)
        moved = Overlay3D::TakePoint(mCenter, value) || moved;
    for (int32 r = 0; index > 0 && r < OR_Count; ++r)
        if (index == mRoleIndex[r] && HasRole(Role(r)))
            moved = OV::TakeNumber(mInput[r], value) || moved;
}

bool ObloidControl::StoreLinked(const Input *input, const Parameter *value)
{
    bool moved = false;
    if (input == mVisibleInput)
        moved = OV::TakeFlag(mVisible, value) || moved;
    if (input == mLockInput)
        moved = OV::TakeFlag(mLocked, value) || moved;
    if (input == mSizeInput)
        moved = OV::TakeNumber(mSizeMul, value) || moved;
    if (input == mCameraInput) {
        ScriptVal table;
        if (Overlay3D::ReadCameraTable(value, table)) {
            mCameraTable = table;
            moved = true;
        }
    }
    return moved;
}

void ObloidControl::SetView(PreviewInfo *info, const TagList *tags)
{
    if (info) {
        mViewMapping = info->Mapping();
        mViewCamera = info->Camera();
    }
    HandleOverlay::SetView(info, tags);
}

void ObloidControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
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

Box3 ObloidControl::Drawn() const
{
    Box3 b;
    b.center = mCenter;
    const float64 k = SizeFactor();
    const float64 x = Value(OR_SizeX) * k;
    b.size = mCube ? OrbVec3(x, x, x) : OrbVec3(x, Value(OR_SizeY) * k, Value(OR_SizeZ) * k);
    b.rotation = OrbVec3(Value(OR_RotX), Value(OR_RotY), Value(OR_RotZ));
    return b;
}

ViewCamera ObloidControl::CameraOf(const PreviewInfo &info) const
{
    return Overlay3D::CameraOver(info, mCameraTable);
}

// The centre above all, then the faces that face the camera, then those
// behind (still grabbable where nothing covers them). A face whose size
// has no Input has no knob.
void ObloidControl::BuildHandles(const PreviewInfo &info, HandleSet &handles) const
{
    handles.Clear();
    const Box3 b = Drawn();
    if (!Grabbable() || !b.center.IsFinite() || !b.size.IsFinite() || !b.rotation.IsFinite())
        return;
    const ViewCamera camera = CameraOf(info);
    OrbPoint at;
    if (mShowCenter && Overlay3D::ToViewer(info, camera, b.center, at))
        handles.AddDisc(at, mCenterSize, OPART_Center, HP_Point);
    if (!mShowFaces)
        return;
    const OrbPoint knob(mKnobSize, mKnobSize);
    for (int32 f = 0; f < BoxGeometry::Faces; ++f) {
        const int32 axis = BoxGeometry::AxisOf(f);
        if (!HasRole(Role(mCube ? OR_SizeX : OR_SizeX + axis)))
            continue;
        if (Overlay3D::ToViewer(info, camera, BoxGeometry::FaceCenter(b, f), at))
            handles.AddBox(at, knob * -1.0, knob, OPART_Face + uint32(f),
                           BoxGeometry::FacesEye(b, f, camera.position) ? HP_Corner : HP_Edge);
    }
}

DragType ObloidControl::ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    if (info->HotControl)
        return HandleOverlay::ControlDown(info, mouse, tags);
    const HandleHit hit = PressHit(*info);
    if (hit) {
        const ViewCamera camera = CameraOf(*info);
        mAtPress = Drawn();
        bool grabbed = false;
        if (hit.part == OPART_Center) {
            OrbVec3 at;
            grabbed = CenterTarget(*info, at);
            mGrab = mAtPress.center - at;
        } else {
            const int32 axis = BoxGeometry::AxisOf(int32(hit.part - OPART_Face));
            grabbed = Overlay3D::MouseOnLine(*info, camera, mAtPress.center,
                                             BoxGeometry::Axes(mAtPress)[std::size_t(axis)], mGrabT);
        }
        // A handle whose drag has no sense from this view (a face seen edge
        // on along its own axis) is not taken.
        if (grabbed) {
            mDragType = DRAG_Handle;
            mDragPart = hit.part;
            Pick(hit);
        }
    }
    return HandleOverlay::ControlDown(info, mouse, tags);
}

void ObloidControl::ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    HandleOverlay::ControlMove(info, mouse, tags);
    if (mDragType != DRAG_Handle)
        return;
    if (mDragPart == OPART_Center)
        DragCenter(*info);
    else
        DragFace(*info);
}

// The centre moves on the plane through it that faces the camera, or along
// one world axis, or on the ground, as OBC_AxisMove says; the point grabbed
// stays under the mouse.
bool ObloidControl::CenterTarget(const PreviewInfo &info, OrbVec3 &at) const
{
    const ViewCamera camera = CameraOf(info);
    const OrbVec3 from = mAtPress.center;
    if (mAxisMove >= 1 && mAxisMove <= 3) {
        const OrbVec3 axis(mAxisMove == 1, mAxisMove == 2, mAxisMove == 3);
        float64 t = 0.0;
        if (!Overlay3D::MouseOnLine(info, camera, from, axis, t))
            return false;
        at = from + axis * t;
        return true;
    }
    if (mAxisMove == 4)
        return camera.OnPlane({info.MouseX, info.MouseY}, info.Mapping(), from, {0.0, 1.0, 0.0}, at);
    return Overlay3D::MouseOnViewPlane(info, camera, from, at);
}

void ObloidControl::DragCenter(const PreviewInfo &info)
{
    OrbVec3 at;
    if (!CenterTarget(info, at))
        return;
    const OrbVec3 to = at + mGrab;
    if (!to.IsFinite() || !Overlay3D::Moved(to, mCenter))
        return;
    OpenGesture("Move Box");
    Overlay3D::WritePoint(*this, to, 0);
}

void ObloidControl::DragFace(const PreviewInfo &info)
{
    const int32 face = int32(mDragPart - OPART_Face);
    const int32 axis = BoxGeometry::AxisOf(face);
    float64 t = 0.0;
    if (!Overlay3D::MouseOnLine(info, CameraOf(info), mAtPress.center, BoxGeometry::Axes(mAtPress)[std::size_t(axis)],
                                t))
        return;
    const Qt::KeyboardModifiers mods = KeyModifiers();
    BoxResize how;
    how.uniform = mCube || mUniform || (mods & Qt::ShiftModifier);
    how.aboutCenter = mAboutCenter || (mods & Qt::ControlModifier);
    how.minSize = mMinSize;
    how.maxSize = mMaxSize;
    how.step = mSizeStep;
    const Box3 box = BoxGeometry::Resized(mAtPress, face, t - mGrabT, how);
    if (box.size.IsFinite() && box.center.IsFinite())
        WriteBox(box);
}

// Writes what the drag changed: each size (as a value, the drawn size
// divided by the scale and the size Input) and the centre.
void ObloidControl::WriteBox(const Box3 &box)
{
    const Box3 now = Drawn();
    const float64 k = SizeFactor();
    bool any = false;
    for (int32 axis = 0; axis < (mCube ? 1 : 3); ++axis) {
        const Role role = Role(OR_SizeX + axis);
        const float64 size = Component(box.size, axis);
        if (HasRole(role) && k != 0.0 && Moved(size, Component(now.size, axis))) {
            OpenGesture("Resize Box");
            WriteRole(role, size / k);
            any = true;
        }
    }
    if (Overlay3D::Moved(box.center, now.center) && (any || mDragPart != OPART_Center)) {
        OpenGesture("Resize Box");
        Overlay3D::WritePoint(*this, box.center, 0);
    }
}

void ObloidControl::WriteRole(Role role, float64 value)
{
    if (HasRole(role))
        WriteNumber(value, uint32(mRoleIndex[role]));
}

// Arrows move the centre by an image pixel in X and Y (or Z, with
// OBC_KeysDepth); the nudges while keys are held are one undo step.
uint64 ObloidControl::ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags)
{
    if (command == CCMD_NeedsKey)
        return IsArrowKey(data) ? 1 : 0;
    if (command == CCMD_KeyDown && IsArrowKey(data)) {
        if (Grabbable())
            Overlay3D::WritePoint(*this, mCenter + Overlay3D::Nudge(*info, data, KeyModifiers(), mKeysDepth), 0);
        HandleOverlay::ControlCommand(info, command, data, tags);
        return 1;
    }
    if (command == CCMD_KeyUpAll)
        ResetUndo(nullptr);
    return HandleOverlay::ControlCommand(info, command, data, tags);
}

void ObloidControl::DrawControls(PreviewInfo *info, const TagList *tags)
{
    GPainter *p = info->GetPainter();
    const Box3 b = Drawn();
    if (p && info->DrawPass != 3 && mVisible && b.center.IsFinite() && b.size.IsFinite() && b.rotation.IsFinite()) {
        const ViewCamera camera = CameraOf(*info);
        p->PushAttrib();
        if (!(mHideWhileDragging && mDragType == DRAG_Handle)) {
            if (mFillFaces)
                DrawFill(*p, *info, camera, b);
            DrawBox(*p, *info, camera, b);
            if (mShowAxes)
                DrawAxes(*p, *info, camera, b);
        }
        DrawKnobs(*p, *info);
        p->PopAttrib();
    }
    HandleOverlay::DrawControls(info, tags);
}

// An edge is seen where one of its two faces faces the camera; the others
// lie behind the box and are dashed (or left out).
void ObloidControl::DrawBox(GPainter &p, const PreviewInfo &info, const ViewCamera &camera, const Box3 &box) const
{
    const auto corners = BoxGeometry::Corners(box);
    bool front[BoxGeometry::Faces];
    for (int32 f = 0; f < BoxGeometry::Faces; ++f)
        front[f] = BoxGeometry::FacesEye(box, f, camera.position);
    p.Color(info.GetColor(mColor), info.GetShadow(mColor));
    for (const bool seen : {true, false}) {
        if (!seen && !mShowHidden)
            break;
        p.PushAttrib();
        RectangleControl::ApplyPen(p, seen ? mPenStyle : kHiddenPen, mLineWidth);
        p.Begin(Graphics::GP_Lines);
        for (int32 e = 0; e < 12; ++e) {
            const auto faces = BoxGeometry::FacesOfEdge(e);
            if ((front[faces[0]] || front[faces[1]]) != seen)
                continue;
            const auto &edge = BoxGeometry::Edges()[std::size_t(e)];
            Overlay3D::Segment(p, info, camera, corners[std::size_t(edge[0])], corners[std::size_t(edge[1])]);
        }
        p.End();
        p.PopAttrib();
    }
    OrbPoint at;
    if (!mLabel.empty() && Overlay3D::ToViewer(info, camera, box.center, at))
        p.Text(at.x + mCenterSize + 4.0, at.y + mCenterSize + 4.0, mLabel.c_str());
}

// The faces that face the camera, shaded; a face with a corner behind the
// near plane is left unshaded rather than drawn through infinity.
void ObloidControl::DrawFill(GPainter &p, const PreviewInfo &info, const ViewCamera &camera, const Box3 &box) const
{
    const auto corners = BoxGeometry::Corners(box);
    const GColor shade = info.GetColor(mFillColor).Faded(float32(std::clamp(mFillOpacity, 0.0, 1.0)));
    p.PushAttrib();
    p.Enable(Graphics::GC_Blend);
    p.BlendFunc(Graphics::GBF_SrcAlpha, Graphics::GBF_OneMinusSrcAlpha);
    p.Color(shade, GColor());
    for (int32 f = 0; f < BoxGeometry::Faces; ++f) {
        if (!BoxGeometry::FacesEye(box, f, camera.position))
            continue;
        OrbPoint quad[4];
        bool whole = true;
        const auto ids = BoxGeometry::FaceCorners(f);
        for (int32 i = 0; i < 4 && whole; ++i)
            whole = Overlay3D::ToViewer(info, camera, corners[std::size_t(ids[std::size_t(i)])], quad[i]);
        if (!whole)
            continue;
        p.Begin(Graphics::GP_Polygon);
        for (const OrbPoint &q : quad)
            p.Vertex(q.x, q.y);
        p.End();
    }
    p.PopAttrib();
}

void ObloidControl::DrawAxes(GPainter &p, const PreviewInfo &info, const ViewCamera &camera, const Box3 &box) const
{
    static const GColor colours[3] = {{0.9f, 0.25f, 0.25f}, {0.3f, 0.85f, 0.3f}, {0.35f, 0.5f, 1.0f}};
    const auto axes = BoxGeometry::Axes(box);
    const float64 reach = kAxisLength * std::max({std::fabs(box.size.x), std::fabs(box.size.y), std::fabs(box.size.z)});
    for (int32 a = 0; a < 3; ++a) {
        p.Color(colours[a], info.GetShadow(OrbColor()));
        p.Begin(Graphics::GP_Lines);
        Overlay3D::Segment(p, info, camera, box.center, box.center + axes[std::size_t(a)] * reach);
        p.End();
    }
}

// Face knobs are squares, the centre a cross in a square, as the
// transform's; knobs of faces turned away are smaller and drawn first, so
// the faces in front cover them.
void ObloidControl::DrawKnobs(GPainter &p, const PreviewInfo &info) const
{
    HandleSet built;
    BuildHandles(info, built);
    for (const bool front : {false, true})
        for (const Handle &h : built.Handles()) {
            if ((h.priority != HP_Edge) != front)
                continue;
            const float64 half = h.part == OPART_Center ? mCenterSize : front ? mKnobSize : mKnobSize * 0.75;
            DrawSquareKnob(p, info, h.at, h.part, half, h.part == OPART_Center);
        }
}

} // namespace Orbane
