#include "ToolFixture.h"

#include "widgets/GradientBar.h"
#include "widgets/GradientStops.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"

#include <QComboBox>
#include <QLineEdit>
#include <QtTest>

#include <cmath>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

constexpr Tag kLabel = 0x30040000;
const OrbID kGradient("GradientControl");

ScriptVal Table(const QVector<QVector<double>> &stops, const char *interp = "linear")
{
    ScriptVal list = ScriptVal::NewTable();
    for (const auto &s : stops) {
        ScriptVal row = ScriptVal::NewTable();
        for (double v : s)
            row.Append(ScriptVal(v));
        list.Append(row);
    }
    ScriptVal t = ScriptVal::NewTable();
    t.SetKey(ScriptVal("interpolation"), ScriptVal(interp));
    t.SetKey(ScriptVal("stops"), list);
    return t;
}

// Black at 0, red at 0.5, white at 1.
struct Ramp
{
    explicit Ramp(const ScriptVal &value = Table({{0, 0, 0, 0, 1}, {0.5, 1, 0, 0, 1}, {1, 1, 1, 1, 1}}))
    {
        input = f.tool->AddInput(OrbID("Ramp"), "Ramp", CLSID_DataType_ScriptVal, TagList{{kLabel, "Ramp"}},
                                 AutoScriptValParam(value));
        control = f.Create(kGradient, {input});
        bar = control->findChild<GradientBar *>("bar");
    }
    GradientStops Value() const
    {
        const AutoParameter now(input->GetValue(f.doc.GetCurrentTime()));
        GradientStops g;
        std::string why;
        const auto *t = dynamic_cast<const ScriptValParam *>(now.get());
        return t && GradientStops::FromScript(t->Value, g, &why) ? g : GradientStops();
    }
    QVector<double> Positions() const
    {
        QVector<double> p;
        for (const auto &s : Value().stops)
            p << s.pos;
        return p;
    }
    QPoint At(double pos, int dy = 0) const
    {
        return QPoint(int(GradientBar::PosToX(pos, bar->width()) + 0.5), bar->height() - 4 + dy);
    }

    ToolFixture f;
    Input *input = nullptr;
    InputControl *control = nullptr;
    GradientBar *bar = nullptr;
};

void Gesture(QWidget *w, QPoint from, QPoint to)
{
    QTest::mousePress(w, Qt::LeftButton, Qt::NoModifier, from);
    for (int i = 1; i <= 4; ++i) {
        const QPoint at = from + (to - from) * i / 4;
        QMouseEvent move(QEvent::MouseMove, at, w->mapToGlobal(at), Qt::NoButton, Qt::LeftButton, Qt::NoModifier);
        QApplication::sendEvent(w, &move);
    }
    QTest::mouseRelease(w, Qt::LeftButton, Qt::NoModifier, to);
}

} // namespace

class GradientControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void stopEdits_data();
    void stopEdits();
    void evaluation_data();
    void evaluation();
    void typedAndChosen();
    void notAGradient();
};

void GradientControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

// Gestures on the bar: positions given as 0..1, dy in pixels below the markers.
void GradientControlTest::stopEdits_data()
{
    QTest::addColumn<double>("from");
    QTest::addColumn<double>("to");
    QTest::addColumn<int>("dy");
    QTest::addColumn<QVector<double>>("positions");
    QTest::addColumn<int>("steps");
    QTest::newRow("click adds") << 0.25 << 0.25 << 0 << QVector<double>{0, 0.25, 0.5, 1} << 1;
    QTest::newRow("drag moves") << 0.5 << 0.7 << 0 << QVector<double>{0, 0.7, 1} << 1;
    QTest::newRow("drag past another reorders") << 0.0 << 0.8 << 0 << QVector<double>{0.5, 0.8, 1} << 1;
    QTest::newRow("drag off deletes") << 0.5 << 0.6 << 40 << QVector<double>{0, 1} << 1;
    QTest::newRow("back on the bar keeps it") << 0.5 << 0.6 << 5 << QVector<double>{0, 0.6, 1} << 1;
    QTest::newRow("click on a marker changes nothing") << 1.0 << 1.0 << 0 << QVector<double>{0, 0.5, 1} << 0;
}

void GradientControlTest::stopEdits()
{
    QFETCH(double, from);
    QFETCH(double, to);
    QFETCH(int, dy);
    QFETCH(QVector<double>, positions);
    QFETCH(int, steps);
    Ramp r;
    Gesture(r.bar, r.At(from), r.At(to, dy));
    const QVector<double> got = r.Positions();
    QCOMPARE(got.size(), positions.size());
    for (int i = 0; i < got.size(); ++i)
        QVERIFY2(std::fabs(got[i] - positions[i]) < 0.01, qPrintable(QString::number(got[i])));
    QCOMPARE(r.f.doc.UndoNames().size(), steps);
    if (steps) {
        QVERIFY(r.f.doc.Undo());
        QCOMPARE(r.Positions(), (QVector<double>{0, 0.5, 1}));
        QCOMPARE(r.bar->Stops().stops.size(), size_t(3));
    }
}

void GradientControlTest::evaluation_data()
{
    QTest::addColumn<QVector<QVector<double>>>("stops");
    QTest::addColumn<QString>("interp");
    QTest::addColumn<double>("at");
    QTest::addColumn<double>("red");
    using S = QVector<QVector<double>>;
    QTest::newRow("linear") << S{{0, 0, 0, 0, 1}, {1, 1, 1, 1, 1}} << "linear" << 0.25 << 0.25;
    QTest::newRow("smooth") << S{{0, 0, 0, 0, 1}, {1, 1, 1, 1, 1}} << "smooth" << 0.25 << 0.15625;
    QTest::newRow("out of order is sorted") << S{{1, 1, 1, 1, 1}, {0, 0, 0, 0, 1}} << "linear" << 0.75 << 0.75;
    QTest::newRow("coincident stops: a hard edge")
        << S{{0, 0, 0, 0, 1}, {0.5, 0, 0, 0, 1}, {0.5, 1, 1, 1, 1}, {1, 1, 1, 1, 1}} << "linear" << 0.5 << 1.0;
    QTest::newRow("before the first stop") << S{{0.2, 0.3, 0, 0, 1}, {1, 1, 1, 1, 1}} << "linear" << 0.0 << 0.3;
    QTest::newRow("HDR kept") << S{{0, 0, 0, 0, 1}, {1, 8, 0, 0, 1}} << "linear" << 0.5 << 4.0;
}

void GradientControlTest::evaluation()
{
    QFETCH(QVector<QVector<double>>, stops);
    QFETCH(QString, interp);
    QFETCH(double, at);
    QFETCH(double, red);
    GradientStops g;
    std::string why;
    QVERIFY(GradientStops::FromScript(Table(stops, interp.toUtf8().constData()), g, &why));
    QCOMPARE(g.Evaluate(at).r, red);
}

// The selected stop's colour typed as hex, the interpolation chosen: a step each.
void GradientControlTest::typedAndChosen()
{
    Ramp r;
    QTest::mouseClick(r.bar, Qt::LeftButton, Qt::NoModifier, r.At(1.0));
    auto *hex = r.control->findChild<QLineEdit *>("hex");
    QCOMPARE(hex->text(), QString("#FFFFFFFF"));
    hex->selectAll();
    QTest::keyClicks(hex, "#00FF00");
    QTest::keyClick(hex, Qt::Key_Return);
    QCOMPARE(r.Value().stops[2].color.g, 1.0);
    QCOMPARE(r.Value().stops[2].color.r, 0.0);
    auto *interp = r.control->findChild<QComboBox *>("interp");
    interp->setFocus();
    QTest::keyClick(interp, Qt::Key_Down);
    QVERIFY(r.Value().smooth);
    QCOMPARE(r.f.doc.UndoNames().size(), 2);
}

// A value that is no gradient shows the default and says why; an edit
// replaces it with a real one.
void GradientControlTest::notAGradient()
{
    ScriptVal junk = ScriptVal::NewTable();
    junk.SetKey(ScriptVal("stops"), ScriptVal("none"));
    Ramp r(junk);
    QVERIFY(r.bar->toolTip().contains("Not a gradient"));
    QCOMPARE(r.bar->Stops(), GradientStops::Default());
    QTest::mouseClick(r.bar, Qt::LeftButton, Qt::NoModifier, r.At(0.5));
    QCOMPARE(r.Positions(), (QVector<double>{0, 0.5, 1}));
    QVERIFY(r.bar->toolTip().isEmpty());
}

QTEST_MAIN(GradientControlTest)
#include "GradientControlTest.moc"
