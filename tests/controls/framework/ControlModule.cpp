#include "ControlModule.h"
#include "LoadControlModule.h"

#include "orbane/RegistryList.h"

#include <dlfcn.h>

namespace Orbane {
namespace Test {

namespace {

std::size_t gAdded = 0;

} // namespace

bool ControlModule::Load(std::string *error)
{
    const std::size_t before = ClassRegistry.All().size();
    if (!LoadControlModule(error))
        return false;
    gAdded = ClassRegistry.All().size() - before;
    return true;
}

std::size_t ControlModule::AddedRegistrations()
{
    return gAdded;
}

// The library's symbols are global once loaded.
void *ControlModule::Symbol(const std::string &name)
{
    return dlsym(RTLD_DEFAULT, name.c_str());
}

} // namespace Test
} // namespace Orbane
