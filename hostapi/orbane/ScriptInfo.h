#pragma once

#include "orbane/OrbString.h"
#include "orbane/Types.h"

#include <typeinfo>

namespace Orbane {

// Script information of one registered class: which native class it is and
// under which class ID scripts see it.
class ScriptInfo
{
public:
    ScriptInfo(int32 version, const char *classID, const char *help, const char *extra);
    virtual ~ScriptInfo();
    ScriptInfo(const ScriptInfo &) = delete;
    ScriptInfo &operator=(const ScriptInfo &) = delete;

    int32 Version() const noexcept { return mVersion; }
    const char *ClassID() const noexcept { return mClassID.c_str(); }
    virtual const std::type_info &NativeType() const noexcept = 0;

private:
    int32 mVersion;
    OrbString mClassID, mHelp, mExtra;
};

template <class T>
class ScriptInfoT : public ScriptInfo
{
public:
    using ScriptInfo::ScriptInfo;
    const std::type_info &NativeType() const noexcept override { return typeid(T); }
};

// Tells the script layer that `cls` derives from `base`.
void SetTypeInfo(const std::type_info &cls, const std::type_info &base);
// The base that SetTypeInfo gave, or null.
const std::type_info *GetBaseTypeInfo(const std::type_info &cls);

} // namespace Orbane
