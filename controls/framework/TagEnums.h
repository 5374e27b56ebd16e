#pragma once

#include "orbane/TagMapEntry.h"

namespace Orbane {

// Value tables of enumeration tags shared by several controls.
extern const EnumEntry AlignEnum[];         // "Align": Left .. Right
extern const EnumEntry LabelPositionEnum[]; // "LabelPosition": Horizontal, Vertical
extern const EnumEntry ColorSpaceEnum[];    // "ColorSpace": HSV, HLS, YUV

} // namespace Orbane
