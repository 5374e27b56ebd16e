#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of the list controls: ListControl and ScriptValListControl
// share these names.
constexpr Tag LC_Rows = 0x10050000;       // visible height in rows
constexpr Tag LC_AlphaSort = 0x10050001;  // sort the items by text
constexpr Tag ICS_AddString = 0x38040000; // adds an item by name (repeatable)
constexpr Tag INPID_AddID = 0x88030000;   // adds an item by identifier (repeatable)

extern const TagMapEntry ListControlTags[];

} // namespace Orbane
