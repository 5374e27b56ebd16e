#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of GradientControl. The control stands on a ScriptVal Input
// holding { interpolation = "linear" | "smooth", stops = { { pos, r, g, b, a }, ... } }.
constexpr Tag GRDC_ShowAlpha = 0x10050000; // stops carry alpha: 8-digit hex, checkerboard (default on)
constexpr Tag GRDC_MaxStops = 0x10050001;  // clicks add stops only up to this many (default 16)

extern const TagMapEntry GradientControlTags[];

} // namespace Orbane
