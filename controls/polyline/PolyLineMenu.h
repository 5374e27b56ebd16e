#pragma once

#include "orbane/OrbString.h"
#include "orbane/Types.h"

#include <vector>

class QMenu;

namespace Orbane {

// The command ids of the polyline overlay: the context menu, the toolbar
// and the keys all end in one of these, with an argument.
enum PolyLineCommand : int32
{
    PLCMD_SelectAll = 0x20001,
    PLCMD_DeletePoints = 0x20002,
    PLCMD_Smooth = 0x20003,
    PLCMD_Linear = 0x20004,
    PLCMD_SmoothPoints = 0x20005,    // arg 1 default, 0 dialog
    PLCMD_SmoothAnimation = 0x20006, // arg 1 default, 0 dialog
    PLCMD_EaseInOut = 0x20007,
    PLCMD_Closed = 0x20008,
    PLCMD_ReducePoints = 0x2000A,
    PLCMD_ShapeBox = 0x2000B, // arg 1: both polylines
    PLCMD_SplineColor = 0x2000C,
    PLCMD_Subdivide = 0x2000D,
    PLCMD_ClickAppend = 0x2000E,
    PLCMD_DrawAppend = 0x2000F,
    PLCMD_InsertModify = 0x20010,
    PLCMD_ModifyOnly = 0x20011,
    PLCMD_Done = 0x20012,
    PLCMD_LockPoints = 0x20013,
    PLCMD_PointNumbers = 0x20014,
    PLCMD_RecordTime = 0x20015, // to PLCMD_RecordTime + 5: time, pressure, height, angle XY, angle Z, rotation
    PLCMD_CurrentTimeOnly = 0x2001B,
    PLCMD_EditPoint = 0x2001C,
    PLCMD_CopyPathValue = 0x2001F,
    PLCMD_Copy = 0x20020,
    PLCMD_Cut = 0x20021,
    PLCMD_Paste = 0x20022,
    PLCMD_PasteWithOffset = 0x20023,
    PLCMD_LockSelection = 0x20024,
    PLCMD_ShowKeyPoints = 0x20025,
    PLCMD_ShowHandles = 0x20026, // arg 1: the convex hull polygon
    PLCMD_ShowTaggedIDs = 0x20027,
    PLCMD_KeyframeList = 0x20028,
    PLCMD_OnionEnable = 0x2002A,
    PLCMD_OnionSettings = 0x2002B,
    PLCMD_OnionClickArmed = 0x2002C, // toolbar only
    PLCMD_OnionClickTime = 0x2002D,
    PLCMD_OnionResetAnchor = 0x2002E,
    PLCMD_OnionSetPrevColor = 0x2002F,
    PLCMD_OnionResetPrevColor = 0x20030,
    PLCMD_PublishPathPoints = 0x20031,
    PLCMD_StopRendering = 0x20032,
    PLCMD_Export = 0x2003E,
    PLCMD_ImportMotionPath = 0x2003F,
    PLCMD_ImportMot = 0x20040,
    PLCMD_ImportShape = 0x20041,
    PLCMD_ImportSsf = 0x20042,
    PLCMD_ImportFxs = 0x20043,
    PLCMD_ImportNuke = 0x20044,
    PLCMD_ImportBoujou = 0x20045,
    PLCMD_PublishPoints = 0x20047,
    PLCMD_UnpublishPoints = 0x20048,
    PLCMD_PublishAll = 0x20049,
    PLCMD_FollowNearby = 0x2004A,
    PLCMD_StopFollowing = 0x2004B,
    PLCMD_PublishTo = 0x2004D, // arg: PublishTarget
    PLCMD_SetFocus = 0x2004E,
    PLCMD_KeyPointColor = 0x2004F,
    PLCMD_HandleColor = 0x20050,
    PLCMD_CreateRectangle = 0x20051,
    PLCMD_CreateEllipse = 0x20052,
    PLCMD_CreateArrow = 0x20054,
    PLCMD_ToBSpline = 0x20055,
    PLCMD_ToBezier = 0x20056,
    PLCMD_CardinalToBezier = 0x20058,
    PLCMD_ToXYPath = 0x2005B,
    PLCMD_OuterMakeRemove = 0x2005C,
    PLCMD_OuterEnable = 0x2005D,
    PLCMD_OuterReset = 0x2005E,
    PLCMD_LockPointPairs = 0x2005F,
    PLCMD_FollowInner = 0x20060,
    PLCMD_ShowPolygon = 0x20061,
    PLCMD_DrawStyle = 0x20062, // arg 0 solid, 1 dash, 5 null
    PLCMD_EditMultiplePolys = 0x20063,
    PLCMD_MultiFrame = 0x20064, // arg 0 none, 1 prev, 2 next, 3 all
    PLCMD_RotoEnable = 0x2006A,
    PLCMD_RotoTrackPoints = 0x2006B,
    PLCMD_RotoFrameSkip = 0x2006C,
    PLCMD_RotoMultiple = 0x2006D,
    PLCMD_RotoDistance = 0x2006E,
    PLCMD_RotoCreateTrackPoints = 0x2006F,
    PLCMD_RotoReset = 0x20070,
    PLCMD_RotoShowArea = 0x20071,
    PLCMD_RotoPatternEdit = 0x20072,
    PLCMD_RotoResetPattern = 0x20073,
    PLCMD_AutoRotoEdges = 0x20074, // toolbar only
    // Key-only actions (no menu entry).
    PLCMD_NextPoint = 0x20100,    // arg +1 / -1
    PLCMD_NextKeyframe = 0x20101, // arg +1 / -1
    PLCMD_ToggleMarkers = 0x20102,
    PLCMD_FinishMode = 0x20103,
    PLCMD_FlipPoints = 0x20104, // arg 0 X, 1 Y
    PLCMD_TagPoints = 0x20105,
    PLCMD_ClosePolygon = 0x20106,
};

enum PublishTarget : int32
{
    PT_Path = 0,
    PT_XYPath = 1,
    PT_IntelliTrack = 2,
    PT_PointTracker = 3,
};

// Bits of a menu entry's flag word.
enum MenuItemFlag : uint32
{
    MIF_Disabled = 0x001,
    MIF_Checked = 0x008,
    MIF_CheckItem = 0x400,
};

// One entry of the context menu: a command with its argument and flag word,
// a submenu (items) or a separator.
struct PolyLineMenuEntry
{
    OrbString text;
    int32 id = 0;
    int32 arg = 0;
    uint32 flags = 0;
    std::vector<PolyLineMenuEntry> items;
    bool separator = false;
};

// What the menu's texts, conditions and checks read of the overlay.
struct PolyLineMenuState
{
    OrbString shapeName; // the Input's name, the first half of the mode submenu's title
    int32 mode = 0;
    bool closed = false;
    int32 points = 0;
    int32 selected = 0;
    bool readOnly = false;
    bool bspline = false;
    int32 pairing = 1;
    bool selectedLocked = false;
    bool lockPointPairs = false;
    bool currentTimeOnly = false;
    bool reduceVisible = false;
    bool canPublish = false;
    bool pointNumbers = false;
    bool lockSelection = false;
    bool publishPathPoints = false;
    uint16 displayFlags = 0;
    bool hull = false;
    bool onionEnabled = false;
    bool onionClickTime = false;
    bool rotoEnabled = false, rotoMultiple = false, rotoTrackPoints = false;
    bool rotoShowArea = false, rotoPatternEdit = false;
    int32 rotoDistance = 0;
    bool editMultiplePolys = false;
    int32 multiFrame = 0;
    bool stopRendering = false;
    bool record[6] = {};
    bool trackingSwitch = false;
};

// The polyline overlay's context menu as data, and its Qt form: each QAction
// carries its command id, argument and flag word as the properties "menuId",
// "menuArg" and "menuFlags", its data() packs id and argument for
// HandleMenu, and its enabled, checkable and checked state agree with the
// flag word.
class PolyLineMenu
{
public:
    // The environment switch ORBANE_ROTO_TRACKING, read once when the
    // library loads ("1", "true", "yes" or "on" is on; off by default).
    static bool TrackingSwitch();
    static bool ReadSwitch(const char *value);

    static std::vector<PolyLineMenuEntry> Build(const PolyLineMenuState &s);
    static void Fill(QMenu *menu, const std::vector<PolyLineMenuEntry> &entries);

    // data() of an action: the id in the low 24 bits, the argument above.
    static int32 Pack(int32 id, int32 arg) noexcept { return (id & 0xFFFFFF) | (arg << 24); }
    static int32 IdOf(int32 packed) noexcept { return packed & 0xFFFFFF; }
    static int32 ArgOf(int32 packed) noexcept { return packed >> 24; }

    // The text of the mode of `mode` ("Done" for any unknown one).
    static const char *ModeName(int32 mode) noexcept;
    static int32 ModeCommand(int32 mode) noexcept;
};

} // namespace Orbane
