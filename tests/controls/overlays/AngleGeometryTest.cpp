#include "overlays/AngleGeometry.h"

#include <QtTest>

#include <cmath>
#include <limits>

using namespace Orbane;
using Geo = AngleGeometry;

namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInf = std::numeric_limits<double>::infinity();

} // namespace

Q_DECLARE_METATYPE(OrbPoint)

// The mappings the viewer cannot reach with whole pixels: the edges of the
// vertical band, the turn below the designed range, the 0.01 degree step,
// numbers that are not numbers.
class AngleGeometryTest : public QObject
{
    Q_OBJECT

private slots:
    void dragDirection_data()
    {
        QTest::addColumn<OrbPoint>("d");
        QTest::addColumn<double>("degrees");
        QTest::newRow("left: 180") << OrbPoint(-1, 0) << 180.0;
        QTest::newRow("down-right: 315, not -45") << OrbPoint(1, -1) << 315.0;
        QTest::newRow("within the vertical band: 270") << OrbPoint(0.0005, -0.001) << 270.0;
        QTest::newRow("just outside it: atan") << OrbPoint(0.0006, 0.0006) << 45.0;
        QTest::newRow("no direction: 90") << OrbPoint(0, 0) << 90.0;
    }
    void dragDirection()
    {
        QFETCH(OrbPoint, d);
        QFETCH(double, degrees);
        QCOMPARE(Geo::DragDirection(d), degrees);
    }

    void turn_data()
    {
        QTest::addColumn<double>("angle");
        QTest::addColumn<double>("target");
        QTest::addColumn<double>("current"); // the grabbed direction
        QTest::addColumn<double>("written"); // NaN: nothing
        QTest::newRow("clockwise through 0") << 10.0 << 350.0 << 10.0 << -10.0;
        QTest::newRow("half a turn goes forward") << 0.0 << 180.0 << 0.0 << 180.0;
        QTest::newRow("three quarters go back") << 0.0 << 270.0 << 0.0 << -90.0;
        QTest::newRow("turns accumulate") << 710.0 << 20.0 << 350.0 << 740.0;
        QTest::newRow("from a negative angle") << -10.0 << 90.0 << -10.0 << 90.0;
        // fmod keeps the sign: below -360000 the turn is no longer the shortest.
        QTest::newRow("below the designed range") << -1e6 << 350.0 << -1e6 << -1e6 + 270.0;
        QTest::newRow("a turn of 0.01: nothing") << 5.0 << 0.01 << 0.0 << kNaN;
        QTest::newRow("a turn of 0.011 is written") << 5.0 << 0.011 << 0.0 << 5.011;
        QTest::newRow("a huge angle a turn cannot change") << 1e20 << 90.0 << 0.0 << kNaN;
        QTest::newRow("no direction") << 5.0 << kNaN << 0.0 << kNaN;
        QTest::newRow("an infinite angle") << kInf << 90.0 << 0.0 << kNaN;
    }
    void turn()
    {
        QFETCH(double, angle);
        QFETCH(double, target);
        QFETCH(double, current);
        QFETCH(double, written);
        const std::optional<double> to = Geo::Dragged(angle, target, current);
        QCOMPARE(to.has_value(), !std::isnan(written));
        if (to)
            QVERIFY2(std::fabs(*to - written) < 1e-9, qPrintable(QString::number(*to, 'g', 17)));
    }

    void radius_data()
    {
        QTest::addColumn<double>("minRadius");
        QTest::addColumn<double>("value");
        QTest::addColumn<double>("radius");
        QTest::newRow("never under MinRadius") << 0.2 << 0.02 << 0.2;
        QTest::newRow("NaN value: MinRadius") << 0.1 << kNaN << 0.1;
        QTest::newRow("NaN MinRadius: the value") << kNaN << 0.3 << 0.3;
    }
    void radius()
    {
        QFETCH(double, minRadius);
        QFETCH(double, value);
        QFETCH(double, radius);
        QCOMPARE(Geo::Radius(minRadius, value, 1.0), radius);
    }

    void differs_data()
    {
        QTest::addColumn<double>("a");
        QTest::addColumn<double>("b");
        QTest::addColumn<bool>("differs");
        QTest::newRow("2e-6: differs") << 1.0 << 1.000002 << true;
        QTest::newRow("5e-7: same") << 1.0 << 1.0000005 << false;
        QTest::newRow("NaN and a number") << kNaN << 1.0 << true;
        QTest::newRow("NaN and NaN") << kNaN << kNaN << false;
        QTest::newRow("equal infinities") << kInf << kInf << false;
    }
    void differs()
    {
        QFETCH(double, a);
        QFETCH(double, b);
        QFETCH(bool, differs);
        QCOMPARE(Geo::Differs(a, b, Geo::RadiusThreshold), differs);
    }

    // The arm ends on the ring at the angle, also for huge angles; an angle
    // that is no number draws no arm; style 0 draws nothing. The arm's end
    // of style 0 keeps its length on screen for a 2:1 aspect.
    void shapes()
    {
        const std::vector<OrbPoint> lines = Geo::DialLines(1, 90.0 + 360.0 * 1e6);
        QVERIFY(std::fabs(lines[1].x) < 1e-9 && lines[1].y == Geo::RingRadius);
        QCOMPARE(Geo::DialLines(1, kNaN).size(), lines.size() - 2);
        QVERIFY(Geo::DialLines(0, 90.0).empty());
        const OrbPoint end = Geo::ArmEnd({0.5, 0.5}, 90.0, 0.1, 2.0);
        QVERIFY(std::fabs(end.x - 0.5) < 1e-12 && std::fabs(end.y - 0.7) < 1e-12);
        QCOMPARE(Geo::RingGrab({0, 0}, {0, 0}, 50.0), OrbPoint(50, 0)); // at the centre: along X
        QCOMPARE(Geo::PressTolerance(2, 2.6), 10.0); // whole pixels for a press
        QCOMPARE(Geo::HoverTolerance(2, 2.6), 10.4);
    }
};

QTEST_MAIN(AngleGeometryTest)
#include "AngleGeometryTest.moc"
