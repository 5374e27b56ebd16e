#include "GraphDrag.h"
#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"
#include "orbane/ScriptValParam.h"

#include <QPushButton>
#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

constexpr Tag kLockEnds = 0x1005000A, kSnapY = 0x20050001, kLabel = 0x30040000;
const OrbID kSpline("SplineControl");

ScriptVal Pair(double x, double y)
{
    ScriptVal p = ScriptVal::NewTable();
    p.Append(x);
    p.Append(y);
    return p;
}

ScriptVal CurveOf(std::initializer_list<std::pair<double, double>> points)
{
    ScriptVal c = ScriptVal::NewTable();
    for (const auto &[x, y] : points)
        c.Append(Pair(x, y));
    return c;
}

// The points of one curve of a value, "x,y x,y", to three places.
QString PointsOf(const ScriptVal &value, const char *key)
{
    const ScriptVal *curve = value.IsTable() ? value.FindKeyConst(ScriptVal(key)) : nullptr;
    QStringList out;
    if (curve)
        for (const auto &entry : curve->GetEntries())
            if (entry.first.IsNumber() && entry.second.IsTable())
                out << QString("%1,%2")
                           .arg(entry.second.GetEntries()[0].second.GetNumber(), 0, 'f', 3)
                           .arg(entry.second.GetEntries()[1].second.GetNumber(), 0, 'f', 3);
    return out.join(' ');
}

struct Spline
{
    explicit Spline(const ScriptVal &value, TagList attrs = TagList())
    {
        attrs.Add(kLabel, "Curves");
        input = f.AddTable("Curves", value, attrs);
        control = f.Create(kSpline, {input});
        graph = control->findChild<QWidget *>("graph");
    }
    QWidget *Child(const char *name) const { return control->findChild<QWidget *>(name); }

    ToolFixture f;
    Input *input = nullptr;
    InputControl *control = nullptr;
    QWidget *graph = nullptr;
};

ScriptVal ThreePoints()
{
    ScriptVal v = ScriptVal::NewTable();
    v.SetKey(ScriptVal("luma"), CurveOf({{0, 0}, {0.5, 0.5}, {1, 1}}));
    return v;
}

} // namespace

Q_DECLARE_METATYPE(Orbane::TagList)

class SplineControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void gestures_data();
    void gestures();
    void chooseAndReset();
    void tidiesWhatScriptsWrite();
};

void SplineControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

// Each gesture on the graph writes the whole curve and is one undo step.
void SplineControlTest::gestures_data()
{
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<QString>("gesture");
    QTest::addColumn<QPointF>("from");
    QTest::addColumn<QPointF>("to");
    QTest::addColumn<int>("mods");
    QTest::addColumn<QString>("luma");
    QTest::newRow("drag a point up") << TagList() << "drag" << QPointF(0.5, 0.5) << QPointF(0.5, 0.75) << 0
                                     << "0.000,0.000 0.500,0.750 1.000,1.000";
    QTest::newRow("Ctrl drags ten times finer") << TagList() << "drag" << QPointF(0.5, 0.5) << QPointF(0.5, 0.9)
                                                << int(Qt::ControlModifier) << "0.000,0.000 0.500,0.540 1.000,1.000";
    QTest::newRow("Shift snaps to the grid") << TagList() << "drag" << QPointF(0.5, 0.5) << QPointF(0.62, 0.8)
                                             << int(Qt::ShiftModifier) << "0.000,0.000 0.500,0.750 1.000,1.000";
    QTest::newRow("snap step always") << TagList{{kSnapY, 0.1}} << "drag" << QPointF(0.5, 0.5) << QPointF(0.5, 0.87)
                                      << 0 << "0.000,0.000 0.500,0.900 1.000,1.000";
    QTest::newRow("a point cannot pass its neighbour")
        << TagList() << "drag" << QPointF(0.5, 0.5) << QPointF(1.4, 0.5) << 0 << "0.000,0.000 1.000,0.500 1.000,1.000";
    QTest::newRow("locked ends move up and down") << TagList{{kLockEnds, 1}} << "drag" << QPointF(0, 0)
                                                  << QPointF(0.3, 0.25) << 0 << "0.000,0.250 0.500,0.500 1.000,1.000";
    QTest::newRow("click adds a point") << TagList() << "click" << QPointF(0.25, 0.1) << QPointF() << 0
                                        << "0.000,0.000 0.250,0.100 0.500,0.500 1.000,1.000";
    QTest::newRow("double click removes it")
        << TagList() << "double" << QPointF(0.5, 0.5) << QPointF() << 0 << "0.000,0.000 1.000,1.000";
}

void SplineControlTest::gestures()
{
    QFETCH(TagList, attrs);
    QFETCH(QString, gesture);
    QFETCH(QPointF, from);
    QFETCH(QPointF, to);
    QFETCH(int, mods);
    QFETCH(QString, luma);
    Spline s(ThreePoints(), attrs);
    const QPoint a = GraphPixel(s.graph, from.x(), from.y());
    if (gesture == "drag")
        DragWith(s.graph, a, GraphPixel(s.graph, to.x(), to.y()), Qt::KeyboardModifiers(mods), 8);
    else if (gesture == "click")
        QTest::mouseClick(s.graph, Qt::LeftButton, Qt::NoModifier, a);
    else
        QTest::mouseDClick(s.graph, Qt::LeftButton, Qt::NoModifier, a);
    // Pixels round: a drag lands within a pixel of its aim, so compare to
    // two places where the mouse did the aiming.
    const QString got = PointsOf(s.f.TableOf(s.input), "luma");
    QVERIFY2(got.size() == luma.size(), qPrintable(got));
    const QStringList gotPoints = got.split(' '), wantPoints = luma.split(' ');
    for (int i = 0; i < wantPoints.size(); ++i)
        for (int c = 0; c < 2; ++c)
            QVERIFY2(std::abs(gotPoints[i].split(',')[c].toDouble() - wantPoints[i].split(',')[c].toDouble()) < 0.01,
                     qPrintable(got));
    QCOMPARE(s.f.doc.UndoNames(), QStringList{"Change Curves"});
    QVERIFY(s.f.doc.Undo());
    QCOMPARE(PointsOf(s.f.TableOf(s.input), "luma"), QString("0.000,0.000 0.500,0.500 1.000,1.000"));
}

// The buttons choose the curve the mouse edits; linear and reset each write
// the chosen curve alone, one step each.
void SplineControlTest::chooseAndReset()
{
    Spline s(ThreePoints());
    QTest::mouseClick(s.Child("red"), Qt::LeftButton);
    QTest::mouseClick(s.graph, Qt::LeftButton, Qt::NoModifier, GraphPixel(s.graph, 0.5, 0.8));
    const ScriptVal after = s.f.TableOf(s.input);
    QCOMPARE(PointsOf(after, "red").split(' ').size(), 3);
    QCOMPARE(PointsOf(after, "luma"), QString("0.000,0.000 0.500,0.500 1.000,1.000"));
    QTest::mouseClick(s.Child("linear"), Qt::LeftButton);
    const ScriptVal linear = s.f.TableOf(s.input);
    const ScriptVal *red = linear.FindKeyConst(ScriptVal("red"));
    QVERIFY(red && red->FindKeyConst(ScriptVal("linear")) && red->FindKeyConst(ScriptVal("linear"))->GetBool());
    QTest::mouseClick(s.Child("reset"), Qt::LeftButton);
    QCOMPARE(PointsOf(s.f.TableOf(s.input), "red"), QString("0.000,0.000 1.000,1.000"));
    QCOMPARE(s.f.doc.UndoNames(), (QStringList{"Change Curves", "Change Curves", "Change Curves"}));
}

// Points out of order, twice at one x, or not numbers arrive from a script:
// the control shows them tidy and writes them tidy on the next edit.
void SplineControlTest::tidiesWhatScriptsWrite()
{
    Spline s(ThreePoints());
    ScriptVal messy = ScriptVal::NewTable();
    ScriptVal luma = CurveOf({{1, 1}, {0.5, 0.2}, {0, 0}, {0.5, 0.6}});
    luma.Append(ScriptVal("not a point"));
    messy.SetKey(ScriptVal("luma"), luma);
    QVERIFY(s.input->SetValue(AutoScriptValParam(messy), s.f.doc.GetCurrentTime(), 0, nullptr));
    // The merged point (0.5, 0.4) is where a drag picks it up; the snap
    // step puts it exactly.
    s.control->SetAttrsTagList(s.input, TagList{{kSnapY, 0.05}});
    DragWith(s.graph, GraphPixel(s.graph, 0.5, 0.4), GraphPixel(s.graph, 0.5, 0.45));
    QCOMPARE(PointsOf(s.f.TableOf(s.input), "luma"), QString("0.000,0.000 0.500,0.450 1.000,1.000"));
}

QTEST_MAIN(SplineControlTest)
#include "SplineControlTest.moc"
