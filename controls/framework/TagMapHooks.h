#pragma once

#include "orbane/OrbID.h"
#include "orbane/TagMapEntry.h"
#include "orbane/TagMapping.h"

namespace Orbane {

class ScriptVal;
class TagList;

// The script methods whose named tags a control translates: "Create",
// "GetAttrs", "SetAttrs" and "UserControl".
bool IsTagMappedMethod(const OrbID &method);

// The table of a class whose script tags are not published yet: it maps
// nothing, so every named tag is reported to the script as unknown.
extern const TagMapEntry NoTags[];

// The tag-mapping hook of a class (registration tag REG_TagMapHook): one
// instantiation per tag table, since the hook receives no class context.
// Methods other than the mapped ones get no translation.
template <const TagMapEntry *Table>
bool MapScriptTags(OrbID method, int32 direction, ScriptVal &args, TagList &tags)
{
    return IsTagMappedMethod(method) && scriptval_maptags(Table, direction, args, tags);
}

} // namespace Orbane
