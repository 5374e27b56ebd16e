#include "OverlayProbe.h"
#include "ViewerFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ControlCommands.h"
#include "orbane/Input.h"

#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

const OrbID kPointControl("PointControl");
constexpr Tag PCID_PrevPoint = 0x80058000;

TagList PointAttrs(const TagList &more = TagList())
{
    TagList attrs{{INPA_PreviewControl, kPointControl}};
    attrs.Append(more);
    return attrs;
}

TagList LinkedTo(const char *prev)
{
    return PointAttrs(TagList{{PCID_PrevPoint, OrbID(prev)}});
}

} // namespace

class PointControlTest : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase();

    void pickTolerance_data();
    void pickTolerance();
    void dragIsOneUndoStepAtTheCurrentTime();
    void moveBelowThresholdWritesNothing();
    void nudge_data();
    void nudge();
    void pressOnLinkedHandleMovesNothing();
    void lineToPreviousPoint();
    void hoverClaimsAndHighlights();
};

void PointControlTest::initTestCase()
{
    std::string why;
    QVERIFY2(ViewerFixture::LoadControls(&why), why.c_str());
}

void PointControlTest::pickTolerance_data()
{
    QTest::addColumn<QPoint>("offset"); // viewer pixels from the handle, Y up
    QTest::addColumn<bool>("hit");
    QTest::newRow("6 right") << QPoint(6, 0) << false;
    QTest::newRow("5 right") << QPoint(5, 0) << true;
    QTest::newRow("5 and 5: a square, not a circle") << QPoint(5, 5) << true;
}

void PointControlTest::pickTolerance()
{
    QFETCH(QPoint, offset);
    QFETCH(bool, hit);
    ViewerFixture f;
    Input *p = f.AddPoint("P", 0.5, 0.5, PointAttrs());
    QVERIFY(f.Show());
    // Logical pixels at any device pixel ratio (a second run is at 2).
    const qreal dpr = qEnvironmentVariableIsSet("QT_SCALE_FACTOR") ? qgetenv("QT_SCALE_FACTOR").toDouble() : 1.0;
    QCOMPARE(f.viewer.devicePixelRatioF(), dpr);
    QCOMPARE(f.viewer.Info().PickTolerance, 6);
    QCOMPARE(f.viewer.Info().HandleScale, 1.0f);
    const QPoint from = f.At({0.5, 0.5}, offset);
    f.Hover(from);
    const uint64 inputAt = f.OverlayOf(p)->ControlCommand(&f.viewer.Info(), CCMD_GetInputAt, 0, nullptr);
    QCOMPARE(inputAt, hit ? uint64(reinterpret_cast<uintptr_t>(p)) : 0u);
    f.Press(from);
    QCOMPARE(f.OverlayOf(p)->IsDragging(), hit ? DRAG_Handle : DRAG_None);
    f.Move(from + QPoint(20, 0));
    f.Release(from + QPoint(20, 0));
    QVERIFY(Near(f.PointOf(p), hit ? OrbPoint(0.5 + 20 / 400.0, 0.5) : OrbPoint(0.5, 0.5)));
    QCOMPARE(f.UndoSteps(), hit ? 1 : 0);
}

void PointControlTest::dragIsOneUndoStepAtTheCurrentTime()
{
    ViewerFixture f;
    Input *p = f.AddPoint("P", 0.5, 0.5, PointAttrs());
    p->SetAnimated(true); // a key at time 0
    f.doc.SetCurrentTime(2.0);
    QVERIFY(f.Show());
    // Grabbed off-centre: the handle keeps its offset to the mouse.
    const QPoint from = f.At({0.5, 0.5}, QPoint(3, -2));
    f.Drag(from, from + QPoint(40, -20), 8);
    QVERIFY(Near(f.PointOf(p), {0.5 + 40 / 400.0, 0.5 + 20 / 200.0})); // 20 widget pixels up
    QCOMPARE(p->KeyTimes(), (std::vector<float64>{0.0, 2.0}));
    QCOMPARE(f.doc.UndoNames(), QStringList{"Change P"});
    QVERIFY(f.doc.Undo());
    QCOMPARE(f.PointOf(p), OrbPoint(0.5, 0.5));
    // The overlay follows the undo: the old place takes the press again.
    f.Drag(f.At({0.5, 0.5}), f.At({0.5, 0.5}, QPoint(0, 10)));
    QVERIFY(Near(f.PointOf(p), {0.5, 0.5 + 10 / 200.0}));
}

void PointControlTest::moveBelowThresholdWritesNothing()
{
    ViewerFixture f;
    Input *p = f.AddPoint("P", 0.5, 0.5, PointAttrs());
    QVERIFY(f.Show());
    // One viewer pixel is 1/120000 of the width: below the 1e-5 threshold.
    f.viewer.SetView(300.0);
    QCOMPARE(f.viewer.Info().ViewWidth, 120000);
    const QPoint at = f.At({0.5, 0.5});
    f.Press(at);
    f.Move(at + QPoint(1, 0));
    QCOMPARE(f.PointOf(p), OrbPoint(0.5, 0.5));
    QVERIFY(!f.OverlayOf(p)->IsUndoOpen());
    f.Move(at + QPoint(2, 0));
    f.Release(at + QPoint(2, 0));
    QVERIFY(Near(f.PointOf(p), {0.5 + 2 / 120000.0, 0.5}));
    QCOMPARE(f.UndoSteps(), 1);
}

void PointControlTest::nudge_data()
{
    NudgeRows();
}

void PointControlTest::nudge() // Y steps by a pixel of the width
{
    CheckNudge(PointAttrs(), 400);
}

void PointControlTest::pressOnLinkedHandleMovesNothing()
{
    ViewerFixture f;
    Input *p1 = f.AddPoint("P1", 0.25, 0.5, PointAttrs());
    Input *p2 = f.AddPoint("P2", 0.75, 0.5, LinkedTo("P1"));
    QVERIFY(f.Show());
    const QPoint from = f.At({0.25, 0.5});
    f.Press(from);
    QCOMPARE(f.viewer.HotControl(), f.OverlayOf(p1));
    QCOMPARE(f.OverlayOf(p2)->IsDragging(), DRAG_Linked);
    f.Move(from + QPoint(30, 30));
    f.Release(from + QPoint(30, 30));
    QCOMPARE(f.PointOf(p2), OrbPoint(0.75, 0.5));
    QVERIFY(Near(f.PointOf(p1), {0.25 + 30 / 400.0, 0.5 - 30 / 200.0}));
    QCOMPARE(f.doc.UndoNames(), QStringList{"Change P1"});
    QCOMPARE(f.OverlayOf(p2)->IsDragging(), DRAG_None);
}

void PointControlTest::lineToPreviousPoint()
{
    ViewerFixture f;
    Input *p1 = f.AddPoint("P1", 0.25, 0.5, PointAttrs());
    f.AddPoint("P2", 0.75, 0.75, LinkedTo("P1"));
    QVERIFY(f.Show());
    QImage shot = f.Grab();
    QVERIFY(Lit(shot, f.At({0.25, 0.5}, QPoint(0, 2))));
    QVERIFY(Lit(shot, f.At({0.75, 0.75}, QPoint(-2, 0))));
    // The line from P2 to P1, and nothing beside it.
    QVERIFY(Lit(shot, f.At({0.5, 0.625})));
    QVERIFY(Dark(shot, f.At({0.5, 0.625}, QPoint(0, 8))));
    QVERIFY(Dark(shot, f.At({0.5, 0.3})));

    const AutoPoint moved(0.75, 0.25);
    QVERIFY(p1->SetValue(moved.get(), 0.0));
    shot = f.Grab();
    QVERIFY(Lit(shot, f.At({0.75, 0.5})));
    QVERIFY(Dark(shot, f.At({0.5, 0.625})));
}

void PointControlTest::hoverClaimsAndHighlights()
{
    ViewerFixture f;
    Input *p = f.AddPoint("P", 0.5, 0.5, PointAttrs());
    QVERIFY(f.Show());
    const QPoint edge = f.At({0.5, 0.5}, QPoint(2, 0));
    // The overlay's light grey, then the warm highlight while the mouse is over it.
    QVERIFY(qBlue(f.Grab().pixel(edge)) > 200);
    f.Hover(f.At({0.5, 0.5}, QPoint(5, 5)));
    QCOMPARE(f.viewer.HoverControl(), f.OverlayOf(p));
    QImage shot = f.Grab();
    QVERIFY2(qRed(shot.pixel(edge)) > 200 && qBlue(shot.pixel(edge)) < 100,
             qPrintable(QString::number(shot.pixel(edge), 16)));
    f.Hover(f.At({0.5, 0.5}, QPoint(6, 0)));
    QCOMPARE(f.viewer.HoverControl(), nullptr);
    QVERIFY(qBlue(f.Grab().pixel(edge)) > 200);
}

QTEST_MAIN(PointControlTest)
#include "PointControlTest.moc"
