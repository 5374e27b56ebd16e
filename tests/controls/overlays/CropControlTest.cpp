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

// The box as left, bottom, right, top in image coordinates.
struct Box
{
    double l, b, r, t;
};

// A crop tool: Corner (main), Size and the aspect lock, on the fixture's
// 400 x 200 image.
Input *AddCrop(ViewerFixture &f, OrbPoint corner, OrbPoint size, double lock = 0.0)
{
    const TagList attrs{{INPA_PreviewControl, CLSID_PreviewControl_Crop},
                        {INPA_OverlayInput, OrbID("Size")},
                        {INPA_OverlayInput, OrbID("Lock")}};
    Input *c = f.AddPoint("Corner", corner.x, corner.y, attrs);
    f.AddPoint("Size", size.x, size.y);
    f.tool->AddInput(OrbID("Lock"), "Lock", CLSID_DataType_Number, TagList(), AutoNumber(lock));
    return c;
}

Box Read(const ViewerFixture &f)
{
    const OrbPoint c = f.PointOf(f.tool->FindInput(OrbID("Corner")));
    const OrbPoint s = f.PointOf(f.tool->FindInput(OrbID("Size")));
    return {c.x, c.y, c.x + s.x, c.y + s.y};
}

QByteArray Describe(const Box &b)
{
    QByteArray out;
    for (double n : {b.l, b.b, b.r, b.t})
        out += QByteArray::number(n, 'g', 12) + " ";
    return out;
}

bool Same(const Box &a, const Box &b)
{
    return std::fabs(a.l - b.l) < 1e-9 && std::fabs(a.b - b.b) < 1e-9 && std::fabs(a.r - b.r) < 1e-9 &&
           std::fabs(a.t - b.t) < 1e-9;
}

} // namespace

Q_DECLARE_METATYPE(Box)

class CropControlTest : public QObject
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
    void outsideIsDarkened();
    void nudges_data() { NudgeRows(); }
    void nudges() { CheckNudge(TagList{{INPA_PreviewControl, CLSID_PreviewControl_Crop}}, 200); }
    void badInput_data();
    void badInput();
};

void CropControlTest::drag_data()
{
    QTest::addColumn<double>("zoom");
    QTest::addColumn<double>("pixelAspect");
    QTest::addColumn<QPoint>("grip"); // -1, 0, 1 per axis; 0, 0 the inside
    QTest::addColumn<int>("mods");
    QTest::addColumn<double>("lock");
    QTest::addColumn<QPoint>("move"); // image pixels, Y up
    QTest::addColumn<Box>("box");
    // The box: 0.25..0.75 on both axes, 200 x 100 image pixels.
    for (auto [zoom, aspect] : {std::pair{1.0, 1.0}, {2.0, 1.0}, {0.5, 2.0}}) {
        const QByteArray at = " at zoom " + QByteArray::number(zoom) + ", pixel aspect " + QByteArray::number(aspect);
        auto row = [&](const char *name, QPoint grip, int mods, double lock, QPoint move, Box box) {
            QTest::newRow(name + at) << zoom << aspect << grip << mods << lock << move << box;
        };
        row("the inside moves it", {0, 0}, 0, 0, {40, 10}, {0.35, 0.3, 0.85, 0.8});
        row("+X edge", {1, 0}, 0, 0, {40, 10}, {0.25, 0.25, 0.85, 0.75});
        row("-Y edge", {0, -1}, 0, 0, {40, -10}, {0.25, 0.2, 0.75, 0.75});
        row("-X+Y corner", {-1, 1}, 0, 0, {40, 10}, {0.35, 0.25, 0.75, 0.8});
        row("past the opposite edge: turned round", {-1, 0}, 0, 0, {240, 0}, {0.75, 0.25, 0.85, 0.75});
        row("locked corner: the larger growth", {1, 1}, 0, 1, {40, 10}, {0.25, 0.25, 0.85, 0.85});
        row("shift locks a corner", {1, 1}, Qt::ShiftModifier, 0, {40, 10}, {0.25, 0.25, 0.85, 0.85});
        row("locked edge: about the middle", {1, 0}, 0, 1, {40, 0}, {0.25, 0.2, 0.85, 0.8});
        row("locked Y edge", {0, 1}, 0, 1, {0, 20}, {0.2, 0.25, 0.8, 0.85});
    }
}

void CropControlTest::drag()
{
    QFETCH(double, zoom);
    QFETCH(double, pixelAspect);
    QFETCH(QPoint, grip);
    QFETCH(int, mods);
    QFETCH(double, lock);
    QFETCH(QPoint, move);
    QFETCH(Box, box);
    ViewerFixture f;
    const Box before{0.25, 0.25, 0.75, 0.75};
    AddCrop(f, {0.25, 0.25}, {0.5, 0.5}, lock);
    QVERIFY(f.Show());
    f.viewer.SetPixelAspect(pixelAspect);
    f.viewer.SetView(zoom);
    QApplication::processEvents();
    const QPoint from = f.At({0.5 + grip.x() * 0.25, 0.5 + grip.y() * 0.25});
    const QPoint by(int(std::lround(move.x() * zoom * pixelAspect)), -int(std::lround(move.y() * zoom)));
    {
        HeldKeys held(&f.viewer, Qt::KeyboardModifiers(mods));
        f.Drag(from, from + by, 4);
    }
    QVERIFY2(Same(Read(f), box), Describe(Read(f)));
    QCOMPARE(f.doc.UndoNames(), QStringList{"Adjust Crop"});
    QVERIFY(f.doc.Undo());
    QVERIFY2(Same(Read(f), before), Describe(Read(f)));
}

// A grey image: darker outside the box than inside it, and the box's edge
// lit; hovering an edge reports it.
void CropControlTest::outsideIsDarkened()
{
    ViewerFixture f;
    QImage grey(400, 200, QImage::Format_RGB32);
    grey.fill(QColor(128, 128, 128));
    f.viewer.SetImage(grey);
    Input *c = AddCrop(f, {0.25, 0.25}, {0.5, 0.5});
    QVERIFY(f.Show());
    const QImage shot = f.Grab();
    const int inside = qGray(shot.pixel(f.At({0.5, 0.5}))), outside = qGray(shot.pixel(f.At({0.1, 0.5})));
    QVERIFY2(inside >= 120 && outside < 80, qPrintable(QString("%1 %2").arg(inside).arg(outside)));
    QVERIFY(Lit(shot, f.At({0.5, 0.75})));
    f.Hover(f.At({0.5, 0.75}, QPoint(0, 3)));
    QCOMPARE(StateOf(f.OverlayOf(c), "hoverPart"), 2.0);
    f.Hover(f.At({0.75, 0.75}, QPoint(-2, 2)));
    QCOMPARE(StateOf(f.OverlayOf(c), "hoverPart"), 3.0);
    f.Hover(f.At({0.5, 0.5}));
    QCOMPARE(StateOf(f.OverlayOf(c), "hoverPart"), 16.0);
    f.Hover(f.At({0.1, 0.5}));
    QCOMPARE(StateOf(f.OverlayOf(c), "hoverPart"), 0.0);
}

void CropControlTest::badInput_data()
{
    const double nan = std::numeric_limits<double>::quiet_NaN();
    QTest::addColumn<OrbPoint>("corner");
    QTest::addColumn<OrbPoint>("size");
    QTest::newRow("zero-size box") << OrbPoint(0.5, 0.5) << OrbPoint(0, 0);
    QTest::newRow("zero height") << OrbPoint(0.2, 0.5) << OrbPoint(0.5, 0);
    QTest::newRow("corner not a number") << OrbPoint(nan, 0.5) << OrbPoint(0.5, 0.5);
    QTest::newRow("size huge") << OrbPoint(0.2, 0.2) << OrbPoint(1e12, 1e12);
}

// Hovering and dragging all over, with and without the lock held: no
// crash, and every value written a finite number.
void CropControlTest::badInput()
{
    QFETCH(OrbPoint, corner);
    QFETCH(OrbPoint, size);
    ViewerFixture f;
    AddCrop(f, corner, size, 1.0);
    QVERIFY(f.Show());
    SweepDrags(f);
    if (f.UndoSteps() > 0) {
        const Box now = Read(f);
        QVERIFY2(std::isfinite(now.l) && std::isfinite(now.b) && std::isfinite(now.r) && std::isfinite(now.t),
                 Describe(now));
    }
}

QTEST_MAIN(CropControlTest)
#include "CropControlTest.moc"
