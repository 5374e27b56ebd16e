#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of CheckListControl: named check boxes whose states are the
// bits of one number Input.
constexpr Tag CLC_Columns = 0x10050000;       // boxes per row (default 1)
constexpr Tag CLC_SelectButtons = 0x10050001; // offer "All" and "None" (default true)
constexpr Tag CLC_AlphaSort = 0x10050002;     // sort the boxes by text
constexpr Tag CLCS_AllText = 0x30050000;      // text of the button that checks every box
constexpr Tag CLCS_NoneText = 0x30050001;     // text of the button that clears every box
constexpr Tag CLCS_AddString = 0x38040000;    // adds a box (repeatable)
constexpr Tag CLCD_ItemBit = 0x28030000;      // the bit of the box being declared (repeatable)

extern const TagMapEntry CheckListControlTags[];

} // namespace Orbane
