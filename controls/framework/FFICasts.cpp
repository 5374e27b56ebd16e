#include "framework/FFICasts.h"

namespace Orbane {

std::string FFICastSymbol(const std::string &nativeName)
{
    return "ffi_" + nativeName + "_cast";
}

std::string FFICastDeclaration(const std::string &nativeName)
{
    return FFICastResult(nativeName) + " " + FFICastSymbol(nativeName) + "(void * obj)";
}

std::string FFICastResult(const std::string &nativeName)
{
    return nativeName + " *";
}

std::string FFIUncastSymbol(const std::string &nativeName)
{
    return "ffi_" + nativeName + "_uncast";
}

std::string FFIUncastDeclaration(const std::string &nativeName)
{
    return "ScriptObject * " + FFIUncastSymbol(nativeName) + "(" + nativeName + " * self)";
}

} // namespace Orbane
