#include "orbane/LuaSandbox.h"

#include <luajit.h>

#include <algorithm>
#include <cstdlib>
#include <set>
#include <string>

namespace Orbane {

namespace {

// The count hook fires after this many instructions; small enough that a
// limit stops a run promptly, large enough to cost nothing.
constexpr int kHookEvery = 1000;

char kMakerKey;

LuaSandbox::Limits gLimits = LuaSandbox::kDefaultLimits;
// The `orbane` functions content may call: those that only compute.
std::set<std::string> gAllowedCalls{"Create", "Classes", "MapTags"};

// What one state has allocated, and the run that is under way in it. The
// allocator's user data, so the hook and the allocator both find it from L.
struct Meter
{
    std::size_t used = 0;
    std::size_t cap = 0; // 0: no cap (no content run)
    int64 instructionsLeft = 0;
    int nesting = 0;
    bool outOfMemory = false;
    bool outOfBudget = false;
};

void *Allocate(void *ud, void *ptr, std::size_t oldSize, std::size_t newSize)
{
    auto *meter = static_cast<Meter *>(ud);
    if (newSize == 0) {
        std::free(ptr);
        meter->used -= oldSize;
        return nullptr;
    }
    // Refusing makes Lua raise "not enough memory" in the script, which
    // unwinds it; growth only, since a shrink must never fail.
    if (meter->cap && newSize > oldSize && meter->used + (newSize - oldSize) > meter->cap) {
        meter->outOfMemory = true;
        return nullptr;
    }
    void *grown = std::realloc(ptr, newSize);
    if (grown)
        meter->used = meter->used - oldSize + newSize;
    return grown;
}

Meter *MeterOf(lua_State *L)
{
    void *ud = nullptr;
    return lua_getallocf(L, &ud) == Allocate ? static_cast<Meter *>(ud) : nullptr;
}

void CountHook(lua_State *L, lua_Debug *)
{
    Meter *meter = MeterOf(L);
    if (!meter || meter->nesting == 0)
        return;
    meter->instructionsLeft -= kHookEvery;
    // A script that caught the memory error is stopped here too.
    if (meter->instructionsLeft > 0 && !meter->outOfMemory)
        return;
    meter->outOfBudget = !meter->outOfMemory;
    // From now on at every instruction, so that a pcall in the script that
    // swallows the error cannot keep the run going.
    lua_sethook(L, CountHook, LUA_MASKCOUNT, 1);
    lua_pushliteral(L, "stopped by the sandbox");
    lua_error(L);
}

// Builds the function that makes a fresh environment per run. It runs once
// per state with full power and keeps the real functions in upvalues that
// content cannot reach.
const char kMaker[] = R"lua(
local G = ...
local load, type, pairs, ipairs, getmetatable = load, type, pairs, ipairs, getmetatable
local base = { "assert", "error", "ipairs", "next", "pairs", "pcall", "select", "tonumber", "tostring",
               "type", "unpack", "xpcall", "rawequal", "rawget", "rawset", "setmetatable", "_VERSION" }
local libraries = { "string", "table", "math", "bit", "coroutine" }
local function copy(t, except)
    local c = {}
    for k, v in pairs(t) do
        if k ~= except then c[k] = v end
    end
    return c
end
-- Methods on strings reach the string table through the shared metatable:
-- take string.dump away there too.
getmetatable("").__index = copy(G.string, "dump")
return function(allowedCalls)
    local env = {}
    for _, name in ipairs(base) do env[name] = G[name] end
    for _, name in ipairs(libraries) do
        if G[name] then env[name] = copy(G[name], "dump") end
    end
    env.os = { clock = G.os.clock, date = G.os.date, time = G.os.time, difftime = G.os.difftime }
    env.getmetatable = function(v)
        if type(v) == "table" then return getmetatable(v) end
    end
    env.load = function(chunk, name)
        if type(chunk) ~= "string" then return nil, "load takes the text of a chunk" end
        return load(chunk, name, "t", env)
    end
    env.loadstring = env.load
    env._G = env
    local orbane = G.package.loaded.orbane
    if type(orbane) == "table" then
        local calls = {}
        for _, name in ipairs(allowedCalls) do calls[name] = orbane[name] end
        env.orbane = calls
    end
    return env
end
)lua";

void PushMaker(lua_State *L)
{
    lua_pushlightuserdata(L, &kMakerKey);
    lua_rawget(L, LUA_REGISTRYINDEX);
    if (!lua_isnil(L, -1))
        return;
    lua_pop(L, 1);
    luaL_loadbuffer(L, kMaker, sizeof kMaker - 1, "=orbane sandbox");
    lua_pushvalue(L, LUA_GLOBALSINDEX);
    lua_call(L, 1, 1);
    lua_pushlightuserdata(L, &kMakerKey);
    lua_pushvalue(L, -2);
    lua_rawset(L, LUA_REGISTRYINDEX);
}

// Gives the function on top of the stack a fresh environment.
void SetFreshEnvironment(lua_State *L)
{
    PushMaker(L);
    lua_createtable(L, int(gAllowedCalls.size()), 0);
    int i = 0;
    for (const std::string &name : gAllowedCalls) {
        lua_pushstring(L, name.c_str());
        lua_rawseti(L, -2, ++i);
    }
    lua_call(L, 1, 1);
    lua_setfenv(L, -2);
}

bool Loaded(lua_State *L, int status, std::string *error)
{
    if (status == 0) {
        SetFreshEnvironment(L);
        return true;
    }
    if (error)
        *error = lua_tostring(L, -1) ? lua_tostring(L, -1) : "cannot load";
    lua_pop(L, 1);
    return false;
}

// What a run changes in the state, put back when it ends (runs may nest in
// a full-power script or in each other).
struct SavedRun
{
    lua_Hook hook;
    int mask;
    int count;
    std::size_t cap;
    int64 instructionsLeft;
    bool outOfMemory;
    bool outOfBudget;
};

SavedRun Begin(lua_State *L, Meter &meter)
{
    const SavedRun saved{lua_gethook(L),         lua_gethookmask(L), lua_gethookcount(L), meter.cap,
                         meter.instructionsLeft, meter.outOfMemory,  meter.outOfBudget};
    // Compiled traces do not call count hooks: the interpreter runs content.
    if (meter.nesting++ == 0)
        luaJIT_setmode(L, 0, LUAJIT_MODE_ENGINE | LUAJIT_MODE_OFF);
    const std::size_t cap = meter.used + gLimits.memoryBytes;
    meter.cap = saved.cap && saved.cap < cap ? saved.cap : cap;
    meter.instructionsLeft = gLimits.instructions;
    meter.outOfMemory = meter.outOfBudget = false;
    lua_sethook(L, CountHook, LUA_MASKCOUNT, kHookEvery);
    return saved;
}

void End(lua_State *L, Meter &meter, const SavedRun &saved)
{
    lua_sethook(L, saved.hook, saved.mask, saved.count);
    meter.cap = saved.cap;
    meter.instructionsLeft = saved.instructionsLeft;
    meter.outOfMemory = saved.outOfMemory;
    meter.outOfBudget = saved.outOfBudget;
    if (--meter.nesting == 0)
        luaJIT_setmode(L, 0, LUAJIT_MODE_ENGINE | LUAJIT_MODE_ON);
}

std::string LimitMessage(const Meter &meter, const std::string &name)
{
    // A script that catches the memory error runs on until the budget
    // stops it: the memory is the cause then.
    if (meter.outOfMemory)
        return name + ": stopped: it needed more than " + std::to_string(gLimits.memoryBytes >> 20) + " MB of memory";
    return name + ": stopped after " + std::to_string(gLimits.instructions) + " instructions (an endless loop?)";
}

} // namespace

lua_State *LuaSandbox::NewState()
{
    auto *meter = new Meter;
    lua_State *L = lua_newstate(Allocate, meter);
    if (!L) {
        delete meter;
        return nullptr;
    }
    luaL_openlibs(L);
    return L;
}

void LuaSandbox::Charge(lua_State *L, std::size_t bytes)
{
    Meter *meter = MeterOf(L);
    if (!meter)
        return;
    meter->used += bytes;
    if (!meter->cap || meter->used <= meter->cap)
        return;
    // Objects the script has let go of are paid back only when the collector
    // finalises them, which Lua paces by its own small heap: collect before
    // calling the run too big.
    lua_gc(L, LUA_GCCOLLECT, 0);
    if (meter->used > meter->cap)
        meter->outOfMemory = true;
}

void LuaSandbox::Refund(lua_State *L, std::size_t bytes)
{
    if (Meter *meter = MeterOf(L))
        meter->used -= std::min(bytes, meter->used);
}

void LuaSandbox::CloseState(lua_State *L)
{
    Meter *meter = MeterOf(L);
    lua_close(L);
    delete meter;
}

bool LuaSandbox::LoadFile(lua_State *L, const std::string &path, std::string *error)
{
    return Loaded(L, luaL_loadfilex(L, path.c_str(), "t"), error);
}

bool LuaSandbox::LoadString(lua_State *L, const std::string &code, const std::string &chunkName, std::string *error)
{
    const std::string name = "=" + chunkName;
    return Loaded(L, luaL_loadbufferx(L, code.data(), code.size(), name.c_str(), "t"), error);
}

bool LuaSandbox::Call(lua_State *L, int nargs, int results, const std::string &name, std::string *error)
{
    Meter *meter = MeterOf(L);
    std::string why;
    if (!meter)
        why = name + ": this Lua state cannot run content";
    else if (meter->nesting >= kMaxNesting)
        why = name + ": content runs nested deeper than " + std::to_string(kMaxNesting) + " levels";
    if (!why.empty()) {
        lua_pop(L, nargs + 1);
        if (error)
            *error = why;
        return false;
    }
    const int base = lua_gettop(L) - nargs - 1;
    const SavedRun saved = Begin(L, *meter);
    const bool ok = lua_pcall(L, nargs, results, 0) == 0;
    const bool limited = meter->outOfBudget || meter->outOfMemory;
    if (!ok)
        why = limited ? LimitMessage(*meter, name) : (lua_tostring(L, -1) ? lua_tostring(L, -1) : "error");
    else if (limited) // the script caught the limit's error: the run still failed
        why = LimitMessage(*meter, name);
    End(L, *meter, saved);
    if (!why.empty())
        lua_settop(L, base);
    if (error && !why.empty())
        *error = why;
    return why.empty();
}

bool LuaSandbox::RunFile(lua_State *L, const std::string &path, int results, std::string *error)
{
    return LoadFile(L, path, error) && Call(L, 0, results, path, error);
}

void LuaSandbox::SetLimits(const Limits &limits)
{
    gLimits = limits;
}

void LuaSandbox::AllowCall(const std::string &name)
{
    gAllowedCalls.insert(name);
}

LuaSandbox::Limits LuaSandbox::GetLimits()
{
    return gLimits;
}

} // namespace Orbane
