#pragma once

#include "orbane/ScriptObject.h"

#include <string>

namespace Orbane {

// The exported cast pair of a scriptable class and the declarations that the
// script layer hands to its foreign-function interface, e.g.
//   "CheckBoxControl * ffi_CheckBoxControl_cast(void * obj)"
//   "ScriptObject * ffi_CheckBoxControl_uncast(CheckBoxControl * self)"
std::string FFICastSymbol(const std::string &nativeName);
std::string FFICastDeclaration(const std::string &nativeName);
std::string FFICastResult(const std::string &nativeName);
std::string FFIUncastSymbol(const std::string &nativeName);
std::string FFIUncastDeclaration(const std::string &nativeName);

// A generic script object as T, or null where it is none (or null).
template <class T>
T *FFICast(void *obj)
{
    return obj ? dynamic_cast<T *>(static_cast<ScriptObject *>(obj)) : nullptr;
}

} // namespace Orbane

// Defines ffi_<Class>_cast and ffi_<Class>_uncast for Orbane::Class, at global
// scope. The uncast is the identity: every control starts with its
// ScriptObject base, so the pointer does not move.
#define ORBANE_FFI_CASTS(Class)                                                                                        \
    extern "C" __attribute__((visibility("default"))) Orbane::Class *ffi_##Class##_cast(void *obj)                     \
    {                                                                                                                  \
        return Orbane::FFICast<Orbane::Class>(obj);                                                                    \
    }                                                                                                                  \
    extern "C" __attribute__((visibility("default"))) Orbane::ScriptObject *ffi_##Class##_uncast(Orbane::Class *self)  \
    {                                                                                                                  \
        return self;                                                                                                   \
    }
