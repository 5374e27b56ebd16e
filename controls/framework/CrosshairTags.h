#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of CrosshairControl.
constexpr Tag CHC_Style = 0x10058000;    // 0 axis crosshair, 1-4 simple shapes, 5+ hidden
constexpr Tag CHCD_FollowX = 0x20058000; // mouse position at which following began
constexpr Tag CHCD_FollowY = 0x20058001;
constexpr Tag CHCD_FollowOrigX = 0x20058002; // the point when following began
constexpr Tag CHCD_FollowOrigY = 0x20058003;
constexpr Tag CHCD_CurrentX = 0x20058004; // read only: the point as last drawn
constexpr Tag CHCD_CurrentY = 0x20058005;

extern const TagMapEntry CrosshairControlTags[];

} // namespace Orbane
