#pragma once

#include <cstddef>
#include <string>

namespace Orbane {
namespace Test {

// The control library as the host loads it: by path from ORBANE_CONTROLS,
// with dlopen(RTLD_NOW | RTLD_GLOBAL), once per test process.
class ControlModule
{
public:
    // Loads the library; false (with the reason) where it cannot be loaded.
    static bool Load(std::string *error);
    // Registrations the library added to ClassRegistry while loading.
    static std::size_t AddedRegistrations();
    // An exported symbol of the library, or null.
    static void *Symbol(const std::string &name);
};

} // namespace Test
} // namespace Orbane
