#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of ClipControl.
constexpr Tag CLCP_InInput = 0x40050000;  // the Number Input of the first frame used (trim in)
constexpr Tag CLCP_OutInput = 0x40050001; // the Number Input of the last frame used (trim out)
constexpr Tag CLCS_Filter = 0x30050000;   // name filters of the browse dialog

extern const TagMapEntry ClipControlTags[];

} // namespace Orbane
