#include "framework/TransformTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry TransformControlTags[] = {
    ORBANE_TAG(TC_AngleInput, TMK_Plain),
    ORBANE_TAG(TC_XSizeInput, TMK_Plain),
    ORBANE_TAG(TC_YSizeInput, TMK_Plain),
    ORBANE_TAG(TC_PivotInput, TMK_Plain),
    ORBANE_TAG(TC_ShearInput, TMK_Plain),
    ORBANE_TAG(TC_KeepAspect, TMK_Boolean),
    ORBANE_TAG(TC_ShowFrame, TMK_Boolean),
    ORBANE_TAG(TCD_FrameWidth, TMK_Plain),
    ORBANE_TAG(TCD_FrameHeight, TMK_Plain),
    ORBANE_TAG(TCD_RingRadius, TMK_Plain),
    ORBANE_TAG_END,
};

} // namespace Orbane
