#include "polyline/PolyLineToolbar.h"

#include "polyline/PolyLineMenu.h"

#include <cstdio>
#include <string>

namespace Orbane {

namespace {

using Event = PreviewControl::ToolbarEvent;

// A button's id names its command and argument, so that a press needs no
// table of its own: "PolyLine.<command hex>.<arg>".
OrbID IdOf(int32 command, int32 arg)
{
    char id[48];
    std::snprintf(id, sizeof id, "PolyLine.%X.%d", unsigned(command), int(arg));
    return OrbID(id);
}

Event Button(const char *tip, const char *label, int32 command, int32 arg = 0)
{
    Event e;
    e.id = IdOf(command, arg);
    e.tip = tip;
    e.label = label;
    return e;
}

Event PopDown(const char *tip, const char *label, std::vector<Event> items)
{
    Event e;
    e.id = PreviewControl::ToolbarPopDown;
    e.tip = tip;
    e.label = label;
    e.items = std::move(items);
    return e;
}

Event Separator()
{
    Event e;
    e.id = PreviewControl::ToolbarSeparator;
    return e;
}

std::string Counted(const char *format, int32 n)
{
    char text[64];
    std::snprintf(text, sizeof text, format, int(n));
    return text;
}

} // namespace

std::vector<Event> PolyLineToolbar::Events(const Values &values)
{
    const std::string distance = Counted("Distance %d…", values.rotoDistance);
    const std::string skip = Counted("Track Frame Skip %d…", values.rotoFrameSkip);
    return {
        Button("Click Append", "Click", PLCMD_ClickAppend),
        Button("Draw Append", "Draw", PLCMD_DrawAppend),
        Button("Insert and Modify", "Insert", PLCMD_InsertModify),
        Button("Modify Only", "Modify", PLCMD_ModifyOnly),
        Button("Done", "Done", PLCMD_Done),
        Separator(),
        Button("Current Time Only", "Current", PLCMD_CurrentTimeOnly),
        Button("Close the Polyline", "Closed", PLCMD_Closed),
        Button("Lock Points", "Lock", PLCMD_LockPoints),
        Button("Select All points", "Select All", PLCMD_SelectAll),
        Separator(),
        Button("Show Key Points", "Keys", PLCMD_ShowKeyPoints),
        Button("Show All Handles", "Handles", PLCMD_ShowHandles),
        Button("Show Polygon curve", "Polygon", PLCMD_ShowPolygon),
        Separator(),
        Button("Shape Box", "Shape", PLCMD_ShapeBox),
        Button("Delete Points (Del)", "Delete", PLCMD_DeletePoints),
        Button("Reduce Points", "Reduce", PLCMD_ReducePoints),
        Separator(),
        PopDown("Publish Menu", "Publish",
                {Button("Publish Points and Animate With a Path", "Publish to Path", PLCMD_PublishTo, PT_Path),
                 Button("Publish Points and Animate With a XYPath", "Publish to XYPath", PLCMD_PublishTo, PT_XYPath),
                 Button("Publish Points and Attach to a Tracker with IntelliTrack", "Publish to IntelliTrack Tracker",
                        PLCMD_PublishTo, PT_IntelliTrack),
                 Button("Publish Points and Attach to a Tracker", "Publish to Point Tracker", PLCMD_PublishTo,
                        PT_PointTracker),
                 Button("Unpublish Points", "Unpublish Points", PLCMD_UnpublishPoints)}),
        Button("Make Points Follow Nearby Published Points", "Follow Points", PLCMD_FollowNearby),
        Separator(),
        Button("Make Double Poly", "Double Poly", PLCMD_OuterMakeRemove),
        Button("Follow Inner Poly", "Follow Inner", PLCMD_FollowInner),
        Separator(),
        PopDown("Multiframe Menu", "Multiframe",
                {Button("No Multiframe Editing", "None", PLCMD_MultiFrame, 0),
                 Button("Editing Multiframes Previous", "Prev", PLCMD_MultiFrame, 1),
                 Button("Editing Multiframes Next", "Next", PLCMD_MultiFrame, 2),
                 Button("Editing Multiframes All", "All", PLCMD_MultiFrame, 3)}),
        Separator(),
        PopDown(
            "Onion Skin", "Onion Skin",
            {Button("Onion Skin Settings…", "Onion Skin Settings…", PLCMD_OnionSettings),
             Button("Click on Shape to Set Current Time", "Click on Shape to Set Current Time", PLCMD_OnionClickTime),
             Button("Enabled Setting Current Time", "Enabled Setting Current Time", PLCMD_OnionClickArmed),
             Button("Reset Anchor to Current Time", "Reset Anchor to Current Time", PLCMD_OnionResetAnchor),
             Button("Set Previous Skin Color", "Set Previous Skin Color", PLCMD_OnionSetPrevColor),
             Button("Reset Previous Skin Color", "Reset Previous Skin Color", PLCMD_OnionResetPrevColor)}),
        Separator(),
        PopDown("Roto Assist", "Roto Assist",
                {Button("Auto-roto Edges", "Auto-roto Edges", PLCMD_AutoRotoEdges),
                 Button("Track Points", "Track Points", PLCMD_RotoTrackPoints),
                 Button("Create Track Points", "Create Track Points", PLCMD_RotoCreateTrackPoints),
                 Button("Reset", "Reset", PLCMD_RotoReset),
                 Button("Show Tracker Area", "Show Tracker Area", PLCMD_RotoShowArea),
                 Button("Track Pattern Edit Mode", "Track Pattern Edit Mode", PLCMD_RotoPatternEdit),
                 Button("Roto Assist Multiple Points", "Roto Assist Multiple Points", PLCMD_RotoMultiple),
                 Button(distance.c_str(), distance.c_str(), PLCMD_RotoDistance),
                 Button(skip.c_str(), skip.c_str(), PLCMD_RotoFrameSkip),
                 Button("Reset Track Pattern To PolyLine Points", "Reset Track Pattern To PolyLine Points",
                        PLCMD_RotoResetPattern)}),
    };
}

bool PolyLineToolbar::CommandOf(const OrbID &id, int32 &command, int32 &arg)
{
    unsigned c = 0;
    int a = 0;
    char tail = 0;
    if (std::sscanf(id.c_str(), "PolyLine.%X.%d%c", &c, &a, &tail) != 2)
        return false;
    command = int32(c);
    arg = a;
    return true;
}

} // namespace Orbane
