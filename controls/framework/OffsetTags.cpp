#include "framework/OffsetTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry OffsetControlTags[] = {
    ORBANE_TAG(OFC_Decimals, TMK_Plain),
    ORBANE_TAG(OFCD_DragStep, TMK_Plain),
    ORBANE_TAG_END,
};

} // namespace Orbane
