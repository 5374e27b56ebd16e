// Look-pack files as they arrive from outside: the input is a layout file,
// read by the look pack (in its sandbox), and every item it returns is built
// as a layout for a control with a few children and arranged at two widths.
#include "FuzzInput.h"

#include "orbane/LayoutContainer.h"
#include "orbane/LayoutWidgetMap.h"
#include "orbane/LookPack.h"

#include <QApplication>
#include <QFile>
#include <QLabel>
#include <QTemporaryDir>

#include <memory>

namespace Orbane {
namespace {

QApplication &App()
{
    static int argc = 1;
    static char name[] = "fuzz_layout";
    static char *argv[] = {name, nullptr};
    qputenv("QT_QPA_PLATFORM", "offscreen");
    static QApplication app(argc, argv);
    return app;
}

// The children most layouts name, as a real control registers them.
struct Children
{
    QWidget owner;
    Layout::WidgetMap map;
    Children()
    {
        for (const char *name : {"label", "slider", "edit", "checkbox", "button", "combo"})
            map.Register(OrbID(name), new QLabel(QString::fromLatin1(name), &owner));
    }
};

} // namespace
} // namespace Orbane

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, std::size_t size)
{
    using namespace Orbane;
    App();
    Fuzz::SmallLimits();
    QTemporaryDir dir;
    QFile file(dir.filePath("layouts.lua"));
    if (!file.open(QIODevice::WriteOnly))
        return 0;
    file.write(reinterpret_cast<const char *>(data), qint64(size));
    file.close();

    const LookPack pack(dir.path());
    static Children children;
    for (const char *item : {"Controls.Fuzz.Layout", "Controls.Default.Layout", "Controls.Slider.Layout"}) {
        if (!pack.HasItem(OrbID(item)))
            continue;
        std::unique_ptr<Layout::Container> layout = Layout::Container::Create(pack.FindItem(OrbID(item)), children.map);
        layout->Arrange(300);
        layout->Arrange(1);
    }
    return 0;
}
