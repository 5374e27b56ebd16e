#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of RangeControl. The control stands on the low end's Input.
constexpr Tag RNGCP_HighInput = 0x40050000;  // the high end's Number Input
constexpr Tag RNGCD_MinAllowed = 0x20050000; // neither end goes below
constexpr Tag RNGCD_MaxAllowed = 0x20050001; // neither end goes above
constexpr Tag RNGCD_MinScale = 0x20050002;   // the value at the left of the track
constexpr Tag RNGCD_MaxScale = 0x20050003;   // the value at the right of the track
constexpr Tag RNGCD_MinSpan = 0x20050004;    // the least distance from low to high (default 0)
constexpr Tag RNGCD_DefaultLow = 0x20050005; // what a double click on the track puts back
constexpr Tag RNGCD_DefaultHigh = 0x20050006;
constexpr Tag RNGC_DecimalPlaces = 0x10050000;  // values are rounded to so many places (default 3)
constexpr Tag RNGC_IntegerDisplay = 0x10050001; // whole numbers only
constexpr Tag RNGC_PushOther = 0x10050002;      // an end dragged into the other pushes it along
constexpr Tag RNGC_TickCount = 0x10050003;      // ticks under the track
constexpr Tag RNGCS_LowName = 0x30050000;       // the low end's name: its tip and its undo steps
constexpr Tag RNGCS_HighName = 0x30050001;

extern const TagMapEntry RangeControlTags[];

} // namespace Orbane
