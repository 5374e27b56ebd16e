#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of RectangleControl. The RCID_ forms name an Input by id, the
// RCP_ forms pass the Input itself.
constexpr Tag RC_PenStyle = 0x10058000;
constexpr Tag RC_DoLockAspect = 0x10058001; // read only together with RCD_LockAspect
constexpr Tag RC_BlendMode = 0x10058002;    // blend of the image drawn inside
constexpr Tag RCD_SetX = 0x20058000;        // centre where no centre Input is linked
constexpr Tag RCD_SetY = 0x20058001;
constexpr Tag RCD_SetAngle = 0x20058002;   // angle where no angle Input is linked
constexpr Tag RCD_LockAspect = 0x20058003; // aspect; its presence locks it
constexpr Tag RCD_BlendAmount = 0x20058004;
constexpr Tag RCD_DisplayXScale = 0x20058005;
constexpr Tag RCD_DisplayYScale = 0x20058006;
constexpr Tag RCD_SetSize = 0x20058007;  // size where no size Input is linked
constexpr Tag RCD_SetAxisX = 0x20058008; // pivot axis where no axis Input is linked
constexpr Tag RCD_SetAxisY = 0x20058009;
constexpr Tag RCID_Center = 0x80058000;
constexpr Tag RCP_Center = 0x60058000;
constexpr Tag RCID_Angle = 0x80058001;
constexpr Tag RCP_Angle = 0x60058001;
constexpr Tag RCID_Image = 0x80058002;
constexpr Tag RCP_Image = 0x60058002;
constexpr Tag RCID_Size = 0x80058003;
constexpr Tag RCP_Size = 0x60058003;
constexpr Tag RCID_Axis = 0x80058004;
constexpr Tag RCP_Axis = 0x60058004;
constexpr Tag RCID_FlipX = 0x80058005;
constexpr Tag RCP_FlipX = 0x60058005;
constexpr Tag RCID_FlipY = 0x80058006;
constexpr Tag RCP_FlipY = 0x60058006;
constexpr Tag RCID_CenterX = 0x80058007;
constexpr Tag RCP_CenterX = 0x60058007;
constexpr Tag RCID_CenterY = 0x80058008;
constexpr Tag RCP_CenterY = 0x60058008;
constexpr Tag RCID_AxisX = 0x80058009;
constexpr Tag RCP_AxisX = 0x60058009;
constexpr Tag RCID_AxisY = 0x8005800a;
constexpr Tag RCP_AxisY = 0x6005800a;

extern const TagMapEntry RectangleControlTags[];

} // namespace Orbane
