#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of SliderControl.
constexpr Tag IC_TickFreq = 0x10050000;   // tick count
constexpr Tag SLCS_LowName = 0x30050000;  // caption under the low end
constexpr Tag SLCS_MidName = 0x30050001;  // caption under the middle
constexpr Tag SLCS_HighName = 0x30050002; // caption under the high end

extern const TagMapEntry SliderControlTags[];

} // namespace Orbane
