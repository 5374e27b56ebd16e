#include "framework/LevelsTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry LevelsControlTags[] = {
    ORBANE_OBJECT_TAG(LVLCP_WhiteInput, "Input"),
    ORBANE_OBJECT_TAG(LVLCP_GammaInput, "Input"),
    ORBANE_TAG(LVLC_LogScale, TMK_Boolean),
    ORBANE_TAG_END,
};

const TagMapEntry LevelsOutputControlTags[] = {
    ORBANE_OBJECT_TAG(LVLOCP_WhiteInput, "Input"),
    ORBANE_TAG(LVLOC_GradientColor, TMK_Color),
    ORBANE_TAG(LVLOC_AllowInvert, TMK_Boolean),
    ORBANE_TAG_END,
};

} // namespace Orbane
