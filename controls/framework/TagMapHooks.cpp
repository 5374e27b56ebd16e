#include "framework/TagMapHooks.h"

#include "framework/TagTable.h"

namespace Orbane {

const TagMapEntry NoTags[] = {
    ORBANE_TAG_END,
};

bool IsTagMappedMethod(const OrbID &method)
{
    // Identifiers are interned, so these compare as pointers.
    static const OrbID create("Create"), getAttrs("GetAttrs"), setAttrs("SetAttrs"), userControl("UserControl");
    return method == create || method == getAttrs || method == setAttrs || method == userControl;
}

} // namespace Orbane
