// The crosshair overlay from the loaded control library, in a real viewer,
// driven by mouse and key events.
#include "OverlayProbe.h"
#include "ViewerFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"

#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

const OrbID kCrosshairControl("CrosshairControl");
constexpr Tag CHC_Style = 0x10058000;
constexpr Tag CHCD_FollowX = 0x20058000;
constexpr Tag CHCD_FollowY = 0x20058001;
constexpr Tag CHCD_FollowOrigX = 0x20058002;
constexpr Tag CHCD_FollowOrigY = 0x20058003;
constexpr Tag CHCD_CurrentX = 0x20058004;

TagList CrosshairAttrs(int style, const TagList &more = TagList())
{
    TagList attrs{{INPA_PreviewControl, kCrosshairControl}, {CHC_Style, style}};
    attrs.Append(more);
    return attrs;
}

using Offsets = QVector<QPoint>;

} // namespace

class CrosshairControlTest : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase();

    void pressZones_data();
    void pressZones();
    void armDragKeepsOtherAxis_data();
    void armDragKeepsOtherAxis();
    void hoverReachesFurtherThanPress();
    void fade_data();
    void fade();
    void fadeRedrawsOnlyOnChange();
    void nudge_data();
    void nudge();
    void nudgeRunIsOneUndoStep();
    void followCursorEndsWithFollowCursorOff();
    void hideWhileDragging();
    void startGrabEcho_data();
    void startGrabEcho();
    void armDragShowsItsAxis();
    void styles_data();
    void styles();
    void dragIsOneUndoStep();
    void notificationBelowThresholdIsDropped();
};

void CrosshairControlTest::initTestCase()
{
    std::string why;
    QVERIFY2(ViewerFixture::LoadControls(&why), why.c_str());
}

void CrosshairControlTest::pressZones_data()
{
    QTest::addColumn<int>("style");
    QTest::addColumn<QPoint>("offset"); // viewer pixels from the centre, Y up
    QTest::addColumn<bool>("movesX");
    QTest::addColumn<bool>("movesY");
    QTest::newRow("centre") << 0 << QPoint(2, -3) << true << true;
    QTest::newRow("X arm, 22 pixels out") << 0 << QPoint(22, 0) << true << false;
    QTest::newRow("X arm ends at 23") << 0 << QPoint(23, 0) << false << false;
    QTest::newRow("Y arm, 22 pixels up") << 0 << QPoint(0, 22) << false << true;
    QTest::newRow("Y arm ends at 23") << 0 << QPoint(0, 23) << false << false;
    QTest::newRow("no arm to the left") << 0 << QPoint(-10, 0) << false << false;
    QTest::newRow("no arm below") << 0 << QPoint(0, -10) << false << false;
    QTest::newRow("beside the X arm") << 0 << QPoint(15, 6) << false << false;
    QTest::newRow("other styles have no arms") << 1 << QPoint(15, 0) << false << false;
    QTest::newRow("other styles have a centre") << 3 << QPoint(-5, 5) << true << true;
    QTest::newRow("style 5 takes no clicks") << 5 << QPoint(0, 0) << false << false;
}

void CrosshairControlTest::pressZones()
{
    QFETCH(int, style);
    QFETCH(QPoint, offset);
    QFETCH(bool, movesX);
    QFETCH(bool, movesY);
    ViewerFixture f;
    Input *c = f.AddPoint("Center", 0.5, 0.5, CrosshairAttrs(style));
    QVERIFY(f.Show());
    const QPoint from = f.At({0.5, 0.5}, offset);
    f.Drag(from, from + QPoint(40, -20));
    QVERIFY(Near(f.PointOf(c), {movesX ? 0.5 + 40 / 400.0 : 0.5, movesY ? 0.5 + 20 / 200.0 : 0.5}));
}

void CrosshairControlTest::armDragKeepsOtherAxis_data()
{
    QTest::addColumn<QPoint>("grab");
    QTest::addColumn<bool>("alongX");
    QTest::newRow("X arm") << QPoint(15, 0) << true;
    QTest::newRow("Y arm") << QPoint(0, 15) << false;
}

void CrosshairControlTest::armDragKeepsOtherAxis()
{
    QFETCH(QPoint, grab);
    QFETCH(bool, alongX);
    ViewerFixture f;
    // An odd start, so that nothing about it is round.
    Input *c = f.AddPoint("Center", 0.4137, 0.5821, CrosshairAttrs(0));
    QVERIFY(f.Show());
    const QPoint from = f.At({0.4137, 0.5821}, grab);
    f.Press(from);
    // The hand wanders across the other axis all the way.
    for (const QPoint step : {QPoint(13, 29), QPoint(31, -41), QPoint(47, 17), QPoint(-7, -33), QPoint(61, 5)})
        f.Move(from + step);
    f.Release(from + QPoint(61, 5));
    const OrbPoint p = f.PointOf(c);
    // Bit for bit: QCOMPARE on doubles would forgive a little.
    if (alongX) {
        QVERIFY2(p.y == 0.5821, qPrintable(QString::number(p.y, 'g', 17)));
        QVERIFY(std::fabs(p.x - 0.4137) > 0.1);
    } else {
        QVERIFY2(p.x == 0.4137, qPrintable(QString::number(p.x, 'g', 17)));
        QVERIFY(std::fabs(p.y - 0.5821) > 0.01);
    }
}

void CrosshairControlTest::hoverReachesFurtherThanPress()
{
    ViewerFixture f;
    Input *c = f.AddPoint("Center", 0.5, 0.5, CrosshairAttrs(0));
    QVERIFY(f.Show());
    PreviewControl *overlay = f.OverlayOf(c);
    // 23 handle pixels plus the tolerance (6), less one.
    const QPoint far = f.At({0.5, 0.5}, QPoint(28, 0));
    f.Hover(far);
    QCOMPARE(f.viewer.HoverControl(), overlay);
    const QImage shot = f.Grab();
    // The X arm takes the highlight, the Y arm does not.
    const QColor arm = Brightest(shot, f.At({0.5, 0.5}, QPoint(12, 0)));
    const QColor other = Brightest(shot, f.At({0.5, 0.5}, QPoint(0, 12)));
    QVERIFY2(arm.red() > 2 * arm.blue(), qPrintable(arm.name()));
    QVERIFY2(std::abs(other.red() - other.blue()) < 10, qPrintable(other.name()));
    f.Hover(f.At({0.5, 0.5}, QPoint(29, 0)));
    QCOMPARE(f.viewer.HoverControl(), static_cast<PreviewControl *>(nullptr));

    f.Drag(far, far + QPoint(30, 0));
    QCOMPARE(f.PointOf(c), OrbPoint(0.5, 0.5));
}

void CrosshairControlTest::fade_data()
{
    QTest::addColumn<int>("distance");
    QTest::addColumn<int>("level");
    QTest::newRow("10 pixels away: full") << 10 << 230;
    QTest::newRow("35 pixels away: three quarters") << 35 << 172;
    QTest::newRow("60 pixels away: half") << 60 << 115;
    QTest::newRow("200 pixels away: still half") << 200 << 115;
}

void CrosshairControlTest::fade()
{
    QFETCH(int, distance);
    QFETCH(int, level);
    ViewerFixture f;
    f.AddPoint("Center", 0.5, 0.5, CrosshairAttrs(1));
    QVERIFY(f.Show());
    f.Hover(f.At({0.5, 0.5}, QPoint(distance, 0)));
    // A point on the vertical line, away from the mouse and the other line.
    const int drawn = Level(f.Grab(), f.At({0.5, 0.5}, QPoint(0, 7)));
    QVERIFY2(std::abs(drawn - level) <= 4, qPrintable(QString::number(drawn)));
}

void CrosshairControlTest::fadeRedrawsOnlyOnChange()
{
    ViewerFixture f;
    f.AddPoint("Center", 0.5, 0.5, CrosshairAttrs(1));
    QVERIFY(f.Show());
    f.Hover(f.At({0.5, 0.5}, QPoint(80, 0)));
    QApplication::processEvents();
    const int paints = f.viewer.PaintCount();
    f.Hover(f.At({0.5, 0.5}, QPoint(120, 0))); // half either way
    f.Hover(f.At({0.5, 0.5}, QPoint(60, 0)));
    QApplication::processEvents();
    QCOMPARE(f.viewer.PaintCount(), paints);
    f.Hover(f.At({0.5, 0.5}, QPoint(40, 0)));
    QApplication::processEvents();
    QCOMPARE(f.viewer.PaintCount(), paints + 1);
}

void CrosshairControlTest::nudge_data()
{
    QTest::addColumn<int>("key");
    QTest::addColumn<int>("mods");
    QTest::addColumn<double>("dx"); // image pixels
    QTest::addColumn<double>("dy");
    QTest::newRow("right") << int(Qt::Key_Right) << int(Qt::NoModifier) << 1.0 << 0.0;
    QTest::newRow("up increases Y") << int(Qt::Key_Up) << int(Qt::NoModifier) << 0.0 << 1.0;
    QTest::newRow("left with shift: ten") << int(Qt::Key_Left) << int(Qt::ShiftModifier) << -10.0 << 0.0;
    QTest::newRow("down with control: a tenth") << int(Qt::Key_Down) << int(Qt::ControlModifier) << 0.0 << -0.1;
    QTest::newRow("up with both: one") << int(Qt::Key_Up) << int(Qt::ShiftModifier | Qt::ControlModifier) << 0.0 << 1.0;
}

// The image is 400 x 200: X steps by 1/400, Y by 1/200.
void CrosshairControlTest::nudge()
{
    QFETCH(int, key);
    QFETCH(int, mods);
    QFETCH(double, dx);
    QFETCH(double, dy);
    ViewerFixture f;
    Input *c = f.AddPoint("Center", 0.5, 0.5, CrosshairAttrs(0));
    QVERIFY(f.Show());
    f.Key(Qt::Key(key), Qt::KeyboardModifiers(mods));
    QVERIFY(Near(f.PointOf(c), {0.5 + dx / 400, 0.5 + dy / 200}));
    QCOMPARE(f.UndoSteps(), 1);
}

void CrosshairControlTest::nudgeRunIsOneUndoStep()
{
    ViewerFixture f;
    Input *c = f.AddPoint("Center", 0.5, 0.5, CrosshairAttrs(0));
    QVERIFY(f.Show());
    QTest::keyPress(&f.viewer, Qt::Key_Left, Qt::ShiftModifier);
    QTest::keyPress(&f.viewer, Qt::Key_Down, Qt::ShiftModifier);
    QTest::keyRelease(&f.viewer, Qt::Key_Down, Qt::NoModifier);
    QTest::keyRelease(&f.viewer, Qt::Key_Left, Qt::NoModifier);
    QVERIFY(!f.doc.CanUndo()); // Shift is still down
    QTest::keyRelease(&f.viewer, Qt::Key_Shift, Qt::NoModifier);
    QCOMPARE(f.doc.UndoNames(), QStringList{"Change Center"});
    QVERIFY(Near(f.PointOf(c), {0.5 - 10 / 400.0, 0.5 - 10 / 200.0}));
    QVERIFY(f.doc.Undo());
    QCOMPARE(f.PointOf(c), OrbPoint(0.5, 0.5));
}

void CrosshairControlTest::followCursorEndsWithFollowCursorOff()
{
    ViewerFixture f;
    Input *c = f.AddPoint("Center", 0.5, 0.5, CrosshairAttrs(0));
    QVERIFY(f.Show());
    PreviewControl *overlay = f.OverlayOf(c);
    const QPoint start(100, 200);
    f.Hover(start);
    const OrbPoint mouse = f.viewer.WidgetToImage(start);
    QVERIFY(f.viewer.BeginFollowCursor(
        overlay,
        TagList{{CHCD_FollowX, mouse.x}, {CHCD_FollowY, mouse.y}, {CHCD_FollowOrigX, 0.5}, {CHCD_FollowOrigY, 0.5}}));
    TagList attrs;
    overlay->GetAttrsTagList(attrs);
    QCOMPARE(attrs.GetInt(PCA_FollowCursor, -1), 1);
    // The point keeps its offset to the mouse.
    f.Hover(start + QPoint(40, -20));
    QVERIFY(Near(f.PointOf(c), {0.5 + 40 / 400.0, 0.5 + 20 / 200.0}));
    f.Hover(start + QPoint(80, 10));
    QVERIFY(Near(f.PointOf(c), {0.5 + 80 / 400.0, 0.5 - 10 / 200.0}));
    f.Press(start + QPoint(80, 10));
    f.Release(start + QPoint(80, 10));

    attrs.Clear();
    overlay->GetAttrsTagList(attrs);
    QCOMPARE(attrs.GetInt(PCA_FollowCursor, -1), 0);
    QCOMPARE(overlay->IsDragging(), DRAG_None);
    QCOMPARE(f.doc.UndoNames(), QStringList{"Change Center"});
    // Moving on no longer moves the point.
    f.Hover(start);
    QVERIFY(Near(f.PointOf(c), {0.5 + 80 / 400.0, 0.5 - 10 / 200.0}));
}

void CrosshairControlTest::hideWhileDragging()
{
    ViewerFixture f;
    Input *c = f.AddPoint("Center", 0.5, 0.5, CrosshairAttrs(1, TagList{{PCA_HideWhileDragging, 1}}));
    QVERIFY(f.Show());
    const QPoint from = f.At({0.5, 0.5});
    QVERIFY(Lit(f.Grab(), f.At({0.5, 0.5}, QPoint(0, 7))));
    f.Press(from);
    f.Move(from + QPoint(40, 0));
    QVERIFY(Near(f.PointOf(c), {0.6, 0.5}));
    QVERIFY(Dark(f.Grab(), f.At({0.6, 0.5}, QPoint(0, 7))));
    f.Release(from + QPoint(40, 0));
    QVERIFY(Lit(f.Grab(), f.At({0.6, 0.5}, QPoint(0, 7))));
}

void CrosshairControlTest::startGrabEcho_data()
{
    QTest::addColumn<uint>("flags");
    QTest::addColumn<bool>("echo");
    QTest::newRow("asked for") << uint(PEF_StartGrab) << true;
    QTest::newRow("not asked for") << 0u << false;
}

// A second crosshair where the press began: at the point's place less the
// grab offset remembered at the press.
void CrosshairControlTest::startGrabEcho()
{
    QFETCH(uint, flags);
    QFETCH(bool, echo);
    ViewerFixture f;
    f.AddPoint("Center", 0.5, 0.5, CrosshairAttrs(1));
    QVERIFY(f.Show());
    f.viewer.SetPressFlags(flags);
    const QPoint from = f.At({0.5, 0.5}, QPoint(4, 0));
    f.Press(from);
    f.Move(from + QPoint(40, 0));
    const QImage shot = f.Grab();
    QVERIFY(Lit(shot, f.At({0.6, 0.5}, QPoint(0, 7))));
    QCOMPARE(Lit(shot, f.At({0.6, 0.5}, QPoint(4, 7))), echo);
    f.Release(from + QPoint(40, 0));
    QVERIFY(Dark(f.Grab(), f.At({0.6, 0.5}, QPoint(4, 7))));
}

void CrosshairControlTest::armDragShowsItsAxis()
{
    ViewerFixture f;
    f.AddPoint("Center", 0.5, 0.5, CrosshairAttrs(0));
    QVERIFY(f.Show());
    const QPoint from = f.At({0.5, 0.5}, QPoint(15, 0));
    f.Press(from);
    f.Move(from + QPoint(60, 0));
    // A guide along X through the place of the press, across the view.
    QVERIFY(Lit(f.Grab(), f.At({0.5, 0.5}, QPoint(-150, 0))));
    QVERIFY(Dark(f.Grab(), f.At({0.5, 0.5}, QPoint(0, -60))));
    f.Release(from + QPoint(60, 0));
    QVERIFY(Dark(f.Grab(), f.At({0.5, 0.5}, QPoint(-150, 0))));
}

void CrosshairControlTest::styles_data()
{
    QTest::addColumn<int>("style");
    QTest::addColumn<Offsets>("lit");
    QTest::addColumn<Offsets>("dark");
    QTest::newRow("0: axis crosshair") << 0 << Offsets{{12, 0}, {0, 12}, {-8, 0}, {4, 2}}
                                       << Offsets{{12, 12}, {-12, -12}, {0, -14}};
    QTest::newRow("1: two crossing lines")
        << 1 << Offsets{{8, 0}, {-8, 0}, {0, 8}, {0, -8}} << Offsets{{6, 6}, {-6, -6}, {14, 0}};
    QTest::newRow("2: four-sided outline")
        << 2 << Offsets{{8, 0}, {-8, 0}, {0, 8}, {0, -8}, {8, 8}} << Offsets{{0, 0}, {4, 4}, {12, 0}};
    QTest::newRow("3: ring") << 3 << Offsets{{8, 0}, {-8, 0}, {0, 8}, {0, -8}} << Offsets{{0, 0}, {8, 8}, {4, 0}};
    QTest::newRow("4: broken ring") << 4 << Offsets{{10, 0}, {-10, 0}} << Offsets{{0, 0}, {7, 0}, {4, 4}};
    QTest::newRow("5: nothing") << 5 << Offsets{} << Offsets{{0, 0}, {8, 0}, {0, 8}, {12, 0}};
}

void CrosshairControlTest::styles()
{
    QFETCH(int, style);
    QFETCH(Offsets, lit);
    QFETCH(Offsets, dark);
    ViewerFixture f;
    f.AddPoint("Center", 0.5, 0.5, CrosshairAttrs(style));
    QVERIFY(f.Show());
    const QImage shot = f.Grab();
    for (const QPoint &o : lit)
        QVERIFY2(Lit(shot, f.At({0.5, 0.5}, o)), qPrintable(QString("lit at %1, %2").arg(o.x()).arg(o.y())));
    for (const QPoint &o : dark)
        QVERIFY2(Dark(shot, f.At({0.5, 0.5}, o)), qPrintable(QString("dark at %1, %2").arg(o.x()).arg(o.y())));
}

void CrosshairControlTest::dragIsOneUndoStep()
{
    ViewerFixture f;
    Input *c = f.AddPoint("Center", 0.25, 0.75, CrosshairAttrs(0));
    QVERIFY(f.Show());
    f.Drag(f.At({0.25, 0.75}, QPoint(-2, 1)), f.At({0.25, 0.75}, QPoint(98, -49)), 10);
    QVERIFY(Near(f.PointOf(c), {0.25 + 100 / 400.0, 0.75 - 50 / 200.0}));
    QCOMPARE(f.doc.UndoNames(), QStringList{"Change Center"});
    QVERIFY(f.doc.Undo());
    QCOMPARE(f.PointOf(c), OrbPoint(0.25, 0.75));
    f.Grab();
    float64 drawn = 0;
    QVERIFY(!f.OverlayOf(c)->CopyAttr(CHCD_CurrentX, &drawn));
    QCOMPARE(drawn, 0.25);
}

void CrosshairControlTest::notificationBelowThresholdIsDropped()
{
    ViewerFixture f;
    Input *c = f.AddPoint("Center", 0.5, 0.5, CrosshairAttrs(0));
    QVERIFY(f.Show());
    QApplication::processEvents();
    const int paints = f.viewer.PaintCount();
    const AutoPoint tiny(0.5, 0.5 + 5e-6);
    QVERIFY(c->SetValue(tiny.get(), 0.0));
    QApplication::processEvents();
    QCOMPARE(f.viewer.PaintCount(), paints);
    f.Grab();
    float64 drawn = 0;
    f.OverlayOf(c)->CopyAttr(CHCD_CurrentX + 1, &drawn);
    QCOMPARE(drawn, 0.5);
}

QTEST_MAIN(CrosshairControlTest)
#include "CrosshairControlTest.moc"
