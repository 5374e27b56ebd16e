#include "framework/GradientTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry GradientControlTags[] = {
    ORBANE_TAG(GRDC_ShowAlpha, TMK_Boolean),
    ORBANE_TAG(GRDC_MaxStops, TMK_Plain),
    ORBANE_TAG_END,
};

} // namespace Orbane
