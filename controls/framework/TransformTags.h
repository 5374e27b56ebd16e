#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of TransformControl. The _Input tags say which of the
// overlay's Inputs (0 is its main Input, the centre) holds each value; -1,
// or an index with no Input, leaves the value out and its handle away.
constexpr Tag TC_AngleInput = 0x10058000;   // default 1
constexpr Tag TC_XSizeInput = 0x10058001;   // default 2
constexpr Tag TC_YSizeInput = 0x10058002;   // default 3; -1: the X size scales both axes
constexpr Tag TC_PivotInput = 0x10058003;   // default 4
constexpr Tag TC_ShearInput = 0x10058004;   // default 5
constexpr Tag TC_KeepAspect = 0x10058005;   // scale handles scale both axes alike, as with Shift
constexpr Tag TC_ShowFrame = 0x10058006;    // draw the layer's frame (default on)
constexpr Tag TCD_FrameWidth = 0x20058000;  // the layer's width in image widths (default 1)
constexpr Tag TCD_FrameHeight = 0x20058001; // its height in image widths; 0: the image's own
constexpr Tag TCD_RingRadius = 0x20058002;  // the rotation ring's radius, handle pixels

extern const TagMapEntry TransformControlTags[];

} // namespace Orbane
