// The keyframe entries of an inspector control's context menu, chosen with a
// real right-click: each is one undo step named after it, undo restores the
// animation exactly, and the control marks its animated Input.
#include "TestControl.h"
#include "ToolFixture.h"

#include "InputStateMark.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"

#include <QContextMenuEvent>
#include <QMenu>
#include <QTimer>
#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

using Keys = QList<double>;

namespace {

QList<double> KeysOf(const Input *in)
{
    const std::vector<float64> times = in->KeyTimes();
    return QList<double>(times.begin(), times.end());
}

// Right-clicks the control and chooses `text` in the menu that opens;
// false where the entry is missing or disabled.
bool ChooseFromContextMenu(QWidget *control, const QString &text)
{
    bool chosen = false;
    QTimer::singleShot(0, control, [&] {
        auto *menu = qobject_cast<QMenu *>(QApplication::activePopupWidget());
        if (!menu)
            return;
        for (QAction *action : menu->actions())
            if (action->text() == text && action->isEnabled()) {
                menu->setActiveAction(action);
                QTest::keyClick(menu, Qt::Key_Return);
                chosen = true;
                return;
            }
        menu->close();
    });
    const QPoint at(control->width() / 2, control->height() / 2);
    QContextMenuEvent event(QContextMenuEvent::Mouse, at, control->mapToGlobal(at));
    QApplication::sendEvent(control, &event);
    return chosen;
}

InputStateMark::State MarkOf(const QWidget *control)
{
    const auto *mark = control->findChild<InputStateMark *>();
    return mark && !mark->isHidden() ? mark->GetState() : InputStateMark::State::Plain;
}

} // namespace

class KeyframeMenuTest : public QObject
{
    Q_OBJECT
private slots:
    void entries_data();
    void entries();
    void lockedToolOffersNothing();
    void markFollowsTime();
};

// The Input holds 0.5 plain, or keys 1 at 0 and 3 at 20 (`animated`); the
// entry is chosen at time `now`.
void KeyframeMenuTest::entries_data()
{
    QTest::addColumn<bool>("animated");
    QTest::addColumn<double>("now");
    QTest::addColumn<QString>("entry");
    QTest::addColumn<bool>("animatedAfter");
    QTest::addColumn<Keys>("keysAfter");
    QTest::addColumn<double>("valueAt10");

    QTest::newRow("Set Key on a plain Input animates it") << false << 5.0 << "Set Key" << true << Keys{5} << 0.5;
    QTest::newRow("Set Key between keys keeps the blend")
        << true << 10.0 << "Set Key" << true << Keys{0, 10, 20} << 2.0;
    QTest::newRow("Remove Key of one of two") << true << 20.0 << "Remove Key" << true << Keys{0} << 1.0;
    QTest::newRow("Animate a plain Input") << false << 7.0 << "Animate" << true << Keys{7} << 0.5;
    QTest::newRow("Remove Animation keeps the value now")
        << true << 5.0 << "Remove Animation" << false << Keys{} << 1.5;
}

void KeyframeMenuTest::entries()
{
    QFETCH(bool, animated);
    QFETCH(double, now);
    QFETCH(QString, entry);
    QFETCH(bool, animatedAfter);
    QFETCH(Keys, keysAfter);
    QFETCH(double, valueAt10);

    ToolFixture f;
    Input *in = f.AddNumber("Blend", 0.5);
    if (animated) {
        in->SetAnimated(true);
        in->SetValue(AutoNumber(1.0), 0.0, SETVALUE_NoUndo);
        in->SetValue(AutoNumber(3.0), 20.0, SETVALUE_NoUndo);
    }
    const Keys keysBefore = KeysOf(in);
    const double before10 = AutoNumber(in, 10.0)->Value;
    f.doc.SetCurrentTime(now);
    InputControl *control = f.Bind(new TestControl, {in});
    const QStringList stepsBefore = f.doc.UndoNames();

    QVERIFY(ChooseFromContextMenu(control, entry));
    QCOMPARE(f.doc.UndoNames(), stepsBefore + QStringList{entry});
    QCOMPARE(in->IsAnimated(), animatedAfter);
    QCOMPARE(KeysOf(in), keysAfter);
    QCOMPARE(AutoNumber(in, 10.0)->Value, valueAt10);

    QVERIFY(f.doc.Undo());
    QCOMPARE(in->IsAnimated(), animated);
    QCOMPARE(KeysOf(in), keysBefore);
    QCOMPARE(AutoNumber(in, 10.0)->Value, before10);
    QCOMPARE(control->accessibleDescription(), QString::number(AutoNumber(in, now)->Value));

    QVERIFY(f.doc.Redo());
    QCOMPARE(KeysOf(in), keysAfter);
    QCOMPARE(in->IsAnimated(), animatedAfter);
}

void KeyframeMenuTest::lockedToolOffersNothing()
{
    ToolFixture f;
    Input *in = f.AddNumber("Blend", 0.5);
    InputControl *control = f.Bind(new TestControl, {in});
    f.tool->SetLocked(true);
    QVERIFY(!ChooseFromContextMenu(control, "Set Key"));
    QVERIFY(!ChooseFromContextMenu(control, "Animate"));
    QVERIFY(!in->IsAnimated());
    QVERIFY(f.doc.UndoNames().isEmpty());
}

// The strip at the control's edge lights at a key and dims between keys;
// the accessible name is the Input's name, the description its value now.
void KeyframeMenuTest::markFollowsTime()
{
    ToolFixture f;
    Input *in = f.AddNumber("Blend", 0.5);
    InputControl *control = f.Bind(new TestControl, {in});
    QCOMPARE(control->accessibleName(), QString("Blend"));
    QCOMPARE(MarkOf(control), InputStateMark::State::Plain);

    QVERIFY(ChooseFromContextMenu(control, "Set Key"));
    QCOMPARE(MarkOf(control), InputStateMark::State::OnKey);
    f.doc.SetCurrentTime(10.0);
    QCOMPARE(MarkOf(control), InputStateMark::State::Animated);
    in->SetValue(AutoNumber(2.0), 10.0);
    QCOMPARE(MarkOf(control), InputStateMark::State::OnKey);
    QCOMPARE(control->accessibleDescription(), QString("2"));
    f.doc.SetCurrentTime(5.0);
    QCOMPARE(control->accessibleDescription(), QString("1.25"));

    QVERIFY(ChooseFromContextMenu(control, "Remove Animation"));
    QCOMPARE(MarkOf(control), InputStateMark::State::Plain);
}

QTEST_MAIN(KeyframeMenuTest)
#include "KeyframeMenuTest.moc"
