#pragma once

#include <string>

namespace Orbane {

class ScriptVal;

// Script values written as Lua source that reads back to the same values:
// numbers to the last bit, strings byte for byte, tables in their key order,
// short tables on one line and longer ones one entry a line. Objects and
// pointers have no text and are refused.
class LuaLiteral
{
public:
    // Appends `value` at `indent` levels of four spaces; false with `error`
    // set (naming where in the value) for what Lua text cannot hold.
    static bool Write(const ScriptVal &value, std::string &out, int indent, std::string *error);
    // The shortest decimal that reads back as `n`; 0/0 and 1/0 for NaN and
    // infinities, so that a reader can tell them and refuse them.
    static std::string Number(double n);
    static std::string String(const std::string &text);
};

} // namespace Orbane
