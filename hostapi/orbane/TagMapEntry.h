#pragma once

#include "orbane/Types.h"

namespace Orbane {

// Kinds of a tag-map row.
enum TagMapKind : int32
{
    TMK_Plain = 1,       // the value type named by the tag's top bits
    TMK_Boolean = 2,     // a boolean carried in an integer tag
    TMK_Enumeration = 3, // an integer tag whose values have names (extra: EnumEntry table)
    TMK_Object = 4,      // an object reference (extra: the script type name it must have)
    TMK_Color = 5,       // a colour carried in an integer tag
};

// One value of an enumeration. A table starts with (ENUM_NameRow, name of
// the enumeration) and ends with a row whose name is null.
struct EnumEntry
{
    int64 value;
    const char *name;
};
constexpr int64 ENUM_NameRow = 0x7FFFFFFF;

// One script-visible tag of a class. A table ends with a row whose name is null.
struct TagMapEntry
{
    const char *name;
    uint64 tag;
    int32 kind;
    const void *extra;
    const void *reserved;
};

} // namespace Orbane
