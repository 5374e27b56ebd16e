#include "framework/TagEnums.h"

namespace Orbane {

const EnumEntry AlignEnum[] = {
    {ENUM_NameRow, "Align"}, {0, "Left"},  {1, "CenteredLeft"}, {2, "Center"},
    {3, "CenteredRight"},    {4, "Right"}, {0, nullptr},
};

const EnumEntry LabelPositionEnum[] = {
    {ENUM_NameRow, "LabelPosition"},
    {0, "Horizontal"},
    {1, "Vertical"},
    {0, nullptr},
};

const EnumEntry ColorSpaceEnum[] = {
    {ENUM_NameRow, "ColorSpace"}, {0, "HSV"}, {1, "HLS"}, {2, "YUV"}, {0, nullptr},
};

} // namespace Orbane
