#include "orbane/ScriptInfo.h"

#include <typeindex>
#include <unordered_map>

namespace Orbane {

namespace {

std::unordered_map<std::type_index, const std::type_info *> &BaseTypes()
{
    static std::unordered_map<std::type_index, const std::type_info *> bases;
    return bases;
}

} // namespace

ScriptInfo::ScriptInfo(int32 version, const char *classID, const char *help, const char *extra)
    : mVersion(version), mClassID(classID), mHelp(help), mExtra(extra)
{
}

ScriptInfo::~ScriptInfo() = default;

void SetTypeInfo(const std::type_info &cls, const std::type_info &base)
{
    // A class naming itself would make every walk up the bases endless.
    if (cls != base)
        BaseTypes()[std::type_index(cls)] = &base;
}

const std::type_info *GetBaseTypeInfo(const std::type_info &cls)
{
    const auto &bases = BaseTypes();
    const auto it = bases.find(std::type_index(cls));
    return it == bases.end() ? nullptr : it->second;
}

} // namespace Orbane
