#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of PointControl.
constexpr Tag PCID_PrevPoint = 0x80058000;    // id of the previous-point Input
constexpr Tag PCP_PrevPoint = 0x60058000;     // the previous-point Input itself
constexpr Tag PCD_SetPrevPointX = 0x20058000; // previous point where no Input is linked
constexpr Tag PCD_SetPrevPointY = 0x20058001;

extern const TagMapEntry PointControlTags[];

} // namespace Orbane
