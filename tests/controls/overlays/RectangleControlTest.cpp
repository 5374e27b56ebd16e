#include "OverlayProbe.h"
#include "ViewerFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/ControlCommands.h"
#include "orbane/ImageParam.h"
#include "orbane/Input.h"
#include "orbane/ScriptVal.h"

#include <QtTest>

#include <cmath>
#include <limits>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

constexpr Tag RC_PenStyle = 0x10058000, RCD_SetAngle = 0x20058002, RCD_LockAspect = 0x20058003;
constexpr Tag RCD_SetSize = 0x20058007, RCD_SetAxisX = 0x20058008, RCD_SetAxisY = 0x20058009;
constexpr Tag RCID_Center = 0x80058000, RCID_FlipX = 0x80058005, RCP_FlipX = 0x60058005;
constexpr Tag RC_BlendMode = 0x10058002, RCD_BlendAmount = 0x20058004, RCP_Image = 0x60058002;
constexpr double kImageWidth = 400; // the fixture's image

// A tool with Width (the rectangle's main Input) and Height (its index 1).
Input *AddRectangle(ViewerFixture &f, double width, double height, const TagList &more = TagList())
{
    TagList attrs{{INPA_PreviewControl, OrbID("RectangleControl")}, {INPA_OverlayInput, OrbID("Height")}};
    attrs.Append(more);
    Input *w = f.tool->AddInput(OrbID("Width"), "Width", CLSID_DataType_Number, attrs, AutoNumber(width));
    f.tool->AddInput(OrbID("Height"), "Height", CLSID_DataType_Number, TagList(), AutoNumber(height));
    return w;
}

// Where the rectangle has the point (u, v) (-1..1 across each half side)
// pushed `out` viewer pixels outward along each named side, for a shape
// turned by `angle` about the image centre with its pivot at `axis`.
struct Placement
{
    double width, height, angle = 0.0, size = 1.0;
    OrbPoint axis{0.5, 0.5};
};

QPoint ScreenOf(const ViewerFixture &f, const Placement &r, int u, int v, double out)
{
    const ViewMapping &m = f.viewer.Mapping();
    const double px = kImageWidth * m.PixelAspect() * m.Zoom() * r.size; // viewer pixels per image width
    const OrbPoint half(r.width * px / 2, r.height * px / 2);
    const OrbPoint middle((0.5 - r.axis.x) * 2 * half.x, (0.5 - r.axis.y) * 2 * half.y);
    const double lx = middle.x + u * (half.x + out), ly = middle.y + v * (half.y + out);
    const double a = r.angle * M_PI / 180.0;
    const OrbPoint c = m.ToViewer({0.5, 0.5});
    const OrbPoint at(c.x + lx * std::cos(a) - ly * std::sin(a), c.y + lx * std::sin(a) + ly * std::cos(a));
    const OrbPoint w = m.ViewerToWidget(at);
    return QPoint(int(std::lround(w.x)), int(std::lround(w.y)));
}

int PartCode(int u, int v)
{
    return (u > 0 ? 1 : u < 0 ? 4 : 0) | (v > 0 ? 2 : v < 0 ? 8 : 0);
}

// Does a pixel within one row or column of `at` pass `test`? (`across`: 0
// looks along the column only.)
template <class Test> bool Near(const QImage &image, QPoint at, Test test, int across = 1)
{
    for (int dy = -1; dy <= 1; ++dy)
        for (int dx = -across; dx <= across; ++dx)
            if (image.rect().contains(at + QPoint(dx, dy)) && test(image.pixel(at + QPoint(dx, dy))))
                return true;
    return false;
}

TagList PlacementTags(const Placement &r)
{
    return TagList{{RCD_SetAngle, r.angle}, {RCD_SetSize, r.size}, {RCD_SetAxisX, r.axis.x}, {RCD_SetAxisY, r.axis.y}};
}

} // namespace

class RectangleControlTest : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase();

    void partGrid_data();
    void partGrid();
    void drag_data();
    void drag();
    void badInput_data();
    void badInput();
    void flipAttachesByPointerOnly_data();
    void flipAttachesByPointerOnly();
    void grabOffsetInFrameUnits_data();
    void grabOffsetInFrameUnits();
    void hoverHighlightsAndRepaintsOnChange();
    void hoverBoundsHoldTheNextDraw();
    void penStyle_data();
    void penStyle();
    void followsItsCentreAsLinkedDrag();
    void blendAmountAloneDoesNotRefresh();
};

void RectangleControlTest::initTestCase()
{
    std::string why;
    QVERIFY2(ViewerFixture::LoadControls(&why), why.c_str());
}

void RectangleControlTest::partGrid_data()
{
    QTest::addColumn<double>("zoom");
    QTest::addColumn<double>("pixelAspect");
    QTest::addColumn<double>("angle");
    QTest::newRow("zoom 1, upright") << 1.0 << 1.0 << 0.0;
    QTest::newRow("zoom 1, turned 30") << 1.0 << 1.0 << 30.0;
    QTest::newRow("zoom 2, turned -120") << 2.0 << 1.0 << -120.0;
    QTest::newRow("zoom 0.5, wide pixels, turned 30") << 0.5 << 2.0 << 30.0;
    QTest::newRow("zoom 1, wide pixels, turned 90") << 1.0 << 2.0 << 90.0;
}

// Each part within the tolerance on both sides of its line, nothing past it,
// at any zoom, pixel aspect and angle: the tolerance stays in screen pixels.
void RectangleControlTest::partGrid()
{
    QFETCH(double, zoom);
    QFETCH(double, pixelAspect);
    QFETCH(double, angle);
    ViewerFixture f;
    Placement r{0.2, 0.1, angle};
    Input *w = AddRectangle(f, r.width, r.height, PlacementTags(r));
    QVERIFY(f.Show());
    f.viewer.SetPixelAspect(pixelAspect);
    f.viewer.SetView(zoom);
    PreviewControl *rect = f.OverlayOf(w);
    const int t = f.viewer.Info().PickTolerance;
    for (int u = -1; u <= 1; ++u)
        for (int v = -1; v <= 1; ++v) {
            const QByteArray where = QByteArray::number(u) + ", " + QByteArray::number(v);
            for (double out : {-3.0, 3.0}) {
                f.Hover(ScreenOf(f, r, u, v, out));
                QVERIFY2(StateOf(rect, "hoverPart") == PartCode(u, v), where.constData());
                QCOMPARE(StateOf(rect, "highlight"), double(PartCode(u, v) != 0));
                const uint64 inputAt = rect->ControlCommand(&f.viewer.Info(), CCMD_GetInputAt, 0, nullptr);
                QCOMPARE(inputAt, PartCode(u, v) ? uint64(reinterpret_cast<uintptr_t>(w)) : 0u);
            }
            f.Hover(ScreenOf(f, r, u, v, t + 3));
            QVERIFY2(StateOf(rect, "hoverPart") == 0, where.constData());
        }
}

void RectangleControlTest::drag_data()
{
    QTest::addColumn<OrbPoint>("axis");
    QTest::addColumn<double>("size");
    QTest::addColumn<double>("angle");
    QTest::addColumn<double>("lock"); // 0: unlocked
    QTest::addColumn<int>("u");
    QTest::addColumn<int>("v");
    QTest::addColumn<QPoint>("move"); // viewer pixels, Y up
    QTest::addColumn<double>("width");
    QTest::addColumn<double>("height");
    QTest::addColumn<QString>("undo");
    const OrbPoint mid(0.5, 0.5);
    const QString adjust = "Adjust Rectangle", change = "Change Width";
    // Width 0.5 and height 0.25 of the 400-pixel image at zoom 1: 200 x 100.
    QTest::newRow("+X edge, pivot in the middle")
        << mid << 1.0 << 0.0 << 0.0 << 1 << 0 << QPoint(40, 0) << 0.7 << 0.25 << adjust;
    QTest::newRow("+X edge, pivot at the -X side")
        << OrbPoint(0, 0.5) << 1.0 << 0.0 << 0.0 << 1 << 0 << QPoint(40, 0) << 0.6 << 0.25 << adjust;
    QTest::newRow("-X edge, pivot at the +X-Y corner")
        << OrbPoint(1, 0) << 1.0 << 0.0 << 0.0 << -1 << 0 << QPoint(-40, 9) << 0.6 << 0.25 << adjust;
    QTest::newRow("+X edge, pivot outside")
        << OrbPoint(2, 0.5) << 1.0 << 0.0 << 0.0 << 1 << 0 << QPoint(40, 0) << 0.4 << 0.25 << adjust;
    QTest::newRow("-X edge, pivot outside")
        << OrbPoint(2, 0.5) << 1.0 << 0.0 << 0.0 << -1 << 0 << QPoint(-40, 0) << 0.55 << 0.25 << adjust;
    QTest::newRow("corner, pivot in the middle")
        << mid << 1.0 << 0.0 << 0.0 << 1 << 1 << QPoint(40, 20) << 0.7 << 0.35 << adjust;
    QTest::newRow("-Y edge at size 2") << mid << 2.0 << 0.0 << 0.0 << 0 << -1 << QPoint(0, -20) << 0.5 << 0.3 << adjust;
    QTest::newRow("+X edge turned 90 is on top")
        << mid << 1.0 << 90.0 << 0.0 << 1 << 0 << QPoint(0, 40) << 0.7 << 0.25 << adjust;
    QTest::newRow("size 0 writes as if 1")
        << mid << 0.0 << 0.0 << 0.0 << 1 << 1 << QPoint(40, 20) << 0.2 << 0.1 << adjust;
    QTest::newRow("locked: an edge writes both")
        << mid << 1.0 << 0.0 << 2.0 << 1 << 0 << QPoint(40, 0) << 0.7 << 0.35 << change;
    QTest::newRow("locked: a Y edge sets the width")
        << mid << 1.0 << 0.0 << 2.0 << 0 << 1 << QPoint(0, 20) << 0.7 << 0.35 << change;
    QTest::newRow("locked: drawn values, size not divided out")
        << mid << 2.0 << 0.0 << 2.0 << 1 << 0 << QPoint(40, 0) << 1.2 << 0.6 << change;
}

void RectangleControlTest::drag()
{
    QFETCH(OrbPoint, axis);
    QFETCH(double, size);
    QFETCH(double, angle);
    QFETCH(double, lock);
    QFETCH(int, u);
    QFETCH(int, v);
    QFETCH(QPoint, move);
    QFETCH(double, width);
    QFETCH(double, height);
    QFETCH(QString, undo);
    ViewerFixture f;
    Placement r{0.5, 0.25, angle, size, axis};
    TagList tags = PlacementTags(r);
    if (lock)
        tags.Add(RCD_LockAspect, lock);
    Input *w = AddRectangle(f, r.width, r.height, tags);
    QVERIFY(f.Show());
    const QPoint from = ScreenOf(f, r, u, v, 0);
    f.Drag(from, from + QPoint(move.x(), -move.y()), 4);
    QCOMPARE(StateOf(f.OverlayOf(w), "lastPart"), double(PartCode(u, v)));
    QVERIFY2(std::fabs(NumberOf(f, "Width") - width) < 1e-9, qPrintable(QString::number(NumberOf(f, "Width"))));
    QVERIFY2(std::fabs(NumberOf(f, "Height") - height) < 1e-9, qPrintable(QString::number(NumberOf(f, "Height"))));
    QCOMPARE(f.doc.UndoNames(), QStringList{undo});
    QVERIFY(f.doc.Undo());
    QCOMPARE(NumberOf(f, "Width"), 0.5);
    QCOMPARE(NumberOf(f, "Height"), 0.25);
}

void RectangleControlTest::badInput_data()
{
    const double nan = std::numeric_limits<double>::quiet_NaN(), inf = std::numeric_limits<double>::infinity();
    QTest::addColumn<double>("width");
    QTest::addColumn<double>("height");
    QTest::addColumn<double>("size");
    QTest::addColumn<double>("axisX");
    QTest::addColumn<double>("angle");
    QTest::newRow("width not a number") << nan << 0.25 << 1.0 << 0.5 << 0.0;
    QTest::newRow("height infinite") << 0.5 << inf << 1.0 << 0.5 << 0.0;
    QTest::newRow("zero width") << 0.0 << 0.25 << 1.0 << 0.5 << 0.0;
    QTest::newRow("zero width and height") << 0.0 << 0.0 << 1.0 << 0.5 << 0.0;
    QTest::newRow("size 0") << 0.5 << 0.25 << 0.0 << 0.5 << 0.0;
    QTest::newRow("size not a number") << 0.5 << 0.25 << nan << 0.5 << 0.0;
    QTest::newRow("pivot far outside") << 0.5 << 0.25 << 1.0 << 1e9 << 30.0;
    QTest::newRow("angle infinite") << 0.5 << 0.25 << 1.0 << 0.5 << -inf;
}

// Hovering, pressing and dragging all over a broken rectangle: no crash, and
// nothing but finite numbers written.
void RectangleControlTest::badInput()
{
    QFETCH(double, width);
    QFETCH(double, height);
    QFETCH(double, size);
    QFETCH(double, axisX);
    QFETCH(double, angle);
    ViewerFixture f;
    AddRectangle(f, width, height, TagList{{RCD_SetSize, size}, {RCD_SetAxisX, axisX}, {RCD_SetAngle, angle}});
    QVERIFY(f.Show());
    f.Grab();
    for (int x = 50; x < ViewerFixture::kViewWidth; x += 50)
        for (int y = 25; y < ViewerFixture::kViewHeight; y += 50) {
            f.Hover(QPoint(x, y));
            f.Drag(QPoint(x, y), QPoint(x + 23, y - 17), 2);
        }
    f.Grab();
    for (auto [id, was] : {std::pair{"Width", width}, {"Height", height}}) {
        const double now = NumberOf(f, id);
        QVERIFY2(std::isfinite(now) || (std::isnan(was) && std::isnan(now)) || now == was, id);
    }
}

void RectangleControlTest::flipAttachesByPointerOnly_data()
{
    QTest::addColumn<bool>("byPointer");
    QTest::newRow("by pointer: flipped") << true;
    QTest::newRow("by id: no effect") << false;
}

// With the pivot on the -X side the rectangle lies right of the centre;
// flipped, it lies left of it, its +X edge leftmost.
void RectangleControlTest::flipAttachesByPointerOnly()
{
    QFETCH(bool, byPointer);
    ViewerFixture f;
    Input *flip = f.tool->AddInput(OrbID("Flip"), "Flip", CLSID_DataType_Number, TagList(), AutoNumber(1.0));
    TagList tags{{RCD_SetAxisX, 0.0}};
    if (byPointer)
        tags.Add(RCP_FlipX, static_cast<void *>(static_cast<ScriptObject *>(flip)));
    else
        tags.Add(RCID_FlipX, OrbID("Flip"));
    Input *w = AddRectangle(f, 0.5, 0.25, tags);
    QVERIFY(f.Show());
    f.Hover(f.At({0.5, 0.5}, QPoint(-200, 0)));
    QCOMPARE(StateOf(f.OverlayOf(w), "hoverPart"), byPointer ? 1.0 : 0.0);
    f.Hover(f.At({0.5, 0.5}, QPoint(200, 0)));
    QCOMPARE(StateOf(f.OverlayOf(w), "hoverPart"), byPointer ? 0.0 : 1.0);
}

void RectangleControlTest::grabOffsetInFrameUnits_data()
{
    QTest::addColumn<double>("zoom");
    QTest::addColumn<bool>("hit");
    QTest::newRow("zoom 1: pixels") << 1.0 << true;
    QTest::newRow("zoom 2: image pixels") << 2.0 << true;
    QTest::newRow("a miss measures to the last part") << 1.0 << false;
}

// 3 screen pixels inside the +X edge: the edge is 3 / zoom frame units on;
// a press that hits nothing measures to the last part grabbed (+X-Y at first).
void RectangleControlTest::grabOffsetInFrameUnits()
{
    QFETCH(double, zoom);
    QFETCH(bool, hit);
    ViewerFixture f;
    Input *w = AddRectangle(f, 0.2, 0.1);
    QVERIFY(f.Show());
    f.viewer.SetView(zoom);
    const Placement r{0.2, 0.1};
    const QPoint at = hit ? ScreenOf(f, r, 1, 0, -3) : ScreenOf(f, r, 0, 0, 0);
    f.Press(at);
    PreviewControl *rect = f.OverlayOf(w);
    double gx = 0, gy = 0;
    rect->CopyAttr(PCA_GrabOffsetX, &gx);
    rect->CopyAttr(PCA_GrabOffsetY, &gy);
    f.Release(at);
    const double halfX = 0.2 * kImageWidth / 2, halfY = 0.1 * kImageWidth / 2; // frame units
    QCOMPARE(gx, hit ? 3 / zoom : halfX);
    QCOMPARE(gy, hit ? 0.0 : -halfY);
    QCOMPARE(StateOf(rect, "grabOffsetX"), gx);
    QCOMPARE(StateOf(rect, "dragPart"), 1.0);
    QCOMPARE(StateOf(rect, "lastPart"), hit ? 1.0 : 9.0);
}

// The hovered edge is drawn in the highlight colour; hovering along the same
// edge asks for no redraw.
void RectangleControlTest::hoverHighlightsAndRepaintsOnChange()
{
    ViewerFixture f;
    AddRectangle(f, 0.5, 0.25);
    QVERIFY(f.Show());
    const QPoint edge = f.At({0.5, 0.5}, QPoint(100, 0));
    const QImage plain = f.Grab();
    QVERIFY(Near(plain, edge, [](QRgb c) { return qBlue(c) > 150; }));
    f.Hover(edge + QPoint(2, 0));
    QApplication::processEvents();
    const int painted = f.viewer.PaintCount();
    f.Hover(edge + QPoint(2, 5));
    QApplication::processEvents();
    QCOMPARE(f.viewer.PaintCount(), painted);
    const QImage hot = f.Grab();
    QVERIFY(Near(hot, edge, [](QRgb c) { return qRed(c) > 200 && qBlue(c) < 120; }));
    // The edge opposite keeps its colour.
    QVERIFY(Near(hot, f.At({0.5, 0.5}, QPoint(-100, 0)), [](QRgb c) { return qBlue(c) > 150; }));
}

// The viewer takes a rectangle's hover bounds when a new value asks for a
// redraw. A hover before that draw meets the sides where they were drawn;
// after it, the sides where the value put them are found, also by a hover
// that only the viewer's index would pass on.
void RectangleControlTest::hoverBoundsHoldTheNextDraw()
{
    ViewerFixture f;
    Input *w = AddRectangle(f, 0.25, 0.25);
    QVERIFY(f.Show());
    f.Grab();
    w->SetValue(AutoNumber(0.5).get(), f.doc.GetCurrentTime());
    f.Hover(f.At({0.5, 0.5}, QPoint(50, 0)));
    QCOMPARE(StateOf(f.OverlayOf(w), "hoverPart"), 1.0);
    f.Grab();
    f.Hover(f.At({0.5, 0.5}));
    f.Hover(f.At({0.5, 0.5}, QPoint(1, 0)));
    f.Hover(f.At({0.5, 0.5}, QPoint(100, 0)));
    QCOMPARE(StateOf(f.OverlayOf(w), "hoverPart"), 1.0);
}

void RectangleControlTest::penStyle_data()
{
    QTest::addColumn<int>("style");
    QTest::addColumn<double>("least");
    QTest::addColumn<double>("most");
    QTest::newRow("0: solid") << 0 << 0.95 << 1.0;
    QTest::newRow("1: 0xf0f0, half") << 1 << 0.35 << 0.65;
    QTest::newRow("3: 0xf060, six of sixteen") << 3 << 0.2 << 0.5;
}

// The share of lit pixels along the bottom edge.
void RectangleControlTest::penStyle()
{
    QFETCH(int, style);
    QFETCH(double, least);
    QFETCH(double, most);
    ViewerFixture f;
    AddRectangle(f, 0.5, 0.25, TagList{{RC_PenStyle, style}});
    QVERIFY(f.Show());
    const QImage image = f.Grab();
    int lit = 0, all = 0;
    for (int x = -60; x <= 60; ++x, ++all) {
        const QPoint at = f.At({0.5, 0.5}, QPoint(x, -50));
        lit += Near(
            image, at, [](QRgb c) { return qGray(c) > 60; }, 0);
    }
    const double share = double(lit) / all;
    QVERIFY2(share >= least && share <= most, qPrintable(QString::number(share)));
}

// A crosshair on the centre Input is pressed: the rectangle joins as a
// linked drag, and is found at the new centre afterwards.
void RectangleControlTest::followsItsCentreAsLinkedDrag()
{
    ViewerFixture f;
    Input *w = AddRectangle(f, 0.5, 0.25, TagList{{RCID_Center, OrbID("Center")}});
    f.AddPoint("Center", 0.5, 0.5, TagList{{INPA_PreviewControl, OrbID("CrosshairControl")}});
    QVERIFY(f.Show());
    const QPoint centre = f.At({0.5, 0.5});
    f.Press(centre);
    QCOMPARE(StateOf(f.OverlayOf(w), "dragType"), double(DRAG_Linked));
    f.Move(centre + QPoint(40, 0));
    f.Release(centre + QPoint(40, 0));
    QCOMPARE(StateOf(f.OverlayOf(w), "dragType"), 0.0);
    f.Grab();
    f.Hover(f.At({0.5, 0.5}, QPoint(140, 0)));
    QCOMPARE(StateOf(f.OverlayOf(w), "hoverPart"), 1.0);
    QCOMPARE(NumberOf(f, "Width"), 0.5);
}

// A white image inside, over the black backdrop: at full amount it shows
// white; a new amount alone is not taken until the mode changes too.
void RectangleControlTest::blendAmountAloneDoesNotRefresh()
{
    ViewerFixture f;
    QImage white(8, 8, QImage::Format_RGB32);
    white.fill(Qt::white);
    Input *image = f.tool->AddInput(OrbID("Inset"), "Inset", CLSID_DataType_Image, TagList(),
                                    AutoRef<ImageParam>(new ImageParam("white", white)).get());
    Input *w = AddRectangle(f, 0.5, 0.25,
                            TagList{{RCP_Image, static_cast<void *>(static_cast<ScriptObject *>(image))},
                                    {RC_BlendMode, 0},
                                    {RCD_BlendAmount, 1.0}});
    QVERIFY(f.Show());
    const QPoint inside = f.At({0.5, 0.5}, QPoint(30, 20));
    QCOMPARE(qGray(f.Grab().pixel(inside)), 255);
    f.OverlayOf(w)->SetAttrsTagList(TagList{{RCD_BlendAmount, 0.2}});
    QCOMPARE(qGray(f.Grab().pixel(inside)), 255);
    // Screen at a fifth: a dark grey over black.
    f.OverlayOf(w)->SetAttrsTagList(TagList{{RC_BlendMode, 2}});
    const int grey = qGray(f.Grab().pixel(inside));
    QVERIFY2(grey > 20 && grey < 80, qPrintable(QString::number(grey)));
    // Without the image nothing is drawn inside.
    f.OverlayOf(w)->RemoveInput(image, nullptr);
    QCOMPARE(qGray(f.Grab().pixel(inside)), 0);
}

QTEST_MAIN(RectangleControlTest)
#include "RectangleControlTest.moc"
