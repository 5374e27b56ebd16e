#pragma once

#include "framework/TagMapHooks.h"

#include "orbane/OrbID.h"
#include "orbane/Registry.h"
#include "orbane/TagList.h"

namespace Orbane {

// What one control class registers, written as one expression:
//   ControlDesc::Preview("AngleControl").Tags<AngleControlTags>().Cleanup(&AngleControl::RegCleanup)
// The family (Input or Preview) gives the defaults: kind, base class, clean-up
// hook, script base type and tag-map name. Every class gets a script type named
// after it and a tag-mapping hook, with no tag map until Tags<>() gives one.
class ControlDesc
{
public:
    // `name` is the native type and registry name. A class ID given as an
    // OrbID must be a constant that outlives the registration (a host CLSID_),
    // because ID variants point at it as their base.
    static ControlDesc Input(const char *name) { return Input(name, name); }
    static ControlDesc Input(const char *name, const char *classID);
    static ControlDesc Input(const char *name, const OrbID &hostClassID);
    static ControlDesc Preview(const char *name) { return Preview(name, name); }
    static ControlDesc Preview(const char *name, const char *classID);
    static ControlDesc Preview(const char *name, const OrbID &hostClassID);

    // The script type name, where it differs from the native name.
    ControlDesc &Script(const char *scriptName);
    // Not scriptable: no script type, casts or tag map.
    ControlDesc &NoScript();
    // Another base class; `baseID` must outlive the registration.
    ControlDesc &Base(const OrbID &baseID, const char *scriptBase = nullptr);
    ControlDesc &MapName(const char *mapName);
    ControlDesc &Cleanup(ClassHook cleanup);
    ControlDesc &NoHook();
    // An extra registration tag, after the common ones and before the hook.
    ControlDesc &Flag(Tag tag, const TagValue &value = 1);

    // The "Create" tag map and the hook that maps by it.
    template <const TagMapEntry *Table>
    ControlDesc &Tags()
    {
        mTable = Table;
        mHook = &MapScriptTags<Table>;
        return *this;
    }

    // The same class under another class ID: the current class ID becomes the
    // base, the hook goes (the primary's is found through the base), and the
    // variant has its own script type `scriptName` or, if null, none.
    ControlDesc Variant(const OrbID &hostClassID, const char *scriptName = nullptr) const;

    OrbID ClassID() const;
    const char *Name() const noexcept { return mName; }
    const char *ScriptName() const noexcept { return mScriptName; }
    const char *ScriptBase() const noexcept { return mScriptBase; }
    const char *MapName() const noexcept { return mMapName; }
    const TagMapEntry *Table() const noexcept { return mTable; }

    // The tag list for Registry::_Init, in the order the host documents.
    // `scriptInfo` is the address of the class's ScriptInfoT, which may still
    // be under construction: only its address is stored.
    TagList RegistrationTags(void *scriptInfo, FactoryFunc factory) const;

private:
    ControlDesc(const char *name, int32 kind, const OrbID &baseID, ClassHook cleanup, const char *scriptBase,
                const char *mapName);

    const char *mName;
    const char *mClassIDText = nullptr;
    const OrbID *mHostClassID = nullptr;
    int32 mKind;
    const OrbID *mBaseID;
    ClassHook mCleanup;
    const char *mScriptName;
    const char *mScriptBase;
    const char *mMapName;
    const TagMapEntry *mTable = nullptr;
    TagMapHook mHook = &MapScriptTags<NoTags>;
    TagList mFlags;
};

} // namespace Orbane
