#include "framework/AngleTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry AngleControlTags[] = {
    ORBANE_TAG(ACD_MinRadius, TMK_Plain),
    ORBANE_TAG(ACD_RadiusScale, TMK_Plain),
    ORBANE_TAG(ACD_FollowX, TMK_Plain),
    ORBANE_TAG(ACD_FollowY, TMK_Plain),
    ORBANE_TAG(ACD_FollowAngle, TMK_Plain),
    ORBANE_TAG(ACD_CurrentAngle, TMK_Plain),
    ORBANE_TAG(ACID_Center, TMK_Plain),
    ORBANE_OBJECT_TAG(ACP_Center, "Input"),
    ORBANE_TAG(ACID_Radius, TMK_Plain),
    ORBANE_OBJECT_TAG(ACP_Radius, "Input"),
    ORBANE_TAG(ACID_CenterX, TMK_Plain),
    ORBANE_OBJECT_TAG(ACP_CenterX, "Input"),
    ORBANE_TAG(ACID_CenterY, TMK_Plain),
    ORBANE_OBJECT_TAG(ACP_CenterY, "Input"),
    ORBANE_TAG(ACID_CenterZ, TMK_Plain),
    ORBANE_OBJECT_TAG(ACP_CenterZ, "Input"),
    ORBANE_TAG_END,
};

} // namespace Orbane
