#include "framework/ColorTags.h"

#include "framework/TagEnums.h"
#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry ColorControlTags[] = {
    ORBANE_OBJECT_TAG(CLRCP_GreenInput, "Input"),
    ORBANE_OBJECT_TAG(CLRCP_BlueInput, "Input"),
    ORBANE_OBJECT_TAG(CLRCP_AlphaInput, "Input"),
    ORBANE_ENUM_TAG(CLRC_ColorSpace, ColorSpaceEnum),
    ORBANE_TAG(CLRC_ShowPicker, TMK_Boolean),
    ORBANE_TAG(CLRCD_MaxScale, TMK_Plain),
    ORBANE_TAG_END,
};

} // namespace Orbane
