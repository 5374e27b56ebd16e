#include "ValueScripting.h"

#include "ScriptHands.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/LuaArgs.h"
#include "orbane/LuaRuntime.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ParameterScript.h"
#include "orbane/PolyLine.h"
#include "orbane/ScriptError.h"
#include "orbane/ScriptVal.h"
#include "orbane/ShapeFile.h"

namespace Orbane {

namespace {

using Hands = ScriptHands;

OrbaneDoc *gDoc = nullptr;

// SVG files are written for an image of this many user units a side; a
// reader maps the box back onto 0..1 whatever its size.
constexpr float64 kSvgUnits = 1000.0;

int RaiseStoreError(lua_State *L, Input *input)
{
    const std::string why = HasScriptError() ? TakeScriptError() : std::string("the value was not stored");
    return Hands::Raise(L, QString("Input \"%1\": %2").arg(input->GetName(), QString::fromStdString(why)));
}

// orbane.SetKey(tool, input, value, time): animates the Input if it is not
// yet (keeping its value as a key at the current time) and stores the key,
// both one undo step "Set Key", so that undo also takes back the animation.
int SetKey(lua_State *L)
{
    const LuaArgs args(L, "SetKey");
    Input *input = Hands::InputArg(args, gDoc);
    const float64 time = args.Number(4, "time");
    const ScriptVal given = LuaRuntime::ToScriptVal(L, 3);
    // Script tables may hold what they like; the values that blend may not.
    if (input->GetDataType() != CLSID_DataType_ScriptVal && !ParameterScript::IsFinite(given))
        return Hands::Raise(L, QString("Input \"%1\": a key's value must be finite numbers").arg(input->GetName()));
    std::string why;
    AutoParameter value(ParameterScript::FromScript(input->GetDataType(), given, &why));
    if (!value)
        return Hands::Raise(L, QString("Input \"%1\": %2").arg(input->GetName(), QString::fromStdString(why)));
    if (time <= TIME_UNDEFINED)
        return Hands::Raise(L, QString("Input \"%1\": a key needs a set time").arg(input->GetName()));
    gDoc->StartUndo("Set Key");
    input->Animate(true);
    const bool stored = input->SetValue(value.get(), time);
    gDoc->EndUndo(stored);
    if (!stored)
        return RaiseStoreError(L, input);
    return 0;
}

int Keys(lua_State *L)
{
    const std::vector<float64> times = Hands::InputArg(LuaArgs(L, "Keys"), gDoc)->KeyTimes();
    lua_createtable(L, int(times.size()), 0);
    for (std::size_t i = 0; i < times.size(); ++i) {
        lua_pushnumber(L, times[i]);
        lua_rawseti(L, -2, int(i + 1));
    }
    return 1;
}

int RemoveKey(lua_State *L)
{
    const LuaArgs args(L, "RemoveKey");
    Input *input = Hands::InputArg(args, gDoc);
    lua_pushboolean(L, input->RemoveKey(args.Number(3, "time")));
    return 1;
}

// Locking is no edit: no undo step. The Inputs are told again so every
// control shows the lock at once.
int SetToolLocked(lua_State *L)
{
    Operator *tool = Hands::ToolArg(LuaArgs(L, "SetToolLocked"), gDoc, 1);
    tool->SetLocked(lua_toboolean(L, 2));
    for (Input *in : tool->Inputs())
        in->Notify();
    return 0;
}

// orbane.ImportShape(tool, input, path[, time]): one undo step; a file that
// does not read changes nothing.
int ImportShape(lua_State *L)
{
    const LuaArgs args(L, "ImportShape");
    Input *input = Hands::InputArg(args, gDoc);
    std::string why;
    AutoRef<PolyLine> read(ShapeFile::Import(args.String(3, "path"), &why));
    if (!read)
        return Hands::Raise(L, QString::fromStdString(why));
    AutoRef<PolyLine> shape(read->Convert(input->GetDataType()));
    if (!shape)
        return Hands::Raise(
            L, QString("Input \"%1\" takes %2, not a shape").arg(input->GetName(), input->GetDataType().c_str()));
    if (!input->SetValue(shape.get(), Hands::TimeArg(args, gDoc, 4)))
        return RaiseStoreError(L, input);
    return 0;
}

int ExportShape(lua_State *L)
{
    const LuaArgs args(L, "ExportShape");
    Input *input = Hands::InputArg(args, gDoc);
    AutoParam<PolyLine> shape(input, Hands::TimeArg(args, gDoc, 4));
    if (!shape)
        return Hands::Raise(L, QString("Input \"%1\" holds no shape").arg(input->GetName()));
    std::string why;
    if (!ShapeFile::Export(args.String(3, "path"), *shape, kSvgUnits, kSvgUnits, &why))
        return Hands::Raise(L, QString::fromStdString(why));
    return 0;
}

} // namespace

void ValueScripting::Install(OrbaneDoc *doc)
{
    gDoc = doc;
    const std::pair<const char *, lua_CFunction> functions[] = {
        {"SetKey", SetKey},           {"Keys", Keys},
        {"RemoveKey", RemoveKey},     {"SetToolLocked", SetToolLocked},
        {"ImportShape", ImportShape}, {"ExportShape", ExportShape},
    };
    for (const auto &[name, fn] : functions)
        LuaRuntime::Instance().AddModuleFunction(name, fn);
}

} // namespace Orbane
