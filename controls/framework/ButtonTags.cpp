#include "framework/ButtonTags.h"

#include "framework/TagEnums.h"
#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry ButtonControlTags[] = {
    ORBANE_ENUM_TAG(BTNC_Align, AlignEnum),
    ORBANE_TAG(BTNCS_Execute, TMK_Plain),
    ORBANE_TAG_END,
};

} // namespace Orbane
