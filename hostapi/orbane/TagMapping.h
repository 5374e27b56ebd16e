#pragma once

#include "orbane/TagMapEntry.h"

namespace Orbane {

class ScriptVal;
class TagList;
struct TagItem;

// Directions of scriptval_maptags.
enum MapDirection : int32
{
    MAP_ToTags = 0,   // a script table of named tags into a TagList (Create, SetAttrs)
    MAP_FromTags = 1, // a TagList into a script table of named tags (GetAttrs)
};

// Translates between a script table of named tags and a TagList by a class's
// tag table. Into tags: every key must name a row and every value must suit the
// row's kind, or the call fails with a script error naming the tag and what was
// expected, leaving `tags` as it was. From tags: every row whose tag is in the
// list gets its value under its name (enumerations by value name, colours as
// {R, G, B, A} tables of 0..1).
bool scriptval_maptags(const TagMapEntry *table, int32 direction, ScriptVal &args, TagList &tags);

// One tag value as a script sees it without a tag table: integers and doubles
// as numbers, texts and identifiers as strings, objects and pointers as such.
ScriptVal TagItemValue(const TagItem &item);

} // namespace Orbane
