#include "framework/SliderTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry SliderControlTags[] = {
    ORBANE_TAG(IC_TickFreq, TMK_Plain),
    ORBANE_TAG(SLCS_LowName, TMK_Plain),
    ORBANE_TAG(SLCS_MidName, TMK_Plain),
    ORBANE_TAG(SLCS_HighName, TMK_Plain),
    ORBANE_TAG_END,
};

} // namespace Orbane
