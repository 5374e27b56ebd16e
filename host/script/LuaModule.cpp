#include "LuaModule.h"

#include "orbane/FFITagMap.h"
#include "orbane/FFIType.h"
#include "orbane/LuaRuntime.h"
#include "orbane/Registry.h"
#include "orbane/RegistryList.h"
#include "orbane/ScriptError.h"
#include "orbane/ScriptInfo.h"
#include "orbane/ScriptObject.h"
#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"
#include "orbane/TagMapping.h"

#include <cstdio>
#include <exception>
#include <string>

namespace Orbane {

namespace {

// Each function comes in two parts. The Do* part may hold C++ objects and
// returns its result count, or -1 with a message pushed; the lua_CFunction
// raises that message only after those objects are gone, because lua_error
// does not promise to run destructors on its way out.
int Finish(lua_State *L, int results)
{
    return results < 0 ? lua_error(L) : results;
}

// Pushes "file:line: message", the line being the calling script's.
int Raise(lua_State *L, const std::string &message)
{
    luaL_where(L, 1);
    lua_pushstring(L, message.c_str());
    lua_concat(L, 2);
    return -1;
}

// ---- classes and their tags

const FFIType *ScriptTypeOf(const Registry &reg)
{
    // An ID variant with a script type of its own has it under its class ID.
    if (const FFIType *type = FFIType::FindScriptName(reg.ClassID().c_str()))
        return type;
    const ScriptInfo *info = reg.GetScriptInfo();
    return info ? GetFFIType(info->NativeType()) : nullptr;
}

std::string ScriptNameOf(const Registry &reg)
{
    const FFIType *type = ScriptTypeOf(reg);
    return type ? type->ScriptName() : reg.ClassID().c_str();
}

// A class without a tag-map hook takes no named tags at all.
bool RefuseTags(const Registry &reg, const ScriptVal &args, std::string &problem)
{
    if (args.GetEntries().empty())
        return true;
    const ScriptVal &key = args.GetEntries().front().first;
    const std::string name = key.IsString() ? key.GetString() : key.TypeName();
    problem = "unknown tag \"" + name + "\" for " + ScriptNameOf(reg);
    return false;
}

bool MapTags(const Registry &reg, const char *method, ScriptVal &args, TagList &tags, std::string &problem)
{
    const TagMapHook hook = reg.FindMapHook();
    if (!hook)
        return RefuseTags(reg, args, problem);
    TakeScriptError(); // a stale message must not stand in for this call's
    if (hook(OrbID(method), MAP_ToTags, args, tags))
        return true;
    problem = TakeScriptError();
    if (problem.empty())
        problem = "the tags for " + ScriptNameOf(reg) + " were not accepted";
    return false;
}

ScriptObject *Construct(const Registry &reg, const ScriptVal &args, const TagList &tags, std::string &problem)
{
    // A constructor may throw through the factory; scripts get it as an error.
    ScriptObject *obj = nullptr;
    try {
        obj = reg.New(args, tags);
    } catch (const std::exception &e) {
        problem = "creating " + ScriptNameOf(reg) + " failed: " + e.what();
        return nullptr;
    } catch (...) {
        problem = "creating " + ScriptNameOf(reg) + " failed";
        return nullptr;
    }
    if (!obj)
        problem = "could not create " + ScriptNameOf(reg);
    return obj;
}

// ---- arguments

const Registry *ClassArg(lua_State *L, int idx, std::string &problem)
{
    if (lua_type(L, idx) != LUA_TSTRING) {
        problem = std::string("expected a class name, got ") + luaL_typename(L, idx);
        return nullptr;
    }
    const char *name = lua_tostring(L, idx);
    const Registry *reg = ClassRegistry.FindScriptName(name);
    if (!reg)
        problem = std::string("unknown class \"") + name + "\"";
    return reg;
}

// Tags are a table or nothing; nothing gives an empty table.
bool TagsArg(lua_State *L, int idx, ScriptVal &args, std::string &problem)
{
    if (lua_isnoneornil(L, idx))
        return true;
    if (!lua_istable(L, idx)) {
        problem = std::string("expected a table of tags, got ") + luaL_typename(L, idx);
        return false;
    }
    std::string why;
    if (LuaRuntime::ToScriptVal(L, idx, args, why))
        return true;
    problem = "the table of tags: " + why;
    return false;
}

ScriptObject *SelfArg(lua_State *L, std::string &problem)
{
    ScriptObject *obj = LuaRuntime::ToObject(L, 1);
    if (!obj)
        problem = "expected an object (call this as obj:Method())";
    return obj;
}

// ---- results

void SetString(lua_State *L, const char *key, const char *value)
{
    lua_pushstring(L, value);
    lua_setfield(L, -2, key);
}

void PushClassInfo(lua_State *L, const Registry &reg)
{
    const FFIType *type = ScriptTypeOf(reg);
    const FFITagMap *map = type ? FFITagMap::ForType(type) : nullptr;
    lua_createtable(L, 0, 5);
    SetString(L, "ClassID", reg.ClassID().c_str());
    if (!reg.BaseClassID().IsEmpty())
        SetString(L, "BaseClassID", reg.BaseClassID().c_str());
    SetString(L, "Name", reg.Name());
    if (type)
        SetString(L, "ScriptType", type->ScriptName());
    lua_pushinteger(L, map ? map->Count() : 0);
    lua_setfield(L, -2, "Tags");
}

void PushTagItems(lua_State *L, const TagList &tags)
{
    lua_createtable(L, tags.Count(), 0);
    int i = 0;
    for (const TagItem &item : tags.Items()) {
        lua_createtable(L, 0, 2);
        lua_pushnumber(L, item.tag);
        lua_setfield(L, -2, "tag");
        LuaRuntime::Push(L, TagItemValue(item));
        lua_setfield(L, -2, "value");
        lua_rawseti(L, -2, ++i);
    }
}

// ---- module functions

int DoCreate(lua_State *L)
{
    std::string problem;
    ScriptVal args = ScriptVal::NewTable();
    TagList tags;
    const Registry *reg = ClassArg(L, 1, problem);
    if (!reg || !TagsArg(L, 2, args, problem) || !MapTags(*reg, "Create", args, tags, problem))
        return Raise(L, problem);
    ScriptObject *obj = Construct(*reg, args, tags, problem);
    if (!obj)
        return Raise(L, problem);
    LuaRuntime::PushObject(L, obj);
    obj->DecRef(); // the creator's reference; the script's object holds its own
    return 1;
}

int DoMapTags(lua_State *L)
{
    std::string problem;
    ScriptVal args = ScriptVal::NewTable();
    TagList tags;
    const Registry *reg = ClassArg(L, 1, problem);
    if (!reg || !TagsArg(L, 2, args, problem) || !MapTags(*reg, "Create", args, tags, problem))
        return Raise(L, problem);
    PushTagItems(L, tags);
    return 1;
}

int DoLoadControls(lua_State *L)
{
    if (lua_type(L, 1) != LUA_TSTRING)
        return Raise(L, std::string("expected a library path, got ") + luaL_typename(L, 1));
    std::string error;
    if (!LuaRuntime::Instance().LoadLibrary(lua_tostring(L, 1), &error))
        return Raise(L, error);
    lua_pushboolean(L, 1);
    return 1;
}

int Create(lua_State *L)
{
    return Finish(L, DoCreate(L));
}

int MapTagsFn(lua_State *L)
{
    return Finish(L, DoMapTags(L));
}

int LoadControls(lua_State *L)
{
    return Finish(L, DoLoadControls(L));
}

int Classes(lua_State *L)
{
    const auto &all = ClassRegistry.All();
    lua_createtable(L, int(all.size()), 0);
    int i = 0;
    for (const Registry *reg : all) {
        PushClassInfo(L, *reg);
        lua_rawseti(L, -2, ++i);
    }
    return 1;
}

// ---- object methods

int DoClassID(lua_State *L)
{
    std::string problem;
    ScriptObject *obj = SelfArg(L, problem);
    if (!obj)
        return Raise(L, problem);
    const Registry *reg = obj->GetRegistry();
    if (reg)
        lua_pushstring(L, reg->ClassID().c_str());
    else
        lua_pushnil(L);
    return 1;
}

int DoTypeName(lua_State *L)
{
    std::string problem;
    ScriptObject *obj = SelfArg(L, problem);
    if (!obj)
        return Raise(L, problem);
    lua_pushstring(L, obj->ScriptTypeName());
    return 1;
}

int DoGetAttrs(lua_State *L)
{
    std::string problem;
    ScriptObject *obj = SelfArg(L, problem);
    if (!obj)
        return Raise(L, problem);
    TagList tags;
    ScriptVal attrs = ScriptVal::NewTable();
    const Registry *reg = obj->GetRegistry();
    const TagMapHook hook = reg ? reg->FindMapHook() : nullptr;
    if (hook && obj->GetAttrsTagList(tags))
        hook(OrbID("GetAttrs"), MAP_FromTags, attrs, tags);
    LuaRuntime::Push(L, attrs);
    return 1;
}

int DoSetAttrs(lua_State *L)
{
    std::string problem;
    ScriptVal args = ScriptVal::NewTable();
    TagList tags;
    ScriptObject *obj = SelfArg(L, problem);
    if (obj && !obj->GetRegistry())
        problem = std::string(obj->ScriptTypeName()) + " takes no attributes";
    if (!obj || !obj->GetRegistry() || !TagsArg(L, 2, args, problem) ||
        !MapTags(*obj->GetRegistry(), "SetAttrs", args, tags, problem))
        return Raise(L, problem);
    lua_pushboolean(L, obj->SetAttrsTagList(tags));
    return 1;
}

int DoToString(lua_State *L)
{
    std::string problem;
    ScriptObject *obj = SelfArg(L, problem);
    if (!obj)
        return Raise(L, problem);
    lua_pushfstring(L, "%s: %p", obj->ScriptTypeName(), static_cast<void *>(obj));
    return 1;
}

int ClassIDMethod(lua_State *L)
{
    return Finish(L, DoClassID(L));
}

int TypeNameMethod(lua_State *L)
{
    return Finish(L, DoTypeName(L));
}

int GetAttrsMethod(lua_State *L)
{
    return Finish(L, DoGetAttrs(L));
}

int SetAttrsMethod(lua_State *L)
{
    return Finish(L, DoSetAttrs(L));
}

int ToStringMethod(lua_State *L)
{
    return Finish(L, DoToString(L));
}

} // namespace

const luaL_Reg *LuaModule::Functions()
{
    static const luaL_Reg functions[] = {
        {"Create", Create}, {"Classes", Classes}, {"MapTags", MapTagsFn}, {"LoadControls", LoadControls},
        {nullptr, nullptr},
    };
    return functions;
}

const luaL_Reg *LuaModule::Methods()
{
    static const luaL_Reg methods[] = {
        {"ClassID", ClassIDMethod},   {"TypeName", TypeNameMethod}, {"GetAttrs", GetAttrsMethod},
        {"SetAttrs", SetAttrsMethod}, {"ToString", ToStringMethod}, {nullptr, nullptr},
    };
    return methods;
}

} // namespace Orbane
