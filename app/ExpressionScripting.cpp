#include "ExpressionScripting.h"

#include "ScriptHands.h"

#include "orbane/Input.h"
#include "orbane/LuaArgs.h"
#include "orbane/LuaRuntime.h"

#include <lua.hpp>

namespace Orbane {

namespace {

OrbaneDoc *gDoc = nullptr;

void PushTextOrNil(lua_State *L, const char *text)
{
    if (*text)
        lua_pushstring(L, text);
    else
        lua_pushnil(L);
}

// orbane.SetExpression(tool, input, text): one undo step, with the value it
// computes; nil or "" makes the Input plain again. A text that is refused
// (does not parse, names no number Input, closes a cycle) is a Lua error and
// changes nothing, like a value SetValue refuses.
int SetExpression(lua_State *L)
{
    const LuaArgs args(L, "SetExpression");
    Input *input = ScriptHands::InputArg(args, gDoc);
    const char *text = args.OptString(3, "text", "");
    std::string why;
    if (!input->SetExpression(text, 0, &why))
        return ScriptHands::Raise(L, QString::fromStdString(why));
    return 0;
}

int GetExpression(lua_State *L)
{
    PushTextOrNil(L, ScriptHands::InputArg(LuaArgs(L, "GetExpression"), gDoc)->GetExpression());
    return 1;
}

int ExpressionError(lua_State *L)
{
    PushTextOrNil(L, ScriptHands::InputArg(LuaArgs(L, "ExpressionError"), gDoc)->GetExpressionError());
    return 1;
}

} // namespace

void ExpressionScripting::Install(OrbaneDoc *doc)
{
    gDoc = doc;
    LuaRuntime::Instance().AddModuleFunction("SetExpression", SetExpression);
    LuaRuntime::Instance().AddModuleFunction("GetExpression", GetExpression);
    LuaRuntime::Instance().AddModuleFunction("ExpressionError", ExpressionError);
}

} // namespace Orbane
