#include "polyline/PolyLineMenu.h"

#include "polyline/PolyLineDrawing.h"

#include <QAction>
#include <QMenu>

#include <cstdlib>
#include <cstring>
#include <initializer_list>
#include <string>

namespace Orbane {

namespace {

using Entry = PolyLineMenuEntry;

// Read once, when the library is loaded: the menu does not change under a
// session because someone set a variable later.
const bool gTrackingSwitch = PolyLineMenu::ReadSwitch(std::getenv("ORBANE_ROTO_TRACKING"));

Entry Item(const char *text, int32 id, int32 arg = 0, uint32 flags = 0)
{
    Entry e;
    e.text = text;
    e.id = id;
    e.arg = arg;
    e.flags = flags;
    return e;
}

// A check item, checked where `on`.
Entry Check(const char *text, int32 id, bool on, int32 arg = 0)
{
    return Item(text, id, arg, MIF_CheckItem | (on ? MIF_Checked : 0u));
}

Entry Sub(const char *text, std::initializer_list<Entry> items)
{
    Entry e;
    e.text = text;
    e.items = items;
    return e;
}

Entry Separator()
{
    Entry e;
    e.separator = true;
    return e;
}

// The mode submenu's title joins the shape's name and its current mode, so
// the closed menu already says which shape it edits and how.
Entry ModeMenu(const PolyLineMenuState &s)
{
    Entry e;
    e.text =
        (s.shapeName.IsEmpty() ? std::string("Polyline") : s.shapeName.str()) + ": " + PolyLineMenu::ModeName(s.mode);
    for (int32 mode : {1, 2, 3, 4, 0})
        e.items.push_back(Check(PolyLineMenu::ModeName(mode), PolyLineMenu::ModeCommand(mode), s.mode == mode));
    return e;
}

// "Copy Path Points" and "Paste Path Points" where some points are selected
// (they act on those points); "Copy" and "Paste" where none is, acting on
// the whole shape.
void AddClipboard(std::vector<Entry> &m, const PolyLineMenuState &s)
{
    const bool points = s.selected > 0;
    m.push_back(Item(points ? "Copy Path Points" : "Copy", PLCMD_Copy));
    m.push_back(Item("Copy Path Value", PLCMD_CopyPathValue));
    m.push_back(Item("Cut Path Points", PLCMD_Cut));
    m.push_back(Item(points ? "Paste Path Points" : "Paste", PLCMD_Paste));
    m.push_back(Item("Paste With Offset", PLCMD_PasteWithOffset));
}

void AddEditing(std::vector<Entry> &m, const PolyLineMenuState &s)
{
    m.push_back(Item("Delete Points", PLCMD_DeletePoints));
    m.push_back(Check("Lock Points", PLCMD_LockPoints, s.selectedLocked));
    m.push_back(Item("Lock Point Pairs", PLCMD_LockPointPairs));
    m.push_back(Item("Edit Point\tE", PLCMD_EditPoint));
    m.push_back(Item("Linear", PLCMD_Linear));
    m.push_back(Item("Smooth", PLCMD_Smooth));
    m.push_back(Sub("Smooth Points", {Item("Default", PLCMD_SmoothPoints, 1), Item("Dialog…", PLCMD_SmoothPoints, 0)}));
    m.push_back(Sub("Smooth Animation",
                    {Item("Default", PLCMD_SmoothAnimation, 1), Item("Dialog…", PLCMD_SmoothAnimation, 0)}));
    m.push_back(Item("Ease In / Out…", PLCMD_EaseInOut));
    m.push_back(Sub("Create", {Item("Ellipse…", PLCMD_CreateEllipse), Item("Rectangle…", PLCMD_CreateRectangle),
                               Item("Arrow…", PLCMD_CreateArrow, 0, s.readOnly ? MIF_Disabled : 0u)}));
}

// The outer (feather) polyline's entries by pairing state: 2 paired, 3
// made but disabled, 0 following; an empty shape has no outline to pair.
void AddOuter(std::vector<Entry> &m, const PolyLineMenuState &s)
{
    const bool empty = s.points == 0;
    if (s.pairing == 2) {
        m.push_back(Item("Remove Outer Polyline", PLCMD_OuterMakeRemove));
        m.push_back(Item("Reset Outer Point Positions", PLCMD_OuterReset));
    } else if (s.pairing == 3) {
        m.push_back(Item("Enable Outer Polyline", PLCMD_OuterEnable));
        m.push_back(Item("Make Outer Polyline", PLCMD_OuterMakeRemove));
    } else if (!empty) {
        m.push_back(Item("Make Outer Polyline", PLCMD_OuterMakeRemove));
    }
    if (s.pairing == 0 && !empty) {
        m.push_back(Item("Follow Inner Polyline", PLCMD_FollowInner));
        m.push_back(Item("Reset Outer Point Positions", PLCMD_OuterReset));
        m.push_back(Item("Enable Polyline", PLCMD_OuterEnable));
    }
}

void AddShapeTools(std::vector<Entry> &m, const PolyLineMenuState &s)
{
    m.push_back(Item("Bezier to B-Spline", PLCMD_ToBSpline));
    m.push_back(Item("B-Spline to Bezier", PLCMD_ToBezier));
    m.push_back(Item("Cardinal to Bezier", PLCMD_CardinalToBezier));
    m.push_back(Item("Convert to XYPath", PLCMD_ToXYPath));
    m.push_back(Item("Shape Box", PLCMD_ShapeBox, 0));
    m.push_back(Item("Shape Box Both Polylines", PLCMD_ShapeBox, 1));
    const uint16 style = s.displayFlags & PLD_Styles;
    m.push_back(
        Sub("Draw Style",
            {Check("Solid", PLCMD_DrawStyle, style == 0, 0), Check("Dash", PLCMD_DrawStyle, style == PLD_Dash, 1),
             Check("Null", PLCMD_DrawStyle, style == PLD_Null, 5), Separator(),
             Item("Custom Spline Color…", PLCMD_SplineColor), Item("Custom Key Point Color…", PLCMD_KeyPointColor),
             Item("Custom Handle Color…", PLCMD_HandleColor)}));
    if (s.bspline)
        m.push_back(Item("Subdivide…", PLCMD_Subdivide));
    const bool canReduce = s.points >= 3 && !s.readOnly && !s.currentTimeOnly;
    m.push_back(Check("Reduce Points…", PLCMD_ReducePoints, s.reduceVisible));
    if (!canReduce)
        m.back().flags |= MIF_Disabled;
}

// Publishing is offered only where the tool asks for it.
void AddPublishing(std::vector<Entry> &m, const PolyLineMenuState &s)
{
    if (!s.canPublish)
        return;
    m.push_back(
        Sub("Publish", {Item("Publish Points", PLCMD_PublishPoints), Item("Unpublish Points", PLCMD_UnpublishPoints),
                        Item("Publish All Points", PLCMD_PublishAll),
                        Item("Make Points Follow Nearby Published Points", PLCMD_FollowNearby),
                        Item("Stop Points Following", PLCMD_StopFollowing)}));
    m.push_back(Sub("Publish To", {Item("Publish To Path", PLCMD_PublishTo, PT_Path),
                                   Item("Publish To XYPath", PLCMD_PublishTo, PT_XYPath),
                                   Item("Publish To IntelliTrack Tracker", PLCMD_PublishTo, PT_IntelliTrack),
                                   Item("Publish To Point Tracker", PLCMD_PublishTo, PT_PointTracker)}));
}

void AddDisplay(std::vector<Entry> &m, const PolyLineMenuState &s)
{
    const uint16 f = s.displayFlags;
    m.push_back(Check("Point Numbers", PLCMD_PointNumbers, s.pointNumbers));
    m.push_back(Check("Current Time Only", PLCMD_CurrentTimeOnly, s.currentTimeOnly));
    m.push_back(Item("Select All", PLCMD_SelectAll));
    m.push_back(Check("Lock Point Selection", PLCMD_LockSelection, s.lockSelection));
    m.push_back(Check("Publishing Path Points Enabled", PLCMD_PublishPathPoints, s.publishPathPoints));
    m.push_back(Sub("Show", {Check("Key Points", PLCMD_ShowKeyPoints, f & PLD_KeyPoints),
                             Check("Handles", PLCMD_ShowHandles, f & PLD_Handles, 0),
                             Check("Convex Hull Polygon", PLCMD_ShowHandles, s.hull, 1),
                             Check("Polygon", PLCMD_ShowPolygon, f & PLD_Curve),
                             Check("Show Tagged Point IDs", PLCMD_ShowTaggedIDs, f & PLD_TaggedIDs)}));
    m.push_back(Item("Polygon Keyframe List...", PLCMD_KeyframeList));
}

void AddTime(std::vector<Entry> &m, const PolyLineMenuState &s)
{
    m.push_back(Sub(
        "Onion Skin",
        {Check("Enable", PLCMD_OnionEnable, s.onionEnabled), Item("Onion skin settings…", PLCMD_OnionSettings),
         Check("Onion skin click to Set Current Time", PLCMD_OnionClickTime, s.onionClickTime),
         Item("Reset onion skin anchor", PLCMD_OnionResetAnchor), Item("Set prev skin color", PLCMD_OnionSetPrevColor),
         Item("Reset prev skin color", PLCMD_OnionResetPrevColor)}));
    Entry roto = Sub("Roto Assist", {Check("Enable", PLCMD_RotoEnable, s.rotoEnabled)});
    if (s.trackingSwitch)
        roto.items.push_back(Check("Track Points", PLCMD_RotoTrackPoints, s.rotoTrackPoints));
    roto.items.push_back(Check("Roto Assist Multiple Points", PLCMD_RotoMultiple, s.rotoMultiple));
    roto.items.push_back(Item(("Distance " + std::to_string(s.rotoDistance) + "…").c_str(), PLCMD_RotoDistance));
    if (s.trackingSwitch)
        roto.items.push_back(Item("Frame Skip", PLCMD_RotoFrameSkip));
    for (Entry e : {Item("Create Track Points", PLCMD_RotoCreateTrackPoints), Item("Reset", PLCMD_RotoReset),
                    Check("Show Tracker Area", PLCMD_RotoShowArea, s.rotoShowArea),
                    Check("Track Pattern Edit Mode", PLCMD_RotoPatternEdit, s.rotoPatternEdit),
                    Item("Reset Track Pattern to PolyLine Points", PLCMD_RotoResetPattern)})
        roto.items.push_back(e);
    m.push_back(roto);
    m.push_back(Check("Edit Multiple Polylines", PLCMD_EditMultiplePolys, s.editMultiplePolys));
    Entry frames = Sub("Edit Multiple Frames", {});
    int32 n = 0;
    for (const char *name : {"None", "Prev", "Next", "All"}) {
        frames.items.push_back(Check(name, PLCMD_MultiFrame, s.multiFrame == n, n));
        ++n;
    }
    m.push_back(frames);
    m.push_back(Check("Stop Rendering", PLCMD_StopRendering, s.stopRendering));
}

void AddFiles(std::vector<Entry> &m, const PolyLineMenuState &s)
{
    Entry record = Sub("Record", {});
    int32 n = 0;
    for (const char *name : {"Time", "Pressure", "Height", "Angle XY", "Angle Z", "Rotation"}) {
        record.items.push_back(Check(name, PLCMD_RecordTime + n, s.record[n]));
        ++n;
    }
    m.push_back(record);
    m.push_back(Item("Export…", PLCMD_Export));
    m.push_back(Sub(
        "Import", {Item("Import LightWave MOT…", PLCMD_ImportMot), Item("Import Motion Path…", PLCMD_ImportMotionPath),
                   Item("Import Shape…", PLCMD_ImportShape), Item("Import SSF Shapes…", PLCMD_ImportSsf),
                   Item("Import FXS (Silhouette) Shapes…", PLCMD_ImportFxs),
                   Item("Import Nuke Shapes…", PLCMD_ImportNuke), Item("Import Boujou Path…", PLCMD_ImportBoujou)}));
}

void FillAction(QAction *action, const Entry &e)
{
    action->setData(PolyLineMenu::Pack(e.id, e.arg));
    action->setProperty("menuId", e.id);
    action->setProperty("menuArg", e.arg);
    action->setProperty("menuFlags", e.flags);
    action->setEnabled(!(e.flags & MIF_Disabled));
    action->setCheckable(e.flags & MIF_CheckItem);
    action->setChecked(e.flags & MIF_Checked);
}

} // namespace

bool PolyLineMenu::TrackingSwitch()
{
    return gTrackingSwitch;
}

bool PolyLineMenu::ReadSwitch(const char *value)
{
    if (!value)
        return false;
    for (const char *on : {"1", "true", "yes", "on", "TRUE", "YES", "ON", "True", "Yes", "On"})
        if (std::strcmp(value, on) == 0)
            return true;
    return false;
}

const char *PolyLineMenu::ModeName(int32 mode) noexcept
{
    switch (mode) {
    case 1:
        return "Click Append";
    case 2:
        return "Draw Append";
    case 3:
        return "Insert and Modify";
    case 4:
        return "Modify Only";
    default:
        return "Done";
    }
}

int32 PolyLineMenu::ModeCommand(int32 mode) noexcept
{
    return mode >= 1 && mode <= 4 ? PLCMD_ClickAppend + mode - 1 : PLCMD_Done;
}

// The groups follow the order of the entries; separators only part them.
std::vector<PolyLineMenuEntry> PolyLineMenu::Build(const PolyLineMenuState &s)
{
    std::vector<Entry> m;
    m.push_back(ModeMenu(s));
    m.push_back(Item("Set Focus", PLCMD_SetFocus));
    m.push_back(Check("Closed", PLCMD_Closed, s.closed));
    m.push_back(Separator());
    AddClipboard(m, s);
    m.push_back(Separator());
    AddEditing(m, s);
    m.push_back(Separator());
    AddOuter(m, s);
    m.push_back(Separator());
    AddShapeTools(m, s);
    AddPublishing(m, s);
    m.push_back(Separator());
    AddDisplay(m, s);
    m.push_back(Separator());
    AddTime(m, s);
    m.push_back(Separator());
    AddFiles(m, s);
    return m;
}

void PolyLineMenu::Fill(QMenu *menu, const std::vector<PolyLineMenuEntry> &entries)
{
    for (const Entry &e : entries) {
        if (e.separator) {
            menu->addSeparator();
        } else if (!e.items.empty() || e.id == 0) {
            QMenu *sub = menu->addMenu(QString::fromUtf8(e.text.c_str()));
            Fill(sub, e.items);
        } else {
            FillAction(menu->addAction(QString::fromUtf8(e.text.c_str())), e);
        }
    }
}

} // namespace Orbane
