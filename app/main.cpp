#include "AutoSave.h"
#include "CommandLine.h"
#include "ControlLister.h"
#include "ControlModule.h"
#include "MainWindow.h"
#include "ScriptRunner.h"
#include "UiScripting.h"

#include "orbane/Input.h"
#include "orbane/LuaRuntime.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/Theme.h"
#include "orbane/ToolLoader.h"
#include "orbane/ViewerPanel.h"

#include <QApplication>
#include <QDir>
#include <QTextStream>

using namespace Orbane;

namespace {

bool NoDisplay()
{
    return qEnvironmentVariableIsEmpty("DISPLAY") && qEnvironmentVariableIsEmpty("WAYLAND_DISPLAY");
}

// With no display, or when asked, Qt draws off screen: scripts and
// screenshots work the same on a build machine as on a desk.
void ChooseOffscreen(int argc, char **argv)
{
    bool asked = false;
    for (int i = 1; i < argc; ++i)
        asked |= QByteArray(argv[i]) == "--headless" || QByteArray(argv[i]) == "--list-controls";
    if ((NoDisplay() || asked) && qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
}

bool HasOverlays(const Operator *tool)
{
    for (const Input *input : tool->Inputs())
        if (input->GetAttrs().FindQuery(INPA_PreviewControl))
            return true;
    return false;
}

bool Shoot(QWidget *widget, const QString &dir, const QString &name, QTextStream &out)
{
    const QString path = QDir(dir).absoluteFilePath(name + ".png");
    if (!widget->grab().save(path))
        return false;
    out << path << "\n";
    return true;
}

// Headless runs of a comp write what a person would have seen: the window
// as it opens, and the viewer over each tool that has overlays.
int WriteScreenshots(MainWindow &window, const OrbaneDoc &doc, const QString &dir, QTextStream &out)
{
    QDir().mkpath(dir);
    // The comp's picture is read in the background: shoot it, not its placeholder.
    constexpr int32 kImageWaitMs = 60000;
    window.Viewer()->WaitForImage(kImageWaitMs);
    const std::pair<const char *, QWidget *> shots[] = {
        {"window", &window}, {"inspector", window.Inspector()}, {"viewer", window.Viewer()}};
    for (const auto &[name, widget] : shots)
        if (!Shoot(widget, dir, name, out))
            return 1;
    const Operator *first = window.Viewer()->GetTool();
    for (const Operator *tool : doc.Tools())
        if (HasOverlays(tool) && (!window.ShowTool(tool->GetName()) ||
                                  !Shoot(window.Viewer(), dir, QString("viewer-") + tool->GetName(), out)))
            return 1;
    if (first)
        window.ShowTool(first->GetName());
    return 0;
}

int RunWindow(const CommandLine &cl, QApplication &app, QTextStream &out, QTextStream &err)
{
    OrbaneDoc doc;
    MainWindow window(&doc);
    UiScripting::Install(&doc, &window);
    window.show();
    // A person at the window gets autosave and the offer of work a crash
    // left behind; headless runs leave the recovery file alone.
    const bool interactive = cl.script.isEmpty() && !cl.headless && !NoDisplay();
    window.Recovery()->SetEnabled(interactive);
    const bool restored = interactive && window.OfferRecovery();
    std::string why;
    if (!restored && !cl.comp.isEmpty() && !ToolLoader::LoadComp(doc, cl.comp.toStdString(), &why)) {
        err << "orbane: " << QString::fromStdString(why) << "\n";
        return 1;
    }
    int status = 0;
    if (!cl.script.isEmpty())
        status = ScriptRunner::Run(cl.script, err);
    else if (cl.headless || NoDisplay())
        status = WriteScreenshots(window, doc, cl.shotDir.isEmpty() ? "screenshots" : cl.shotDir, out);
    else
        status = app.exec();
    // Objects that scripts still hold are released while the window lives.
    LuaRuntime::Instance().Reset();
    return status;
}

} // namespace

int main(int argc, char **argv)
{
    ChooseOffscreen(argc, argv);
    QApplication app(argc, argv);
    QApplication::setApplicationName("orbane");
    Theme::Apply(app);
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
    // With a display and nothing named, the window opens on a new comp.
    if (cl.comp.isEmpty() && cl.script.isEmpty() && (cl.headless || NoDisplay())) {
        err << CommandLine::Usage();
        return 2;
    }
    return RunWindow(cl, app, out, err);
}
