#include "framework/PointTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry PointControlTags[] = {
    ORBANE_TAG(PCID_PrevPoint, TMK_Plain),
    ORBANE_TAG(PCD_SetPrevPointX, TMK_Plain),
    ORBANE_TAG(PCD_SetPrevPointY, TMK_Plain),
    // The Input form of the link, like the Input pairs of the other overlays.
    ORBANE_OBJECT_TAG(PCP_PrevPoint, "Input"),
    ORBANE_TAG_END,
};

} // namespace Orbane
