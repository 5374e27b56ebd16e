#include "GraphDrag.h"
#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"
#include "orbane/TimeCodeEdit.h"

#include <QtTest>

#include <cmath>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

constexpr Tag kLabel = 0x30040000;

void Type(TimeCodeEdit *edit, const QString &text)
{
    edit->selectAll();
    QTest::keyClicks(edit, text);
    QTest::keyClick(edit, Qt::Key_Return);
}

double Key(const ScriptVal &table, const char *key)
{
    const ScriptVal *v = table.FindKeyConst(ScriptVal(key));
    return v ? v->GetNumber(-1) : -1;
}

} // namespace

class GammaLogControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void gamma_data();
    void gamma();
    void log_data();
    void log();
};

void GammaLogControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

void GammaLogControlTest::gamma_data()
{
    QTest::addColumn<QString>("gesture");
    QTest::addColumn<QString>("typed");
    QTest::addColumn<double>("gamma");
    QTest::newRow("typed") << "type"
                           << "2.2" << 2.2;
    QTest::newRow("typed above the top") << "type"
                                         << "40" << 10.0;
    QTest::newRow("typed zero") << "type"
                                << "0" << 0.01;
    // The handle over 0.5 dragged up to 0.5^(1/2) = 0.7071: gamma 2.
    QTest::newRow("handle dragged up") << "drag"
                                       << "" << 2.0;
}

void GammaLogControlTest::gamma()
{
    QFETCH(QString, gesture);
    QFETCH(QString, typed);
    QFETCH(double, gamma);
    ToolFixture f;
    Input *in = f.AddNumber("Gamma", 1.0, TagList{{kLabel, "Gamma"}});
    InputControl *control = f.Create(OrbID("GammaControl"), {in});
    if (gesture == "type") {
        Type(control->findChild<TimeCodeEdit *>("edit"), typed);
    } else {
        QWidget *graph = control->findChild<QWidget *>("graph");
        DragWith(graph, GraphPixel(graph, 0.5, 0.5), GraphPixel(graph, 0.5, std::sqrt(0.5)));
    }
    QVERIFY2(std::abs(f.NumberOf(in) - gamma) < 0.03, qPrintable(QString::number(f.NumberOf(in))));
    QCOMPARE(f.doc.UndoNames(), QStringList{"Change Gamma"});
}

// Each typed setting is one step; black stays below white.
void GammaLogControlTest::log_data()
{
    QTest::addColumn<QString>("box");
    QTest::addColumn<QString>("typed");
    QTest::addColumn<QString>("key");
    QTest::addColumn<double>("value");
    QTest::newRow("white") << "white"
                           << "600"
                           << "white" << 600.0;
    QTest::newRow("black above white") << "black"
                                       << "900"
                                       << "black" << 684.0;
    QTest::newRow("film gamma") << "gamma"
                                << "0.45"
                                << "filmGamma" << 0.45;
    QTest::newRow("soft clip kept within 1") << "softclip"
                                             << "3"
                                             << "softClip" << 1.0;
}

void GammaLogControlTest::log()
{
    QFETCH(QString, box);
    QFETCH(QString, typed);
    QFETCH(QString, key);
    QFETCH(double, value);
    ToolFixture f;
    ScriptVal table = ScriptVal::NewTable();
    table.SetKey(ScriptVal("white"), ScriptVal(685.0));
    Input *in = f.AddTable("Log", table, TagList{{kLabel, "Log"}});
    InputControl *control = f.Create(OrbID("LogControl"), {in});
    Type(control->findChild<TimeCodeEdit *>(box), typed);
    const ScriptVal now = f.TableOf(in);
    QCOMPARE(Key(now, key.toUtf8().constData()), value);
    QCOMPARE(f.doc.UndoNames(), QStringList{"Change Log"});
    QVERIFY(f.doc.Undo());
    QCOMPARE(Key(f.TableOf(in), "white"), 685.0);
}

QTEST_MAIN(GammaLogControlTest)
#include "GammaLogControlTest.moc"
