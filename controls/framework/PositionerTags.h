#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of PositionerControl. The layer's box is Width x Height
// image widths (as displayed) times Size, turned by Angle degrees, with its
// point (AnchorX, AnchorY) (0..1 across it) on the position. Each of Width,
// Height, Angle and Size may come from a Number Input instead (PSID_ by id,
// PSP_ the Input itself), which then wins over the plain tag.
constexpr Tag PS_ShowBox = 0x10058000;      // draw and grab the box (default on); off: the centre only
constexpr Tag PS_SnapToPixels = 0x10058001; // drags put the position on whole image pixels
constexpr Tag PS_Axis = 0x10058002;         // 0 drags move freely, 1 along X only, 2 along Y only
constexpr Tag PSD_Width = 0x20058000;       // default 0.25
constexpr Tag PSD_Height = 0x20058001;      // default 0.25
constexpr Tag PSD_AnchorX = 0x20058002;     // default 0.5
constexpr Tag PSD_AnchorY = 0x20058003;     // default 0.5
constexpr Tag PSD_Angle = 0x20058004;       // default 0
constexpr Tag PSID_Width = 0x80058000;
constexpr Tag PSP_Width = 0x60058000;
constexpr Tag PSID_Height = 0x80058001;
constexpr Tag PSP_Height = 0x60058001;
constexpr Tag PSID_Angle = 0x80058002;
constexpr Tag PSP_Angle = 0x60058002;
constexpr Tag PSID_Size = 0x80058003;
constexpr Tag PSP_Size = 0x60058003;

extern const TagMapEntry PositionerControlTags[];

} // namespace Orbane
