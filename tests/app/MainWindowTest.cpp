// The application window on the demo comp, worked with real events: the File
// menu and its question before losing work, recent comps, autosave and the
// recovery offer, the undo history and Edit menu, scrubbing the time ruler,
// its key marks, and Tab through every inspector control.
#include "LoadControlModule.h"

#include "AutoSave.h"
#include "FileMenu.h"
#include "MainWindow.h"
#include "RecentFiles.h"
#include "TimeRuler.h"
#include "TimeScale.h"
#include "UndoHistoryDock.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"
#include "orbane/InputControl.h"
#include "orbane/LayoutObj.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ToolLoader.h"

#include <QComboBox>
#include <QLineEdit>
#include <QMenu>
#include <QMenuBar>
#include <QMouseEvent>
#include <QSettings>
#include <QStandardPaths>
#include <QTemporaryDir>
#include <QUndoStack>
#include <QUndoView>
#include <QtTest>

#include <memory>
#include <set>

using namespace Orbane;

namespace {

// A window on the demo comp whose questions and file dialogs answer as told.
struct Session
{
    Session()
    {
        std::string why;
        loaded = ToolLoader::LoadComp(doc, ORBANE_EXAMPLES "/demo.lua", &why);
        if (!loaded)
            qWarning("%s", why.c_str());
        window.resize(1000, 700);
        window.show();
        // Shortcuts reach the active window only.
        QApplication::setActiveWindow(&window);
        window.File()->SetAsk([this](const QString &) {
            ++questions;
            return answer;
        });
        window.File()->SetChoose([this](bool, const QString &) { return chosenPath; });
        window.File()->SetTell([](const QString &) {});
    }

    Input *InputOf(const char *tool, const char *id) const
    {
        Operator *op = doc.FindTool(tool);
        return op ? op->FindInput(OrbID(id)) : nullptr;
    }
    // A user's edit: one undo step.
    void Edit(const char *tool, const char *id, float64 value)
    {
        InputOf(tool, id)->SetValue(AutoNumber(value), doc.GetCurrentTime());
    }
    QAction *MenuEntry(const QString &menu, const QString &text) const
    {
        for (QAction *top : window.menuBar()->actions())
            if (top->menu() && top->text().remove('&') == menu)
                for (QAction *a : top->menu()->actions())
                    if (a->text().remove('&').startsWith(text))
                        return a;
        return nullptr;
    }

    OrbaneDoc doc;
    MainWindow window{&doc};
    bool loaded = false;
    FileMenu::Answer answer = FileMenu::Answer::Cancel;
    QString chosenPath;
    int questions = 0;
};

QString ShownText(InputControl *control, const char *child)
{
    Layout::LayoutObj *obj = control->FindLayoutObj(child);
    auto *edit = obj ? qobject_cast<QLineEdit *>(obj->GetWidget()) : nullptr;
    return edit ? edit->text() : QString();
}

} // namespace

class MainWindowTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void init();
    void saveMarksTitleAndRecent();
    void questionBeforeLosingWork_data();
    void questionBeforeLosingWork();
    void badCompLeavesDocument();
    void recentListKeepsNewestOnce();
    void autosaveOffersRecovery();
    void historyAndEditMenuNameSteps();
    void scrubbingShowsValueAtTime();
    void keyMarksSitAtKeyTimes();
    void tabReachesEveryControl_data();
    void tabReachesEveryControl();

private:
    QTemporaryDir mDir;
};

void MainWindowTest::initTestCase()
{
    std::string error;
    QVERIFY2(Test::LoadControlModule(&error), error.c_str());
    QVERIFY(mDir.isValid());
    QStandardPaths::setTestModeEnabled(true);
    QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, mDir.filePath("settings"));
}

void MainWindowTest::init()
{
    QSettings().clear();
    AutoSave::Discard();
}

void MainWindowTest::saveMarksTitleAndRecent()
{
    Session s;
    QVERIFY(s.loaded);
    QVERIFY(!s.window.isWindowModified());
    QCOMPARE(s.window.windowTitle(), QString("demo.lua[*] - Orbane"));
    s.Edit("Sliders1", "Blend", 0.25);
    QVERIFY(s.window.isWindowModified());

    s.chosenPath = mDir.filePath("saved.lua");
    s.MenuEntry("File", "Save As")->trigger();
    QVERIFY(QFileInfo::exists(s.chosenPath));
    QVERIFY(!s.window.isWindowModified());
    QCOMPARE(s.window.windowTitle(), QString("saved.lua[*] - Orbane"));
    QCOMPARE(RecentFiles().Paths().value(0), s.chosenPath);

    // Ctrl+S saves again to the same comp, without a dialog.
    s.Edit("Sliders1", "Blend", 0.75);
    s.chosenPath.clear();
    QTest::keySequence(&s.window, QKeySequence::Save);
    QVERIFY(!s.window.isWindowModified());

    Session reopened;
    reopened.answer = FileMenu::Answer::Discard;
    QVERIFY(reopened.window.File()->OpenPath(mDir.filePath("saved.lua")));
    QCOMPARE(AutoNumber(reopened.InputOf("Sliders1", "Blend"), 0.0)->Value, 0.75);
    QCOMPARE(reopened.questions, 0);
}

void MainWindowTest::questionBeforeLosingWork_data()
{
    QTest::addColumn<int>("answer");
    QTest::addColumn<bool>("cleared");
    QTest::addColumn<bool>("saved");
    QTest::newRow("Save writes the comp, then New") << int(FileMenu::Answer::Save) << true << true;
    QTest::newRow("Discard drops the work") << int(FileMenu::Answer::Discard) << true << false;
    QTest::newRow("Cancel keeps everything") << int(FileMenu::Answer::Cancel) << false << false;
}

void MainWindowTest::questionBeforeLosingWork()
{
    QFETCH(int, answer);
    QFETCH(bool, cleared);
    QFETCH(bool, saved);
    Session s;
    QVERIFY(s.window.File()->SaveTo(mDir.filePath("before.lua")));
    s.Edit("Sliders1", "Blend", 0.5);
    s.answer = FileMenu::Answer(answer);

    QTest::keySequence(&s.window, QKeySequence::New);
    QCOMPARE(s.questions, 1);
    QCOMPARE(s.doc.Tools().empty(), cleared);
    QCOMPARE(s.window.isWindowModified(), !cleared);
    Session check;
    QVERIFY(check.window.File()->OpenPath(mDir.filePath("before.lua")));
    QCOMPARE(AutoNumber(check.InputOf("Sliders1", "Blend"), 0.0)->Value, saved ? 0.5 : 1.0);

    // Nothing unsaved: no question at all.
    s.questions = 0;
    s.doc.Clear();
    QVERIFY(s.window.File()->New());
    QCOMPARE(s.questions, 0);
}

void MainWindowTest::badCompLeavesDocument()
{
    QFile bad(mDir.filePath("bad.lua"));
    QVERIFY(bad.open(QIODevice::WriteOnly));
    bad.write("return { tools = { { file = ");
    bad.close();
    Session s;
    const std::size_t tools = s.doc.Tools().size();
    QVERIFY(!s.window.File()->OpenPath(bad.fileName()));
    QCOMPARE(s.doc.Tools().size(), tools);
    QVERIFY(s.window.File()->LastMessage().contains("bad.lua"));
}

void MainWindowTest::recentListKeepsNewestOnce()
{
    Session s;
    RecentFiles recent;
    for (int i = 0; i < RecentFiles::kMax + 2; ++i)
        recent.Add(mDir.filePath(QString("c%1.lua").arg(i)));
    recent.Add(mDir.filePath("c5.lua"));
    const QStringList paths = recent.Paths();
    QCOMPARE(paths.size(), RecentFiles::kMax);
    QCOMPARE(paths.first(), mDir.filePath("c5.lua"));
    QCOMPARE(paths.count(mDir.filePath("c5.lua")), 1);
    QVERIFY(!paths.contains(mDir.filePath("c0.lua")));
    // The menu the user sees lists the same comps (the window's own list
    // reads the same settings).
    s.window.File()->RecentMenu()->aboutToShow();
    QStringList shown;
    for (QAction *a : s.window.File()->RecentMenu()->actions())
        if (!a->isSeparator() && a->text() != "Clear Menu")
            shown << a->text();
    QCOMPARE(shown, paths);
}

void MainWindowTest::autosaveOffersRecovery()
{
    {
        Session crashed;
        crashed.window.Recovery()->SetInterval(20);
        crashed.window.Recovery()->SetEnabled(true);
        QVERIFY(!AutoSave::HasRecovery());
        crashed.Edit("Sliders1", "Blend", 0.125);
        QTRY_VERIFY(AutoSave::HasRecovery());
        // The session ends without closing its window: a crash.
    }
    OrbaneDoc doc;
    MainWindow window(&doc);
    window.File()->SetAsk([](const QString &) { return FileMenu::Answer::Save; });
    QVERIFY(window.OfferRecovery());
    Input *blend = doc.FindTool("Sliders1")->FindInput(OrbID("Blend"));
    QCOMPARE(AutoNumber(blend, 0.0)->Value, 0.125);
    QVERIFY(window.isWindowModified());
    QCOMPARE(QString::fromStdString(doc.CompPath()), QFileInfo(ORBANE_EXAMPLES "/demo.lua").absoluteFilePath());
    QVERIFY(!AutoSave::HasRecovery());
    QVERIFY(!window.OfferRecovery());
}

void MainWindowTest::historyAndEditMenuNameSteps()
{
    Session s;
    s.Edit("Sliders1", "Blend", 0.5);
    s.Edit("Sliders1", "Size", 20);
    QCOMPARE(s.window.History()->Rows(), (QStringList{"<empty>", "Change Blend", "Change Size"}));
    QCOMPARE(s.MenuEntry("Edit", "Undo")->text(), QString("Undo Change Size"));
    QTest::keySequence(&s.window, QKeySequence::Undo);
    QCOMPARE(s.MenuEntry("Edit", "Undo")->text(), QString("Undo Change Blend"));
    QCOMPARE(s.MenuEntry("Edit", "Redo")->text(), QString("Redo Change Size"));
    QCOMPARE(s.window.History()->View()->currentIndex().row(), 1);
}

// Keys 1 at 0 and 0 at 10 on Blend: a drag on the ruler to frame 5 shows
// 0.5 in the slider's field.
void MainWindowTest::scrubbingShowsValueAtTime()
{
    Session s;
    Input *blend = s.InputOf("Sliders1", "Blend");
    blend->SetAnimated(true);
    blend->SetValue(AutoNumber(1.0), 0.0);
    blend->SetValue(AutoNumber(0.0), 10.0);
    QVERIFY(s.window.ShowTool("Sliders1"));
    InputControl *slider = s.window.Inspector()->ControlsOf(blend).front();
    TimeScale *scale = s.window.Ruler()->Scale();
    const int y = scale->height() / 2;
    QTest::mousePress(scale, Qt::LeftButton, Qt::NoModifier, QPoint(scale->XOf(2.0), y));
    QMouseEvent drag(QEvent::MouseMove, QPoint(scale->XOf(5.0), y), Qt::NoButton, Qt::LeftButton, Qt::NoModifier);
    QApplication::sendEvent(scale, &drag);
    QCOMPARE(s.doc.GetCurrentTime(), 5.0);
    QCOMPARE(ShownText(slider, "edit"), QString("0.500"));
    QTest::mouseRelease(scale, Qt::LeftButton, Qt::NoModifier, QPoint(scale->XOf(5.0), y));

    s.window.Ruler()->Step(1);
    QCOMPARE(ShownText(slider, "edit"), QString("0.400"));
    s.window.Ruler()->GoToFirst();
    QCOMPARE(ShownText(slider, "edit"), QString("1.000"));
}

void MainWindowTest::keyMarksSitAtKeyTimes()
{
    Session s;
    s.InputOf("Sliders1", "Blend")->SetAnimated(true);
    s.InputOf("Sliders1", "Blend")->SetValue(AutoNumber(0.5), 30.0);
    s.InputOf("Sliders1", "Size")->SetAnimated(true);
    s.InputOf("Sliders1", "Size")->SetValue(AutoNumber(3), 30.0);
    s.InputOf("Sliders1", "Size")->SetValue(AutoNumber(4), 75.0);
    s.InputOf("Points1", "Center")->SetAnimated(true);
    QVERIFY(s.window.ShowTool("Sliders1"));
    s.doc.SetCurrentTime(50.0); // the current-time line away from every mark
    TimeScale *scale = s.window.Ruler()->Scale();
    QCOMPARE(scale->KeyMarks(), (std::vector<float64>{0.0, 30.0, 75.0}));
    const QImage shot = scale->grab().toImage();
    const qreal ratio = shot.devicePixelRatio();
    for (const float64 time : scale->KeyMarks()) {
        const QPoint at(int(scale->XOf(time) * ratio), int((scale->height() / 2 - 2) * ratio));
        QCOMPARE(QColor(shot.pixel(at)), QColor(240, 190, 60));
    }
    QCOMPARE(TimeScale::TimeToX(0, 0, 100, 216), TimeScale::kMargin);
    QCOMPARE(TimeScale::TimeToX(100, 0, 100, 216), 216 - TimeScale::kMargin);
    QCOMPARE(TimeScale::XToFrame(216 - TimeScale::kMargin, 0, 100, 216), 100.0);
}

void MainWindowTest::tabReachesEveryControl_data()
{
    QTest::addColumn<QString>("tool");
    for (const char *tool : {"Switches1", "Points1", "Dials1", "Sliders1", "Choices1", "Transform1", "Files1",
                             "Groups1", "Roto1", "Layers1", "Framing1"})
        QTest::newRow(tool) << QString(tool);
}

// From the tool chooser, Tab visits every control of the tool, each named
// for screen readers after its Input.
void MainWindowTest::tabReachesEveryControl()
{
    QFETCH(QString, tool);
    Session s;
    QVERIFY(s.window.ShowTool(tool));
    ParameterPanel *inspector = s.window.Inspector();
    inspector->ControlsOf(s.doc.FindTool(tool.toUtf8().constData())->Inputs().back());
    std::vector<const InputControl *> controls;
    for (const InputControl *c : inspector->Controls())
        if (c->isVisibleTo(inspector)) // rows of closed groups are out of reach until opened
            controls.push_back(c);
    QWidget *start = s.window.findChild<QComboBox *>();
    start->setFocus(Qt::TabFocusReason);
    std::set<const InputControl *> reached;
    for (int i = 0; i < 400 && QApplication::focusWidget(); ++i) {
        QTest::keyClick(QApplication::focusWidget(), Qt::Key_Tab);
        for (const InputControl *c : controls)
            if (c->isAncestorOf(QApplication::focusWidget()) || c == QApplication::focusWidget())
                reached.insert(c);
    }
    for (const InputControl *c : controls) {
        QVERIFY2(reached.count(c), qPrintable(c->accessibleName() + " is not reached with Tab"));
        QCOMPARE(c->accessibleName(), QString::fromUtf8(c->GetCurrentInput()->GetName()));
    }
}

QTEST_MAIN(MainWindowTest)
#include "MainWindowTest.moc"
