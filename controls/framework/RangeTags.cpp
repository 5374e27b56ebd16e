#include "framework/RangeTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry RangeControlTags[] = {
    ORBANE_OBJECT_TAG(RNGCP_HighInput, "Input"),
    ORBANE_TAG(RNGCD_MinAllowed, TMK_Plain),
    ORBANE_TAG(RNGCD_MaxAllowed, TMK_Plain),
    ORBANE_TAG(RNGCD_MinScale, TMK_Plain),
    ORBANE_TAG(RNGCD_MaxScale, TMK_Plain),
    ORBANE_TAG(RNGCD_MinSpan, TMK_Plain),
    ORBANE_TAG(RNGCD_DefaultLow, TMK_Plain),
    ORBANE_TAG(RNGCD_DefaultHigh, TMK_Plain),
    ORBANE_TAG(RNGC_DecimalPlaces, TMK_Plain),
    ORBANE_TAG(RNGC_IntegerDisplay, TMK_Boolean),
    ORBANE_TAG(RNGC_PushOther, TMK_Boolean),
    ORBANE_TAG(RNGC_TickCount, TMK_Plain),
    ORBANE_TAG(RNGCS_LowName, TMK_Plain),
    ORBANE_TAG(RNGCS_HighName, TMK_Plain),
    ORBANE_TAG_END,
};

} // namespace Orbane
