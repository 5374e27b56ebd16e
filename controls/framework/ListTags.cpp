#include "framework/ListTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry ListControlTags[] = {
    ORBANE_TAG(LC_Rows, TMK_Plain),
    ORBANE_TAG(LC_AlphaSort, TMK_Boolean),
    ORBANE_TAG(ICS_AddString, TMK_Plain),
    ORBANE_TAG(INPID_AddID, TMK_Plain),
    ORBANE_TAG_END,
};

} // namespace Orbane
