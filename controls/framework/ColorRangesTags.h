#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of ColorRangesControl.
constexpr Tag CRC_SmoothFalloff = 0x10050000; // the falloffs are smooth (default) or straight
constexpr Tag CRC_ShowMidtones = 0x10050001;  // the midtone range drawn, dashed (default on)
constexpr Tag CRC_Height = 0x10050002;        // the graph's height in pixels (default 110)
constexpr Tag CRCD_SnapStep = 0x20050000;     // the ends snap to this step (0: off)

extern const TagMapEntry ColorRangesControlTags[];

} // namespace Orbane
