#include "overlays/TrackerControl.h"

#include "framework/OverlayValue.h"
#include "framework/TrackerTags.h"

#include "orbane/AutoParam.h"
#include "orbane/GPainter.h"
#include "orbane/Input.h"
#include "orbane/PreviewInfo.h"
#include "orbane/ScriptVal.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

using Graphics::GColor;
using Graphics::GPainter;
using OV = OverlayValue;

namespace {

// Handle parts: the pattern box's inside (moves the point), its corners
// and the search box's corners (items 0..3: the corner's quadrant).
constexpr uint32 kInside = 1;
constexpr uint32 kPatternCorner = 2;
constexpr uint32 kSearchCorner = 4;
constexpr float64 kCorner = 3.0; // half a corner knob, handle pixels
// A box never shrinks below this many image pixels across.
constexpr float64 kMinPixels = 3.0;

const OrbID kTrackForward("TrackForward");
const OrbID kTrackBackward("TrackBackward");

// The corner of quadrant `k` (0 bottom left, counter-clockwise) as signs.
OrbPoint CornerSign(int32 k)
{
    return {k == 1 || k == 2 ? 1.0 : -1.0, k >= 2 ? 1.0 : -1.0};
}

} // namespace

TrackerControl::TrackerControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : HandleOverlay(reg, args, tags)
{
    TrackerControl::SetAttrsTagList(nullptr, tags);
}

bool TrackerControl::GetAttrsTagList(TagList &tags) const
{
    HandleOverlay::GetAttrsTagList(tags);
    tags.Set(TRC_PatternInput, mRoles[R_Pattern]);
    tags.Set(TRC_SearchInput, mRoles[R_Search]);
    tags.Set(TRC_ShowPath, mShowPath);
    tags.Set(TRC_PathFrames, mPathFrames);
    tags.Set(TRC_PatternUpdate, mPatternUpdate);
    tags.Set(TRC_SubPixel, mSubPixel);
    tags.Set(TRC_PathColor, int32(mPathColor.Packed()));
    tags.Set(TRC_BoxColor, int32(mBoxColor.Packed()));
    tags.Set(TRCD_MinScore, mMinScore);
    return true;
}

void TrackerControl::GetState(ScriptVal &state) const
{
    HandleOverlay::GetState(state);
    for (const auto &[key, v] : {std::pair{"x", mPoint.x},
                                 {"y", mPoint.y},
                                 {"patternWidth", mPattern.x},
                                 {"patternHeight", mPattern.y},
                                 {"searchWidth", mSearch.x},
                                 {"searchHeight", mSearch.y}})
        state.SetKey(ScriptVal(key), ScriptVal(v));
    const Input *in = GetMainInput();
    state.SetKey(ScriptVal("keys"), ScriptVal(int64(in ? in->KeyTimes().size() : 0)));
    state.SetKey(ScriptVal("tracked"), ScriptVal(mTracked));
    state.SetKey(ScriptVal("trackMessage"), ScriptVal(mTrackMessage.toStdString()));
}

void TrackerControl::GetAvailableEvents(std::vector<ToolbarEvent> &events, const TagList *)
{
    events.push_back({kTrackBackward,
                      OrbString("Track Backward"),
                      OrbString("Track the pattern backward from the current frame"),
                      {}});
    events.push_back(
        {kTrackForward, OrbString("Track Forward"), OrbString("Track the pattern forward from the current frame"), {}});
}

bool TrackerControl::HandleEvent(const OrbID &event, PreviewInfo *info, const TagList *tags)
{
    const bool forward = event == kTrackForward;
    if (!forward && event != kTrackBackward)
        return HandleOverlay::HandleEvent(event, info, tags);
    Run run;
    if (!ParseRun(tags, forward, run))
        return false;
    return Track(run) > 0;
}

// The run's frames: "start:end" from a script, else from the current frame
// to the sequence's end (found when the sequence is read; INT32_MIN here).
bool TrackerControl::ParseRun(const TagList *tags, bool forward, Run &run)
{
    run.step = forward ? 1 : -1;
    run.fromScript = tags && tags->GetBool(PCA_FromScript, false);
    run.start = int32(std::lround(GetCurrentTime()));
    run.end = INT32_MIN;
    const char *value = tags ? tags->GetString(PCA_CommandValue) : nullptr;
    if (!value || !*value)
        return true;
    const QStringList parts = QString(value).split(':');
    bool ok = parts.size() == 2;
    auto frame = [&ok](const QString &text, int32 fallback) {
        if (text.trimmed().isEmpty())
            return fallback;
        bool good = false;
        const int32 n = text.trimmed().toInt(&good);
        ok = ok && good;
        return n;
    };
    if (ok) {
        run.start = frame(parts[0], run.start);
        run.end = frame(parts[1], INT32_MIN);
    }
    if (!ok)
        Finish(0, QString("the frames \"%1\" are not \"start:end\"").arg(value));
    return ok;
}

bool TrackerControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    ReadLook(tags);
    return HandleOverlay::SetAttrsTagList(input, tags);
}

void TrackerControl::ReadLook(const TagList &tags)
{
    mRoles[R_Pattern] = tags.GetInt(TRC_PatternInput, mRoles[R_Pattern]);
    mRoles[R_Search] = tags.GetInt(TRC_SearchInput, mRoles[R_Search]);
    mShowPath = tags.GetBool(TRC_ShowPath, mShowPath);
    mPathFrames = std::max(tags.GetInt(TRC_PathFrames, mPathFrames), 0);
    mPatternUpdate = std::clamp(tags.GetInt(TRC_PatternUpdate, mPatternUpdate), 0, 1);
    mSubPixel = tags.GetBool(TRC_SubPixel, mSubPixel);
    mPathColor = OrbColor(uint32(tags.GetLong(TRC_PathColor, int64(mPathColor.Packed()))));
    mBoxColor = OrbColor(uint32(tags.GetLong(TRC_BoxColor, int64(mBoxColor.Packed()))));
    const float64 score = tags.GetDouble(TRCD_MinScore, mMinScore);
    if (std::isfinite(score))
        mMinScore = std::clamp(score, -1.0, 1.0);
    // Inputs bound before the roles were known take their role now.
    for (std::size_t i = 0; i < Inputs().size(); ++i) {
        const AutoParameter value(Inputs()[i]->GetValue(GetCurrentTime()));
        TakeValue(int32(i), value.get());
    }
}

bool TrackerControl::AddInput(Input *input, const TagList *tags)
{
    return AddInputTaking(input, tags,
                          [this](int32 index, const Parameter *value, bool &) { TakeValue(index, value); });
}

void TrackerControl::TakeValue(int32 index, const Parameter *value)
{
    OrbPoint p;
    if (!OV::ReadPoint(value, p))
        return;
    if (index == 0)
        mPoint = p;
    for (int32 role = 0; role < R_Count; ++role)
        if (HoldsRole(mRoles, role) && mRoles[role] == index && p.x > 0.0 && p.y > 0.0)
            BoxSize(role) = p;
}

void TrackerControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return;
    // Keys come and go with the same value now: the path still changes.
    TakeValue(IndexOf(input), value);
    HandleOverlay::NotifyChanged(input, value, tags);
}

void TrackerControl::BuildHandles(const PreviewInfo &info, HandleSet &handles) const
{
    handles.Clear();
    const OrbPoint at = info.TransformOut(mPoint);
    if (!OV::OnScreen(at))
        return;
    const float64 scale = info.HandleScale > 0 ? info.HandleScale : 1.0;
    for (int32 k = 0; k < 4; ++k) {
        const OrbPoint sign = CornerSign(k);
        for (const auto &[part, size] : {std::pair{kPatternCorner, mPattern}, {kSearchCorner, mSearch}}) {
            const OrbPoint corner = info.TransformOut(mPoint + OrbPoint(sign.x * size.x, sign.y * size.y) * 0.5);
            handles.AddBox(corner, {-kCorner, -kCorner}, {kCorner, kCorner}, part, HP_Corner).item = k;
        }
    }
    const OrbPoint half = info.TransformOut(mPoint + mPattern * 0.5) - at;
    const OrbPoint h(std::fabs(half.x) / scale, std::fabs(half.y) / scale);
    handles.AddBox(at, -h, h, kInside, HP_Body);
}

DragType TrackerControl::ControlDown(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    if (info->HotControl)
        return HandleOverlay::ControlDown(info, mouse, tags);
    if (const HandleHit hit = PressHit(*info)) {
        mDragType = DRAG_Handle;
        mGrabOffset = info->TransformOut(mPoint) - info->MouseInViewer();
        Pick(hit);
    }
    return HandleOverlay::ControlDown(info, mouse, tags);
}

void TrackerControl::ControlMove(PreviewInfo *info, const OrbPointI &mouse, const TagList *tags)
{
    HandleOverlay::ControlMove(info, mouse, tags);
    const HandleHit picked = Handles().PickedHit();
    if (mDragType != DRAG_Handle || !picked)
        return;
    if (picked.part == kInside) {
        const OrbPoint to = info->TransformIn(info->MouseInViewer() + mGrabOffset);
        if (OV::Finite(to) && (Moved(to.x, mPoint.x) || Moved(to.y, mPoint.y))) {
            OpenGesture("Move Tracker");
            WritePoint(to, 0);
        }
        return;
    }
    // A corner: the box keeps its middle on the point and reaches the mouse.
    const OrbPoint mouseImage(info->MouseX, info->MouseY);
    const OrbPoint size = (mouseImage - mPoint) * 2.0;
    Resize(*info, picked.part == kPatternCorner ? R_Pattern : R_Search, {std::fabs(size.x), std::fabs(size.y)});
}

// Keeps the pattern inside the search box (and the other way round), both
// at least a few pixels across; writes the role's Input where it has one.
void TrackerControl::Resize(const PreviewInfo &info, int32 role, OrbPoint size)
{
    size = {std::max(size.x, kMinPixels / std::max(info.ImageWidth, 1)),
            std::max(size.y, kMinPixels / std::max(info.ImageHeight, 1))};
    if (!OV::Finite(size))
        return;
    if (role == R_Pattern)
        size = {std::min(size.x, mSearch.x), std::min(size.y, mSearch.y)};
    else
        size = {std::max(size.x, mPattern.x), std::max(size.y, mPattern.y)};
    OrbPoint &box = BoxSize(role);
    if (!(Moved(size.x, box.x) || Moved(size.y, box.y)))
        return;
    OpenGesture(role == R_Pattern ? "Resize Tracker Pattern" : "Resize Tracker Search Area");
    if (HoldsRole(mRoles, role))
        WritePoint(size, uint32(mRoles[role]));
    else
        box = size;
    Redraw();
}

uint64 TrackerControl::ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags)
{
    uint64 result = 0;
    if (NudgeCommand(info, command, data, tags, mPoint, 1.0 / info->ImageHeight, result))
        return result;
    return HandleOverlay::ControlCommand(info, command, data, tags);
}

void TrackerControl::DrawControls(PreviewInfo *info, const TagList *tags)
{
    GPainter *p = info->GetPainter();
    if (p && info->DrawPass != 3 && OV::OnScreen(info->TransformOut(mPoint))) {
        p->PushAttrib();
        DrawPath(*p, *info);
        DrawBox(*p, *info, mSearch, kSearchCorner);
        DrawBox(*p, *info, mPattern, kPatternCorner);
        // The point itself: a small cross.
        const OrbPoint at = info->TransformOut(mPoint);
        BeginHandle(*p, *info, at, kInside);
        p->Begin(Graphics::GP_Lines);
        for (const OrbPoint &d : {OrbPoint(4, 0), OrbPoint(0, 4)}) {
            p->Vertex(-d.x, -d.y);
            p->Vertex(d.x, d.y);
        }
        p->End();
        EndHandle(*p);
        p->PopAttrib();
    }
    HandleOverlay::DrawControls(info, tags);
}

void TrackerControl::DrawBox(GPainter &p, const PreviewInfo &info, OrbPoint size, uint32 corners) const
{
    const GColor color = mBoxColor.IsNone() ? HandleFill(info, corners == kPatternCorner ? kInside : 0)
                                            : info.GetColor(mBoxColor).Faded(Fade());
    p.Color(color, HandleShadow(info));
    if (corners == kSearchCorner) {
        // The search box is dashed: it is where the tracker looks, not what.
        p.Enable(Graphics::GC_LineStipple);
        p.LineStipple(1, 0x0F0F);
    }
    p.Begin(Graphics::GP_LineLoop);
    for (int32 k = 0; k < 4; ++k) {
        const OrbPoint sign = CornerSign(k);
        const OrbPoint c = info.TransformOut(mPoint + OrbPoint(sign.x * size.x, sign.y * size.y) * 0.5);
        p.Vertex(c.x, c.y);
    }
    p.End();
    p.Disable(Graphics::GC_LineStipple);
    for (int32 k = 0; k < 4; ++k) {
        const OrbPoint sign = CornerSign(k);
        BeginHandle(p, info, info.TransformOut(mPoint + OrbPoint(sign.x * size.x, sign.y * size.y) * 0.5), corners, k);
        p.Rectangle(-kCorner, -kCorner, kCorner, kCorner);
        EndHandle(p);
    }
}

// The point's keys as a line with a dot on each, within TRC_PathFrames of
// the current time where that is set.
void TrackerControl::DrawPath(GPainter &p, const PreviewInfo &info) const
{
    Input *in = GetMainInput();
    if (!mShowPath || !in)
        return;
    const float64 now = GetCurrentTime();
    std::vector<OrbPoint> path;
    for (const float64 t : in->KeyTimes()) {
        if (mPathFrames > 0 && std::fabs(t - now) > mPathFrames)
            continue;
        const AutoParameter key(in->GetKey(t));
        OrbPoint at;
        if (OV::ReadPoint(key.get(), at))
            path.push_back(info.TransformOut(at));
    }
    if (path.size() < 2)
        return;
    const GColor color = mPathColor.IsNone() ? info.GetColor(OrbColor()) : info.GetColor(mPathColor);
    p.Color(color, HandleShadow(info));
    p.Begin(Graphics::GP_LineStrip);
    for (const OrbPoint &v : path)
        p.Vertex(v.x, v.y);
    p.End();
    p.PointSize(3.0f);
    p.Begin(Graphics::GP_Points);
    for (const OrbPoint &v : path)
        p.Vertex(v.x, v.y);
    p.End();
}

} // namespace Orbane
