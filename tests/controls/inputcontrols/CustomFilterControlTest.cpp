#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"
#include "orbane/ScriptValParam.h"

#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

Q_DECLARE_METATYPE(Orbane::ScriptVal)

namespace {

constexpr Tag kLabel = 0x30040000;

ScriptVal Rows(const std::vector<std::vector<double>> &rows)
{
    ScriptVal t = ScriptVal::NewTable();
    for (const auto &row : rows) {
        ScriptVal r = ScriptVal::NewTable();
        for (double v : row)
            r.Append(v);
        t.Append(r);
    }
    return t;
}

// The rows of a value as "a b c / d e f / ...", each cell to 4 places.
QString RowsOf(const ScriptVal &v)
{
    QStringList rows;
    for (const auto &row : v.GetEntries()) {
        QStringList cells;
        for (const auto &cell : row.second.GetEntries())
            cells << QString::number(cell.second.GetNumber(), 'g', 4);
        rows << cells.join(' ');
    }
    return rows.join(" / ");
}

struct Filter
{
    explicit Filter(const ScriptVal &value)
    {
        input = f.AddTable("Kernel", value, TagList{{kLabel, "Kernel"}});
        control = f.Create(OrbID("CustomFilterControl"), {input});
    }
    template <class T = QWidget> T *Child(const char *name) const { return control->findChild<T *>(name); }

    ToolFixture f;
    Input *input = nullptr;
    InputControl *control = nullptr;
};

} // namespace

class CustomFilterControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void edits_data();
    void edits();
    void normaliseRefusesZeroSums_data();
    void normaliseRefusesZeroSums();
};

void CustomFilterControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

// Every edit writes the kernel's rows as one undo step.
void CustomFilterControlTest::edits_data()
{
    QTest::addColumn<QString>("gesture");
    QTest::addColumn<QString>("rows");
    QTest::newRow("typed cell") << "cell5=3"
                                << "1 2 1 / 2 3 2 / 1 2 1";
    QTest::newRow("normalise") << "normalise"
                               << "0.0625 0.125 0.0625 / 0.125 0.25 0.125 / 0.0625 0.125 0.0625";
    QTest::newRow("blur preset") << "blur"
                                 << "0.0625 0.125 0.0625 / 0.125 0.25 0.125 / 0.0625 0.125 0.0625";
    QTest::newRow("sharpen preset") << "sharpen"
                                    << "-0.0625 -0.125 -0.0625 / -0.125 1.75 -0.125 / -0.0625 -0.125 -0.0625";
    QTest::newRow("edge preset") << "edge"
                                 << "-1 -1 -1 / -1 8 -1 / -1 -1 -1";
    QTest::newRow("grown to 5x5 about the centre") << "size=1"
                                                   << "0 0 0 0 0 / 0 1 2 1 0 / 0 2 4 2 0 / 0 1 2 1 0 / 0 0 0 0 0";
}

void CustomFilterControlTest::edits()
{
    QFETCH(QString, gesture);
    QFETCH(QString, rows);
    Filter k(Rows({{1, 2, 1}, {2, 4, 2}, {1, 2, 1}}));
    if (gesture.startsWith("cell")) {
        auto *cell = k.Child<QLineEdit>(gesture.section('=', 0, 0).toUtf8().constData());
        cell->selectAll();
        QTest::keyClicks(cell, gesture.section('=', 1));
        QTest::keyClick(cell, Qt::Key_Return);
    } else if (gesture.startsWith("size")) {
        auto *size = k.Child<QComboBox>("size");
        size->setFocus();
        QTest::keyClick(size, Qt::Key_Down);
    } else {
        QTest::mouseClick(k.Child(gesture.toUtf8().constData()), Qt::LeftButton);
    }
    QCOMPARE(RowsOf(k.f.TableOf(k.input)), rows);
    QCOMPARE(k.f.doc.UndoNames(), QStringList{"Change Kernel"});
}

// Kernels that sum to 0 cannot be normalised: nothing is written and the
// message says why.
void CustomFilterControlTest::normaliseRefusesZeroSums_data()
{
    QTest::addColumn<ScriptVal>("kernel");
    QTest::addColumn<QString>("message");
    QTest::newRow("all zeros") << Rows({{0, 0, 0}, {0, 0, 0}, {0, 0, 0}}) << "Every cell is 0";
    QTest::newRow("edge") << Rows({{0, -1, 0}, {-1, 4, -1}, {0, -1, 0}}) << "sum to 0";
}

void CustomFilterControlTest::normaliseRefusesZeroSums()
{
    QFETCH(ScriptVal, kernel);
    QFETCH(QString, message);
    Filter k(kernel);
    const QString before = RowsOf(k.f.TableOf(k.input));
    QTest::mouseClick(k.Child("normalise"), Qt::LeftButton);
    QCOMPARE(RowsOf(k.f.TableOf(k.input)), before);
    QVERIFY(k.f.doc.UndoNames().isEmpty());
    QVERIFY2(k.Child<QLabel>("message")->text().contains(message), qPrintable(k.Child<QLabel>("message")->text()));
}

QTEST_MAIN(CustomFilterControlTest)
#include "CustomFilterControlTest.moc"
