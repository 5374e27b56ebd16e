#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of ComboControl (both the number and the identifier variant).
constexpr Tag CC_LabelPosition = 0x10050000; // "LabelPosition": which layout places the label
constexpr Tag CC_AlphaSort = 0x10050001;     // sort the items by text
constexpr Tag CCS_AddString = 0x38040000;    // starts a new item (repeatable)
constexpr Tag CCS_AddSeparator = 0x38040001; // adds a separator (repeatable)
constexpr Tag CCID_AddID = 0x88030000;       // identifier of the item being declared (repeatable)

extern const TagMapEntry ComboControlTags[];

} // namespace Orbane
