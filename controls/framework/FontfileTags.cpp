#include "framework/FontfileTags.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry FontfileControlTags[] = {
    ORBANE_TAG(FFC_ShowPreview, TMK_Boolean),
    ORBANE_TAG(FFCS_PreviewText, TMK_Plain),
    ORBANE_OBJECT_TAG(FFCP_StyleInput, "Input"),
    ORBANE_TAG_END,
};

} // namespace Orbane
