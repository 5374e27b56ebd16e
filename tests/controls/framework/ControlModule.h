#pragma once

#include <cstddef>
#include <string>

namespace Orbane {
namespace Test {

// The control library, loaded from ORBANE_CONTROLS as the host loads it.
class ControlModule
{
public:
    static bool Load(std::string *error);
    // Registrations the library added to ClassRegistry while loading.
    static std::size_t AddedRegistrations();
    static void *Symbol(const std::string &name);
};

} // namespace Test
} // namespace Orbane
