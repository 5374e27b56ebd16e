#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of FontfileControl.
constexpr Tag FFC_ShowPreview = 0x10050000;  // show a line of text in the chosen font (default on)
constexpr Tag FFCS_PreviewText = 0x30050000; // the text of that line
constexpr Tag FFCP_StyleInput = 0x40050000;  // the Text Input that holds the style ("Bold Italic")

extern const TagMapEntry FontfileControlTags[];

} // namespace Orbane
