#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of LabelControl and its nest, separator and spacer variants.
constexpr Tag LBLC_DropDownButton = 0x10050000; // the header folds: an arrow, a click shows or hides its group
constexpr Tag LBLC_NumInputs = 0x10050001;      // how many Inputs after this one form its group
constexpr Tag LBLC_NestLevel = 0x10050002;      // indentation of the header, one step a level
constexpr Tag LBLC_Expanded = 0x10050003;       // the open state while the Input has no value yet
constexpr Tag LBLC_Align = 0x10050004;          // "Align": where the text sits
constexpr Tag LBLC_Bold = 0x10050005;           // bold text
constexpr Tag LBLC_Height = 0x10050006;         // a spacer's height, a separator's room
constexpr Tag LBLC_TextColor = 0x10050007;      // colour of the text
constexpr Tag LBLC_LineColor = 0x10050008;      // colour of the separator's line
constexpr Tag LBLCS_Tooltip = 0x30050000;       // tip shown over the text

extern const TagMapEntry LabelControlTags[];

} // namespace Orbane
