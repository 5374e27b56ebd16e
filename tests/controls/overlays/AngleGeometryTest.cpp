#include "overlays/AngleGeometry.h"

#include <QtTest>

#include <cmath>
#include <limits>

using namespace Orbane;
using Geo = AngleGeometry;

namespace {

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInf = std::numeric_limits<double>::infinity();

bool Close(double a, double b)
{
    return std::fabs(a - b) <= 1e-9;
}

} // namespace

Q_DECLARE_METATYPE(OrbPoint)

class AngleGeometryTest : public QObject
{
    Q_OBJECT

private slots:
    void dragDirection_data();
    void dragDirection();
    void turn_data();
    void turn();
    void dragged_data();
    void dragged();
    void radius_data();
    void radius();
    void differs_data();
    void differs();
    void fade_data();
    void fade();
    void grab_data();
    void grab();
    void keyStep_data();
    void keyStep();
    void dial();
};

void AngleGeometryTest::dragDirection_data()
{
    QTest::addColumn<OrbPoint>("d");
    QTest::addColumn<double>("degrees");
    QTest::newRow("right: 0") << OrbPoint(1, 0) << 0.0;
    QTest::newRow("up: 90") << OrbPoint(0, 1) << 90.0;
    QTest::newRow("left: 180") << OrbPoint(-1, 0) << 180.0;
    QTest::newRow("down: 270") << OrbPoint(0, -1) << 270.0;
    QTest::newRow("down-right: 315, not -45") << OrbPoint(1, -1) << 315.0;
    QTest::newRow("within the vertical band: 270") << OrbPoint(0.0005, -0.001) << 270.0;
    QTest::newRow("just outside it: atan") << OrbPoint(0.0006, 0.0006) << 45.0;
    QTest::newRow("no direction: 90") << OrbPoint(0, 0) << 90.0;
}

void AngleGeometryTest::dragDirection()
{
    QFETCH(OrbPoint, d);
    QFETCH(double, degrees);
    QVERIFY2(Close(Geo::DragDirection(d), degrees), qPrintable(QString::number(Geo::DragDirection(d))));
}

void AngleGeometryTest::turn_data()
{
    QTest::addColumn<double>("target");
    QTest::addColumn<double>("current");
    QTest::addColumn<double>("turn");
    QTest::newRow("clockwise through 0") << 350.0 << 10.0 << -20.0;
    QTest::newRow("counter-clockwise through 0") << 10.0 << 350.0 << 20.0;
    QTest::newRow("after three turns") << 30.0 << 1080.0 << 30.0;
    QTest::newRow("negative angle") << 90.0 << -10.0 << 100.0;
    QTest::newRow("half a turn stays positive") << 180.0 << 0.0 << 180.0;
    QTest::newRow("three quarters go the short way") << 270.0 << 0.0 << -90.0;
    // fmod keeps the sign: below the designed range the turn is no longer the shortest.
    QTest::newRow("below -360000") << 350.0 << -1e6 << 270.0;
}

void AngleGeometryTest::turn()
{
    QFETCH(double, target);
    QFETCH(double, current);
    QFETCH(double, turn);
    QVERIFY2(Close(Geo::Turn(target, current), turn), qPrintable(QString::number(Geo::Turn(target, current))));
}

void AngleGeometryTest::dragged_data()
{
    QTest::addColumn<double>("angle");
    QTest::addColumn<double>("target");
    QTest::addColumn<double>("current");
    QTest::addColumn<double>("written"); // NaN: nothing
    QTest::newRow("a turn of 0.01 writes nothing") << 5.0 << 0.01 << 0.0 << kNaN;
    QTest::newRow("a turn of 0.011 writes") << 5.0 << 0.011 << 0.0 << 5.011;
    QTest::newRow("turns accumulate past 360") << 710.0 << 20.0 << 350.0 << 740.0;
    QTest::newRow("a huge angle a turn cannot change") << 1e20 << 90.0 << 0.0 << kNaN;
    QTest::newRow("no direction") << 5.0 << kNaN << 0.0 << kNaN;
    QTest::newRow("an infinite angle") << kInf << 90.0 << 0.0 << kNaN;
}

void AngleGeometryTest::dragged()
{
    QFETCH(double, angle);
    QFETCH(double, target);
    QFETCH(double, current);
    QFETCH(double, written);
    const std::optional<double> to = Geo::Dragged(angle, target, current);
    QCOMPARE(to.has_value(), !std::isnan(written));
    if (to)
        QVERIFY2(Close(*to, written), qPrintable(QString::number(*to, 'g', 17)));
}

void AngleGeometryTest::radius_data()
{
    QTest::addColumn<double>("minRadius");
    QTest::addColumn<double>("value");
    QTest::addColumn<double>("scale");
    QTest::addColumn<double>("radius");
    QTest::newRow("value times scale") << 0.0 << 0.2 << 0.5 << 0.1;
    QTest::newRow("never under MinRadius") << 0.2 << 0.02 << 0.5 << 0.2;
    QTest::newRow("NaN value: MinRadius") << 0.1 << kNaN << 1.0 << 0.1;
    QTest::newRow("NaN MinRadius: the value") << kNaN << 0.3 << 1.0 << 0.3;
}

void AngleGeometryTest::radius()
{
    QFETCH(double, minRadius);
    QFETCH(double, value);
    QFETCH(double, scale);
    QFETCH(double, radius);
    QCOMPARE(Geo::Radius(minRadius, value, scale), radius);
}

void AngleGeometryTest::differs_data()
{
    QTest::addColumn<double>("a");
    QTest::addColumn<double>("b");
    QTest::addColumn<bool>("differs");
    QTest::newRow("2e-6: differs") << 1.0 << 1.000002 << true;
    QTest::newRow("5e-7: same") << 1.0 << 1.0000005 << false;
    QTest::newRow("NaN and a number") << kNaN << 1.0 << true;
    QTest::newRow("NaN and NaN") << kNaN << kNaN << false;
    QTest::newRow("equal infinities") << kInf << kInf << false;
    QTest::newRow("infinity and a number") << kInf << 1.0 << true;
}

void AngleGeometryTest::differs()
{
    QFETCH(double, a);
    QFETCH(double, b);
    QFETCH(bool, differs);
    QCOMPARE(Geo::Differs(a, b, Geo::RadiusThreshold), differs);
}

void AngleGeometryTest::fade_data()
{
    QTest::addColumn<double>("distance");
    QTest::addColumn<float>("fade");
    QTest::newRow("on the ring") << 0.0 << 1.0f;
    QTest::newRow("10: still full") << 10.0 << 1.0f;
    QTest::newRow("35: three quarters") << 35.0 << 0.75f;
    QTest::newRow("60 and on: half") << 200.0 << 0.5f;
    QTest::newRow("no distance: half") << kNaN << 0.5f;
}

void AngleGeometryTest::fade()
{
    QFETCH(double, distance);
    QFETCH(float, fade);
    QCOMPARE(Geo::Fade(distance), fade);
}

void AngleGeometryTest::grab_data()
{
    QTest::addColumn<OrbPoint>("mouse"); // viewer units, the centre at 0, 0
    QTest::addColumn<OrbPoint>("offset");
    QTest::addColumn<double>("ringDistance");
    QTest::newRow("outside the ring") << OrbPoint(56, 0) << OrbPoint(-6, 0) << 6.0;
    QTest::newRow("on it, slanted") << OrbPoint(30, -40) << OrbPoint(0, 0) << 0.0;
    QTest::newRow("inside") << OrbPoint(0, 20) << OrbPoint(0, 30) << 30.0;
    QTest::newRow("at the centre: along X") << OrbPoint(0, 0) << OrbPoint(50, 0) << 50.0;
}

void AngleGeometryTest::grab()
{
    QFETCH(OrbPoint, mouse);
    QFETCH(OrbPoint, offset);
    QFETCH(double, ringDistance);
    const OrbPoint got = Geo::RingGrab(mouse, {}, 50.0);
    QVERIFY(Close(got.x, offset.x) && Close(got.y, offset.y));
    QVERIFY(Close(Geo::GrabDistance(1, mouse, {}, {1e9, 0}, 50.0), ringDistance));
    // Style 0 measures to the arm's end instead.
    QVERIFY(Close(Geo::GrabDistance(0, mouse, {}, mouse + OrbPoint(3, 4), 50.0), 5.0));
}

void AngleGeometryTest::keyStep_data()
{
    QTest::addColumn<int>("key");
    QTest::addColumn<int>("mods");
    QTest::addColumn<double>("step");
    QTest::newRow("left: +1") << int(Qt::Key_Left) << int(Qt::NoModifier) << 1.0;
    QTest::newRow("right: -1") << int(Qt::Key_Right) << int(Qt::NoModifier) << -1.0;
    QTest::newRow("shift: 10") << int(Qt::Key_Left) << int(Qt::ShiftModifier) << 10.0;
    QTest::newRow("control: a tenth") << int(Qt::Key_Right) << int(Qt::ControlModifier) << -0.1;
    QTest::newRow("both: 1") << int(Qt::Key_Right) << int(Qt::ShiftModifier | Qt::ControlModifier) << -1.0;
    QTest::newRow("up: none") << int(Qt::Key_Up) << int(Qt::ShiftModifier) << 0.0;
}

void AngleGeometryTest::keyStep()
{
    QFETCH(int, key);
    QFETCH(int, mods);
    QFETCH(double, step);
    QVERIFY(Close(Geo::KeyStep(key, Qt::KeyboardModifiers(mods)), step));
}

// The arm ends on the ring at the angle, also for huge angles; an angle
// that is no number draws no arm; style 0 draws nothing. The arm's end of
// style 0 keeps its length on screen for a 2:1 aspect.
void AngleGeometryTest::dial()
{
    const std::vector<OrbPoint> arm = Geo::DialLines(1, 90.0 + 360.0 * 1e6);
    QVERIFY(Close(arm[1].x, 0.0) && Close(arm[1].y, Geo::RingRadius));
    QCOMPARE(Geo::DialLines(1, kNaN).size(), arm.size() - 2);
    QVERIFY(Geo::DialLines(0, 90.0).empty());
    QCOMPARE(int(Geo::RingLoop().size()), Geo::RingPoints);
    const OrbPoint end = Geo::ArmEnd({0.5, 0.5}, 90.0, 0.1, 2.0);
    QVERIFY(Close(end.x, 0.5) && Close(end.y, 0.7));
    QCOMPARE(Geo::PressTolerance(2, 2.6), 10.0);
    QCOMPARE(Geo::HoverTolerance(2, 2.6), 10.4);
}

QTEST_MAIN(AngleGeometryTest)
#include "AngleGeometryTest.moc"
