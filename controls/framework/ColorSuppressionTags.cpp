#include "framework/ColorSuppressionTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry ColorSuppressionControlTags[] = {
    ORBANE_OBJECT_TAG(CSCP_YellowInput, "Input"),  ORBANE_OBJECT_TAG(CSCP_GreenInput, "Input"),
    ORBANE_OBJECT_TAG(CSCP_CyanInput, "Input"),    ORBANE_OBJECT_TAG(CSCP_BlueInput, "Input"),
    ORBANE_OBJECT_TAG(CSCP_MagentaInput, "Input"), ORBANE_TAG(CSCD_Maximum, TMK_Plain),
    ORBANE_TAG(CSC_ShowValues, TMK_Boolean),       ORBANE_TAG_END,
};

} // namespace Orbane
