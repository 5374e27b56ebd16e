#include "framework/ComboTags.h"

#include "framework/TagEnums.h"
#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry ComboControlTags[] = {
    ORBANE_ENUM_TAG(CC_LabelPosition, LabelPositionEnum),
    ORBANE_TAG(CC_AlphaSort, TMK_Boolean),
    ORBANE_TAG(CCS_AddString, TMK_Plain),
    ORBANE_TAG(CCS_AddSeparator, TMK_Plain),
    ORBANE_TAG(CCID_AddID, TMK_Plain),
    ORBANE_TAG_END,
};

} // namespace Orbane
