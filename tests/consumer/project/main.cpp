// A host that knows the installed package only: it loads the control module
// and checks that the check box registered under its class ID, and that the
// widget library's headers and library serve a program of its own.
#include <orbane/ClassIDs.h>
#include <orbane/Registry.h>
#include <orbane/RegistryList.h>
#include <widgets/SliderMapping.h>

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
    const double rounded = Orbane::SliderMapping::RoundHalfUp(0.125, 0.01);
    std::printf("0.125 to two places: %g\n", rounded);
    return reg && count == 53 && rounded == 0.13 ? 0 : 1;
}
