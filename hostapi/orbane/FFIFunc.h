#pragma once

#include "orbane/OrbString.h"
#include "orbane/Types.h"

#include <vector>

namespace Orbane {

class FFIType;

// A C function exported by a library for scripts: its symbol and the
// declaration that the script layer gives to ffi.cdef. Built before the
// FFIType it belongs to is constructed, so it only keeps the reference.
class FFIFunc
{
public:
    FFIFunc(FFIType &type, const char *name, const char *scriptName, const char *symbol, const char *declaration,
            const char *argNames, void *extra, const char *resultType, int32 flags);
    ~FFIFunc();
    FFIFunc(const FFIFunc &) = delete;
    FFIFunc &operator=(const FFIFunc &) = delete;

    FFIType &Type() const noexcept { return mType; }
    const char *Name() const noexcept { return mName.c_str(); }
    const char *Symbol() const noexcept { return mSymbol.c_str(); }
    const char *Declaration() const noexcept { return mDeclaration.c_str(); }
    const char *ArgNames() const noexcept { return mArgNames.c_str(); }
    const char *ResultType() const noexcept { return mResultType.c_str(); }

    static const std::vector<FFIFunc *> &All();

private:
    FFIType &mType;
    OrbString mName, mScriptName, mSymbol, mDeclaration, mArgNames, mResultType;
    void *mExtra;
    int32 mFlags;
};

} // namespace Orbane
