#include "orbane/RegistryList.h"

#include "orbane/FFIType.h"
#include "orbane/Registry.h"

#include <algorithm>
#include <cstring>

namespace Orbane {

RegistryList ClassRegistry;

void RegistryList::Add(Registry *reg)
{
    if (reg && std::find(mRegs.begin(), mRegs.end(), reg) == mRegs.end())
        mRegs.push_back(reg);
}

void RegistryList::Remove(Registry *reg)
{
    mRegs.erase(std::remove(mRegs.begin(), mRegs.end(), reg), mRegs.end());
}

const Registry *RegistryList::Find(const OrbID &classID) const
{
    if (classID.IsEmpty())
        return nullptr;
    for (const Registry *reg : mRegs)
        if (reg->ClassID() == classID)
            return reg;
    return nullptr;
}

const Registry *RegistryList::FindScriptName(const char *name) const
{
    if (!name || !*name)
        return nullptr;
    if (const Registry *reg = Find(OrbID(name)))
        return reg;
    const FFIType *type = FFIType::FindScriptName(name);
    return type ? FindNativeName(type->NativeName()) : nullptr;
}

const Registry *RegistryList::FindNativeName(const char *nativeName) const
{
    // The primary registration carries the tag-map hook; its variants share
    // the registry name but not the hook.
    const Registry *first = nullptr;
    for (const Registry *reg : mRegs) {
        if (std::strcmp(reg->Name(), nativeName) != 0)
            continue;
        if (reg->MapHook())
            return reg;
        if (!first)
            first = reg;
    }
    return first;
}

ScriptObject *RegistryList::New(const OrbID &classID, const ScriptVal &args, const TagList &tags) const
{
    const Registry *reg = Find(classID);
    return reg ? reg->New(args, tags) : nullptr;
}

} // namespace Orbane
