#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tag of ScrewControl (the thumbwheel).
constexpr Tag SCRD_Step = 0x20050000; // change per pixel the wheel turns

extern const TagMapEntry ScrewControlTags[];

} // namespace Orbane
