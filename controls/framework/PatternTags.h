#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of PatternControl. The control stands on a Number Input: the
// chosen pattern's index (0 Checker, 1 Horizontal stripes, 2 Vertical
// stripes, 3 Diagonal, 4 Dots, 5 Grid).
constexpr Tag PTNC_TileSize = 0x10050000; // the previews' tile, in pixels (default 8; 2 to 64)
constexpr Tag PTNC_InkColor = 0x10050001; // the previews' ink, a colour (default light grey)

extern const TagMapEntry PatternControlTags[];

} // namespace Orbane
