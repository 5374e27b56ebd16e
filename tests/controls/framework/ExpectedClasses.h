#pragma once

#include "orbane/Tags.h"

#include <ostream>
#include <vector>

namespace Orbane {
namespace Test {

enum class Family
{
    Input,
    Preview,
};

// One row of the library's published class table.
struct ExpectedClass
{
    const char *name; // native type and registry name
    const char *classID;
    const char *baseID;
    Family family;
    const char *script;      // script type; null: none
    const char *scriptBase;  // null where there is no script type
    int tags;                // rows of the "Create" map as published
    bool tagNamesKnown;      // false: names not published yet, so no map is registered
    std::vector<Tag> extras; // extra registration tags, in order
    bool hook;               // has a tag-mapping hook of its own

    // Primaries that are scriptable export a cast pair; variants do not.
    bool HasCasts() const { return script && hook; }
    bool IsVariant() const;
    const char *MapName() const;
};

const std::vector<ExpectedClass> &ExpectedClasses();

// Names the row in test output.
void PrintTo(const ExpectedClass &row, std::ostream *out);

} // namespace Test
} // namespace Orbane
