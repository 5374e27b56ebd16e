// The point overlay from the loaded control library, in a real viewer, driven
// by mouse and key events.
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
constexpr Tag PCD_SetPrevPointX = 0x20058000;
constexpr Tag PCD_SetPrevPointY = 0x20058001;

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
    void dragIsOneUndoStep();
    void moveBelowThresholdWritesNothing();
    void nudge_data();
    void nudge();
    void nudgeRunIsOneUndoStep();
    void pressOnLinkedHandleMovesNothing();
    void drawsSquareAndLineToPrevious();
    void tagGivenPreviousPointDrawsNoLine();
    void lineFollowsPreviousPointAndGoesWithIt();
    void activationWalksTheChain();
    void notificationBelowThresholdDoesNotRedraw();
    void grabOffsetAndInputAt();
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
    // The tolerance is 6: six pixels away on either axis misses.
    QTest::newRow("6 right") << QPoint(6, 0) << false;
    QTest::newRow("5 right") << QPoint(5, 0) << true;
    QTest::newRow("6 left") << QPoint(-6, 0) << false;
    QTest::newRow("5 left") << QPoint(-5, 0) << true;
    QTest::newRow("6 up") << QPoint(0, 6) << false;
    QTest::newRow("5 up") << QPoint(0, 5) << true;
    QTest::newRow("6 down") << QPoint(0, -6) << false;
    QTest::newRow("5 down") << QPoint(0, -5) << true;
    QTest::newRow("5 and 5: a square, not a circle") << QPoint(5, 5) << true;
    QTest::newRow("5 and 6") << QPoint(5, 6) << false;
}

void PointControlTest::pickTolerance()
{
    QFETCH(QPoint, offset);
    QFETCH(bool, hit);
    ViewerFixture f;
    Input *p = f.AddPoint("P", 0.5, 0.5, PointAttrs());
    QVERIFY(f.Show());
    QCOMPARE(f.viewer.Info().PickTolerance, 6);
    const QPoint from = f.At({0.5, 0.5}, offset);
    f.Press(from);
    QCOMPARE(f.OverlayOf(p)->IsDragging(), hit ? DRAG_Handle : DRAG_None);
    f.Move(from + QPoint(20, 0));
    f.Release(from + QPoint(20, 0));
    QVERIFY(Near(f.PointOf(p), hit ? OrbPoint(0.5 + 20 / 400.0, 0.5) : OrbPoint(0.5, 0.5)));
    QCOMPARE(f.UndoSteps(), hit ? 1 : 0);
}

void PointControlTest::dragIsOneUndoStep()
{
    ViewerFixture f;
    Input *p = f.AddPoint("P", 0.5, 0.5, PointAttrs());
    QVERIFY(f.Show());
    // Grabbed off-centre: the handle keeps its offset to the mouse.
    const QPoint from = f.At({0.5, 0.5}, QPoint(3, -2));
    f.Drag(from, from + QPoint(40, -20), 8);
    QVERIFY(Near(f.PointOf(p), {0.5 + 40 / 400.0, 0.5 + 20 / 200.0})); // 20 widget pixels up
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
    // 400 image pixels over 120000 viewer pixels: one pixel is 1/120000 of
    // the width, below the 1e-5 threshold; two are above it.
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
    QTest::addColumn<int>("key");
    QTest::addColumn<int>("mods");
    QTest::addColumn<double>("dx"); // image pixels of the width
    QTest::addColumn<double>("dy");
    QTest::newRow("right") << int(Qt::Key_Right) << int(Qt::NoModifier) << 1.0 << 0.0;
    QTest::newRow("left with shift: ten") << int(Qt::Key_Left) << int(Qt::ShiftModifier) << -10.0 << 0.0;
    QTest::newRow("up increases Y, by the width's pixel") << int(Qt::Key_Up) << int(Qt::NoModifier) << 0.0 << 1.0;
    QTest::newRow("down with control: a tenth") << int(Qt::Key_Down) << int(Qt::ControlModifier) << 0.0 << -0.1;
    QTest::newRow("up with both: one") << int(Qt::Key_Up) << int(Qt::ShiftModifier | Qt::ControlModifier) << 0.0 << 1.0;
}

// The image is 400 x 200: one step is 1/400 on both axes.
void PointControlTest::nudge()
{
    QFETCH(int, key);
    QFETCH(int, mods);
    QFETCH(double, dx);
    QFETCH(double, dy);
    ViewerFixture f;
    Input *p = f.AddPoint("P", 0.5, 0.5, PointAttrs());
    QVERIFY(f.Show());
    f.Key(Qt::Key(key), Qt::KeyboardModifiers(mods));
    QVERIFY(Near(f.PointOf(p), {0.5 + dx / 400, 0.5 + dy / 400}));
    QCOMPARE(f.UndoSteps(), 1);
}

void PointControlTest::nudgeRunIsOneUndoStep()
{
    ViewerFixture f;
    Input *p = f.AddPoint("P", 0.5, 0.5, PointAttrs());
    QVERIFY(f.Show());
    QTest::keyPress(&f.viewer, Qt::Key_Right);
    QTest::keyPress(&f.viewer, Qt::Key_Right);
    QTest::keyPress(&f.viewer, Qt::Key_Up);
    QVERIFY(!f.doc.CanUndo()); // the step is still open
    QTest::keyRelease(&f.viewer, Qt::Key_Up);
    QTest::keyRelease(&f.viewer, Qt::Key_Right);
    QCOMPARE(f.doc.UndoNames(), QStringList{"Change P"});
    QVERIFY(Near(f.PointOf(p), {0.5 + 2 / 400.0, 0.5 + 1 / 400.0}));
    QVERIFY(f.doc.Undo());
    QCOMPARE(f.PointOf(p), OrbPoint(0.5, 0.5));
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

    // The other way round nothing is linked: P1 has no previous point.
    f.Press(f.At({0.75, 0.5}));
    QCOMPARE(f.OverlayOf(p1)->IsDragging(), DRAG_None);
    f.Release(f.At({0.75, 0.5}));
}

void PointControlTest::drawsSquareAndLineToPrevious()
{
    ViewerFixture f;
    f.AddPoint("P1", 0.25, 0.5, PointAttrs());
    f.AddPoint("P2", 0.75, 0.75, LinkedTo("P1"));
    QVERIFY(f.Show());
    const QImage shot = f.Grab();
    // A 4-pixel square at each point.
    QVERIFY(Lit(shot, f.At({0.25, 0.5}, QPoint(0, 2))));
    QVERIFY(Lit(shot, f.At({0.25, 0.5}, QPoint(0, -2))));
    QVERIFY(Lit(shot, f.At({0.75, 0.75}, QPoint(-2, 0))));
    // The line from P2 to P1, and nothing beside it.
    QVERIFY(Lit(shot, f.At({0.5, 0.625})));
    QVERIFY(Dark(shot, f.At({0.5, 0.625}, QPoint(0, 8))));
    QVERIFY(Dark(shot, f.At({0.5, 0.3})));
}

void PointControlTest::tagGivenPreviousPointDrawsNoLine()
{
    ViewerFixture f;
    Input *p = f.AddPoint("P", 0.75, 0.5, PointAttrs(TagList{{PCD_SetPrevPointX, 0.25}, {PCD_SetPrevPointY, 0.5}}));
    QVERIFY(f.Show());
    const QImage shot = f.Grab();
    // The square's outline, hollow, and no line to the previous point.
    QVERIFY(Lit(shot, f.At({0.75, 0.5}, QPoint(2, 0))));
    QVERIFY(Lit(shot, f.At({0.75, 0.5}, QPoint(-2, 0))));
    QVERIFY(Dark(shot, f.At({0.75, 0.5}), 0));
    QVERIFY(Dark(shot, f.At({0.5, 0.5})));
    TagList attrs;
    QVERIFY(f.OverlayOf(p)->GetAttrsTagList(attrs));
    QCOMPARE(attrs.GetDouble(PCD_SetPrevPointX, -1), 0.25);
    QVERIFY(!attrs.FindQuery(PCID_PrevPoint));
}

void PointControlTest::lineFollowsPreviousPointAndGoesWithIt()
{
    ViewerFixture f;
    Input *p1 = f.AddPoint("P1", 0.25, 0.5, PointAttrs());
    Input *p2 = f.AddPoint("P2", 0.75, 0.5, LinkedTo("P1"));
    QVERIFY(f.Show());
    const AutoPoint moved(0.75, 0.9);
    QVERIFY(p1->SetValue(moved.get(), 0.0));
    QImage shot = f.Grab();
    QVERIFY(Lit(shot, f.At({0.75, 0.7})));
    QVERIFY(Dark(shot, f.At({0.5, 0.5})));

    PreviewControl *overlay = f.OverlayOf(p2);
    QVERIFY(overlay->RemoveInput(p1, nullptr));
    TagList attrs;
    overlay->GetAttrsTagList(attrs);
    QVERIFY(!attrs.FindQuery(PCID_PrevPoint));
    shot = f.Grab();
    QVERIFY(Dark(shot, f.At({0.75, 0.7})));
    QVERIFY(Lit(shot, f.At({0.75, 0.5}, QPoint(2, 0))));
}

void PointControlTest::activationWalksTheChain()
{
    ViewerFixture f;
    Input *p1 = f.AddPoint("P1", 0.2, 0.5, PointAttrs());
    Input *p2 = f.AddPoint("P2", 0.4, 0.5, LinkedTo("P1"));
    Input *p3 = f.AddPoint("P3", 0.6, 0.5, LinkedTo("P2"));
    QVERIFY(f.Show());
    for (PreviewControl *o : f.viewer.Overlays())
        o->SetInactive(nullptr);
    f.OverlayOf(p2)->SetActive(1, nullptr);
    QVERIFY(f.OverlayOf(p1)->IsActive());
    QVERIFY(!f.OverlayOf(p3)->IsActive());
    for (PreviewControl *o : f.viewer.Overlays())
        o->SetInactive(nullptr);
    f.OverlayOf(p3)->SetActive(1, nullptr);
    QVERIFY(f.OverlayOf(p2)->IsActive());
    QVERIFY(f.OverlayOf(p1)->IsActive());
}

void PointControlTest::notificationBelowThresholdDoesNotRedraw()
{
    ViewerFixture f;
    Input *p = f.AddPoint("P", 0.5, 0.5, PointAttrs());
    QVERIFY(f.Show());
    QApplication::processEvents();
    const int paints = f.viewer.PaintCount();
    const AutoPoint tiny(0.5 + 5e-6, 0.5);
    QVERIFY(p->SetValue(tiny.get(), 0.0));
    QApplication::processEvents();
    QCOMPARE(f.viewer.PaintCount(), paints);
    const AutoPoint real(0.5 + 5e-3, 0.5);
    QVERIFY(p->SetValue(real.get(), 0.0));
    QApplication::processEvents();
    QCOMPARE(f.viewer.PaintCount(), paints + 1);
}

void PointControlTest::grabOffsetAndInputAt()
{
    ViewerFixture f;
    Input *p = f.AddPoint("P", 0.5, 0.5, PointAttrs());
    QVERIFY(f.Show());
    PreviewControl *overlay = f.OverlayOf(p);
    f.Press(f.At({0.5, 0.5}, QPoint(3, -2)));
    float64 x = 0, y = 0;
    QVERIFY(!overlay->CopyAttr(PCA_GrabOffsetX, &x)); // false: supplied
    QVERIFY(!overlay->CopyAttr(PCA_GrabOffsetY, &y));
    QVERIFY(Near(OrbPoint(x, y), {-3, 2}, 1e-9));
    f.Release(f.At({0.5, 0.5}, QPoint(3, -2)));

    f.Hover(f.At({0.5, 0.5}, QPoint(1, 1)));
    QCOMPARE(overlay->ControlCommand(&f.viewer.Info(), CCMD_GetInputAt, 0, nullptr),
             uint64(reinterpret_cast<uintptr_t>(p)));
    f.Hover(f.At({0.5, 0.5}, QPoint(9, 1)));
    QCOMPARE(overlay->ControlCommand(&f.viewer.Info(), CCMD_GetInputAt, 0, nullptr), uint64(0));
    QCOMPARE(overlay->ControlCommand(&f.viewer.Info(), CCMD_NeedsKey, Qt::Key_Left, nullptr), uint64(1));
    QCOMPARE(overlay->ControlCommand(&f.viewer.Info(), CCMD_NeedsKey, Qt::Key_A, nullptr), uint64(0));
}

QTEST_MAIN(PointControlTest)
#include "PointControlTest.moc"
