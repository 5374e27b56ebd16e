#include "orbane/LuaArgs.h"

#include "orbane/LuaRuntime.h"
#include "orbane/ScriptVal.h"

#include <cmath>
#include <cstdio>
#include <cstdlib>

namespace Orbane {

namespace {

bool IsFinite(const ScriptVal &v)
{
    if (v.IsNumber())
        return std::isfinite(v.GetNumber());
    if (!v.IsTable())
        return true;
    for (const ScriptVal::Entry &entry : v.GetEntries())
        if (!IsFinite(entry.first) || !IsFinite(entry.second))
            return false;
    return true;
}

// NaN fails every comparison, so it is never within range.
bool WholeIn(float64 n, int32 lo, int32 hi)
{
    return n >= lo && n <= hi && n == std::floor(n);
}

std::string Num(double n)
{
    char text[32];
    std::snprintf(text, sizeof text, "%.10g", n);
    return text;
}

std::string Shown(lua_State *L, int idx)
{
    if (lua_type(L, idx) == LUA_TNUMBER) {
        const double n = lua_tonumber(L, idx);
        if (!std::isfinite(n))
            return std::isnan(n) ? "nan" : n > 0 ? "inf" : "-inf";
        return Num(n);
    }
    return luaL_typename(L, idx);
}

} // namespace

void LuaArgs::Fail(int idx, const char *name, const std::string &problem) const
{
    luaL_where(mL, 1);
    lua_pushfstring(mL, "%s: argument %d (%s): %s", mFunction, idx, name, problem.c_str());
    lua_concat(mL, 2);
    lua_error(mL);
    std::abort(); // lua_error does not return
}

void LuaArgs::Expected(int idx, const char *name, const char *what) const
{
    Fail(idx, name, std::string("expected ") + what + ", got " + Shown(mL, idx));
}

void LuaArgs::FieldExpected(int idx, const char *key, const char *what) const
{
    lua_getfield(mL, idx, key);
    const std::string got = Shown(mL, -1);
    lua_pop(mL, 1);
    Fail(idx, key, std::string("expected ") + what + ", got " + got);
}

const char *LuaArgs::String(int idx, const char *name) const
{
    if (lua_type(mL, idx) != LUA_TSTRING)
        Expected(idx, name, "a string");
    return lua_tostring(mL, idx);
}

const char *LuaArgs::OptString(int idx, const char *name, const char *def) const
{
    return lua_isnoneornil(mL, idx) ? def : String(idx, name);
}

float64 LuaArgs::Number(int idx, const char *name) const
{
    if (lua_type(mL, idx) != LUA_TNUMBER || !std::isfinite(lua_tonumber(mL, idx)))
        Expected(idx, name, "a finite number");
    return lua_tonumber(mL, idx);
}

float64 LuaArgs::OptNumber(int idx, const char *name, float64 def) const
{
    return lua_isnoneornil(mL, idx) ? def : Number(idx, name);
}

int32 LuaArgs::Integer(int idx, const char *name, int32 lo, int32 hi) const
{
    const float64 n = lua_type(mL, idx) == LUA_TNUMBER ? lua_tonumber(mL, idx) : NAN;
    if (!WholeIn(n, lo, hi))
        Fail(idx, name, "expected a whole number from " + Num(lo) + " to " + Num(hi) + ", got " + Shown(mL, idx));
    return int32(n);
}

bool LuaArgs::OptTable(int idx, const char *name) const
{
    if (lua_isnoneornil(mL, idx))
        return false;
    if (lua_type(mL, idx) != LUA_TTABLE)
        Expected(idx, name, "a table");
    return true;
}

bool LuaArgs::NumberAt(int idx, const char *key, float64 &n) const
{
    lua_getfield(mL, idx, key);
    const bool present = !lua_isnil(mL, -1);
    n = lua_type(mL, -1) == LUA_TNUMBER ? lua_tonumber(mL, -1) : NAN;
    lua_pop(mL, 1);
    return present;
}

int32 LuaArgs::IntegerField(int idx, const char *key, int32 lo, int32 hi, int32 def) const
{
    float64 n = 0;
    if (!NumberAt(idx, key, n))
        return def;
    if (!WholeIn(n, lo, hi))
        FieldExpected(idx, key, ("a whole number from " + Num(lo) + " to " + Num(hi)).c_str());
    return int32(n);
}

float64 LuaArgs::NumberField(int idx, const char *key, float64 lo, float64 hi, float64 def) const
{
    float64 n = 0;
    if (!NumberAt(idx, key, n))
        return def;
    if (!(n >= lo && n <= hi))
        FieldExpected(idx, key, ("a number from " + Num(lo) + " to " + Num(hi)).c_str());
    return n;
}

bool LuaArgs::HasField(int idx, const char *key) const
{
    lua_getfield(mL, idx, key);
    const bool present = !lua_isnil(mL, -1);
    lua_pop(mL, 1);
    return present;
}

const char *LuaArgs::StringField(int idx, const char *key, const char *def) const
{
    lua_getfield(mL, idx, key);
    const int type = lua_type(mL, -1);
    // The string stays alive in the table it came from.
    const char *text = type == LUA_TSTRING ? lua_tostring(mL, -1) : def;
    lua_pop(mL, 1);
    if (type != LUA_TSTRING && type != LUA_TNIL)
        FieldExpected(idx, key, "a string");
    return text;
}

ScriptVal LuaArgs::Value(int idx, const char *name) const
{
    ScriptVal value;
    std::string why;
    if (!LuaRuntime::ToScriptVal(mL, idx, value, why))
        Fail(idx, name, why);
    if (!IsFinite(value))
        Fail(idx, name, "NaN and infinities are not values");
    return value;
}

} // namespace Orbane
