#include "orbane/FFIType.h"

#include "orbane/ScriptInfo.h"

#include <algorithm>
#include <cstring>
#include <typeindex>
#include <unordered_map>

namespace Orbane {

namespace {

std::vector<FFIType *> &Types()
{
    static std::vector<FFIType *> types;
    return types;
}

std::unordered_map<std::type_index, FFIType *> &Bindings()
{
    static std::unordered_map<std::type_index, FFIType *> bindings;
    return bindings;
}

// Base chains come from registrations, so a cycle is possible in principle;
// no real hierarchy is this deep.
constexpr int kMaxDepth = 64;

} // namespace

FFIType::FFIType(const char *scriptName, const char *nativeName, const char *baseName, int32 size, int32 flags,
                 void *extra)
    : mScriptName(scriptName), mNativeName(nativeName), mBaseName(baseName), mSize(size), mFlags(flags), mExtra(extra)
{
    Types().push_back(this);
}

FFIType::~FFIType()
{
    auto &types = Types();
    types.erase(std::remove(types.begin(), types.end(), this), types.end());
    auto &bindings = Bindings();
    for (auto it = bindings.begin(); it != bindings.end();)
        it = it->second == this ? bindings.erase(it) : std::next(it);
}

const std::vector<FFIType *> &FFIType::All()
{
    return Types();
}

FFIType *FFIType::FindScriptName(const char *name)
{
    if (!name)
        return nullptr;
    for (FFIType *type : Types())
        if (std::strcmp(type->ScriptName(), name) == 0)
            return type;
    return nullptr;
}

void SetFFIType(const std::type_info &cls, FFIType *type)
{
    // The first binding wins: a class's ID variants bind their own script
    // types to the same class after the primary, and objects of the class
    // still report the primary's name.
    if (type)
        Bindings().emplace(std::type_index(cls), type);
}

FFIType *GetFFIType(const std::type_info &cls)
{
    const auto &bindings = Bindings();
    const std::type_info *at = &cls;
    for (int depth = 0; at && depth < kMaxDepth; ++depth, at = GetBaseTypeInfo(*at)) {
        const auto it = bindings.find(std::type_index(*at));
        if (it != bindings.end())
            return it->second;
    }
    return nullptr;
}

} // namespace Orbane
