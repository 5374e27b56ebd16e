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
    void fade_data();
    void fade();
    void nudge_data();
    void nudge();
    void nudgeRunIsOneUndoStep();
    void followCursorEndsWithFollowCursorOff();
    void styles_data();
    void styles();
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
    QTest::newRow("other styles have no arms") << 1 << QPoint(15, 0) << false << false;
    QTest::newRow("style 5 takes no clicks") << 5 << QPoint(0, 0) << false << false;
}

void CrosshairControlTest::pressZones()
{
    QFETCH(int, style);
    QFETCH(QPoint, offset);
    QFETCH(bool, movesX);
    QFETCH(bool, movesY);
    ViewerFixture f;
    // On whole pixels but not round in binary: an arm drag keeps the other axis bit for bit.
    const OrbPoint start(0.4125, 0.585);
    Input *c = f.AddPoint("Center", start.x, start.y, CrosshairAttrs(style));
    QVERIFY(f.Show());
    const QPoint from = f.At(start, offset);
    f.Drag(from, from + QPoint(40, -20));
    const OrbPoint p = f.PointOf(c);
    const QString at = QString("%1, %2").arg(p.x, 0, 'g', 17).arg(p.y, 0, 'g', 17);
    QVERIFY2(movesX ? std::fabs(p.x - start.x - 40 / 400.0) < 1e-12 : p.x == start.x, qPrintable(at));
    QVERIFY2(movesY ? std::fabs(p.y - start.y - 20 / 200.0) < 1e-12 : p.y == start.y, qPrintable(at));
}

void CrosshairControlTest::fade_data()
{
    QTest::addColumn<int>("distance");
    QTest::addColumn<int>("level");
    QTest::newRow("10 pixels away: full") << 10 << 230;
    QTest::newRow("60 pixels away: half") << 60 << 115;
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

void CrosshairControlTest::nudge_data()
{
    NudgeRows();
}

void CrosshairControlTest::nudge() // Y steps by a pixel of the height
{
    CheckNudge(CrosshairAttrs(0), 200);
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
    const auto following = [overlay] {
        TagList attrs;
        overlay->GetAttrsTagList(attrs);
        return attrs.GetInt(PCA_FollowCursor, -1);
    };
    QCOMPARE(following(), 1);
    // The point keeps its offset to the mouse.
    f.Hover(start + QPoint(40, -20));
    f.Hover(start + QPoint(80, 10));
    QVERIFY(Near(f.PointOf(c), {0.5 + 80 / 400.0, 0.5 - 10 / 200.0}));
    f.Click(start + QPoint(80, 10));

    QCOMPARE(following(), 0);
    QCOMPARE(overlay->IsDragging(), DRAG_None);
    QCOMPARE(f.doc.UndoNames(), QStringList{"Change Center"});
    // Moving on no longer moves the point.
    f.Hover(start);
    QVERIFY(Near(f.PointOf(c), {0.5 + 80 / 400.0, 0.5 - 10 / 200.0}));
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

QTEST_MAIN(CrosshairControlTest)
#include "CrosshairControlTest.moc"
