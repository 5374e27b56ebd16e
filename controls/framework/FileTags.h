#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of FileControl.
constexpr Tag FC_SaveFile = 0x10050000;       // browse asks where to save: a file that is not there yet is fine
constexpr Tag FC_Directory = 0x10050001;      // the Input names a folder, not a file
constexpr Tag FC_RelativeToComp = 0x10050002; // chosen paths are written relative to the comp's folder
constexpr Tag FCS_Filter = 0x30050000;        // name filters of the browse dialog ("Images (*.exr *.png)")

extern const TagMapEntry FileControlTags[];

} // namespace Orbane
