#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of CheckBoxControl.
constexpr Tag CBC_TriState = 0x10050000; // offer the third, mixed state

extern const TagMapEntry CheckBoxControlTags[];

} // namespace Orbane
