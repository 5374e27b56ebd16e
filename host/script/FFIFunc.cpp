#include "orbane/FFIFunc.h"

#include <algorithm>

namespace Orbane {

namespace {

std::vector<FFIFunc *> &Funcs()
{
    static std::vector<FFIFunc *> funcs;
    return funcs;
}

} // namespace

FFIFunc::FFIFunc(FFIType &type, const char *name, const char *scriptName, const char *symbol, const char *declaration,
                 const char *argNames, void *extra, const char *resultType, int32 flags)
    : mType(type), mName(name), mScriptName(scriptName), mSymbol(symbol), mDeclaration(declaration),
      mArgNames(argNames), mResultType(resultType), mExtra(extra), mFlags(flags)
{
    // `type` is not constructed yet: keep the reference, never read it here.
    Funcs().push_back(this);
}

FFIFunc::~FFIFunc()
{
    auto &funcs = Funcs();
    funcs.erase(std::remove(funcs.begin(), funcs.end(), this), funcs.end());
}

const std::vector<FFIFunc *> &FFIFunc::All()
{
    return Funcs();
}

} // namespace Orbane
