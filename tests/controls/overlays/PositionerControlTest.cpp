#include "OverlayProbe.h"
#include "ViewerFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"

#include <QtTest>

#include <cmath>
#include <limits>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

constexpr Tag PS_ShowBox = 0x10058000, PS_SnapToPixels = 0x10058001, PS_Axis = 0x10058002;
constexpr Tag PSD_Width = 0x20058000, PSD_Height = 0x20058001, PSD_AnchorX = 0x20058002, PSD_AnchorY = 0x20058003,
              PSD_Angle = 0x20058004;
constexpr Tag PSP_Width = 0x60058000, PSID_Size = 0x80058003;

Input *AddPositioner(ViewerFixture &f, const TagList &more = TagList())
{
    TagList attrs{{INPA_PreviewControl, OrbID("PositionerControl")}};
    attrs.Append(more);
    return f.AddPoint("Position", 0.5, 0.5, attrs);
}

bool Close(OrbPoint a, OrbPoint b)
{
    return std::fabs(a.x - b.x) < 1e-9 && std::fabs(a.y - b.y) < 1e-9;
}

} // namespace

class PositionerControlTest : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase()
    {
        std::string why;
        QVERIFY2(ViewerFixture::LoadControls(&why), why.c_str());
    }

    void drag_data();
    void drag();
    void box_data();
    void box();
    void nudges_data() { NudgeRows(); }
    void nudges() { CheckNudge(TagList{{INPA_PreviewControl, OrbID("PositionerControl")}}, 200); }
    void notANumber();
};

void PositionerControlTest::drag_data()
{
    QTest::addColumn<double>("zoom");
    QTest::addColumn<double>("pixelAspect");
    QTest::addColumn<QPoint>("grab"); // viewer pixels from the position, Y up
    QTest::addColumn<int>("axis");
    QTest::addColumn<bool>("snap");
    QTest::addColumn<QPoint>("move"); // viewer pixels, Y up
    QTest::addColumn<OrbPoint>("want");
    // The box is 0.25 image widths square: 100 viewer pixels at zoom 1.
    QTest::newRow("centre") << 1.0 << 1.0 << QPoint() << 0 << false << QPoint(30, 20) << OrbPoint(0.575, 0.6);
    QTest::newRow("inside the box") << 1.0 << 1.0 << QPoint(40, -40) << 0 << false << QPoint(30, 20)
                                    << OrbPoint(0.575, 0.6);
    QTest::newRow("zoom 2, wide pixels") << 2.0 << 2.0 << QPoint(-40, 40) << 0 << false << QPoint(32, 20)
                                         << OrbPoint(0.52, 0.55);
    QTest::newRow("along X only") << 1.0 << 1.0 << QPoint() << 1 << false << QPoint(30, 20) << OrbPoint(0.575, 0.5);
    QTest::newRow("along Y only") << 1.0 << 1.0 << QPoint() << 2 << false << QPoint(30, 20) << OrbPoint(0.5, 0.6);
    QTest::newRow("snapped to whole pixels")
        << 0.6 << 1.0 << QPoint() << 0 << true << QPoint(31, 11) << OrbPoint(0.63, 0.59);
}

void PositionerControlTest::drag()
{
    QFETCH(double, zoom);
    QFETCH(double, pixelAspect);
    QFETCH(QPoint, grab);
    QFETCH(int, axis);
    QFETCH(bool, snap);
    QFETCH(QPoint, move);
    QFETCH(OrbPoint, want);
    ViewerFixture f;
    Input *p = AddPositioner(f, TagList{{PS_Axis, axis}, {PS_SnapToPixels, snap}});
    QVERIFY(f.Show());
    f.viewer.SetPixelAspect(pixelAspect);
    f.viewer.SetView(zoom);
    QApplication::processEvents();
    const QPoint from = f.At({0.5, 0.5}, grab);
    f.Drag(from, from + QPoint(move.x(), -move.y()), 4);
    QVERIFY2(Close(f.PointOf(p), want), toString(f.PointOf(p)));
    QCOMPARE(f.doc.UndoNames(), QStringList{"Move Layer"});
    QVERIFY(f.doc.Undo());
    QCOMPARE(f.PointOf(p), OrbPoint(0.5, 0.5));
}

void PositionerControlTest::box_data()
{
    QTest::addColumn<bool>("linkWidth"); // width 1 from a linked Input, not 0.5 from the tag
    QTest::addColumn<double>("angle");
    QTest::addColumn<OrbPoint>("anchor");
    QTest::addColumn<bool>("shown");
    QTest::addColumn<QPoint>("inside"); // viewer pixels from the position
    QTest::addColumn<QPoint>("outside");
    QTest::newRow("square") << false << 0.0 << OrbPoint(0.5, 0.5) << true << QPoint(45, 45) << QPoint(55, 0);
    QTest::newRow("width from an Input") << true << 0.0 << OrbPoint(0.5, 0.5) << true << QPoint(95, 0)
                                         << QPoint(105, 0);
    QTest::newRow("turned a quarter: wide upwards")
        << true << 90.0 << OrbPoint(0.5, 0.5) << true << QPoint(0, 95) << QPoint(95, 0);
    QTest::newRow("anchored at its lower-left corner")
        << false << 0.0 << OrbPoint(0, 0) << true << QPoint(90, 90) << QPoint(-20, -20);
    QTest::newRow("box hidden: the centre only")
        << false << 0.0 << OrbPoint(0.5, 0.5) << false << QPoint(4, 0) << QPoint(30, 30);
}

// Where the box reaches, by hover: inside it the box is under the mouse
// (or the centre, where it is hidden), beyond it nothing is.
void PositionerControlTest::box()
{
    QFETCH(bool, linkWidth);
    QFETCH(double, angle);
    QFETCH(OrbPoint, anchor);
    QFETCH(bool, shown);
    QFETCH(QPoint, inside);
    QFETCH(QPoint, outside);
    ViewerFixture f;
    Input *width = f.tool->AddInput(OrbID("Width"), "Width", CLSID_DataType_Number, TagList(), AutoNumber(1.0));
    f.tool->AddInput(OrbID("Size"), "Size", CLSID_DataType_Number, TagList(), AutoNumber(0.5));
    TagList tags{{PSD_Angle, angle}, {PSD_AnchorX, anchor.x}, {PSD_AnchorY, anchor.y},   {PS_ShowBox, shown},
                 {PSD_Width, 0.5},   {PSD_Height, 0.5},       {PSID_Size, OrbID("Size")}};
    if (linkWidth)
        tags.Add(PSP_Width, static_cast<void *>(static_cast<ScriptObject *>(width)));
    Input *p = AddPositioner(f, tags);
    QVERIFY(f.Show());
    f.Hover(f.At({0.5, 0.5}, inside));
    QCOMPARE(StateOf(f.OverlayOf(p), "hoverPart"), shown ? 2.0 : 1.0);
    f.Hover(f.At({0.5, 0.5}, outside));
    QCOMPARE(StateOf(f.OverlayOf(p), "hoverPart"), 0.0);
    QCOMPARE(StateOf(f.OverlayOf(p), "width"), linkWidth ? 0.5 : 0.25);
}

// A position that is no number: nothing drawn, nothing pressed, no crash.
void PositionerControlTest::notANumber()
{
    ViewerFixture f;
    Input *p = f.AddPoint("Position", std::numeric_limits<double>::quiet_NaN(), 0.5,
                          TagList{{INPA_PreviewControl, OrbID("PositionerControl")}, {PSD_AnchorX, 1e300}});
    QVERIFY(f.Show());
    f.Grab();
    for (int x = 30; x < ViewerFixture::kViewWidth; x += 40)
        f.Drag(QPoint(x, 150), QPoint(x + 20, 130), 2);
    QCOMPARE(f.UndoSteps(), 0);
    QVERIFY(std::isnan(f.PointOf(p).x));
}

QTEST_MAIN(PositionerControlTest)
#include "PositionerControlTest.moc"
