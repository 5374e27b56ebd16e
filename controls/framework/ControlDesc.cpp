#include "framework/ControlDesc.h"

#include "orbane/InputControl.h"
#include "orbane/PreviewControl.h"

namespace Orbane {

namespace {

// Registration format level that the host expects of every class.
constexpr int32 kFormatLevel = 7;

// Tells which build of the library registered a class.
constexpr const char *kBuildStamp = "Built: " __DATE__;

} // namespace

ControlDesc::ControlDesc(const char *name, int32 kind, const OrbID &baseID, ClassHook cleanup, const char *scriptBase,
                         const char *mapName)
    : mName(name), mKind(kind), mBaseID(&baseID), mCleanup(cleanup), mScriptName(name), mScriptBase(scriptBase),
      mMapName(mapName)
{}

ControlDesc ControlDesc::Input(const char *name, const char *classID)
{
    ControlDesc desc(name, REGKIND_InputControl, InputControl::ClassID, &Object::RegCleanup, "InputControl",
                     "InputControl.Create");
    desc.mClassIDText = classID;
    return desc;
}

ControlDesc ControlDesc::Input(const char *name, const OrbID &hostClassID)
{
    ControlDesc desc = Input(name, nullptr);
    desc.mHostClassID = &hostClassID;
    return desc;
}

ControlDesc ControlDesc::Preview(const char *name, const char *classID)
{
    ControlDesc desc(name, REGKIND_PreviewControl, PreviewControl::ClassID, &PreviewControl::RegCleanup,
                     "PreviewControl", "PreviewControl.Create");
    desc.mClassIDText = classID;
    return desc;
}

ControlDesc ControlDesc::Preview(const char *name, const OrbID &hostClassID)
{
    ControlDesc desc = Preview(name, nullptr);
    desc.mHostClassID = &hostClassID;
    return desc;
}

ControlDesc &ControlDesc::Script(const char *scriptName)
{
    mScriptName = scriptName;
    return *this;
}

ControlDesc &ControlDesc::NoScript()
{
    mScriptName = nullptr;
    mTable = nullptr;
    return *this;
}

ControlDesc &ControlDesc::Base(const OrbID &baseID, const char *scriptBase)
{
    mBaseID = &baseID;
    if (scriptBase)
        mScriptBase = scriptBase;
    return *this;
}

ControlDesc &ControlDesc::MapName(const char *mapName)
{
    mMapName = mapName;
    return *this;
}

ControlDesc &ControlDesc::Cleanup(ClassHook cleanup)
{
    mCleanup = cleanup;
    return *this;
}

ControlDesc &ControlDesc::NoHook()
{
    mHook = nullptr;
    return *this;
}

ControlDesc &ControlDesc::Flag(Tag tag, const TagValue &value)
{
    mFlags.Add(tag, value);
    return *this;
}

ControlDesc ControlDesc::Variant(const OrbID &hostClassID, const char *scriptName) const
{
    ControlDesc variant = *this;
    variant.mBaseID = mHostClassID;
    variant.mHostClassID = &hostClassID;
    variant.mClassIDText = nullptr;
    variant.mScriptName = scriptName;
    variant.mHook = nullptr;
    variant.mFlags.Clear();
    return variant;
}

OrbID ControlDesc::ClassID() const
{
    return mHostClassID ? *mHostClassID : OrbID(mClassIDText);
}

TagList ControlDesc::RegistrationTags(void *scriptInfo, FactoryFunc factory) const
{
    TagList tags{
        {REG_ClassInit, &Object::RegInit},
        {REG_ClassCleanup, mCleanup},
        {REG_Kind, mKind},
        {REG_FormatLevel, kFormatLevel},
        {REG_BuildStamp, kBuildStamp},
        {REG_BaseClassID, static_cast<const void *>(mBaseID)},
        {REG_ScriptInfo, scriptInfo},
        {REG_Name, mName},
        {REG_Factory, factory},
    };
    tags.Append(mFlags);
    if (mHook)
        tags.Add(REG_TagMapHook, mHook);
    return tags;
}

} // namespace Orbane
