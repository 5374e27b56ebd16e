#pragma once

#include "orbane/OrbID.h"

#include <vector>

namespace Orbane {

class Registry;
class ScriptObject;
class ScriptVal;
class TagList;

// A list of registered classes, in registration order.
class RegistryList
{
public:
    void Add(Registry *reg);
    void Remove(Registry *reg);

    // By class ID.
    const Registry *Find(const OrbID &classID) const;
    // By class ID, else by script type name (the primary registration of the
    // native class that the script type is bound to). Null if neither.
    const Registry *FindScriptName(const char *name) const;
    // The registration named `nativeName` that has a tag-map hook, else the
    // first of that name.
    const Registry *FindNativeName(const char *nativeName) const;
    // Creates an instance of the class `classID`; null if unknown.
    ScriptObject *New(const OrbID &classID, const ScriptVal &args, const TagList &tags) const;

    const std::vector<Registry *> &All() const noexcept { return mRegs; }

private:
    std::vector<Registry *> mRegs;
};

// The host's list of every class, controls included. Libraries that register
// classes load after the script library, so it is constructed before they use it.
extern RegistryList ClassRegistry;

} // namespace Orbane
