#include "polyline/PolyLineControl.h"

#include "framework/OverlayValue.h"

#include "polyline/PolyLineDialogs.h"
#include "polyline/PolyLineTags.h"
#include "polyline/ShapeBox.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/ControlCommands.h"
#include "orbane/GPainter.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/PolyLine.h"
#include "orbane/Prefs.h"
#include "orbane/PreviewInfo.h"
#include "orbane/ScriptVal.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

using Graphics::GColor;
using Graphics::GPainter;

namespace {

constexpr OrbColor kGrey{192, 192, 192};
constexpr GColor kCyan{0.0f, 1.0f, 1.0f}, kMagenta{1.0f, 0.0f, 1.0f}, kYellow{1.0f, 1.0f, 0.0f};
// Dimmed handles are this much darker.
constexpr float32 kDimming = 0.75f;
// The centre marker's arms, in handle pixels.
constexpr float64 kCentreArm = 8.0;
// A Click Append press pulls the new point's handles only once the mouse has
// gone this many viewer pixels from it; a wobble of the hand adds a corner.
constexpr float64 kPullDistance = 3.0;

// The colour with its alpha byte replaced by the fade.
OrbColor WithFade(OrbColor c, float32 fade)
{
    return OrbColor(c.R(), c.G(), c.B(), uint8(std::lround(255.0f * fade)));
}

} // namespace

const LinkedInput<PolyLineControl> PolyLineControl::Links[] = {
    {PLCP_Center, PLCID_Center, &PolyLineControl::mCenterInput},
    {PLCP_Angle, PLCID_Angle, &PolyLineControl::mAngleInput},
    {PLCP_Size, PLCID_Size, &PolyLineControl::mSizeInput},
    {PLCP_Displacement, PLCID_Displacement, &PolyLineControl::mDisplacementInput},
    {PLCP_CurrentTimePoint, PLCID_CurrentTimePoint, &PolyLineControl::mCurrentTimePointInput},
    {PLCP_AngleX, PLCID_AngleX, &PolyLineControl::mAngleXInput},
    {PLCP_AngleY, PLCID_AngleY, &PolyLineControl::mAngleYInput},
    {PLCP_AngleZ, PLCID_AngleZ, &PolyLineControl::mAngleZInput},
    {PLCP_InPolyLine2, PLCID_InPolyLine2, &PolyLineControl::mOuterInput},
    {PLCP_CenterX, PLCID_CenterX, &PolyLineControl::mCenterXInput},
    {PLCP_CenterY, PLCID_CenterY, &PolyLineControl::mCenterYInput},
    {PLCP_CenterZ, PLCID_CenterZ, &PolyLineControl::mCenterZInput},
    {PLCP_TrackerSize, PLCID_TrackerSize, &PolyLineControl::mTrackerSizeInput},
    {PLCP_TrackerSearchSize, PLCID_TrackerSearchSize, &PolyLineControl::mTrackerSearchSizeInput},
    {PLCP_InPolyLine, PLCID_InPolyLine, &PolyLineControl::mInnerInput},
};

PolyLineControl::PolyLineControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : HandleOverlay(reg, args, tags), mShapeBox(new ShapeBox(nullptr, args, TagList()))
{
    for (std::size_t i = 0; i < mCursors->size(); ++i)
        (*mCursors)[i] = QCursor(CursorShapes[i]);
    mCurrentCursor = &(*mCursors)[0];
    PolyLineControl::SetAttrsTagList(nullptr, tags);
}

PolyLineControl::~PolyLineControl()
{
    CloseStep();
    DetachLinkedInputs(*this, Links);
    mShapeBox->DecRef();
}

// --- set-up ---

bool PolyLineControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    const Input *main = GetMainInput();
    Operator *tool = main ? main->GetOperator() : nullptr;
    const uint32 linked = AttachLinkedInputs(*this, Links, tool, tags);
    ReadAttachResult(tags);
    ReadFlags(tags);
    ReadColors(tags);
    ReadDefaults(tags);
    if (tool) {
        mFollowExternMatchPoint = tool->GetAttrs().GetBool(PLC_FollowExternMatchPoint, mFollowExternMatchPoint);
        ReadPairing(tool->GetAttrs());
    }
    if (OrbaneDoc *doc = GetDoc())
        mExportSplineMode = uint16(doc->GetPrefs().GetLong(PREF_ExportSplineMode, mExportSplineMode));
    if (main)
        mShapeReadOnly = main->GetAttrs().GetBool(INPA_ReadOnly, mShapeReadOnly);
    EmptySelectionWhenHidden();
    PullLinkedInputs(*this, Links, linked);
    UpdateDisplay(nullptr, nullptr);
    return HandleOverlay::SetAttrsTagList(input, tags);
}

// A tag that is absent leaves its field as it is.
void PolyLineControl::ReadFlags(const TagList &tags)
{
    if (tags.FindQuery(PLC_DrawMode))
        SetMode(uint8(tags.GetLong(PLC_DrawMode, 0)));
    for (auto [tag, field] : {std::pair{PLC_RecordTime, &mRecordTime},
                              {PLC_RecordPressure, &mRecordPressure},
                              {PLC_RecordHeight, &mRecordHeight},
                              {PLC_RecordAngleXY, &mRecordAngleXY},
                              {PLC_RecordAngleZ, &mRecordAngleZ},
                              {PLC_RecordRotation, &mRecordRotation},
                              {PLC_CanPublishPoints, &mCanPublishPoints},
                              {PLC_CurrentTimeOnly, &mCurrentTimeOnly},
                              {PLC_Animated, &mAnimated},
                              {PLC_PairFromAttach, &mPairFromAttach},
                              {PLC_KeepFlag, &mKeptFlag}})
        *field = tags.GetBool(tag, *field);
    mStopRendering = tags.GetInt(PLC_StopRendering, mStopRendering);
    for (auto [tag, bit] : {std::pair{PLC_ShowKeyPoints, PLD_KeyPoints},
                            {PLC_ShowHandles, PLD_Handles},
                            {PLC_ShowPolyLine, PLD_Curve},
                            {PLC_ShowSelectedHidden, PLD_SelectedWhenHidden},
                            {PLC_ShowTaggedPointIDs, PLD_TaggedIDs}}) {
        const bool on = tags.GetLong(tag, (mDisplayFlags & bit) ? 1 : 0) != 0;
        mDisplayFlags = uint16(on ? mDisplayFlags | bit : mDisplayFlags & ~bit);
    }
    if (tags.FindQuery(PLC_DrawStyle))
        ReadDrawStyle(tags.GetLong(PLC_DrawStyle, 0));
}

// 0 is solid; 1, 2 and 5 (the menu's "Null") set their own bit alone; any
// other value keeps the style there is.
void PolyLineControl::ReadDrawStyle(int64 style)
{
    uint16 bit = 0;
    if (style == 1)
        bit = PLD_Dash;
    else if (style == 2)
        bit = PLD_Style2;
    else if (style == 5)
        bit = PLD_Null;
    else if (style != 0)
        return;
    mDisplayFlags = uint16((mDisplayFlags & ~PLD_Styles) | bit);
}

void PolyLineControl::ReadColors(const TagList &tags)
{
    if (tags.FindQuery(PLC_HandleColor))
        mHandleColor = mHandleColorAlt = OrbColor(uint32(tags.GetLong(PLC_HandleColor, 0)));
    mCustomSplineColor = OrbColor(uint32(tags.GetLong(PCA_Color, mCustomSplineColor.Packed())));
    mCustomKeyPointColor = OrbColor(uint32(tags.GetLong(PLC_KeyPointColor, mCustomKeyPointColor.Packed())));
}

// The values of the placing Inputs, where no Input is linked for them.
void PolyLineControl::ReadDefaults(const TagList &tags)
{
    auto read = [&tags](const Input *linked, Tag tag, float64 &field) {
        const float64 to = tags.GetDouble(tag, field);
        if (!linked && std::isfinite(to))
            field = to;
    };
    read(mCenterInput ? mCenterInput : mCenterXInput, PLCD_SetX, mCenter.x);
    read(mCenterInput ? mCenterInput : mCenterYInput, PLCD_SetY, mCenter.y);
    read(mAngleInput, PLCD_SetAngle, mAngle);
    read(mSizeInput, PLCD_SetSize, mSize);
    read(mAngleXInput, PLCD_SetAngleX, mAngleX);
    read(mAngleYInput, PLCD_SetAngleY, mAngleY);
    read(mTrackerSizeInput, PLCD_SetTrackerSize, mTrackerSize);
    read(mTrackerSearchSizeInput, PLCD_SetTrackerSearchSize, mTrackerSearchSize);
}

// Displacement, inner and outer polyline named by id and found add 1, 2 and 4.
void PolyLineControl::ReadAttachResult(const TagList &tags)
{
    for (auto [tag, slot, bit] : {std::tuple{PLCID_Displacement, mDisplacementInput, 1u},
                                  {PLCID_InPolyLine, mInnerInput, 2u},
                                  {PLCID_InPolyLine2, mOuterInput, 4u}})
        if (tags.FindQuery(tag) && slot)
            mAttachResult |= bit;
}

// With an outer polyline the source tool's "follow inner" setting decides:
// following is state 1, free state 2. Where the tags ask for the state from
// the attach result, a shape that is itself the outer of another (result 2)
// is state 0 and one with neither is state 3, an outer that may be enabled.
void PolyLineControl::ReadPairing(const TagList &toolAttrs)
{
    if (mOuterInput)
        mPairing = toolAttrs.GetBool(TOOL_FollowInner, false) ? 1 : 2;
    else if (mPairFromAttach)
        mPairing = (mAttachResult & 2) ? 0 : 3;
}

// Nothing of the points shows: nothing stays selected, except on a dimmed
// shape (one edited among several) that keeps its selection for the others.
void PolyLineControl::EmptySelectionWhenHidden()
{
    if ((mDisplayFlags & (PLD_KeyPoints | PLD_Handles)) || (mDimmed && !mKeptFlag))
        return;
    mSelection.Reset();
}

void PolyLineControl::SetMode(uint8 mode)
{
    mDrawMode = uint8((mDrawMode & 0xF0) | (mode & 0x0F));
    const uint8 now = ModeOf();
    mCurrentCursor = &(*mCursors)[now == PLM_ClickAppend ? 2 : now == PLM_DrawAppend ? 1 : 0];
}

bool PolyLineControl::GetAttrsTagList(TagList &tags) const
{
    WriteLinkedInputIds(*this, Links, tags);
    tags.Set(PLC_DrawMode, int32(mDrawMode));
    tags.Set(PLC_ShowKeyPoints, bool(mDisplayFlags & PLD_KeyPoints));
    tags.Set(PLC_ShowHandles, bool(mDisplayFlags & PLD_Handles));
    tags.Set(PLC_ShowPolyLine, (mDisplayFlags & PLD_Curve) ? 1 : 0);
    tags.Set(PLC_ShowTaggedPointIDs, (mDisplayFlags & PLD_TaggedIDs) ? 1 : 0);
    const uint16 style = mDisplayFlags & PLD_Styles;
    tags.Set(PLC_DrawStyle, style == PLD_Dash ? 1 : style == PLD_Style2 ? 2 : style == PLD_Null ? 5 : 0);
    tags.Set(PLC_HandleColor, mHandleColor.Packed());
    for (auto [tag, on] : {std::pair{PLC_RecordTime, mRecordTime},
                           {PLC_RecordPressure, mRecordPressure},
                           {PLC_CurrentTimeOnly, mCurrentTimeOnly},
                           {PLC_Animated, mAnimated}})
        tags.Set(tag, on);
    tags.Set(PLCD_SetX, mCenter.x);
    tags.Set(PLCD_SetY, mCenter.y);
    tags.Set(PLCD_SetAngle, mAngle);
    tags.Set(PLCD_SetSize, mSize);
    return true;
}

void PolyLineControl::GetState(ScriptVal &state) const
{
    HandleOverlay::GetState(state);
    state.SetKey(ScriptVal("mode"), ScriptVal(int(ModeOf())));
    state.SetKey(ScriptVal("displayFlags"), ScriptVal(int(mDisplayFlags)));
    state.SetKey(ScriptVal("dimmed"), ScriptVal(mDimmed));
    state.SetKey(ScriptVal("shapeReadOnly"), ScriptVal(mShapeReadOnly));
    state.SetKey(ScriptVal("attachResult"), ScriptVal(int64(mAttachResult)));
    state.SetKey(ScriptVal("pairing"), ScriptVal(mPairing));
    state.SetKey(ScriptVal("cursor"), ScriptVal(int(mCurrentCursor->shape())));
    ScriptVal selected = ScriptVal::NewTable();
    for (int32 n = 0; n < mSelection.GetSetCount(); ++n)
        selected.SetKey(ScriptVal(n + 1), ScriptVal(mSelection.GetSetItem(n)));
    state.SetKey(ScriptVal("selected"), selected);
    const AutoRef<PolyLine> shape = Shape();
    state.SetKey(ScriptVal("points"), ScriptVal(shape ? shape->GetCount() : 0));
    ScriptVal locked = ScriptVal::NewTable();
    for (int32 i = 0, n = 0; shape && i < shape->GetCount(); ++i)
        if (shape->GetPoint(i)->Flags & PPF_Locked)
            locked.SetKey(ScriptVal(++n), ScriptVal(i));
    state.SetKey(ScriptVal("lockedPoints"), locked);
    state.SetKey(ScriptVal("selectionLocked"), ScriptVal(mEditor.IsSelectionLocked()));
    state.SetKey(ScriptVal("lockPairs"), ScriptVal(mEditor.LockPairs()));
    state.SetKey(ScriptVal("multiFrame"), ScriptVal(mEditor.GetMultiFrame()));
    state.SetKey(ScriptVal("currentTimeOnly"), ScriptVal(mCurrentTimeOnly));
    state.SetKey(ScriptVal("shapeBox"), ScriptVal(mEditor.GetShapeBox()));
    state.SetKey(ScriptVal("gesture"), ScriptVal(int(mMouse.Current())));
    ScriptVal keys = ScriptVal::NewTable();
    int32 k = 0;
    for (const float64 t : mEditor.KeyTimes())
        keys.SetKey(ScriptVal(++k), ScriptVal(t));
    state.SetKey(ScriptVal("keyTimes"), keys);
    AddSurfaceState(state);
}

// --- values ---

bool PolyLineControl::RemoveInput(Input *input, const TagList *tags)
{
    const bool linked = DetachLinkedInput(*this, Links, input);
    return HandleOverlay::RemoveInput(input, tags) || linked;
}

void PolyLineControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return;
    bool moved = false;
    if (input && input == GetMainInput())
        moved = StoreShape(value);
    else if (FindLinkedInput(*this, Links, input))
        StoreLinked(input, value, moved);
    else
        moved = true;
    // The keyframe list follows keys that come and go without changing
    // the shape shown now.
    if (moved || input == GetMainInput())
        PolyLineDialogs::Follow(*mSurface);
    if (moved)
        HandleOverlay::NotifyChanged(input, value, tags);
}

// Replaces the drawn copy under the lock; the selection follows the count.
bool PolyLineControl::StoreShape(const Parameter *value)
{
    auto *shape = dynamic_cast<PolyLine *>(const_cast<Parameter *>(value));
    if (!shape)
        return false;
    {
        const WriteGuard guard(*this);
        if (mShape && mShape->Equals(*shape))
            return false;
        mShape = AutoRef<PolyLine>::Share(shape);
    }
    if (mSelection.GetCount() != shape->GetCount()) {
        SelMask resized(shape->GetCount());
        for (int32 i = 0; i < std::min(resized.GetCount(), mSelection.GetCount()); ++i)
            resized.SetState(i, mSelection[i]);
        mSelection = resized;
    }
    return true;
}

void PolyLineControl::StoreLinked(Input *input, const Parameter *value, bool &moved)
{
    float64 n = 0.0;
    const bool isNumber = OverlayValue::ReadNumber(value, n);
    if (input == mCenterInput)
        if (const auto *p = dynamic_cast<const Point *>(value))
            moved = (OverlayValue::Take(mCenter.x, p->X) | OverlayValue::Take(mCenter.y, p->Y)) || moved;
    for (auto [in, field] : {std::pair{mCenterXInput, &mCenter.x},
                             {mCenterYInput, &mCenter.y},
                             {mAngleInput, &mAngle},
                             {mSizeInput, &mSize},
                             {mAngleXInput, &mAngleX},
                             {mAngleYInput, &mAngleY},
                             {mTrackerSizeInput, &mTrackerSize},
                             {mTrackerSearchSizeInput, &mTrackerSearchSize}})
        if (in == input && isNumber)
            moved = OverlayValue::Take(*field, n) || moved;
    // The shapes paired with this one redraw with it.
    if (input == mOuterInput || input == mInnerInput)
        moved = true;
}

AutoRef<PolyLine> PolyLineControl::Shape() const
{
    const ReadGuard guard(*this);
    return mShape;
}

bool PolyLineControl::IsToolLocked() const
{
    const Input *main = GetMainInput();
    return main && main->GetOperator() && main->GetOperator()->IsLocked();
}

bool PolyLineControl::IsAppending() const
{
    return ModeOf() == PLM_ClickAppend || ModeOf() == PLM_DrawAppend;
}

void PolyLineControl::SetInactive(const TagList *tags)
{
    mMouse.Cancel();
    mEditor.EndNudge();
    CloseStep();
    mCreation.gesture = PolyLineCreation::PCG_None;
    HandleOverlay::SetInactive(tags);
}

// --- drawing ---

// The viewer's control size: twice its handle scale, so markers grow with
// the handles on a viewer that draws them larger.
PolyLineStyle PolyLineControl::Style(const PreviewInfo &info) const
{
    PolyLineStyle s;
    s.flags = mDisplayFlags;
    const bool grey = mShapeReadOnly || IsToolLocked() || ModeOf() == PLM_Done;
    const OrbColor base = grey ? kGrey : OrbColor();
    const float32 fade = Fade();
    s.curve = mCustomSplineColor.IsNone() ? info.GetColor(base).Faded(fade)
                                          : GColor::FromOrb(WithFade(mCustomSplineColor, fade));
    s.shadow = info.GetShadow(base).Faded(fade);
    const OrbColor keyPoint = mCustomKeyPointColor.IsNone() ? mHandleColor : mCustomKeyPointColor;
    s.keyPoint = GColor::FromOrb(WithFade(keyPoint, fade));
    s.handle = GColor::FromOrb(WithFade(mHandleColorAlt, fade));
    if (mDimmed) {
        s.keyPoint = s.keyPoint.Darker(kDimming);
        s.handle = s.handle.Darker(kDimming);
    }
    s.active = (IsActive() ? kCyan : kMagenta).Faded(fade);
    s.hover = kYellow.Faded(fade);
    s.stipple = PolyLineDrawing::StippleFor(mDisplayFlags);
    const ViewMapping &m = info.Mapping();
    s.span = OrbPoint(m.SpanX(), m.SpanY());
    const float64 half = PolyLineDrawing::MarkerSide(2.0 * info.HandleScale) / 2.0;
    s.half = OrbPoint(half / s.span.x, half / s.span.y);
    s.hot = Handles().PickedHit() ? Handles().PickedHit() : Handles().PoisedHit();
    s.pending = mCreation.gesture == PolyLineCreation::PCG_Click ||
                (mCreation.gesture == PolyLineCreation::PCG_Edit && mMouse.Current() == PolyLineMouse::PMG_Points &&
                 !mSelection.IsMultiSet());
    return s;
}

void PolyLineControl::DrawControls(PreviewInfo *info, const TagList *tags)
{
    GPainter *p = info->GetPainter();
    if (!p || info->DrawPass == 3)
        return HandleOverlay::DrawControls(info, tags);
    // The point editor follows the selection, which changes in many places.
    PolyLineDialogs::Follow(*mSurface);
    const ReadGuard guard(*this);
    p->PushAttrib();
    p->PushMatrix();
    if ((mCenterInput || mCenterXInput || mCenterYInput) && mShape && mShape->GetCount() > 0)
        DrawCentre(*p, *info);
    // From here on the painter takes image coordinates.
    const ViewMapping &m = info->Mapping();
    p->Translate(m.Origin().x, m.Origin().y);
    p->Scale(m.SpanX(), m.SpanY());
    const PolyLineStyle style = Style(*info);
    if (mShape) {
        mDrawing.Draw(*p, *mShape, mSelection, style);
        DrawExtras(*p, *mShape, style);
    }
    DrawOuter(*p, style);
    mMouse.Draw(*p, *info, style);
    if (mCreation.gesture == PolyLineCreation::PCG_Stroke) {
        p->Color(style.curve, style.shadow);
        PolyLineDrawing::DrawStrip(*p, mCreation.StrokePoints());
    }
    DrawOnionSkins(*p, *info, style);
    p->PopMatrix();
    p->PopAttrib();
    HandleOverlay::DrawControls(info, tags);
}

// A magenta cross on the centre, sized, turned about Z and then tilted
// about X and Y as the linked Inputs say.
void PolyLineControl::DrawCentre(GPainter &p, const PreviewInfo &info) const
{
    p.PushMatrix();
    p.Color(GColor::FromOrb(OrbColor(255, 0, 255)), info.GetShadow(OrbColor()));
    p.Translate(info.TransformXOut(mCenter.x), info.TransformYOut(mCenter.y));
    p.Scale(mSize, mSize, 1.0);
    p.Rotate(mAngle, 0.0, 0.0, 1.0);
    p.Rotate(mAngleX, 1.0, 0.0, 0.0);
    p.Rotate(mAngleY, 0.0, 1.0, 0.0);
    const float64 arm = kCentreArm * info.HandleScale;
    p.Begin(Graphics::GP_Lines);
    p.Vertex(-arm, 0.0), p.Vertex(arm, 0.0);
    p.Vertex(0.0, -arm), p.Vertex(0.0, arm);
    p.End();
    p.PopMatrix();
}

// The shapes of the nearby keyframes, dotted in their own colour.
void PolyLineControl::DrawOnionSkins(GPainter &p, const PreviewInfo &info, const PolyLineStyle &style) const
{
    Input *main = GetMainInput();
    const PolyLineSettings &s = mSurface->settings;
    if (!main || !main->IsAnimated() || !s.onionEnabled)
        return;
    const float64 now = GetCurrentTime();
    p.PushAttrib();
    p.LineStipple(1, s.onionStipple);
    p.Enable(Graphics::GC_LineStipple);
    for (const float64 time : SkinTimes()) {
        const AutoParam<PolyLine> skin(main, time);
        // The skins before now in their own colour, where one is set, as
        // opaque as the others.
        const OrbColor prev(s.onionPrevColor.R(), s.onionPrevColor.G(), s.onionPrevColor.B(), s.onionColor.A());
        const bool before = time < now && !s.onionPrevColor.IsNone();
        p.Color(GColor::FromOrb(before ? prev : s.onionColor), info.GetShadow(OrbColor()).Faded(0.5f));
        if (skin)
            PolyLineDrawing::DrawCurve(p, *skin, style.span);
    }
    p.PopAttrib();
}

std::vector<float64> PolyLineControl::SkinTimes() const
{
    const Input *main = GetMainInput();
    if (!main || !main->IsAnimated())
        return {};
    const float64 now = GetCurrentTime();
    const std::vector<float64> keys = main->KeyTimes();
    // Keys this near to now are the shape itself, not a skin.
    constexpr float64 kAtNow = 1e-9;
    const auto after = std::upper_bound(keys.begin(), keys.end(), now + kAtNow);
    const auto atOrAfter = std::lower_bound(keys.begin(), keys.end(), now - kAtNow);
    const auto first = atOrAfter - std::min<std::ptrdiff_t>(mSurface->settings.onionBefore, atOrAfter - keys.begin());
    const auto last = after + std::min<std::ptrdiff_t>(mSurface->settings.onionAfter, keys.end() - after);
    std::vector<float64> times(first, atOrAfter);
    times.insert(times.end(), after, last);
    return times;
}

// --- handles ---

// Key points where they show (or, hidden, the selected ones where flag 8
// asks), and the handle ends of the selected points where handles show.
void PolyLineControl::BuildHandles(const PreviewInfo &info, HandleSet &handles) const
{
    handles.Clear();
    const AutoRef<PolyLine> shape = Shape();
    if (!shape)
        return;
    const bool points = mDisplayFlags & PLD_KeyPoints;
    const bool selected = !points && !(mDisplayFlags & PLD_Handles) && (mDisplayFlags & PLD_SelectedWhenHidden);
    const bool ends = mDisplayFlags & PLD_Handles;
    const int32 count = shape->GetCount();
    // Only the handles the mouse can reach: a hit test of a large shape
    // then costs a walk over its points, not a handle for each.
    const OrbPoint mouse = info.MouseInViewer();
    const float64 reach = HandleReach(info);
    auto add = [&](OrbPoint image, uint32 part, int32 priority, int32 i) {
        const OrbPoint at = info.TransformOut(image);
        if (std::fabs(at.x - mouse.x) <= reach && std::fabs(at.y - mouse.y) <= reach)
            handles.AddPixelSquare(at, part, priority).item = i;
    };
    for (int32 i = 0; i < count; ++i) {
        const PolyPoint &pt = *shape->GetPoint(i);
        if (points || (selected && mSelection.IsSet(i)))
            add(pt.Pos(), PLP_Point, HP_Point, i);
        if (ends && mSelection.IsSet(i)) {
            add(pt.In(), PLP_InHandle, HP_Tangent, i);
            add(pt.Out(), PLP_OutHandle, HP_Tangent, i);
        }
    }
}

// In the append modes the overlay hears every hover, to show its cursor
// anywhere in the viewer.
bool PolyLineControl::HoverBounds(const PreviewInfo &info, OrbRect &bounds) const
{
    if (IsAppending())
        return false;
    const AutoRef<PolyLine> shape = Shape();
    bounds = OrbRect(1.0, 1.0, 0.0, 0.0);
    if (!shape || shape->GetCount() == 0)
        return true;
    // Every key point and the handle ends of the selected ones, with room
    // for a marker, the pick tolerance and the shape box's turning ring.
    OrbRect image(shape->First()->Pos(), shape->First()->Pos());
    auto grow = [&image](OrbPoint p) {
        image =
            OrbRect(std::min(image.x1, p.x), std::min(image.y1, p.y), std::max(image.x2, p.x), std::max(image.y2, p.y));
    };
    for (int32 i = 0; i < shape->GetCount(); ++i) {
        const PolyPoint &p = *shape->GetPoint(i);
        grow(p.Pos());
        if (mSelection.IsSet(i))
            grow(p.In()), grow(p.Out());
    }
    const OrbRect viewer = info.TransformOut(image).Normalized();
    const float64 margin = HandleReach(info) + (ShapeBox::RotateReach + 1.0) * info.PickTolerance;
    bounds = OrbRect(viewer.x1 - margin, viewer.y1 - margin, viewer.x2 + margin, viewer.y2 + margin);
    return true;
}

// How far from the mouse a marker may be and still be hit (viewer units).
float64 PolyLineControl::HandleReach(const PreviewInfo &info)
{
    return PolyLineDrawing::MarkerSide(2.0 * info.HandleScale) + 2.0 * info.PickTolerance;
}

// The control's cursor while it takes the viewer's presses; the viewer's
// own again once it does not.
void PolyLineControl::ShowCursor(const PreviewInfo &info, bool show)
{
    if (show)
        info.SetCursor(mCurrentCursor);
    else if (mCursorShown)
        info.SetCursor(nullptr);
    mCursorShown = show;
}

// --- the mouse ---

bool PolyLineControl::CanCreate() const
{
    return IsAppending() && GetMainInput() && !mShapeReadOnly && !IsToolLocked();
}

// In the append modes any press is ours: it adds a point (or closes the
// shape on its first point) or starts a stroke. In the others a press on a
// key point or a handle end picks it for a drag.
DragType PolyLineControl::ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    if (info->HotControl)
        return HandleOverlay::ControlDown(info, mouse, tags);
    const HandleHit hit = PressHit(*info);
    const OrbPoint at(info->MouseX, info->MouseY);
    if (CanCreate() && ModeOf() == PLM_ClickAppend)
        BeginClick(hit, at);
    else if (CanCreate())
        BeginStroke(at);
    else if (CanEditByMouse() && mMouse.Press(*info, hit)) {
        mCreation.gesture = PolyLineCreation::PCG_Edit;
        Pick(hit);
    }
    if (mCreation.gesture != PolyLineCreation::PCG_None) {
        mDragType = DRAG_Handle;
        ShowCursor(*info, IsAppending());
    }
    return HandleOverlay::ControlDown(info, mouse, tags);
}

// A press on the first point of an open shape of three or more closes it;
// any other adds a corner point, selected alone.
void PolyLineControl::BeginClick(HandleHit hit, OrbPoint at)
{
    const AutoRef<PolyLine> shape = Shape();
    if (shape && !shape->IsClosed() && shape->GetCount() >= 3 && hit.part == PLP_Point && hit.item == 0) {
        OpenStep("Close polygon");
        WriteShape(PolyLineCreation::Closed(*shape));
        mCreation.gesture = PolyLineCreation::PCG_Close;
        SetMode(PLM_InsertModify);
        return;
    }
    // Where the mouse is: the press, not the pick, places the point.
    OpenStep("Add Point");
    if (!WriteShape(PolyLineCreation::Appended(shape.get(), at))) {
        CloseStep();
        return;
    }
    mCreation.gesture = PolyLineCreation::PCG_Click;
    mCreation.index = Shape()->GetCount() - 1;
    mSelection.DoSet(mCreation.index, SelMask::SEL_Only);
}

void PolyLineControl::BeginStroke(OrbPoint at)
{
    mStrokeClock.start();
    mCreation.BeginStroke({at, 0.0, 1.0});
    mCreation.gesture = PolyLineCreation::PCG_Stroke;
}

// Points are edited in "Insert and Modify" and "Modify Only" (presses
// pass through in the other modes, so the shape can be left alone).
bool PolyLineControl::CanEditByMouse() const
{
    return GetMainInput() && mShape && !mShapeReadOnly && (ModeOf() == PLM_InsertModify || ModeOf() == PLM_ModifyOnly);
}

void PolyLineControl::ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    HandleOverlay::ControlMove(info, mouse, tags);
    if (mDragType != DRAG_Handle)
        return;
    const OrbPoint at(info->MouseX, info->MouseY);
    switch (mCreation.gesture) {
    case PolyLineCreation::PCG_Click:
        PullHandles(*info, at);
        break;
    case PolyLineCreation::PCG_Stroke:
        if (mCreation.AddSample({at, mStrokeClock.elapsed() / 1000.0, 1.0}, OnePixel(*info)))
            Redraw();
        break;
    case PolyLineCreation::PCG_Edit:
        mMouse.Move(*info);
        break;
    default:
        break;
    }
}

// The new point's handles follow the mouse, smooth, once it has left the
// point; they stay on the point while it has not.
void PolyLineControl::PullHandles(const PreviewInfo &info, OrbPoint to)
{
    const AutoRef<PolyLine> shape = Shape();
    // A B-spline's control points have no handles to pull.
    if (!shape || mCreation.index >= shape->GetCount() || shape->DataType() == CLSID_DataType_BSplinePolyline)
        return;
    const OrbPoint point = shape->GetPoint(mCreation.index)->Pos();
    if ((info.TransformOut(to) - info.TransformOut(point)).Length() < kPullDistance)
        to = point;
    WriteShape(PolyLineCreation::Pulled(*shape, mCreation.index, to));
}

OrbPoint PolyLineControl::OnePixel(const PreviewInfo &info)
{
    return OrbPoint(1.0 / info.Mapping().SpanX(), 1.0 / info.Mapping().SpanY());
}

void PolyLineControl::ControlUp(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    if (mCreation.gesture == PolyLineCreation::PCG_Stroke)
        EndStroke(*info);
    if (mCreation.gesture == PolyLineCreation::PCG_Edit)
        mMouse.Release(*info);
    mCreation.gesture = PolyLineCreation::PCG_None;
    CloseStep();
    HandleOverlay::ControlUp(info, mouse, tags);
    Redraw();
}

// The stroke goes in as one step: fitted ("Freehand Add Points"), or every
// sample a corner at tolerance 0 ("Add Points"), or a single point where
// the hand did not move ("Add Point"). A stroke that went away and ends on
// the shape's first point (its own, on an empty shape) closes the shape.
void PolyLineControl::EndStroke(const PreviewInfo &info)
{
    const AutoRef<PolyLine> shape = Shape();
    const std::vector<PolyLineCreation::Sample> &stroke = mCreation.Stroke();
    const bool empty = !shape || shape->GetCount() == 0;
    const OrbPoint start = info.TransformOut(empty ? stroke.front().at : shape->First()->Pos());
    auto near = [&](OrbPoint at, float64 reach) {
        const OrbPoint d = info.TransformOut(at) - start;
        return std::fabs(d.x) < reach && std::fabs(d.y) < reach;
    };
    bool away = false;
    for (const PolyLineCreation::Sample &s : stroke)
        away = away || !near(s.at, 2.0 * info.PickTolerance);
    const bool closes = away && near(stroke.back().at, info.PickTolerance) && !(shape && shape->IsClosed());
    // The closing tail on the start is left to the closing segment.
    while (closes && mCreation.Stroke().size() > 3 && near(mCreation.Stroke().back().at, info.PickTolerance))
        mCreation.DropLastSample();
    const uint32 record = (mRecordTime ? PLR_Time : 0u) | (mRecordPressure ? PLR_Pressure : 0u);
    AutoRef<PolyLine> drawn = mCreation.WithStroke(shape.get(), OnePixel(info), mReduceTolerance, record, closes);
    if (!drawn)
        return;
    if (closes)
        drawn->Close();
    OpenStep(stroke.size() < 2 ? "Add Point" : mReduceTolerance > 0.0 ? "Freehand Add Points" : "Add Points");
    WriteShape(drawn);
    if (closes)
        SetMode(PLM_InsertModify);
}

// --- the pair of shapes ---

Input *PolyLineControl::InnerInput() const
{
    return mOuterInput ? GetMainInput() : mInnerInput;
}

Input *PolyLineControl::OuterInput() const
{
    return mOuterInput ? mOuterInput : mInnerInput ? GetMainInput() : nullptr;
}

AutoRef<PolyLine> PolyLineControl::InnerShape() const
{
    return AutoParam<PolyLine>(InnerInput(), GetCurrentTime());
}

AutoRef<PolyLine> PolyLineControl::OuterShape() const
{
    return AutoParam<PolyLine>(OuterInput(), GetCurrentTime());
}

void PolyLineControl::FollowInner(const PolyLine &inner)
{
    const AutoRef<PolyLine> outer = mPairing == PAIR_Follow && mOuterInput ? OuterShape() : AutoRef<PolyLine>();
    if (!outer || outer->GetCount() != inner.GetCount())
        return;
    AutoRef<PolyLine> moved(static_cast<PolyLine *>(outer->Clone()));
    if (moved->UpdateShape(inner))
        mOuterInput->SetValue(moved.get(), GetCurrentTime());
}

// The outer shape of a pair, dotted, while it is in use.
void PolyLineControl::DrawOuter(GPainter &p, const PolyLineStyle &style) const
{
    if (!mOuterInput || mPairing == PAIR_Off)
        return;
    const AutoRef<PolyLine> outer = OuterShape();
    if (!outer || outer->GetCount() == 0)
        return;
    p.PushAttrib();
    p.LineStipple(1, 0xF0F0);
    p.Enable(Graphics::GC_LineStipple);
    p.Color(style.curve, style.shadow);
    PolyLineDrawing::DrawCurve(p, *outer, style.span);
    p.PopAttrib();
}

bool PolyLineControl::WriteShape(PolyLine *shape)
{
    return shape && SetInputs(shape, GetCurrentTime(), 0, nullptr);
}

void PolyLineControl::OpenStep(const char *name)
{
    if (mStepOpen)
        return;
    if (OrbaneDoc *doc = GetDoc()) {
        doc->StartUndo(name);
        mStepOpen = true;
    }
}

void PolyLineControl::CloseStep()
{
    if (!std::exchange(mStepOpen, false))
        return;
    // The base's own level, opened by the first write inside this step,
    // closes first: an edit from a key or the menu has no release to do it.
    ResetUndo(nullptr);
    if (OrbaneDoc *doc = GetDoc())
        doc->EndUndo(true);
}

} // namespace Orbane
