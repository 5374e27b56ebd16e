#pragma once

#include "orbane/TagMapEntry.h"

// Rows of a class's script tag table. The row's script name is the spelling of
// its tag constant, so a table cannot drift from the constants it lists.
#define ORBANE_TAG(tag, kind) {#tag, tag, kind, nullptr, nullptr}
#define ORBANE_ENUM_TAG(tag, values) {#tag, tag, ::Orbane::TMK_Enumeration, values, nullptr}
#define ORBANE_OBJECT_TAG(tag, scriptType) {#tag, tag, ::Orbane::TMK_Object, scriptType, nullptr}
#define ORBANE_TAG_END {nullptr, 0, 0, nullptr, nullptr}
