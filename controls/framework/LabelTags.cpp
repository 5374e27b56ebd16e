#include "framework/LabelTags.h"

#include "framework/TagEnums.h"
#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry LabelControlTags[] = {
    ORBANE_TAG(LBLC_DropDownButton, TMK_Boolean),
    ORBANE_TAG(LBLC_NumInputs, TMK_Plain),
    ORBANE_TAG(LBLC_NestLevel, TMK_Plain),
    ORBANE_TAG(LBLC_Expanded, TMK_Boolean),
    ORBANE_ENUM_TAG(LBLC_Align, AlignEnum),
    ORBANE_TAG(LBLC_Bold, TMK_Boolean),
    ORBANE_TAG(LBLC_Height, TMK_Plain),
    ORBANE_TAG(LBLC_TextColor, TMK_Color),
    ORBANE_TAG(LBLC_LineColor, TMK_Color),
    ORBANE_TAG(LBLCS_Tooltip, TMK_Plain),
    ORBANE_TAG_END,
};

} // namespace Orbane
