#include "framework/ClipTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry ClipControlTags[] = {
    ORBANE_OBJECT_TAG(CLCP_InInput, "Input"),
    ORBANE_OBJECT_TAG(CLCP_OutInput, "Input"),
    ORBANE_TAG(CLCS_Filter, TMK_Plain),
    ORBANE_TAG_END,
};

} // namespace Orbane
