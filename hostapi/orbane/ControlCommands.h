#pragma once

#include "orbane/DragType.h"
#include "orbane/OrbID.h"

namespace Orbane {

// The commands a viewer sends to overlays through
// PreviewControl::ControlCommand. Each id's text is its own name, so a
// command reads the same in logs and scripts.
extern const OrbID CCMD_GetInputAt; // the Input whose handle is under the mouse
extern const OrbID CCMD_NeedsKey;   // data: Qt key; 1 if the overlay wants it
extern const OrbID CCMD_KeyDown;    // data: Qt key
extern const OrbID CCMD_KeyUp;      // data: Qt key
extern const OrbID CCMD_KeyUpAll;   // every key released: end the nudge's undo step
extern const OrbID CCMD_HitTest;    // data: flags in and out, bit 0 hit, bit 1 redraw
extern const OrbID CCMD_Select;
extern const OrbID CCMD_Copy;
extern const OrbID CCMD_Paste;
extern const OrbID CCMD_Delete;
extern const OrbID CCMD_FollowCursor;
extern const OrbID CCMD_TimeChanged;
extern const OrbID CCMD_ImageChanged;

} // namespace Orbane
