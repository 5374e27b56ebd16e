#pragma once

#include "orbane/Types.h"

#include <lua.hpp>

#include <string>

namespace Orbane {

class ScriptVal;

// The one place where scripting entry points check what they were given.
// Each check raises a Lua error at the script's line that names the argument
// ("SetValue: argument 3 (value): expected a finite number, got nan") and
// does not return then. Numbers are finite; integers are whole and within
// the range the caller gives, so no conversion overflows.
class LuaArgs
{
public:
    LuaArgs(lua_State *L, const char *function) : mL(L), mFunction(function) {}

    const char *String(int idx, const char *name) const;
    const char *OptString(int idx, const char *name, const char *def) const;
    float64 Number(int idx, const char *name) const;
    float64 OptNumber(int idx, const char *name, float64 def) const;
    int32 Integer(int idx, const char *name, int32 lo, int32 hi) const;
    // A table or nothing (false when nothing was given).
    bool OptTable(int idx, const char *name) const;
    // A field of the table at idx; def where it is absent.
    int32 IntegerField(int idx, const char *key, int32 lo, int32 hi, int32 def) const;
    float64 NumberField(int idx, const char *key, float64 lo, float64 hi, float64 def) const;
    const char *StringField(int idx, const char *key, const char *def) const;
    bool HasField(int idx, const char *key) const;
    // Any value as a script value: no table that contains itself, no NaN or
    // infinity anywhere in it.
    ScriptVal Value(int idx, const char *name) const;

    // Raises "Function: argument n (name): problem".
    [[noreturn]] void Fail(int idx, const char *name, const std::string &problem) const;
    lua_State *State() const noexcept { return mL; }

private:
    // The number of a field (NaN where it holds another kind); false where
    // the field is absent.
    bool NumberAt(int idx, const char *key, float64 &n) const;
    [[noreturn]] void Expected(int idx, const char *name, const char *what) const;
    [[noreturn]] void FieldExpected(int idx, const char *key, const char *what) const;

    lua_State *mL;
    const char *mFunction;
};

} // namespace Orbane
