#include "GraphDrag.h"
#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"
#include "orbane/ScriptValParam.h"

#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

constexpr Tag kLabel = 0x30040000;
const char *const kKeys[] = {"lowStart", "lowEnd", "highStart", "highEnd"};

QString EndsOf(const ScriptVal &v)
{
    QStringList out;
    for (const char *key : kKeys) {
        const ScriptVal *n = v.IsTable() ? v.FindKeyConst(ScriptVal(key)) : nullptr;
        out << QString::number(n ? n->GetNumber(-1) : -1, 'f', 2);
    }
    return out.join(' ');
}

ScriptVal Table(std::initializer_list<double> ends)
{
    ScriptVal t = ScriptVal::NewTable();
    int i = 0;
    for (double e : ends)
        t.SetKey(ScriptVal(kKeys[i++]), ScriptVal(e));
    return t;
}

} // namespace

class ColorRangesControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void gestures_data();
    void gestures();
    void tidiesWhatScriptsWrite();
};

void ColorRangesControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

// Each end drags sideways only, on either curve; each gesture is one step.
void ColorRangesControlTest::gestures_data()
{
    QTest::addColumn<QString>("gesture");
    QTest::addColumn<QPointF>("from");
    QTest::addColumn<double>("to");
    QTest::addColumn<int>("mods");
    QTest::addColumn<QString>("ends");
    QTest::newRow("shadows end") << "drag" << QPointF(0.4, 0.0) << 0.5 << 0 << "0.10 0.50 0.60 0.90";
    QTest::newRow("highlights start overlaps the shadows")
        << "drag" << QPointF(0.6, 0.0) << 0.3 << 0 << "0.10 0.40 0.30 0.90";
    QTest::newRow("Ctrl finer") << "drag" << QPointF(0.9, 1.0) << 0.5 << int(Qt::ControlModifier)
                                << "0.10 0.40 0.60 0.86";
    QTest::newRow("a start stops before its end") << "drag" << QPointF(0.1, 1.0) << 0.8 << 0 << "0.40 0.40 0.60 0.90";
    QTest::newRow("reset") << "reset" << QPointF() << 0.0 << 0 << "0.10 0.40 0.60 0.90";
}

void ColorRangesControlTest::gestures()
{
    QFETCH(QString, gesture);
    QFETCH(QPointF, from);
    QFETCH(double, to);
    QFETCH(int, mods);
    QFETCH(QString, ends);
    ToolFixture f;
    Input *in = f.AddTable("Ranges", gesture == "reset" ? Table({0.2, 0.3, 0.5, 0.7}) : Table({0.1, 0.4, 0.6, 0.9}),
                           TagList{{kLabel, "Ranges"}});
    InputControl *control = f.Create(OrbID("ColorRangesControl"), {in});
    QWidget *graph = control->findChild<QWidget *>("graph");
    if (gesture == "reset")
        QTest::mouseClick(control->findChild<QWidget *>("reset"), Qt::LeftButton);
    else
        DragWith(graph, GraphPixel(graph, from.x(), from.y()), GraphPixel(graph, to, from.y() + 0.3),
                 Qt::KeyboardModifiers(mods), 8);
    const QStringList got = EndsOf(f.TableOf(in)).split(' '), want = ends.split(' ');
    for (int i = 0; i < 4; ++i)
        QVERIFY2(std::abs(got[i].toDouble() - want[i].toDouble()) < 0.015, qPrintable(got.join(' ')));
    QCOMPARE(f.doc.UndoNames(), QStringList{"Change Ranges"});
}

// Reversed, coincident and out-of-range ends from a script are shown tidy
// and written tidy on the next edit.
void ColorRangesControlTest::tidiesWhatScriptsWrite()
{
    ToolFixture f;
    Input *in = f.AddTable("Ranges", Table({0.1, 0.4, 0.6, 0.9}), TagList{{kLabel, "Ranges"}});
    InputControl *control = f.Create(OrbID("ColorRangesControl"), {in});
    QVERIFY(in->SetValue(AutoScriptValParam(Table({0.5, 0.2, 1.7, 1.7})), f.doc.GetCurrentTime(), 0, nullptr));
    QWidget *graph = control->findChild<QWidget *>("graph");
    // The shadows' end, now at 0.5, moved to 0.55.
    DragWith(graph, GraphPixel(graph, 0.5, 0.0), GraphPixel(graph, 0.55, 0.0));
    QCOMPARE(EndsOf(f.TableOf(in)), QString("0.20 0.55 1.00 1.00"));
}

QTEST_MAIN(ColorRangesControlTest)
#include "ColorRangesControlTest.moc"
