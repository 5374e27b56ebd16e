#include "inputcontrols/ButtonScript.h"

#include "orbane/LuaRuntime.h"
#include "orbane/LuaSandbox.h"
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
    const bool ok = Load(doc, error) && (SetEnvironment(tool, self, modifiers), true) &&
                    LuaSandbox::Call(L, 0, 0, mChunkName, error);
    lua_settop(L, top);
    // The environment held references to the tool and the control: give
    // them back now, not at some later collection when the control may be
    // gone.
    lua_gc(L, LUA_GCCOLLECT, 0);
    return ok;
}

bool ButtonScript::Load(OrbaneDoc *doc, std::string *error) const
{
    lua_State *L = LuaRuntime::Instance().State();
    const std::string mapped = doc ? doc->MapPath(mText.c_str()).str() : mText;
    if (mapped != mText || (mText.size() > 4 && mText.compare(mText.size() - 4, 4, ".lua") == 0 &&
                            QFileInfo(QString::fromStdString(mapped)).isFile()))
        return LuaSandbox::LoadFile(L, mapped, error);
    return LuaSandbox::LoadString(L, mText, mChunkName, error);
}

// Adds the button's names to the fresh environment of the loaded chunk.
void ButtonScript::SetEnvironment(ScriptObject *tool, ScriptObject *self, uint64 modifiers) const
{
    lua_State *L = LuaRuntime::Instance().State();
    lua_getfenv(L, -1);
    LuaRuntime::PushObject(L, tool);
    lua_setfield(L, -2, "tool");
    LuaRuntime::PushObject(L, self);
    lua_setfield(L, -2, "self");
    lua_pushnumber(L, lua_Number(modifiers));
    lua_setfield(L, -2, "modifiers");
    lua_pop(L, 1);
}

} // namespace Orbane
