#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"
#include "orbane/Point.h"
#include "orbane/TimeCodeEdit.h"

#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

Q_DECLARE_METATYPE(std::vector<int32>)

Q_DECLARE_METATYPE(Qt::KeyboardModifiers)

namespace {

constexpr Tag kDragStep = 0x20050000;

TimeCodeEdit *Edit(const InputControl *c, const char *name)
{
    return c->findChild<TimeCodeEdit *>(name);
}

QPointF PointOf(const ToolFixture &f, Input *in)
{
    const AutoPoint p(in, f.doc.GetCurrentTime());
    return p ? QPointF(p->X, p->Y) : QPointF(-1, -1);
}

InputControl *MakeOffset(ToolFixture &f, Input *in)
{
    return f.Create(OrbID("OffsetControl"), {in});
}

} // namespace

class OffsetControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void typing_data();
    void typing();
    void dragging_data();
    void dragging();
    void boundControlsFollow();
};

void OffsetControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

void OffsetControlTest::typing_data()
{
    QTest::addColumn<QString>("box");
    QTest::addColumn<QString>("text");
    QTest::addColumn<QPointF>("point");
    QTest::addColumn<int>("steps");
    QTest::newRow("x typed") << "x"
                             << "0.75" << QPointF(0.75, 0.2) << 1;
    QTest::newRow("y as arithmetic") << "y"
                                     << "0.25*2" << QPointF(0.1, 0.5) << 1;
    QTest::newRow("unreadable text changes nothing") << "x"
                                                     << "left" << QPointF(0.1, 0.2) << 0;
    QTest::newRow("same value writes nothing") << "y"
                                               << "0.2" << QPointF(0.1, 0.2) << 0;
}

void OffsetControlTest::typing()
{
    QFETCH(QString, box);
    QFETCH(QString, text);
    QFETCH(QPointF, point);
    QFETCH(int, steps);
    ToolFixture f;
    Input *in = f.AddPoint("Center", 0.1, 0.2);
    TimeCodeEdit *edit = Edit(MakeOffset(f, in), box.toUtf8().constData());
    edit->setFocus();
    edit->selectAll();
    QTest::keyClicks(edit, text);
    QTest::keyClick(edit, Qt::Key_Return);
    QCOMPARE(PointOf(f, in), point);
    QCOMPARE(f.doc.UndoNames(), QVector<QString>(steps, "Change Center").toList());
    // The box shows the value again, not what could not be read.
    QCOMPARE(edit->GetValue(), box == "x" ? point.x() : point.y());
}

void OffsetControlTest::dragging_data()
{
    QTest::addColumn<std::vector<int32>>("moves");
    QTest::addColumn<Qt::KeyboardModifiers>("mods");
    QTest::addColumn<double>("x");
    QTest::newRow("a pixel a step") << std::vector<int32>{10, 10, 20} << Qt::KeyboardModifiers() << 0.1 + 40 * 0.002;
    QTest::newRow("back past the start") << std::vector<int32>{30, -50} << Qt::KeyboardModifiers() << 0.1 - 20 * 0.002;
    QTest::newRow("ctrl: a tenth") << std::vector<int32>{20, 20} << Qt::KeyboardModifiers(Qt::ControlModifier)
                                   << 0.1 + 4 * 0.002;
    QTest::newRow("shift: ten times") << std::vector<int32>{5, 5} << Qt::KeyboardModifiers(Qt::ShiftModifier)
                                      << 0.1 + 100 * 0.002;
}

void OffsetControlTest::dragging()
{
    QFETCH(std::vector<int32>, moves);
    QFETCH(Qt::KeyboardModifiers, mods);
    QFETCH(double, x);
    ToolFixture f;
    Input *in = f.AddPoint("Center", 0.1, 0.2, {{kDragStep, 0.002}});
    InputControl *c = MakeOffset(f, in);
    ToolFixture::DragSideways(Edit(c, "x"), moves, mods);
    const QPointF now = PointOf(f, in);
    QVERIFY2(std::fabs(now.x() - x) < 1e-12, qPrintable(QString::number(now.x(), 'g', 17)));
    QCOMPARE(now.y(), 0.2);
    QCOMPARE(f.doc.UndoNames(), QStringList{"Change Center"});
    QVERIFY(!c->IsUndoOpen());
}

void OffsetControlTest::boundControlsFollow()
{
    ToolFixture f;
    Input *in = f.AddPoint("Center", 0.1, 0.2);
    InputControl *first = MakeOffset(f, in);
    InputControl *second = MakeOffset(f, in);
    TimeCodeEdit *y = Edit(first, "y");
    y->setFocus();
    y->selectAll();
    QTest::keyClicks(y, "0.9");
    QTest::keyClick(y, Qt::Key_Return);
    QCOMPARE(Edit(second, "y")->GetValue(), 0.9);
    QVERIFY(in->SetValue(AutoPoint(0.3, 0.4), f.doc.GetCurrentTime()));
    QCOMPARE(Edit(first, "x")->GetValue(), 0.3);
    f.Destroy(second);
    QCOMPARE(PointOf(f, in), QPointF(0.3, 0.4));
    QCOMPARE(f.doc.UndoNames().size(), 2);
}

QTEST_MAIN(OffsetControlTest)
#include "OffsetControlTest.moc"
