#include "framework/ScrewTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry ScrewControlTags[] = {
    ORBANE_TAG(SCRD_Step, TMK_Plain),
    ORBANE_TAG_END,
};

} // namespace Orbane
