#include "framework/PositionerTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry PositionerControlTags[] = {
    ORBANE_TAG(PS_ShowBox, TMK_Boolean),
    ORBANE_TAG(PS_SnapToPixels, TMK_Boolean),
    ORBANE_TAG(PS_Axis, TMK_Plain),
    ORBANE_TAG(PSD_Width, TMK_Plain),
    ORBANE_TAG(PSD_Height, TMK_Plain),
    ORBANE_TAG(PSD_AnchorX, TMK_Plain),
    ORBANE_TAG(PSD_AnchorY, TMK_Plain),
    ORBANE_TAG(PSD_Angle, TMK_Plain),
    ORBANE_TAG(PSID_Width, TMK_Plain),
    ORBANE_OBJECT_TAG(PSP_Width, "Input"),
    ORBANE_TAG(PSID_Height, TMK_Plain),
    ORBANE_OBJECT_TAG(PSP_Height, "Input"),
    ORBANE_TAG(PSID_Angle, TMK_Plain),
    ORBANE_OBJECT_TAG(PSP_Angle, "Input"),
    ORBANE_TAG(PSID_Size, TMK_Plain),
    ORBANE_OBJECT_TAG(PSP_Size, "Input"),
    ORBANE_TAG_END,
};

} // namespace Orbane
