#pragma once

#include "orbane/OrbID.h"
#include "orbane/TagList.h"

namespace Orbane {

class Registry;
class RegistryList;
class ScriptInfo;
class ScriptObject;
class ScriptVal;

// Creates an instance of a registered class (registration tag REG_Factory).
using FactoryFunc = ScriptObject *(*)(const Registry *reg, const ScriptVal &args, const TagList &tags);
// Translates named script tags for one method (registration tag REG_TagMapHook).
// The hook owns its copy of the method name.
using TagMapHook = bool (*)(OrbID method, int32 direction, ScriptVal &args, TagList &tags);
// Class initialisation and clean-up hooks.
using ClassHook = bool (*)(Registry *reg);

// One registered class: its ID, its base, its factory and its script binding,
// all read from the registration tag list.
class Registry
{
public:
    Registry() = default;
    ~Registry();
    Registry(const Registry &) = delete;
    Registry &operator=(const Registry &) = delete;

    // Reads the registration tags, enters the list and runs REG_ClassInit.
    bool _Init(RegistryList &list, const OrbID &classID, const TagList &tags);

    const OrbID &ClassID() const noexcept { return mClassID; }
    const OrbID &BaseClassID() const noexcept { return mBaseRef ? *mBaseRef : mBaseID; }
    const char *Name() const noexcept { return mName.c_str(); }
    int32 Kind() const noexcept { return mKind; }
    ScriptInfo *GetScriptInfo() const noexcept { return mScriptInfo; }
    FactoryFunc Factory() const noexcept { return mFactory; }
    TagMapHook MapHook() const noexcept { return mMapHook; }
    const TagList &Tags() const noexcept { return mTags; }

    // The registry this one derives from, in the same list, or null.
    const Registry *Base() const;
    // Is this class `classID` or derived from it?
    bool IsA(const OrbID &classID) const;
    // The own hook, or the nearest base's (ID variants inherit their primary's).
    TagMapHook FindMapHook() const;
    // Creates an instance through the factory; null where there is none.
    ScriptObject *New(const ScriptVal &args, const TagList &tags) const;

private:
    void ReadBaseClassID(const TagList &tags);

    RegistryList *mList = nullptr;
    OrbID mClassID, mBaseID;
    // The base class ID passed by address is read when needed: it may be a
    // static of another source file that is not constructed yet at _Init.
    const OrbID *mBaseRef = nullptr;
    OrbString mName;
    int32 mKind = 0;
    ScriptInfo *mScriptInfo = nullptr;
    FactoryFunc mFactory = nullptr;
    TagMapHook mMapHook = nullptr;
    ClassHook mCleanup = nullptr;
    TagList mTags;
};

} // namespace Orbane
