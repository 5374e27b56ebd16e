#include "framework/CheckBoxTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry CheckBoxControlTags[] = {
    ORBANE_TAG(CBC_TriState, TMK_Boolean),
    ORBANE_TAG_END,
};

} // namespace Orbane
