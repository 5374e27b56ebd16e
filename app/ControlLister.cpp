#include "ControlLister.h"

#include "orbane/LuaRuntime.h"

#include <lua.hpp>

namespace Orbane {

namespace {

QString Field(lua_State *L, int row, const char *key)
{
    lua_getfield(L, row, key);
    const char *text = lua_isstring(L, -1) ? lua_tostring(L, -1) : "";
    QString value = QString::fromUtf8(text);
    lua_pop(L, 1);
    return value;
}

} // namespace

// Reads the listing through the script layer's orbane.Classes(), so the table
// shows exactly what scripts see.
int ControlLister::Print(QTextStream &out)
{
    lua_State *L = LuaRuntime::Instance().State();
    lua_getglobal(L, "orbane");
    lua_getfield(L, -1, "Classes");
    if (lua_pcall(L, 0, 1, 0) != 0) {
        out << "cannot list classes: " << lua_tostring(L, -1) << "\n";
        lua_pop(L, 2);
        return 1;
    }
    const int n = int(lua_objlen(L, -1));
    out << qSetFieldWidth(26) << Qt::left << "class ID" << "base class ID" << "registry name" << "script type"
        << qSetFieldWidth(0) << "tags\n";
    for (int i = 1; i <= n; ++i) {
        lua_rawgeti(L, -1, i);
        const int row = lua_gettop(L);
        out << qSetFieldWidth(26) << Field(L, row, "ClassID") << Field(L, row, "BaseClassID")
            << Field(L, row, "Name") << Field(L, row, "ScriptType") << qSetFieldWidth(0)
            << Field(L, row, "Tags") << "\n";
        lua_pop(L, 1);
    }
    out << n << " registrations\n";
    lua_pop(L, 2);
    return 0;
}

} // namespace Orbane
