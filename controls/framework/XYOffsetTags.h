#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tag of XYOffsetControl: the Point Input the arrow starts from
// (image centre where none is linked).
constexpr Tag XOP_Center = 0x60058000;

extern const TagMapEntry XYOffsetControlTags[];

} // namespace Orbane
