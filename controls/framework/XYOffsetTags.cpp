#include "framework/XYOffsetTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry XYOffsetControlTags[] = {
    ORBANE_OBJECT_TAG(XOP_Center, "Input"),
    ORBANE_TAG_END,
};

} // namespace Orbane
