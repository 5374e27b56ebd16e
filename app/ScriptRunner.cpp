#include "ScriptRunner.h"

#include "orbane/LuaRuntime.h"

#include <lua.hpp>

namespace Orbane {

int ScriptRunner::Run(const QString &path, QTextStream &err)
{
    LuaRuntime &lua = LuaRuntime::Instance();
    lua_State *L = lua.State();
    const int top = lua_gettop(L);
    std::string why;
    if (!lua.RunFile(path.toStdString(), &why, 1)) {
        err << why.c_str() << "\n";
        return 1;
    }
    int status = 0;
    // An exit status is a small whole number; anything else is a failure.
    if (lua_gettop(L) > top && lua_isnumber(L, -1)) {
        const double n = lua_tonumber(L, -1);
        status = n >= -255 && n <= 255 ? int(n) : 1;
    }
    lua_settop(L, top);
    return status;
}

} // namespace Orbane
