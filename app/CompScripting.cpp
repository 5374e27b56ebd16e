#include "CompScripting.h"

#include "MainWindow.h"
#include "ScriptHands.h"

#include "orbane/Input.h"
#include "orbane/LuaArgs.h"
#include "orbane/LuaRuntime.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ToolLoader.h"

#include <cstring>

namespace Orbane {

namespace {

using Hands = ScriptHands;

OrbaneDoc *gDoc = nullptr;
MainWindow *gWindow = nullptr;

// orbane.SaveComp(path): the document is then that file, unmodified.
int SaveComp(lua_State *L)
{
    std::string why;
    if (!ToolLoader::SaveComp(*gDoc, LuaArgs(L, "SaveComp").String(1, "path"), &why))
        return Hands::Raise(L, QString::fromStdString(why));
    return 0;
}

// orbane.OpenComp(path): replaces the document's work, as File > Open.
int OpenComp(lua_State *L)
{
    std::string why;
    if (!ToolLoader::OpenComp(*gDoc, LuaArgs(L, "OpenComp").String(1, "path"), &why))
        return Hands::Raise(L, QString::fromStdString(why));
    if (!gDoc->Tools().empty())
        gWindow->ShowTool(QString::fromUtf8(gDoc->Tools().front()->GetName()));
    return 0;
}

int CompPath(lua_State *L)
{
    lua_pushstring(L, gDoc->CompPath().c_str());
    return 1;
}

int IsModified(lua_State *L)
{
    lua_pushboolean(L, gDoc->IsModified());
    return 1;
}

// orbane.SetInterpolation(tool, input, "linear" | "smooth")
int SetInterpolation(lua_State *L)
{
    const LuaArgs args(L, "SetInterpolation");
    Input *input = Hands::InputArg(args, gDoc);
    const char *mode = args.String(3, "mode");
    if (std::strcmp(mode, "linear") != 0 && std::strcmp(mode, "smooth") != 0)
        return Hands::Raise(L, QString("SetInterpolation: mode is \"linear\" or \"smooth\", not \"%1\"").arg(mode));
    input->SetInterpolation(std::strcmp(mode, "smooth") == 0 ? Interpolation::Smooth : Interpolation::Linear);
    return 0;
}

int GetInterpolation(lua_State *L)
{
    const Input *input = Hands::InputArg(LuaArgs(L, "GetInterpolation"), gDoc);
    lua_pushstring(L, input->GetInterpolation() == Interpolation::Smooth ? "smooth" : "linear");
    return 1;
}

} // namespace

void CompScripting::Install(OrbaneDoc *doc, MainWindow *window)
{
    gDoc = doc;
    gWindow = window;
    const std::pair<const char *, lua_CFunction> functions[] = {
        {"SaveComp", SaveComp},
        {"OpenComp", OpenComp},
        {"CompPath", CompPath},
        {"IsModified", IsModified},
        {"SetInterpolation", SetInterpolation},
        {"GetInterpolation", GetInterpolation},
    };
    for (const auto &[name, fn] : functions)
        LuaRuntime::Instance().AddModuleFunction(name, fn);
}

} // namespace Orbane
