#pragma once

#include "orbane/Types.h"

#include <lua.hpp>

#include <cstddef>
#include <string>

namespace Orbane {

// Runs content (tool and comp files, look-pack layouts, button scripts):
// Lua that arrives with a file someone else made. Each run gets a fresh
// environment of its own with the base functions that compute, copies of the
// string, table, math, bit and coroutine libraries (no string.dump), os.clock,
// os.date and os.time, `load` for text chunks into the same environment, and
// the `orbane` functions that read and write the document. It has no io, no
// ffi, no debug, no require, no file loading and no view of the real globals.
// Each run has an instruction budget and a memory cap; the JIT is off during
// the run so that the count hook sees every loop. Scripts the user runs on
// purpose go through LuaRuntime instead and keep full power.
class LuaSandbox
{
public:
    struct Limits
    {
        int64 instructions;
        std::size_t memoryBytes;
    };
    static constexpr Limits kDefaultLimits{200'000'000, std::size_t(256) << 20};
    // Content that runs content (a button that presses itself) stops here.
    static constexpr int kMaxNesting = 8;

    // A state whose allocator counts its bytes, so that runs can be capped.
    // Close it with CloseState.
    static lua_State *NewState();
    static void CloseState(lua_State *L);

    // Loads a text chunk (bytecode is refused) into a fresh restricted
    // environment and leaves the function on the stack; on failure nothing.
    static bool LoadFile(lua_State *L, const std::string &path, std::string *error);
    static bool LoadString(lua_State *L, const std::string &code, const std::string &chunkName, std::string *error);
    // Calls the function below `nargs` arguments under the limits. Leaves
    // `results` values on success; on failure nothing, and a message that
    // names `name` when a limit stopped the run.
    static bool Call(lua_State *L, int nargs, int results, const std::string &name, std::string *error);
    // LoadFile and Call in one.
    static bool RunFile(lua_State *L, const std::string &path, int results, std::string *error);

    // Host memory a script holds through its objects (a control it made),
    // which Lua's allocator does not see: counted against the run's memory
    // cap like Lua's own, so a loop that makes objects stops at the cap. Over
    // the cap (after a collection) the run stops at its next instruction count check. Every
    // Charge is paid back by one Refund of the same bytes when the script
    // lets go. Nothing happens in a state that NewState did not make.
    static void Charge(lua_State *L, std::size_t bytes);
    static void Refund(lua_State *L, std::size_t bytes);

    // Lets content call the `orbane` function of this name. Only functions
    // that read or write the document (and so are undone like any edit) may
    // be allowed; none that touch files, load libraries or drive the window.
    static void AllowCall(const std::string &name);

    // The limits of the runs that start from now on (tests lower them).
    static void SetLimits(const Limits &limits);
    static Limits GetLimits();
};

} // namespace Orbane
