#include "CommandLine.h"
#include "ControlLister.h"
#include "ControlModule.h"
#include "ScriptRunner.h"

#include <QApplication>
#include <QTextStream>

using namespace Orbane;

namespace {

// With no display, or when asked, Qt draws off screen: scripts and
// screenshots work the same on a build machine as on a desk.
void ChooseOffscreen(int argc, char **argv)
{
    const bool noDisplay = qEnvironmentVariableIsEmpty("DISPLAY") && qEnvironmentVariableIsEmpty("WAYLAND_DISPLAY");
    bool asked = false;
    for (int i = 1; i < argc; ++i)
        asked |= QByteArray(argv[i]) == "--headless" || QByteArray(argv[i]) == "--list-controls";
    if ((noDisplay || asked) && qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
}

} // namespace

int main(int argc, char **argv)
{
    ChooseOffscreen(argc, argv);
    QApplication app(argc, argv);
    QApplication::setApplicationName("orbane");
    QTextStream out(stdout), err(stderr);

    CommandLine cl = CommandLine::Parse(QApplication::arguments());
    if (cl.help || !cl.error.isEmpty()) {
        (cl.help ? out : err) << (cl.error.isEmpty() ? QString() : cl.error + "\n") << CommandLine::Usage();
        return cl.help ? 0 : 2;
    }
    QString why;
    if (!ControlModule::Load(&why)) {
        err << "orbane: " << why << "\n";
        return 1;
    }
    if (cl.listControls)
        return ControlLister::Print(out);
    if (!cl.script.isEmpty())
        return ScriptRunner::Run(cl.script, err);
    err << "orbane: nothing to do yet without --script or --list-controls\n";
    return 2;
}
