#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of PolyLineControl. Each linked Input comes as a pair: PLCP_ passes
// the Input itself, PLCID_ names it by id; PLCD_ gives the value used where no
// Input is linked.
constexpr Tag PLC_DrawMode = 0x10058000;         // initial editing mode (low nibble)
constexpr Tag PLC_RecordTime = 0x10058001;       // freehand drawing stores per point: time
constexpr Tag PLC_RecordPressure = 0x10058002;   // pen pressure
constexpr Tag PLC_RecordHeight = 0x10058003;     // pen height
constexpr Tag PLC_RecordAngleXY = 0x10058004;    // pen tilt in XY
constexpr Tag PLC_RecordAngleZ = 0x10058005;     // pen angle about Z
constexpr Tag PLC_RecordRotation = 0x10058006;   // pen barrel rotation
constexpr Tag PLC_CanPublishPoints = 0x10058007; // the menu offers point publishing
constexpr Tag PLC_CurrentTimeOnly = 0x10058008;  // edits apply at the current time only
constexpr Tag PLC_ShowKeyPoints = 0x10058009;
constexpr Tag PLC_ShowHandles = 0x1005800A;
constexpr Tag PLC_StopRendering = 0x1005800B;
constexpr Tag PLC_Animated = 0x1005800C;               // creates the keyframe list
constexpr Tag PLC_HandleColor = 0x1005800D;            // key point and handle colour
constexpr Tag PLC_FollowExternMatchPoint = 0x1005800E; // read from the source tool's attributes
constexpr Tag PLC_ShowPolyLine = 0x1005800F;
constexpr Tag PLC_DrawStyle = 0x10058010; // 0 solid, 1 dash, 2, 5 null
constexpr Tag PLC_ShowTaggedPointIDs = 0x10058015;
// Creation tags without a script name (so not in the tag map).
constexpr Tag PLC_PairFromAttach = 0x10058011;     // the pairing state comes from the attach result
constexpr Tag PLC_KeepFlag = 0x10058012;           // a bool the control keeps
constexpr Tag PLC_ShowSelectedHidden = 0x10058013; // selected points drawn with points and handles hidden
constexpr Tag PLC_KeyPointColor = 0x10058014;      // the custom key point colour
// Host tags the control reads: the overlay colour of any preview control
// (its custom spline colour) and the source tool's "follow inner" setting.
constexpr Tag PCA_Color = 0x1003000F;
constexpr Tag TOOL_FollowInner = 0x10030005;
constexpr Tag PLCP_Center = 0x60058000;
constexpr Tag PLCID_Center = 0x80058000;
constexpr Tag PLCD_SetX = 0x20058000;
constexpr Tag PLCD_SetY = 0x20058001;
constexpr Tag PLCP_Angle = 0x60058001;
constexpr Tag PLCID_Angle = 0x80058001;
constexpr Tag PLCD_SetAngle = 0x20058002;
constexpr Tag PLCP_Size = 0x60058002;
constexpr Tag PLCID_Size = 0x80058002;
constexpr Tag PLCD_SetSize = 0x20058003;
constexpr Tag PLCP_Displacement = 0x60058003;
constexpr Tag PLCID_Displacement = 0x80058003;
constexpr Tag PLCP_CurrentTimePoint = 0x60058004;
constexpr Tag PLCID_CurrentTimePoint = 0x80058004;
constexpr Tag PLCP_AngleX = 0x60058005;
constexpr Tag PLCID_AngleX = 0x80058005;
constexpr Tag PLCD_SetAngleX = 0x20058004;
constexpr Tag PLCP_AngleY = 0x60058006;
constexpr Tag PLCID_AngleY = 0x80058006;
constexpr Tag PLCD_SetAngleY = 0x20058005;
constexpr Tag PLCP_AngleZ = 0x60058007;
constexpr Tag PLCID_AngleZ = 0x80058007;
constexpr Tag PLCP_InPolyLine2 = 0x60058008;
constexpr Tag PLCID_InPolyLine2 = 0x80058008;
constexpr Tag PLCP_CenterX = 0x60058009;
constexpr Tag PLCID_CenterX = 0x80058009;
constexpr Tag PLCP_CenterY = 0x6005800A;
constexpr Tag PLCID_CenterY = 0x8005800A;
constexpr Tag PLCP_CenterZ = 0x6005800B;
constexpr Tag PLCID_CenterZ = 0x8005800B;
constexpr Tag PLCP_TrackerSize = 0x6005800D;
constexpr Tag PLCID_TrackerSize = 0x8005800D;
constexpr Tag PLCD_SetTrackerSize = 0x20058006;
constexpr Tag PLCP_TrackerSearchSize = 0x6005800E;
constexpr Tag PLCID_TrackerSearchSize = 0x8005800E;
constexpr Tag PLCD_SetTrackerSearchSize = 0x20058007;
constexpr Tag PLCP_InPolyLine = 0x6005800F;
constexpr Tag PLCID_InPolyLine = 0x8005800F;

extern const TagMapEntry PolyLineControlTags[];

} // namespace Orbane
