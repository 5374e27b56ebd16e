#include "framework/PatternTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry PatternControlTags[] = {
    ORBANE_TAG(PTNC_TileSize, TMK_Plain),
    ORBANE_TAG(PTNC_InkColor, TMK_Color),
    ORBANE_TAG_END,
};

} // namespace Orbane
