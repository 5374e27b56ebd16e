#include "orbane/ControlCommands.h"

namespace Orbane {

const OrbID CCMD_GetInputAt("CCMD_GetInputAt");
const OrbID CCMD_NeedsKey("CCMD_NeedsKey");
const OrbID CCMD_KeyDown("CCMD_KeyDown");
const OrbID CCMD_KeyUp("CCMD_KeyUp");
const OrbID CCMD_KeyUpAll("CCMD_KeyUpAll");
const OrbID CCMD_HitTest("CCMD_HitTest");
const OrbID CCMD_Select("CCMD_Select");
const OrbID CCMD_Copy("CCMD_Copy");
const OrbID CCMD_Paste("CCMD_Paste");
const OrbID CCMD_Delete("CCMD_Delete");
const OrbID CCMD_FollowCursor("CCMD_FollowCursor");
const OrbID CCMD_TimeChanged("CCMD_TimeChanged");
const OrbID CCMD_ImageChanged("CCMD_ImageChanged");

} // namespace Orbane
