// A host that knows the installed package only: it loads the control module
// and checks that the check box registered under its class ID.
#include <orbane/ClassIDs.h>
#include <orbane/Registry.h>
#include <orbane/RegistryList.h>

#include <QApplication>
#include <cstdio>
#include <dlfcn.h>

int main(int argc, char **argv)
{
    qputenv("QT_QPA_PLATFORM", "offscreen");
    QApplication app(argc, argv);
    void *module = dlopen(CONTROLS_MODULE, RTLD_NOW | RTLD_GLOBAL);
    if (!module) {
        std::fprintf(stderr, "cannot load %s: %s\n", CONTROLS_MODULE, dlerror());
        return 1;
    }
    const Orbane::Registry *reg = Orbane::ClassRegistry.Find(Orbane::CLSID_InputControl_Checkbox);
    const std::size_t count = Orbane::ClassRegistry.All().size();
    std::printf("%zu registrations; check box: %s\n", count, reg ? reg->Name() : "missing");
    return reg && count == 53 ? 0 : 1;
}
