// The polyline overlay's command surface: the context menu, the viewer
// toolbar, the keys it claims, the viewer commands it answers and its tool
// tips. The commands themselves run in PolyLineCommandRunner.
#include "polyline/PolyLineControl.h"

#include "polyline/PolyLineCommandRunner.h"
#include "polyline/PolyLineDialogs.h"
#include "polyline/PolyLineKeys.h"
#include "polyline/PolyLineMenu.h"
#include "polyline/PolyLineTips.h"
#include "polyline/PolyLineToolbar.h"

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

#include <cmath>
#include <cstdio>
#include <cstring>

namespace Orbane {

namespace {

// Onion skins are sampled this finely for the hover tip.
constexpr int32 kSkinSamples = 16;
// CCMD_Select with every bit set selects every point.
constexpr uint64 kSelectAll = ~uint64(0);

} // namespace

// --- the context menu ---

void PolyLineControl::AddToMenu(QMenu *menu, PreviewInfo *info, const TagList *tags)
{
    const AutoRef<PolyLine> shape = Shape();
    const Input *main = GetMainInput();
    const OrbaneDoc *doc = GetDoc();
    PolyLineMenuState s;
    s.shapeName = main ? main->GetName() : "";
    s.mode = ModeOf();
    s.closed = shape && shape->IsClosed();
    s.points = shape ? shape->GetCount() : 0;
    s.selected = mSelection.GetSetCount();
    s.readOnly = mShapeReadOnly;
    s.bspline = shape && shape->DataType() == CLSID_DataType_BSplinePolyline;
    s.pairing = mPairing;
    s.selectedLocked = mEditor.IsSelectionLockedPoint();
    s.lockPointPairs = mEditor.LockPairs();
    s.currentTimeOnly = mEditor.CurrentTimeOnly();
    s.canPublish = mCanPublishPoints;
    s.reduceVisible = mSurface->settings.reduceOpen;
    s.pointNumbers = mSurface->settings.pointNumbers;
    s.lockSelection = mEditor.IsSelectionLocked();
    s.publishPathPoints = mSurface->settings.publishPathPoints;
    s.displayFlags = mDisplayFlags;
    s.hull = mSurface->settings.hull;
    s.onionEnabled = mSurface->settings.onionEnabled;
    s.onionClickTime = mSurface->settings.onionClickTime;
    s.rotoEnabled = mSurface->settings.rotoEnabled;
    s.rotoMultiple = mSurface->settings.rotoMultiple;
    s.rotoTrackPoints = mSurface->settings.rotoTrackPoints;
    s.rotoShowArea = mSurface->settings.rotoShowArea;
    s.rotoPatternEdit = mSurface->settings.rotoPatternEdit;
    s.rotoDistance = mSurface->settings.rotoDistance;
    s.editMultiplePolys = doc && doc->GetPrefs().GetLong(PREF_SelectPointsFromMultiPolies, 0) != 0;
    s.multiFrame = mEditor.GetMultiFrame();
    s.stopRendering = mStopRendering != 0;
    const bool record[6] = {mRecordTime,    mRecordPressure, mRecordHeight,
                            mRecordAngleXY, mRecordAngleZ,   mRecordRotation};
    std::copy(std::begin(record), std::end(record), s.record);
    s.trackingSwitch = PolyLineMenu::TrackingSwitch();
    PolyLineMenu::Fill(menu, PolyLineMenu::Build(s));
    HandleOverlay::AddToMenu(menu, info, tags);
}

bool PolyLineControl::HandleMenu(int32 id, PreviewInfo *info, const TagList *tags)
{
    return RunWhole(info, PolyLineMenu::IdOf(id), PolyLineMenu::ArgOf(id), tags);
}

bool PolyLineControl::RunCommand(int32 command, int32 arg, const TagList *tags)
{
    return RunWhole(nullptr, command, arg, tags);
}

// A menu choice or a button is a gesture of its own: its writes are one
// undo step, closed with it.
bool PolyLineControl::RunWhole(PreviewInfo *info, int32 command, int32 arg, const TagList *tags)
{
    const bool done = PolyLineCommandRunner(*this, info, tags).Run(command, arg);
    ResetUndo(nullptr);
    return done;
}

// --- the toolbar ---

void PolyLineControl::GetAvailableEvents(std::vector<ToolbarEvent> &events, const TagList *tags)
{
    HandleOverlay::GetAvailableEvents(events, tags);
    for (ToolbarEvent &e : PolyLineToolbar::Events({mSurface->settings.rotoDistance, mSurface->settings.rotoFrameSkip}))
        events.push_back(std::move(e));
}

bool PolyLineControl::HandleEvent(const OrbID &event, PreviewInfo *info, const TagList *tags)
{
    int32 command = 0, arg = 0;
    if (!PolyLineToolbar::CommandOf(event, command, arg))
        return HandleOverlay::HandleEvent(event, info, tags);
    return RunWhole(info, command, arg, tags);
}

// --- viewer commands, in the order they are tested ---

uint64 PolyLineControl::ControlCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags)
{
    if (command == CCMD_ImageChanged) {
        UpdateDisplay(nullptr, nullptr);
    } else if (command == CCMD_Copy) {
        return RunCommand(PLCMD_Copy, 0, tags) ? 1 : 0;
    } else if (command == CCMD_Delete) {
        return RunCommand(PLCMD_DeletePoints, 0, tags) ? 1 : 0;
    } else if (command == CCMD_Paste) {
        return RunCommand(PLCMD_Paste, 0, tags) ? 1 : 0;
    } else if (command == CCMD_Select) {
        // data: the point to select alone, or every bit set for all of them.
        if (data == kSelectAll)
            return RunCommand(PLCMD_SelectAll, 0, tags) ? 1 : 0;
        const AutoRef<PolyLine> shape = Shape();
        if (!shape || data >= uint64(shape->GetCount()))
            return 0;
        mSelection.DoSet(int32(data), SelMask::SEL_Only);
        Redraw();
        return 1;
    } else if (command == CCMD_NeedsKey || command == CCMD_KeyDown || command == CCMD_KeyUp) {
        return KeyCommand(info, command, data, tags);
    } else if (command == CCMD_KeyUpAll) {
        // The keys' edits (a run of nudges) end as one step.
        mEditor.EndNudge();
        ResetUndo(nullptr);
    } else if (command == CCMD_TimeChanged) {
        // A new time may be a new keyframe: the point numbers and the skins move.
        PolyLineDialogs::Follow(*mSurface);
        Redraw();
    } else if (command == CCMD_HitTest) {
        const uint64 result = HandleOverlay::ControlCommand(info, command, data, tags);
        // Over the shape box its part's cursor shows.
        const int32 boxCursor = IsAppending() ? -1 : mMouse.HoverCursor(*info);
        if (boxCursor >= 0)
            mCurrentCursor = &(*mCursors)[std::size_t(boxCursor)];
        else if (!IsAppending())
            mCurrentCursor = &(*mCursors)[0];
        ShowCursor(*info, (IsAppending() && !(data & 1)) || boxCursor >= 0);
        return boxCursor >= 0 ? result | 1 : result;
    }
    return HandleOverlay::ControlCommand(info, command, data, tags);
}

// The key table of PolyLineKeys, with the modifiers held at the event.
uint64 PolyLineControl::KeyCommand(PreviewInfo *info, const OrbID &command, uint64 data, const TagList *tags)
{
    const int key = int(data);
    const Qt::KeyboardModifiers mods = KeyModifiers();
    if (!PolyLineKeys::Claims(key, mods))
        return 0;
    if (command == CCMD_KeyDown) {
        const PolyLineKeys::Action action = PolyLineKeys::ActionOf(key, mods);
        if (action.kind == PolyLineKeys::Action::Command)
            PolyLineCommandRunner(*this, info, tags).Run(action.command, action.arg);
        else if (action.kind == PolyLineKeys::Action::Nudge)
            mEditor.NudgeKey(key, mods, *info);
    }
    return 1;
}

// --- tips ---

bool PolyLineControl::ControlGetTip(PreviewInfo *info, char *buffer, const TagList *tags)
{
    Input *main = GetMainInput();
    const AutoRef<PolyLine> shape = Shape();
    if (!main || !shape)
        return HandleOverlay::ControlGetTip(info, buffer, tags);
    std::string tip;
    const HandleHit hit = PressHit(*info);
    if (hit && hit.item >= 0 && hit.item < shape->GetCount()) {
        const PolyPoint &pt = *shape->GetPoint(hit.item);
        char tag[32] = {};
        if (pt.Flags & PPF_Published)
            std::snprintf(tag, sizeof tag, "Published %d", int(pt.TagID));
        else if (pt.Flags & PPF_Tagged)
            std::snprintf(tag, sizeof tag, "Tag %d", int(pt.TagID));
        PolyLineTips::Point p;
        p.tool = main->GetOperator() ? main->GetOperator()->GetName() : "";
        p.shape = main->GetName();
        p.index = hit.item;
        p.role = mInnerInput                      ? PolyLineTips::Outer
                 : (mOuterInput && mPairing == 2) ? PolyLineTips::Inner
                                                  : PolyLineTips::Single;
        p.tag = tag;
        p.animated = main->IsAnimated();
        p.time = GetCurrentTime();
        tip = PolyLineTips::ForPoint(p);
    } else if (mSurface->settings.onionEnabled && main->IsAnimated()) {
        const OrbPoint mouse = info->MouseInViewer();
        for (const float64 time : SkinTimes()) {
            const AutoParam<PolyLine> skin(main, time);
            const int32 n = skin ? skin->GetSegmentsCount() * kSkinSamples : 0;
            for (int32 i = 0; i <= n && tip.empty(); ++i)
                if ((info->TransformOut(skin->ValueAt(float64(i) / kSkinSamples)) - mouse).Length() <
                    info->PickTolerance)
                    tip = PolyLineTips::ForSkin(time);
        }
    }
    if (tip.empty())
        return HandleOverlay::ControlGetTip(info, buffer, tags);
    std::snprintf(buffer, TipSize, "%s", tip.c_str());
    return true;
}

// --- state ---

// What the menu's own settings show, for scripts.
void PolyLineControl::AddSurfaceState(ScriptVal &state) const
{
    const PolyLineSettings &s = mSurface->settings;
    for (auto [key, on] : {std::pair{"pointNumbers", s.pointNumbers},
                           {"hull", s.hull},
                           {"onionSkins", s.onionEnabled},
                           {"onionClickTime", s.onionClickTime},
                           {"rotoAssist", s.rotoEnabled},
                           {"reduceDialog", s.reduceOpen},
                           {"pointEditor", mSurface->pointEditor && mSurface->pointEditor->isVisible()},
                           {"keyList", mSurface->keyList && mSurface->keyList->isVisible()},
                           {"onionDialog", mSurface->onion && mSurface->onion->isVisible()},
                           {"stopRendering", mStopRendering != 0}})
        state.SetKey(ScriptVal(key), ScriptVal(on));
    // Always there, empty until the overlay has told the user something.
    state.SetKey(ScriptVal("message"), ScriptVal(LastMessage().c_str()));
    state.SetKey(ScriptVal("rotoDistance"), ScriptVal(s.rotoDistance));
    state.SetKey(ScriptVal("rotoFrameSkip"), ScriptVal(s.rotoFrameSkip));
    state.SetKey(ScriptVal("onionBefore"), ScriptVal(s.onionBefore));
    state.SetKey(ScriptVal("onionAfter"), ScriptVal(s.onionAfter));
    state.SetKey(ScriptVal("onionStipple"), ScriptVal(int32(s.onionStipple)));
    char colour[16];
    std::snprintf(colour, sizeof colour, "#%02x%02x%02x%02x", s.onionColor.R(), s.onionColor.G(), s.onionColor.B(),
                  s.onionColor.A());
    state.SetKey(ScriptVal("onionColor"), ScriptVal(colour));
    const bool record[6] = {mRecordTime,    mRecordPressure, mRecordHeight,
                            mRecordAngleXY, mRecordAngleZ,   mRecordRotation};
    int32 bits = 0;
    for (int32 i = 0; i < 6; ++i)
        bits |= record[i] ? 1 << i : 0;
    state.SetKey(ScriptVal("record"), ScriptVal(bits));
}

// --- what the settings add to the drawing ---

// The point numbers beside their points and the Bezier control polygon,
// in image coordinates (the painter is set up for them).
void PolyLineControl::DrawExtras(Graphics::GPainter &p, const PolyLine &shape, const PolyLineStyle &style) const
{
    const int32 n = shape.GetCount();
    if (mSurface->settings.hull && n > 1) {
        p.Color(style.handle, style.shadow);
        p.Begin(Graphics::GP_LineStrip);
        for (int32 i = 0; i < n; ++i) {
            const PolyPoint &pt = *shape.GetPoint(i);
            if (i > 0)
                p.Vertex(pt.InX, pt.InY);
            p.Vertex(pt.X, pt.Y);
            if (i + 1 < n || shape.IsClosed())
                p.Vertex(pt.OutX, pt.OutY);
        }
        if (shape.IsClosed())
            p.Vertex(shape.GetPoint(0)->InX, shape.GetPoint(0)->InY),
                p.Vertex(shape.GetPoint(0)->X, shape.GetPoint(0)->Y);
        p.End();
    }
    if (mSurface->settings.pointNumbers) {
        p.Color(style.keyPoint, style.shadow);
        for (int32 i = 0; i < n; ++i) {
            const PolyPoint &pt = *shape.GetPoint(i);
            p.Text(pt.X + 2.0 * style.half.x, pt.Y + 2.0 * style.half.y, std::to_string(i + 1).c_str());
        }
    }
}

} // namespace Orbane
