#include "overlays/RectangleGeometry.h"

#include <QtTest>

#include <cmath>
#include <limits>

using namespace Orbane;

Q_DECLARE_METATYPE(Orbane::OrbPoint)

// The rectangle's pure geometry: frames, grab offsets, resizing. Which part
// of its outline the mouse is over is the handles' outline shape.
class RectangleGeometryTest : public QObject
{
    Q_OBJECT

private slots:
    void frame_data();
    void frame();
    void resizedSide_data();
    void resizedSide();
    void grabOffset_data();
    void grabOffset();
    void lockedSizeAndTolerance();
};

// A 400 x 200 image; frame units are image pixels high.
void RectangleGeometryTest::frame_data()
{
    QTest::addColumn<double>("angle");
    QTest::addColumn<double>("pixelAspect");
    QTest::addColumn<bool>("flipX");
    QTest::addColumn<OrbPoint>("image");
    QTest::addColumn<OrbPoint>("frame");
    QTest::newRow("upright") << 0.0 << 1.0 << false << OrbPoint(0.6, 0.5) << OrbPoint(40, 0);
    QTest::newRow("turned 90: up is +X") << 90.0 << 1.0 << false << OrbPoint(0.5, 0.75) << OrbPoint(50, 0);
    QTest::newRow("turned 90: left is +Y") << 90.0 << 1.0 << false << OrbPoint(0.4, 0.5) << OrbPoint(0, 40);
    QTest::newRow("wide pixels count twice across") << 0.0 << 2.0 << false << OrbPoint(0.6, 0.6) << OrbPoint(80, 20);
    QTest::newRow("flipped X mirrors about the pivot") << 0.0 << 1.0 << true << OrbPoint(0.6, 0.6) << OrbPoint(-40, 20);
}

void RectangleGeometryTest::frame()
{
    QFETCH(double, angle);
    QFETCH(double, pixelAspect);
    QFETCH(bool, flipX);
    QFETCH(OrbPoint, image);
    QFETCH(OrbPoint, frame);
    RectangleShape s;
    s.angle = angle;
    s.flipX = flipX;
    s.width = 0.5;
    s.height = 0.25;
    const RectangleFrame f(s, 400, 200, pixelAspect);
    const OrbPoint got = f.ToFrame(image);
    QVERIFY2(std::fabs(got.x - frame.x) < 1e-9 && std::fabs(got.y - frame.y) < 1e-9,
             qPrintable(QString("(%1, %2)").arg(got.x).arg(got.y)));
    const OrbPoint back = f.ToImage(got);
    QVERIFY(std::fabs(back.x - image.x) < 1e-12 && std::fabs(back.y - image.y) < 1e-12);
    // Width and height are image widths as displayed: equal on screen.
    QCOMPARE(f.Half(), OrbPoint(100 * pixelAspect, 50 * pixelAspect));
    QVERIFY(f.IsValid());
}

void RectangleGeometryTest::resizedSide_data()
{
    QTest::addColumn<double>("pivotLocal"); // frame units from the pivot
    QTest::addColumn<double>("middleLocal");
    QTest::addColumn<double>("axis");
    QTest::addColumn<int>("side");
    QTest::addColumn<bool>("resized");
    QTest::addColumn<double>("length"); // image widths, unit 400
    QTest::newRow("pivot in the middle") << 140.0 << 40.0 << 0.5 << 1 << true << 0.7;
    QTest::newRow("pivot at the far side") << 240.0 << 40.0 << 0.0 << 1 << true << 0.6;
    QTest::newRow("pivot on the dragged side") << 0.0 << -100.0 << 0.0 << -1 << false << 0.0;
    QTest::newRow("pivot at +X, dragging -X") << -120.0 << -20.0 << 1.0 << -1 << true << 0.3;
    QTest::newRow("pivot outside: the near side") << -160.0 << 140.0 << 2.0 << 1 << true << 0.4;
    QTest::newRow("pivot outside: the far side") << -440.0 << -140.0 << 2.0 << -1 << true << 0.55;
    QTest::newRow("pivot outside: the mouse's side wins") << -440.0 << -140.0 << 2.0 << 1 << true << 0.55;
    QTest::newRow("axis not dragged") << 100.0 << 0.0 << 0.5 << 0 << false << 0.0;
    QTest::newRow("no number") << std::nan("") << 0.0 << 0.5 << 1 << false << 0.0;
    QTest::newRow("pivot at infinity") << 100.0 << 0.0 << std::numeric_limits<double>::infinity() << 1 << false << 0.0;
}

void RectangleGeometryTest::resizedSide()
{
    QFETCH(double, pivotLocal);
    QFETCH(double, middleLocal);
    QFETCH(double, axis);
    QFETCH(int, side);
    QFETCH(bool, resized);
    QFETCH(double, length);
    double got = -1.0;
    QCOMPARE(RectangleResizedSide(pivotLocal, middleLocal, axis, side, 400.0, got), resized);
    if (resized)
        QVERIFY2(std::fabs(got - length) < 1e-12, qPrintable(QString::number(got)));
}

void RectangleGeometryTest::grabOffset_data()
{
    QTest::addColumn<OrbPoint>("local");
    QTest::addColumn<int>("part");
    QTest::addColumn<double>("round");
    QTest::addColumn<OrbPoint>("offset");
    QTest::newRow("+X edge, 2 inside") << OrbPoint(98, 10) << 1 << 0.0 << OrbPoint(2, 0);
    QTest::newRow("-Y edge, 3 outside") << OrbPoint(5, -53) << 8 << 0.0 << OrbPoint(0, 3);
    QTest::newRow("corner") << OrbPoint(101, 52) << 3 << 0.0 << OrbPoint(-1, -2);
    // r = 20: the corner is grabbed on its arc, (1 - sqrt(2)/2) r in.
    QTest::newRow("rounded corner") << OrbPoint(100, 50) << 3 << 0.4 << OrbPoint(-5.857864376269, -5.857864376269);
    QTest::newRow("no part") << OrbPoint(7, 7) << 0 << 0.0 << OrbPoint(0, 0);
}

void RectangleGeometryTest::grabOffset()
{
    QFETCH(OrbPoint, local);
    QFETCH(int, part);
    QFETCH(double, round);
    QFETCH(OrbPoint, offset);
    const OrbPoint got = RectangleGrabOffset(local, part, {100, 50}, round);
    QVERIFY2(std::fabs(got.x - offset.x) < 1e-9 && std::fabs(got.y - offset.y) < 1e-9,
             qPrintable(QString("(%1, %2)").arg(got.x).arg(got.y)));
}

void RectangleGeometryTest::lockedSizeAndTolerance()
{
    QCOMPARE(RectangleLockedSize(0.4, 0.1, 2.0), OrbPoint(0.4, 0.2));
    QCOMPARE(RectangleLockedSize(0.0, 0.3, 2.0), OrbPoint(0.6, 0.3));
    QCOMPARE(RectangleTolerance(6, {2, 0.5}), OrbPoint(3, 12));
    QCOMPARE(RectangleTolerance(6, {0, 1}), OrbPoint(6, 6));
    RectangleShape s;
    s.width = std::nan("");
    QVERIFY(!RectangleFrame(s, 400, 200, 1.0).IsValid());
}

QTEST_APPLESS_MAIN(RectangleGeometryTest)
#include "RectangleGeometryTest.moc"
