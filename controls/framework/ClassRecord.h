#pragma once

#include "framework/ControlDesc.h"

#include "orbane/Object.h"
#include "orbane/Registry.h"
#include "orbane/RegistryList.h"
#include "orbane/ScriptInfo.h"

namespace Orbane {

// The class-registry side of one registration of class T: its class ID, its
// Registry in ClassRegistry and its ScriptInfo, made in this order.
template <class T>
class ClassRecord
{
public:
    explicit ClassRecord(const ControlDesc &desc)
        : mClassID(desc.ClassID()), mRegistry(mClassID, desc.RegistrationTags(&mScriptInfo, &NewObject<T>)),
          mScriptInfo(1, mClassID.c_str(), "", "")
    {}

private:
    // Enters the class list on construction, which needs the class ID made
    // before it; the script information after it is only pointed at.
    class Entry : public Registry
    {
    public:
        Entry(const OrbID &classID, const TagList &tags) { _Init(ClassRegistry, classID, tags); }
    };

    OrbID mClassID;
    Entry mRegistry;
    ScriptInfoT<T> mScriptInfo;
};

} // namespace Orbane
