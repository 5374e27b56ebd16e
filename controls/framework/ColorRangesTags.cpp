#include "framework/ColorRangesTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry ColorRangesControlTags[] = {
    ORBANE_TAG(CRC_SmoothFalloff, TMK_Boolean),
    ORBANE_TAG(CRC_ShowMidtones, TMK_Boolean),
    ORBANE_TAG(CRC_Height, TMK_Plain),
    ORBANE_TAG(CRCD_SnapStep, TMK_Plain),
    ORBANE_TAG_END,
};

} // namespace Orbane
