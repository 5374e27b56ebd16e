#pragma once

#include "orbane/OrbString.h"
#include "orbane/Types.h"

#include <typeinfo>
#include <vector>

namespace Orbane {

// A type known to the script layer's foreign-function interface: its script
// name, its native (C) type name and the script type it derives from.
// Every FFIType lives in the process-wide list from construction to destruction.
class FFIType
{
public:
    FFIType(const char *scriptName, const char *nativeName, const char *baseName, int32 size, int32 flags, void *extra);
    virtual ~FFIType();
    FFIType(const FFIType &) = delete;
    FFIType &operator=(const FFIType &) = delete;

    const char *ScriptName() const noexcept { return mScriptName.c_str(); }
    const char *NativeName() const noexcept { return mNativeName.c_str(); }
    const char *BaseName() const noexcept { return mBaseName.c_str(); }
    virtual const std::type_info &NativeType() const noexcept = 0;

    static const std::vector<FFIType *> &All();
    static FFIType *FindScriptName(const char *name);

private:
    OrbString mScriptName, mNativeName, mBaseName;
    int32 mSize, mFlags;
    void *mExtra;
};

template <class T>
class FFITypeT : public FFIType
{
public:
    using FFIType::FFIType;
    const std::type_info &NativeType() const noexcept override { return typeid(T); }
};

// Binds a native class to its script type, so objects of it report that name.
void SetFFIType(const std::type_info &cls, FFIType *type);
// The script type bound to the class, or, failing that, to its nearest base
// known through SetTypeInfo; null if none.
FFIType *GetFFIType(const std::type_info &cls);

} // namespace Orbane
