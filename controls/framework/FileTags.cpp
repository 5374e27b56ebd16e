#include "framework/FileTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry FileControlTags[] = {
    ORBANE_TAG(FC_SaveFile, TMK_Boolean),
    ORBANE_TAG(FC_Directory, TMK_Boolean),
    ORBANE_TAG(FC_RelativeToComp, TMK_Boolean),
    ORBANE_TAG(FCS_Filter, TMK_Plain),
    ORBANE_TAG_END,
};

} // namespace Orbane
