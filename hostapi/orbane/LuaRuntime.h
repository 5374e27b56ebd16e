#pragma once

#include <lua.hpp>

#include <set>
#include <string>
#include <utility>
#include <vector>

namespace Orbane {

class ScriptObject;
class ScriptVal;

// The one Lua state of the UI thread (LuaJIT with its ffi library), with the
// `orbane` module loaded as require("orbane") and as the global `orbane`.
// Objects reach scripts as `ScriptObject *` cdata that hold one reference
// until the collector drops them.
class LuaRuntime
{
public:
    static LuaRuntime &Instance();
    LuaRuntime(const LuaRuntime &) = delete;
    LuaRuntime &operator=(const LuaRuntime &) = delete;

    lua_State *State() const noexcept { return mState; }

    // Run a file or a chunk of code. Errors come back as "file:line: message".
    // On success `results` values that the chunk returned are left on the
    // stack (LUA_MULTRET: all of them); the caller pops them.
    bool RunFile(const std::string &path, std::string *error = nullptr, int results = 0);
    bool RunString(const std::string &code, const std::string &chunkName, std::string *error = nullptr,
                   int results = 0);

    // Conversions between Lua values and script values. Lua tables become
    // tables in Lua's iteration order (the array part 1..n first).
    static void Push(lua_State *L, const ScriptVal &value);
    // A table that contains itself or nests too deeply is cut there.
    static ScriptVal ToScriptVal(lua_State *L, int idx);
    // The same, but such a table is refused: false and the reason.
    static bool ToScriptVal(lua_State *L, int idx, ScriptVal &out, std::string &error);
    // Pushes a `ScriptObject *` cdata holding a new reference (nil for null).
    static void PushObject(lua_State *L, ScriptObject *obj);
    // The object of a `ScriptObject *` cdata at idx, else null.
    static ScriptObject *ToObject(lua_State *L, int idx);

    // Adds a function to the `orbane` module; it stays there after Reset().
    void AddModuleFunction(const char *name, lua_CFunction fn);
    // Makes every registered FFI type and function known to ffi.cdef. Each
    // declaration is given once, so this runs again after a library loads.
    bool DeclareFFI(std::string *error = nullptr);
    // Loads a library that registers classes (dlopen with RTLD_GLOBAL, so
    // ffi.C finds its exported functions), then declares its FFI functions.
    bool LoadLibrary(const std::string &path, std::string *error = nullptr);
    // Closes the state, releasing every object that scripts hold, and opens a
    // fresh one. The application calls this before its widgets go away.
    void Reset();

private:
    LuaRuntime();
    ~LuaRuntime();

    void Open();
    void Close();
    bool Finish(int status, std::string *error, int results);
    bool Declare(const std::string &declaration, std::string *error);

    lua_State *mState = nullptr;
    std::set<std::string> mDeclared;
    std::vector<std::pair<std::string, lua_CFunction>> mModuleFunctions;
};

} // namespace Orbane
