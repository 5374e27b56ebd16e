#include "OverlayProbe.h"
#include "ViewerFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"

#include <QtTest>

#include <cmath>
#include <limits>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

constexpr Tag XOP_Center = 0x60058000;

// An Offset (the overlay's Input) drawn from a Center Point Input.
Input *AddOffset(ViewerFixture &f, OrbPoint offset, Input *&center)
{
    center = f.AddPoint("Center", 0.4, 0.5);
    const TagList attrs{{INPA_PreviewControl, OrbID("XYOffsetControl")},
                        {XOP_Center, static_cast<void *>(static_cast<ScriptObject *>(center))}};
    return f.AddPoint("Offset", offset.x, offset.y, attrs);
}

} // namespace

class XYOffsetControlTest : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase()
    {
        std::string why;
        QVERIFY2(ViewerFixture::LoadControls(&why), why.c_str());
    }

    void drag_data()
    {
        QTest::addColumn<double>("zoom");
        QTest::addColumn<double>("pixelAspect");
        QTest::addColumn<QPoint>("grab"); // where on the tip's disc, viewer pixels
        QTest::newRow("zoom 1, on the tip") << 1.0 << 1.0 << QPoint();
        QTest::newRow("zoom 2, 4 pixels off the tip") << 2.0 << 1.0 << QPoint(4, -3);
        QTest::newRow("zoom 0.5, wide pixels") << 0.5 << 2.0 << QPoint(-3, 0);
    }
    // The tip follows the mouse as far from it as it was grabbed: the offset
    // grows by the move in image units; one undo step puts it back.
    void drag()
    {
        QFETCH(double, zoom);
        QFETCH(double, pixelAspect);
        QFETCH(QPoint, grab);
        ViewerFixture f;
        Input *center = nullptr;
        Input *offset = AddOffset(f, {0.1, 0.05}, center);
        QVERIFY(f.Show());
        f.viewer.SetPixelAspect(pixelAspect);
        f.viewer.SetView(zoom);
        QApplication::processEvents();
        const QPoint from = f.At({0.5, 0.55}, grab);
        f.Drag(from, from + QPoint(30, 20), 4);
        const OrbPoint want(0.1 + 30 / (400 * zoom * pixelAspect), 0.05 - 20 / (200 * zoom));
        QVERIFY2(std::fabs(f.PointOf(offset).x - want.x) < 1e-9 && std::fabs(f.PointOf(offset).y - want.y) < 1e-9,
                 toString(f.PointOf(offset)));
        QCOMPARE(f.doc.UndoNames(), QStringList{"Move Offset"});
        QVERIFY(f.doc.Undo());
        QCOMPARE(f.PointOf(offset), OrbPoint(0.1, 0.05));
        QCOMPARE(f.PointOf(center), OrbPoint(0.4, 0.5));
    }

    // The arrow starts where the centre Input is now.
    void followsItsCentre()
    {
        ViewerFixture f;
        Input *center = nullptr;
        Input *offset = AddOffset(f, {0.1, 0.0}, center);
        QVERIFY(f.Show());
        center->SetValue(AutoPoint(0.2, 0.3).get(), f.doc.GetCurrentTime());
        QApplication::processEvents();
        f.Hover(f.At({0.3, 0.3}));
        QCOMPARE(StateOf(f.OverlayOf(offset), "hoverPart"), 1.0);
        QCOMPARE(StateOf(f.OverlayOf(offset), "centerY"), 0.3);
        f.Hover(f.At({0.5, 0.5}));
        QCOMPARE(StateOf(f.OverlayOf(offset), "hoverPart"), 0.0);
    }

    void nudges_data() { NudgeRows(); }
    void nudges() { CheckNudge(TagList{{INPA_PreviewControl, OrbID("XYOffsetControl")}}, 200); }

    // An offset that is no number draws nothing and takes no press.
    void notANumber()
    {
        ViewerFixture f;
        Input *center = nullptr;
        const double nan = std::numeric_limits<double>::quiet_NaN();
        Input *offset = AddOffset(f, {nan, 0.1}, center);
        QVERIFY(f.Show());
        f.Grab();
        for (int x = 30; x < ViewerFixture::kViewWidth; x += 40)
            f.Drag(QPoint(x, 150), QPoint(x + 20, 130), 2);
        QCOMPARE(f.UndoSteps(), 0);
        QVERIFY(std::isnan(f.PointOf(offset).x));
    }
};

QTEST_MAIN(XYOffsetControlTest)
#include "XYOffsetControlTest.moc"
