#include "framework/CheckListTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry CheckListControlTags[] = {
    ORBANE_TAG(CLC_Columns, TMK_Plain),     ORBANE_TAG(CLC_SelectButtons, TMK_Boolean),
    ORBANE_TAG(CLC_AlphaSort, TMK_Boolean), ORBANE_TAG(CLCS_AllText, TMK_Plain),
    ORBANE_TAG(CLCS_NoneText, TMK_Plain),   ORBANE_TAG(CLCS_AddString, TMK_Plain),
    ORBANE_TAG(CLCD_ItemBit, TMK_Plain),    ORBANE_TAG_END,
};

} // namespace Orbane
