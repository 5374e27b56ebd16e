#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of ColorSuppressionControl. The control stands on the red
// hue's Number Input; the other five hues are further Number Inputs.
constexpr Tag CSCP_YellowInput = 0x40050000;
constexpr Tag CSCP_GreenInput = 0x40050001;
constexpr Tag CSCP_CyanInput = 0x40050002;
constexpr Tag CSCP_BlueInput = 0x40050003;
constexpr Tag CSCP_MagentaInput = 0x40050004;
constexpr Tag CSCD_Maximum = 0x20050000;   // the value at a spoke's end (default 1)
constexpr Tag CSC_ShowValues = 0x10050000; // the six value boxes beside the hexagon (default on)

extern const TagMapEntry ColorSuppressionControlTags[];

} // namespace Orbane
