#include "inputcontrols/ButtonScript.h"

#include "orbane/LuaRuntime.h"
#include "orbane/OrbaneDoc.h"

#include <QFileInfo>

namespace Orbane {

ButtonScript::ButtonScript(std::string text, std::string chunkName)
    : mText(std::move(text)), mChunkName(std::move(chunkName))
{
}

bool ButtonScript::Run(OrbaneDoc *doc, ScriptObject *tool, ScriptObject *self, uint64 modifiers,
                       std::string *error) const
{
    lua_State *L = LuaRuntime::Instance().State();
    const int top = lua_gettop(L);
    bool ok = Load(doc, error);
    if (ok) {
        SetEnvironment(tool, self, modifiers);
        ok = lua_pcall(L, 0, 0, 0) == 0;
        if (!ok && error)
            *error = lua_tostring(L, -1) ? lua_tostring(L, -1) : "error";
    }
    lua_settop(L, top);
    // The environment held references to the tool and the control: give
    // them back now, not at some later collection when the control may be
    // gone. A script that kept them in a global keeps its references.
    lua_gc(L, LUA_GCCOLLECT, 0);
    return ok;
}

bool ButtonScript::Load(OrbaneDoc *doc, std::string *error) const
{
    lua_State *L = LuaRuntime::Instance().State();
    const std::string mapped = doc ? doc->MapPath(mText.c_str()).str() : mText;
    int status;
    if (mapped != mText || (mText.size() > 4 && mText.compare(mText.size() - 4, 4, ".lua") == 0 &&
                            QFileInfo(QString::fromStdString(mapped)).isFile()))
        status = luaL_loadfile(L, mapped.c_str());
    else
        status = luaL_loadbuffer(L, mText.data(), mText.size(), ("=" + mChunkName).c_str());
    if (status != 0 && error)
        *error = lua_tostring(L, -1) ? lua_tostring(L, -1) : "cannot load";
    return status == 0;
}

void ButtonScript::SetEnvironment(ScriptObject *tool, ScriptObject *self, uint64 modifiers) const
{
    lua_State *L = LuaRuntime::Instance().State();
    lua_newtable(L);
    LuaRuntime::PushObject(L, tool);
    lua_setfield(L, -2, "tool");
    LuaRuntime::PushObject(L, self);
    lua_setfield(L, -2, "self");
    lua_pushnumber(L, lua_Number(modifiers));
    lua_setfield(L, -2, "modifiers");
    // Reads fall through to the globals, and new names become globals.
    lua_newtable(L);
    lua_pushvalue(L, LUA_GLOBALSINDEX);
    lua_setfield(L, -2, "__index");
    lua_pushvalue(L, LUA_GLOBALSINDEX);
    lua_setfield(L, -2, "__newindex");
    lua_setmetatable(L, -2);
    lua_setfenv(L, -2);
}

} // namespace Orbane
