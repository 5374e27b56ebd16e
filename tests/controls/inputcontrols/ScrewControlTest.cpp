#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"
#include "orbane/TimeCodeEdit.h"

#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

Q_DECLARE_METATYPE(std::vector<int32>)

Q_DECLARE_METATYPE(Qt::KeyboardModifiers)

namespace {

constexpr Tag kStep = 0x20050000;

QWidget *Wheel(const InputControl *c)
{
    return c->findChild<QWidget *>("wheel");
}

InputControl *MakeScrew(ToolFixture &f, Input *in)
{
    return f.Create(OrbID("ScrewControl"), {in});
}

void Notch(QWidget *wheel, int notches, Qt::KeyboardModifiers mods)
{
    const QPoint at(wheel->width() / 2, wheel->height() / 2);
    QWheelEvent event(at, wheel->mapToGlobal(at), QPoint(), QPoint(0, 120 * notches), Qt::NoButton, mods,
                      Qt::NoScrollPhase, false);
    QApplication::sendEvent(wheel, &event);
}

} // namespace

class ScrewControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void turning_data();
    void turning();
    void boundScrewsFollow();
};

void ScrewControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

// Drags (pixels) and notches of the mouse wheel, with modifiers; the value
// has no bounds, and each drag or notch is one undo step.
void ScrewControlTest::turning_data()
{
    QTest::addColumn<std::vector<int32>>("moves");
    QTest::addColumn<int>("notches");
    QTest::addColumn<Qt::KeyboardModifiers>("mods");
    QTest::addColumn<double>("value");
    QTest::addColumn<int>("steps");
    const Qt::KeyboardModifiers none;
    QTest::newRow("drag right") << std::vector<int32>{10, 30} << 0 << none << 1000.0 + 40 * 0.5 << 1;
    QTest::newRow("far below zero") << std::vector<int32>{-3000, -2000} << 0 << none << 1000.0 - 5000 * 0.5 << 1;
    QTest::newRow("ctrl drag: a tenth") << std::vector<int32>{40} << 0 << Qt::KeyboardModifiers(Qt::ControlModifier)
                                        << 1000.0 + 4 * 0.5 << 1;
    QTest::newRow("shift drag: ten times")
        << std::vector<int32>{4} << 0 << Qt::KeyboardModifiers(Qt::ShiftModifier) << 1000.0 + 40 * 0.5 << 1;
    QTest::newRow("a notch") << std::vector<int32>{} << 1 << none << 1000.0 + 10 * 0.5 << 1;
    QTest::newRow("notch down with ctrl")
        << std::vector<int32>{} << -1 << Qt::KeyboardModifiers(Qt::ControlModifier) << 1000.0 - 0.5 << 1;
    QTest::newRow("drag then notch") << std::vector<int32>{2} << 1 << none << 1000.0 + 12 * 0.5 << 2;
}

void ScrewControlTest::turning()
{
    QFETCH(std::vector<int32>, moves);
    QFETCH(int, notches);
    QFETCH(Qt::KeyboardModifiers, mods);
    QFETCH(double, value);
    QFETCH(int, steps);
    ToolFixture f;
    Input *in = f.AddNumber("Angle", 1000.0, {{kStep, 0.5}});
    InputControl *c = MakeScrew(f, in);
    if (!moves.empty())
        ToolFixture::DragSideways(Wheel(c), moves, mods);
    if (notches)
        Notch(Wheel(c), notches, mods);
    QCOMPARE(f.NumberOf(in), value);
    QCOMPARE(c->findChild<TimeCodeEdit *>("edit")->GetValue(), value);
    QCOMPARE(f.doc.UndoNames(), QVector<QString>(steps, "Change Angle").toList());
    QVERIFY(!c->IsUndoOpen());
}

void ScrewControlTest::boundScrewsFollow()
{
    ToolFixture f;
    Input *in = f.AddNumber("Angle", 0.0);
    InputControl *first = MakeScrew(f, in);
    InputControl *second = MakeScrew(f, in);
    TimeCodeEdit *edit = first->findChild<TimeCodeEdit *>("edit");
    edit->setFocus();
    edit->selectAll();
    QTest::keyClicks(edit, "-720");
    QTest::keyClick(edit, Qt::Key_Return);
    QCOMPARE(second->findChild<TimeCodeEdit *>("edit")->GetValue(), -720.0);
    Notch(Wheel(second), 2, Qt::NoModifier);
    QCOMPARE(f.NumberOf(in), -720.0 + 20 * 0.01);
    QVERIFY(in->SetValue(AutoNumber(3.25), f.doc.GetCurrentTime()));
    f.Destroy(second);
    QCOMPARE(f.NumberOf(in), 3.25);
    // Typed, turned, set: the unbinding adds no step.
    QCOMPARE(f.doc.UndoNames().size(), 3);
}

QTEST_MAIN(ScrewControlTest)
#include "ScrewControlTest.moc"
