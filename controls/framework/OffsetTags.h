#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of OffsetControl (a point's X and Y edit boxes).
constexpr Tag OFC_Decimals = 0x10050000;  // decimal places shown; -1: as many as needed
constexpr Tag OFCD_DragStep = 0x20050000; // change per pixel of a sideways drag on a box

extern const TagMapEntry OffsetControlTags[];

} // namespace Orbane
