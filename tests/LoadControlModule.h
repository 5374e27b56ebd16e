#pragma once

#include <cstdlib>
#include <dlfcn.h>
#include <string>

namespace Orbane {
namespace Test {

// The control library as the host loads it: dlopen of ORBANE_CONTROLS with
// RTLD_NOW | RTLD_GLOBAL, once per process. False with the reason where it fails.
inline bool LoadControlModule(std::string *error)
{
    static void *handle = nullptr;
    static std::string failure;
    if (!handle && failure.empty()) {
        const char *path = std::getenv("ORBANE_CONTROLS");
        handle = path ? dlopen(path, RTLD_NOW | RTLD_GLOBAL) : nullptr;
        if (!handle)
            failure = path ? dlerror() : "ORBANE_CONTROLS is not set";
    }
    if (error)
        *error = failure;
    return handle != nullptr;
}

} // namespace Test
} // namespace Orbane
