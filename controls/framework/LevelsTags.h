#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of LevelsControl. The control stands on the input black
// point's Number Input.
constexpr Tag LVLCP_WhiteInput = 0x40050000; // the input white point's Number Input
constexpr Tag LVLCP_GammaInput = 0x40050001; // the gamma's Number Input
constexpr Tag LVLC_LogScale = 0x10050000;    // the histogram starts on the log scale (default on)

// Script tags of LevelsOutputControl. The control stands on the output
// black's Number Input.
constexpr Tag LVLOCP_WhiteInput = 0x40050000;   // the output white's Number Input
constexpr Tag LVLOC_GradientColor = 0x10050000; // the ramp's colour at 1 (default white; kind 5)
constexpr Tag LVLOC_AllowInvert = 0x10050001;   // black may pass white, inverting the output

extern const TagMapEntry LevelsControlTags[];
extern const TagMapEntry LevelsOutputControlTags[];

} // namespace Orbane
