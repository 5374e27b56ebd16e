#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of ButtonControl.
constexpr Tag BTNC_Align = 0x10050000;    // alignment of the button ("Align")
constexpr Tag BTNCS_Execute = 0x30050000; // script run when the button is pressed

extern const TagMapEntry ButtonControlTags[];

} // namespace Orbane
