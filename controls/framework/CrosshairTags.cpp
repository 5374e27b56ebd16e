#include "framework/CrosshairTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry CrosshairControlTags[] = {
    ORBANE_TAG(CHC_Style, TMK_Plain),
    ORBANE_TAG(CHCD_FollowX, TMK_Plain),
    ORBANE_TAG(CHCD_FollowY, TMK_Plain),
    ORBANE_TAG(CHCD_FollowOrigX, TMK_Plain),
    ORBANE_TAG(CHCD_FollowOrigY, TMK_Plain),
    ORBANE_TAG(CHCD_CurrentX, TMK_Plain),
    ORBANE_TAG(CHCD_CurrentY, TMK_Plain),
    ORBANE_TAG_END,
};

} // namespace Orbane
