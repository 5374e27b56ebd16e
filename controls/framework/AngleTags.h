#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of AngleControl. The ACID_ forms name an Input by id, the ACP_
// forms pass the Input itself.
constexpr Tag ACD_MinRadius = 0x20058000;
constexpr Tag ACD_RadiusScale = 0x20058001;
constexpr Tag ACD_FollowX = 0x20058002; // centre used while following the cursor
constexpr Tag ACD_FollowY = 0x20058003;
constexpr Tag ACD_FollowAngle = 0x20058004;  // offset added while following
constexpr Tag ACD_CurrentAngle = 0x20058005; // read only
constexpr Tag ACID_Center = 0x80058000;
constexpr Tag ACP_Center = 0x60058000;
constexpr Tag ACID_Radius = 0x80058001;
constexpr Tag ACP_Radius = 0x60058001;
constexpr Tag ACID_CenterX = 0x80058002;
constexpr Tag ACP_CenterX = 0x60058002;
constexpr Tag ACID_CenterY = 0x80058003;
constexpr Tag ACP_CenterY = 0x60058003;
constexpr Tag ACID_CenterZ = 0x80058004;
constexpr Tag ACP_CenterZ = 0x60058004;
// Tools choose the dial, scripts do not: no row in the table below.
// 1 draws the dial and grabs its ring; 0 grabs the end of the radius arm
// and draws nothing.
constexpr Tag AC_DialStyle = 0x10058000;

extern const TagMapEntry AngleControlTags[];

} // namespace Orbane
