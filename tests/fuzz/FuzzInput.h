#pragma once

#include "orbane/LuaRuntime.h"
#include "orbane/LuaSandbox.h"
#include "orbane/ScriptVal.h"

#include <cstddef>
#include <cstdint>
#include <string>

namespace Orbane {
namespace Fuzz {

// Fuzz inputs run with small limits, so that every input ends in well under
// a second and an endless loop is just one more input.
inline void SmallLimits()
{
    LuaSandbox::SetLimits({200'000, std::size_t(16) << 20});
}

// Runs the input as content and takes the value it returns; false where the
// run failed or the value is no table.
inline bool ContentTable(const uint8_t *data, std::size_t size, ScriptVal &out)
{
    lua_State *L = LuaRuntime::Instance().State();
    const std::string code(reinterpret_cast<const char *>(data), size);
    std::string error;
    if (!LuaSandbox::LoadString(L, code, "fuzz", &error) || !LuaSandbox::Call(L, 0, 1, "fuzz", &error))
        return false;
    const bool ok = LuaRuntime::ToScriptVal(L, -1, out, error) && out.IsTable();
    lua_pop(L, 1);
    return ok;
}

} // namespace Fuzz
} // namespace Orbane
