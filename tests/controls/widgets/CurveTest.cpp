#include "widgets/Curve.h"

#include <QtTest>

#include <cmath>
#include <limits>

using namespace Orbane;

Q_DECLARE_METATYPE(Orbane::Curve)

namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
// Printed values of the tables are given to this many places.
constexpr double kTolerance = 1e-9;

} // namespace

class CurveTest : public QObject
{
    Q_OBJECT
private slots:
    void evaluate_data();
    void evaluate();
    void smoothNeverOvershoots();
    void editing_data();
    void editing();
};

void CurveTest::evaluate_data()
{
    QTest::addColumn<Curve>("curve");
    QTest::addColumn<double>("x");
    QTest::addColumn<double>("y");
    const Curve bend({{0, 0}, {0.5, 0.8}, {1, 1}});
    const Curve straight({{0, 0}, {0.5, 0.8}, {1, 1}}, true);
    QTest::newRow("no point: identity") << Curve() << 0.3 << 0.3;
    QTest::newRow("one point: flat") << Curve({{0.4, 0.7}}) << 0.9 << 0.7;
    QTest::newRow("on a point") << bend << 0.5 << 0.8;
    QTest::newRow("straight between points") << straight << 0.25 << 0.4;
    QTest::newRow("straight, second segment") << straight << 0.75 << 0.9;
    // Fritsch-Carlson: tangents 1.6 at 0 and 0.64 at 0.5 (the harmonic mean of the secants 1.6 and 0.4).
    QTest::newRow("smooth between points") << bend << 0.25 << 0.46;
    QTest::newRow("flat below the first point") << Curve({{0.2, 0.3}, {1, 1}}) << -5.0 << 0.3;
    QTest::newRow("flat above the last point") << Curve({{0, 0}, {0.8, 0.6}}) << 7.0 << 0.6;
    QTest::newRow("out of order points sorted") << Curve({{1, 1}, {0, 0}, {0.5, 0.8}}, true) << 0.25 << 0.4;
    QTest::newRow("coincident points merge at their mean")
        << Curve({{0, 0}, {0.5, 0.2}, {0.5, 0.6}, {1, 1}}, true) << 0.5 << 0.4;
    QTest::newRow("points that are not numbers left out")
        << Curve({{0, 0}, {kNaN, 0.5}, {0.5, kNaN}, {1, 1}}, true) << 0.5 << 0.5;
    QTest::newRow("NaN input gives the first value") << Curve({{0, 0.1}, {1, 1}}) << kNaN << 0.1;
}

void CurveTest::evaluate()
{
    QFETCH(Curve, curve);
    QFETCH(double, x);
    QFETCH(double, y);
    QVERIFY2(std::abs(curve.Evaluate(x) - y) < kTolerance, qPrintable(QString::number(curve.Evaluate(x), 'g', 17)));
}

// A rising curve with a sharp knee stays between its neighbours' values.
void CurveTest::smoothNeverOvershoots()
{
    const Curve knee({{0, 0}, {0.1, 0.9}, {0.2, 1.0}, {1, 1}});
    for (int i = 0; i <= 1000; ++i) {
        const double y = knee.Evaluate(i / 1000.0);
        QVERIFY2(y >= 0.0 && y <= 1.0, qPrintable(QString("x %1 gives %2").arg(i / 1000.0).arg(y)));
    }
}

void CurveTest::editing_data()
{
    QTest::addColumn<QString>("edit");
    QTest::addColumn<int>("index");
    QTest::addColumn<double>("x");
    QTest::addColumn<double>("y");
    QTest::addColumn<QString>("points");
    QTest::newRow("move inside") << "move" << 1 << 0.4 << 0.3 << "0,0 0.4,0.3 1,1";
    QTest::newRow("move stops before the next point") << "move" << 1 << 2.0 << 0.5 << "0,0 0.9999,0.5 1,1";
    QTest::newRow("move stops after the previous point") << "move" << 1 << -1.0 << 0.5 << "0,0 0.0001,0.5 1,1";
    QTest::newRow("move out of range refused") << "move" << 7 << 0.5 << 0.5 << "0,0 0.5,0.5 1,1";
    QTest::newRow("insert in order") << "insert" << 1 << 0.25 << 0.1 << "0,0 0.25,0.1 0.5,0.5 1,1";
    QTest::newRow("insert on a point replaces it") << "insert" << 1 << 0.5 << 0.9 << "0,0 0.5,0.9 1,1";
    QTest::newRow("remove") << "remove" << 1 << 0.0 << 0.0 << "0,0 1,1";
}

void CurveTest::editing()
{
    QFETCH(QString, edit);
    QFETCH(int, index);
    QFETCH(double, x);
    QFETCH(double, y);
    QFETCH(QString, points);
    Curve curve({{0, 0}, {0.5, 0.5}, {1, 1}});
    if (edit == "move")
        curve.Move(index, {x, y});
    else if (edit == "insert")
        QCOMPARE(curve.Insert({x, y}), index);
    else
        curve.Remove(index);
    QStringList got;
    for (const CurvePoint &p : curve.Points())
        got << QString("%1,%2").arg(p.x).arg(p.y);
    QCOMPARE(got.join(' '), points);
}

QTEST_APPLESS_MAIN(CurveTest)
#include "CurveTest.moc"
