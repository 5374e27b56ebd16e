#include "framework/RectangleTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry RectangleControlTags[] = {
    ORBANE_TAG(RC_PenStyle, TMK_Plain),
    ORBANE_TAG(RC_DoLockAspect, TMK_Boolean),
    ORBANE_TAG(RC_BlendMode, TMK_Plain),
    ORBANE_TAG(RCD_SetX, TMK_Plain),
    ORBANE_TAG(RCD_SetY, TMK_Plain),
    ORBANE_TAG(RCD_SetAngle, TMK_Plain),
    ORBANE_TAG(RCD_LockAspect, TMK_Plain),
    ORBANE_TAG(RCD_BlendAmount, TMK_Plain),
    ORBANE_TAG(RCD_DisplayXScale, TMK_Plain),
    ORBANE_TAG(RCD_DisplayYScale, TMK_Plain),
    ORBANE_TAG(RCD_SetSize, TMK_Plain),
    ORBANE_TAG(RCD_SetAxisX, TMK_Plain),
    ORBANE_TAG(RCD_SetAxisY, TMK_Plain),
    ORBANE_TAG(RCID_Center, TMK_Plain),
    ORBANE_OBJECT_TAG(RCP_Center, "Input"),
    ORBANE_TAG(RCID_Angle, TMK_Plain),
    ORBANE_OBJECT_TAG(RCP_Angle, "Input"),
    ORBANE_TAG(RCID_Image, TMK_Plain),
    ORBANE_OBJECT_TAG(RCP_Image, "Input"),
    ORBANE_TAG(RCID_Size, TMK_Plain),
    ORBANE_OBJECT_TAG(RCP_Size, "Input"),
    ORBANE_TAG(RCID_Axis, TMK_Plain),
    ORBANE_OBJECT_TAG(RCP_Axis, "Input"),
    ORBANE_TAG(RCID_FlipX, TMK_Plain),
    ORBANE_OBJECT_TAG(RCP_FlipX, "Input"),
    ORBANE_TAG(RCID_FlipY, TMK_Plain),
    ORBANE_OBJECT_TAG(RCP_FlipY, "Input"),
    ORBANE_TAG(RCID_CenterX, TMK_Plain),
    ORBANE_OBJECT_TAG(RCP_CenterX, "Input"),
    ORBANE_TAG(RCID_CenterY, TMK_Plain),
    ORBANE_OBJECT_TAG(RCP_CenterY, "Input"),
    ORBANE_TAG(RCID_AxisX, TMK_Plain),
    ORBANE_OBJECT_TAG(RCP_AxisX, "Input"),
    ORBANE_TAG(RCID_AxisY, TMK_Plain),
    ORBANE_OBJECT_TAG(RCP_AxisY, "Input"),
    ORBANE_TAG_END,
};

} // namespace Orbane
