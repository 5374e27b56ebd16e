#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of ColorControl. The control stands on the red channel's
// Number Input; the other channels are further Number Inputs.
constexpr Tag CLRCP_GreenInput = 0x40050000; // the green channel's Number Input
constexpr Tag CLRCP_BlueInput = 0x40050001;  // the blue channel's Number Input
constexpr Tag CLRCP_AlphaInput = 0x40050002; // the alpha channel's; without it the control is RGB only
constexpr Tag CLRC_ColorSpace = 0x10050000;  // the model of the second view: HSV (default), HLS or YUV
constexpr Tag CLRC_ShowPicker = 0x10050001;  // the viewer picker button (default on)
constexpr Tag CLRCD_MaxScale = 0x20050000;   // the channel sliders' right end (default 1; HDR grading: more)

extern const TagMapEntry ColorControlTags[];

} // namespace Orbane
