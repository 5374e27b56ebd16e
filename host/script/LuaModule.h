#pragma once

#include <lua.hpp>

namespace Orbane {

// The C side of the `orbane` module: its functions (Create, Classes, MapTags,
// LoadControls) and the methods of script objects (ClassID, TypeName,
// GetAttrs, SetAttrs, ToString). LuaRuntime installs both.
class LuaModule
{
public:
    static const luaL_Reg *Functions();
    static const luaL_Reg *Methods();
};

} // namespace Orbane
