#include "ControlModule.h"

#include "orbane/RegistryList.h"

#include <cstdlib>
#include <dlfcn.h>

namespace Orbane {
namespace Test {

namespace {

void *gHandle = nullptr;
std::size_t gAdded = 0;

} // namespace

bool ControlModule::Load(std::string *error)
{
    const char *path = std::getenv("ORBANE_CONTROLS");
    if (!path) {
        *error = "ORBANE_CONTROLS is not set";
        return false;
    }
    const std::size_t before = ClassRegistry.All().size();
    gHandle = dlopen(path, RTLD_NOW | RTLD_GLOBAL);
    if (!gHandle) {
        *error = dlerror();
        return false;
    }
    gAdded = ClassRegistry.All().size() - before;
    return true;
}

std::size_t ControlModule::AddedRegistrations()
{
    return gAdded;
}

void *ControlModule::Symbol(const std::string &name)
{
    return gHandle ? dlsym(gHandle, name.c_str()) : nullptr;
}

} // namespace Test
} // namespace Orbane
