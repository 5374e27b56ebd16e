#include "orbane/LuaRuntime.h"

#include "LuaModule.h"

#include "orbane/FFIFunc.h"
#include "orbane/FFIType.h"
#include "orbane/LuaSandbox.h"
#include "orbane/ScriptObject.h"
#include "orbane/ScriptVal.h"

#include <dlfcn.h>

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstring>
#include <vector>

namespace Orbane {

namespace {

// LuaJIT's type tag of cdata values (not in the Lua 5.1 headers).
constexpr int kTypeCData = 10;
// Deeper tables than this are refused instead of overflowing the stack.
constexpr int kMaxDepth = 100;
// A table that shares subtables can stand for more entries than memory holds
// ({t, t} thirty times over): the walk stops past this many.
constexpr std::size_t kMaxEntries = std::size_t(1) << 20;

// Registry keys: the addresses are unique.
char kModuleKey, kWrapKey, kClassifyKey, kCdefKey;

// Builds the object type and the helpers the C side needs from Lua. Gets the
// object methods and the release function; returns wrap, classify and cdef.
const char kPrelude[] = R"lua(
local methods, release = ...
local ffi = require("ffi")
ffi.cdef("typedef struct ScriptObject ScriptObject;")
local objectPtr = ffi.typeof("ScriptObject *")
ffi.metatype("ScriptObject", { __index = methods, __tostring = methods.ToString })
local function wrap(p)
    return ffi.gc(ffi.cast(objectPtr, p), release)
end
-- 1 an object, 2 another pointer, 3 a number (with its value), 0 anything else
local function classify(v)
    if ffi.istype(objectPtr, v) then return 1 end
    if tostring(ffi.typeof(v)):find("*>", 1, true) then return 2 end
    local n = tonumber(v)
    if n then return 3, n end
    return 0
end
return wrap, classify, ffi.cdef
)lua";

void PushKey(lua_State *L, char &key)
{
    lua_pushlightuserdata(L, &key);
    lua_rawget(L, LUA_REGISTRYINDEX);
}

void StoreKey(lua_State *L, char &key)
{
    lua_pushlightuserdata(L, &key);
    lua_insert(L, -2);
    lua_rawset(L, LUA_REGISTRYINDEX);
}

int AbsIndex(lua_State *L, int idx)
{
    return idx < 0 && idx > LUA_REGISTRYINDEX ? lua_gettop(L) + idx + 1 : idx;
}

// The pointer a pointer cdata holds: lua_topointer gives its payload address.
void *CDataPointer(lua_State *L, int idx)
{
    void *p = nullptr;
    std::memcpy(&p, lua_topointer(L, idx), sizeof p);
    return p;
}

// The garbage collector's end of a script's object.
int ReleaseObject(lua_State *L)
{
    if (lua_type(L, 1) == kTypeCData)
        if (auto *obj = static_cast<ScriptObject *>(CDataPointer(L, 1))) {
            LuaSandbox::Refund(L, obj->SizeOf());
            obj->DecRef();
        }
    return 0;
}

std::string ErrorText(lua_State *L, int idx)
{
    const char *text = lua_tostring(L, idx);
    return text ? text : std::string("(error object is a ") + luaL_typename(L, idx) + " value)";
}

void PushValue(lua_State *L, const ScriptVal &v, int depth);

void PushTable(lua_State *L, const ScriptVal &v, int depth)
{
    if (depth > kMaxDepth || !lua_checkstack(L, 4)) {
        lua_pushnil(L);
        return;
    }
    const int length = v.Length();
    lua_createtable(L, length, int(v.GetEntries().size()) - length);
    for (const ScriptVal::Entry &entry : v.GetEntries()) {
        // Lua refuses nil and NaN keys.
        if (entry.first.IsNil() || (entry.first.IsNumber() && std::isnan(entry.first.GetNumber())))
            continue;
        PushValue(L, entry.first, depth + 1);
        PushValue(L, entry.second, depth + 1);
        lua_rawset(L, -3);
    }
}

void PushValue(lua_State *L, const ScriptVal &v, int depth)
{
    switch (v.GetType()) {
    case ScriptVal::Nil:
        lua_pushnil(L);
        break;
    case ScriptVal::Boolean:
        lua_pushboolean(L, v.GetBool());
        break;
    case ScriptVal::Number:
        lua_pushnumber(L, v.GetNumber());
        break;
    case ScriptVal::String:
        lua_pushstring(L, v.GetString());
        break;
    case ScriptVal::Table:
        PushTable(L, v, depth);
        break;
    case ScriptVal::Object:
        LuaRuntime::PushObject(L, v.GetObject());
        break;
    case ScriptVal::Pointer:
        lua_pushlightuserdata(L, v.GetPointer());
        break;
    }
}

// One conversion of a Lua value: the tables on the way down, to stop at a
// table that contains itself (an endless walk otherwise), and the first
// problem met when the caller wants to hear of it.
struct Walk
{
    std::vector<const void *> path;
    std::size_t entries = 0; // shared subtables count each time they are met
    std::string *error = nullptr;
};

ScriptVal ValueAt(lua_State *L, int idx, Walk &walk);

bool Refuse(Walk &walk, const char *problem)
{
    if (walk.error && walk.error->empty())
        *walk.error = problem;
    return false;
}

bool CanEnter(lua_State *L, int idx, Walk &walk)
{
    const void *table = lua_topointer(L, idx);
    if (std::find(walk.path.begin(), walk.path.end(), table) != walk.path.end())
        return Refuse(walk, "a table contains itself");
    if (int(walk.path.size()) >= kMaxDepth || !lua_checkstack(L, 4))
        return Refuse(walk, "tables are nested too deeply");
    if (walk.entries > kMaxEntries)
        return Refuse(walk, "tables hold too many entries");
    return !walk.error || walk.error->empty();
}

ScriptVal TableAt(lua_State *L, int idx, Walk &walk)
{
    ScriptVal table = ScriptVal::NewTable();
    if (!CanEnter(L, idx, walk))
        return table;
    walk.path.push_back(lua_topointer(L, idx));
    lua_pushnil(L);
    while (lua_next(L, idx)) {
        ++walk.entries;
        // Keys from lua_next are unique, so no search is needed.
        table.InsertNew(ValueAt(L, lua_gettop(L) - 1, walk), ValueAt(L, lua_gettop(L), walk));
        lua_pop(L, 1);
    }
    walk.path.pop_back();
    return table;
}

enum CDataKind
{
    kOtherCData,
    kObjectCData,
    kPointerCData,
    kNumberCData
};

// Asks the prelude what a cdata is: only Lua can read its C type.
CDataKind Classify(lua_State *L, int idx, float64 *number)
{
    PushKey(L, kClassifyKey);
    lua_pushvalue(L, idx);
    lua_call(L, 1, 2);
    const auto kind = CDataKind(lua_tointeger(L, -2));
    *number = lua_tonumber(L, -1);
    lua_pop(L, 2);
    return kind;
}

ScriptVal CDataAt(lua_State *L, int idx)
{
    float64 number = 0.0;
    switch (Classify(L, idx, &number)) {
    case kObjectCData:
        return ScriptVal(static_cast<ScriptObject *>(CDataPointer(L, idx)));
    case kPointerCData:
        return ScriptVal::FromPointer(CDataPointer(L, idx));
    case kNumberCData:
        return ScriptVal(number);
    case kOtherCData:
        break;
    }
    return {};
}

ScriptVal ValueAt(lua_State *L, int idx, Walk &walk)
{
    switch (lua_type(L, idx)) {
    case LUA_TBOOLEAN:
        return ScriptVal(lua_toboolean(L, idx) != 0);
    case LUA_TNUMBER:
        return ScriptVal(float64(lua_tonumber(L, idx)));
    case LUA_TSTRING: {
        std::size_t length = 0;
        const char *text = lua_tolstring(L, idx, &length);
        return ScriptVal(std::string(text, length));
    }
    case LUA_TTABLE:
        return TableAt(L, idx, walk);
    case LUA_TLIGHTUSERDATA:
        return ScriptVal::FromPointer(lua_touserdata(L, idx));
    case kTypeCData:
        return CDataAt(L, idx);
    }
    return {};
}

} // namespace

LuaRuntime &LuaRuntime::Instance()
{
    static LuaRuntime runtime;
    return runtime;
}

LuaRuntime::LuaRuntime()
{
    Open();
}

LuaRuntime::~LuaRuntime()
{
    Close();
}

void LuaRuntime::Open()
{
    mState = LuaSandbox::NewState();
    lua_State *L = mState;
    lua_newtable(L);
    luaL_register(L, nullptr, LuaModule::Functions());
    for (const auto &[name, fn] : mModuleFunctions) {
        lua_pushcfunction(L, fn);
        lua_setfield(L, -2, name.c_str());
    }
    lua_getfield(L, LUA_REGISTRYINDEX, "_LOADED");
    lua_pushvalue(L, -2);
    lua_setfield(L, -2, "orbane");
    lua_pop(L, 1);
    lua_pushvalue(L, -1);
    lua_setglobal(L, "orbane");
    StoreKey(L, kModuleKey);

    luaL_loadbuffer(L, kPrelude, sizeof kPrelude - 1, "=orbane prelude");
    lua_newtable(L);
    luaL_register(L, nullptr, LuaModule::Methods());
    lua_pushcfunction(L, ReleaseObject);
    lua_call(L, 2, 3);
    StoreKey(L, kCdefKey);
    StoreKey(L, kClassifyKey);
    StoreKey(L, kWrapKey);
    mDeclared.insert("typedef struct ScriptObject ScriptObject;");
}

void LuaRuntime::Close()
{
    if (mState)
        LuaSandbox::CloseState(mState);
    mState = nullptr;
    mDeclared.clear();
}

void LuaRuntime::Reset()
{
    Close();
    Open();
    DeclareFFI();
}

bool LuaRuntime::Finish(int status, std::string *error, int results)
{
    lua_State *L = mState;
    if (status == 0)
        status = lua_pcall(L, 0, results, 0);
    if (status == 0)
        return true;
    if (error)
        *error = ErrorText(L, -1);
    lua_pop(L, 1);
    return false;
}

bool LuaRuntime::RunFile(const std::string &path, std::string *error, int results)
{
    return Finish(luaL_loadfile(mState, path.c_str()), error, results);
}

bool LuaRuntime::RunString(const std::string &code, const std::string &chunkName, std::string *error, int results)
{
    // "=" keeps the chunk name as given, so messages read "name:line: message".
    const std::string name = "=" + chunkName;
    return Finish(luaL_loadbuffer(mState, code.data(), code.size(), name.c_str()), error, results);
}

void LuaRuntime::Push(lua_State *L, const ScriptVal &value)
{
    PushValue(L, value, 0);
}

ScriptVal LuaRuntime::ToScriptVal(lua_State *L, int idx)
{
    Walk walk;
    return ValueAt(L, AbsIndex(L, idx), walk);
}

bool LuaRuntime::ToScriptVal(lua_State *L, int idx, ScriptVal &out, std::string &error)
{
    Walk walk;
    std::string problem;
    walk.error = &problem;
    out = ValueAt(L, AbsIndex(L, idx), walk);
    error = problem;
    return problem.empty();
}

void LuaRuntime::PushObject(lua_State *L, ScriptObject *obj)
{
    if (!obj) {
        lua_pushnil(L);
        return;
    }
    obj->IncRef();
    PushKey(L, kWrapKey);
    lua_pushlightuserdata(L, obj);
    // A limit met inside the wrapper (a content run's memory cap or budget)
    // must not strand the reference the wrapper was to own: the script gets
    // nil, and the limit stops it at its next check.
    if (lua_pcall(L, 1, 1, 0) != 0) {
        lua_pop(L, 1);
        obj->DecRef();
        lua_pushnil(L);
        return;
    }
    // Charged to a content run while the script holds it; after the wrap, so
    // that a run charged past its cap still gets the wrapper it is owed.
    LuaSandbox::Charge(L, obj->SizeOf());
}

ScriptObject *LuaRuntime::ToObject(lua_State *L, int idx)
{
    float64 number = 0.0;
    idx = AbsIndex(L, idx);
    if (lua_type(L, idx) != kTypeCData || Classify(L, idx, &number) != kObjectCData)
        return nullptr;
    return static_cast<ScriptObject *>(CDataPointer(L, idx));
}

void LuaRuntime::AddModuleFunction(const char *name, lua_CFunction fn)
{
    mModuleFunctions.emplace_back(name, fn);
    lua_State *L = mState;
    PushKey(L, kModuleKey);
    lua_pushcfunction(L, fn);
    lua_setfield(L, -2, name);
    lua_pop(L, 1);
}

bool LuaRuntime::Declare(const std::string &declaration, std::string *error)
{
    // A declaration that failed once is not retried: it would only fail again.
    if (!mDeclared.insert(declaration).second)
        return true;
    lua_State *L = mState;
    PushKey(L, kCdefKey);
    lua_pushlstring(L, declaration.data(), declaration.size());
    if (lua_pcall(L, 1, 0, 0) == 0)
        return true;
    if (error)
        *error += (error->empty() ? "" : "\n") + declaration + ": " + ErrorText(L, -1);
    lua_pop(L, 1);
    return false;
}

bool LuaRuntime::DeclareFFI(std::string *error)
{
    bool ok = true;
    for (const FFIType *type : FFIType::All()) {
        const std::string name = type->NativeName();
        if (!name.empty())
            ok = Declare("typedef struct " + name + " " + name + ";", error) && ok;
    }
    for (const FFIFunc *func : FFIFunc::All())
        ok = Declare(std::string(func->Declaration()) + ";", error) && ok;
    return ok;
}

bool LuaRuntime::LoadLibrary(const std::string &path, std::string *error)
{
    // Never closed: objects and registrations of the library live to the end.
    if (!dlopen(path.c_str(), RTLD_NOW | RTLD_GLOBAL)) {
        if (error)
            *error = dlerror();
        return false;
    }
    return DeclareFFI(error);
}

} // namespace Orbane
