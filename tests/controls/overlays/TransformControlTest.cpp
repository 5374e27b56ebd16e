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

constexpr Tag TC_YSizeInput = 0x10058002, TC_ShearInput = 0x10058004, TC_KeepAspect = 0x10058005;
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

struct Values
{
    OrbPoint center{0.5, 0.5};
    double angle = 0.0, xSize = 1.0, ySize = 1.0;
    OrbPoint pivot{0.5, 0.5};
    double shear = 0.0;
};

// A transform tool: Center (the overlay's main Input), then Angle, X Size,
// Y Size, Pivot and Shear, the roles' default order.
Input *AddTransform(ViewerFixture &f, const Values &v, const TagList &more = TagList())
{
    TagList attrs{{INPA_PreviewControl, OrbID("TransformControl")}};
    for (const char *id : {"Angle", "XSize", "YSize", "Pivot", "Shear"})
        attrs.Add(INPA_OverlayInput, OrbID(id));
    attrs.Append(more);
    Input *c = f.AddPoint("Center", v.center.x, v.center.y, attrs);
    for (auto [id, value] : {std::pair{"Angle", v.angle}, {"XSize", v.xSize}, {"YSize", v.ySize}, {"Shear", v.shear}})
        f.tool->AddInput(OrbID(id), id, CLSID_DataType_Number, TagList(), AutoNumber(value));
    f.AddPoint("Pivot", v.pivot.x, v.pivot.y);
    return c;
}

Values Read(const ViewerFixture &f)
{
    Values v;
    v.center = f.PointOf(f.tool->FindInput(OrbID("Center")));
    v.pivot = f.PointOf(f.tool->FindInput(OrbID("Pivot")));
    v.angle = NumberOf(f, "Angle");
    v.xSize = NumberOf(f, "XSize");
    v.ySize = NumberOf(f, "YSize");
    v.shear = NumberOf(f, "Shear");
    return v;
}

// Equal to far below what a viewer shows; a value that is no number equals
// the same non-number.
bool Close(double a, double b)
{
    return a == b || (std::isnan(a) && std::isnan(b)) || std::fabs(a - b) < 1e-9;
}

QByteArray Describe(const Values &v)
{
    QByteArray out;
    for (double n : {v.center.x, v.center.y, v.angle, v.xSize, v.ySize, v.pivot.x, v.pivot.y, v.shear})
        out += QByteArray::number(n, 'g', 12) + " ";
    return out;
}

bool Same(const Values &a, const Values &b)
{
    return Close(a.center.x, b.center.x) && Close(a.center.y, b.center.y) && Close(a.angle, b.angle) &&
           Close(a.xSize, b.xSize) && Close(a.ySize, b.ySize) && Close(a.pivot.x, b.pivot.x) &&
           Close(a.pivot.y, b.pivot.y) && Close(a.shear, b.shear);
}

// Handles, named by where they sit at angle 0 with the frame covering the
// image: offsets from the centre in viewer pixels for a view whose image
// spans `w` x `h` pixels.
enum Grip
{
    G_Center,
    G_PlusX,
    G_MinusY,
    G_Corner,
    G_Ring,
    G_Shear,
};

QPoint GripAt(Grip g, double w, double h)
{
    switch (g) {
    case G_Center:
        return {};
    case G_PlusX:
        return QPoint(int(std::lround(w / 2)), 0);
    case G_MinusY:
        return QPoint(0, -int(std::lround(h / 2)));
    case G_Corner:
        return QPoint(int(std::lround(w / 2)), int(std::lround(h / 2)));
    case G_Ring:
        return QPoint(70, 0);
    case G_Shear:
        return QPoint(0, int(std::lround(h / 2)) + 30);
    }
    return {};
}

} // namespace

Q_DECLARE_METATYPE(Grip)

class TransformControlTest : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase()
    {
        std::string why;
        QVERIFY2(ViewerFixture::LoadControls(&why), why.c_str());
    }

    void handles_data();
    void handles();
    void hoverHighlightsTheKnob();
    void nudges_data() { NudgeRows(); }
    void nudges() { CheckNudge(TagList{{INPA_PreviewControl, OrbID("TransformControl")}}, 200); }
    void badInput_data();
    void badInput();
    void missingRolesHaveNoHandles();
};

void TransformControlTest::handles_data()
{
    QTest::addColumn<double>("zoom");
    QTest::addColumn<double>("pixelAspect");
    QTest::addColumn<Grip>("grip");
    QTest::addColumn<int>("mods");
    QTest::addColumn<QPoint>("move"); // viewer pixels, Y up
    QTest::addColumn<QString>("undo");
    for (auto [zoom, aspect] : {std::pair{1.0, 1.0}, {0.75, 1.0}, {0.5, 2.0}}) {
        const QByteArray at = " at zoom " + QByteArray::number(zoom) + ", pixel aspect " + QByteArray::number(aspect);
        auto row = [&](const char *name, Grip g, int mods, QPoint move, const char *undo) {
            QTest::newRow(name + at) << zoom << aspect << g << mods << move << QString(undo);
        };
        row("centre moves", G_Center, Qt::NoModifier, {40, 20}, "Move Transform");
        row("ctrl on the centre moves the pivot", G_Center, Qt::ControlModifier, {40, 20}, "Move Pivot");
        row("+X side scales X", G_PlusX, Qt::NoModifier, {40, 0}, "Scale Transform");
        row("shift: both axes", G_PlusX, Qt::ShiftModifier, {40, 0}, "Scale Transform");
        row("ctrl: about the opposite side", G_PlusX, Qt::ControlModifier, {40, 0}, "Scale Transform");
        row("-Y side scales Y", G_MinusY, Qt::NoModifier, {0, -20}, "Scale Transform");
        row("corner scales both", G_Corner, Qt::NoModifier, {40, 20}, "Scale Transform");
        row("ring turns", G_Ring, Qt::NoModifier, {-70, 70}, "Rotate Transform");
        row("shear bar", G_Shear, Qt::NoModifier, {30, 0}, "Shear Transform");
    }
}

// Each handle dragged by `move`: the values it writes, worked out by hand
// from the frame on screen, one undo step that puts them all back.
void TransformControlTest::handles()
{
    QFETCH(double, zoom);
    QFETCH(double, pixelAspect);
    QFETCH(Grip, grip);
    QFETCH(int, mods);
    QFETCH(QPoint, move);
    QFETCH(QString, undo);
    ViewerFixture f;
    const Values before;
    AddTransform(f, before);
    QVERIFY(f.Show());
    f.viewer.SetPixelAspect(pixelAspect);
    f.viewer.SetView(zoom);
    QApplication::processEvents();
    const double w = 400 * zoom * pixelAspect, h = 200 * zoom; // the image on screen
    const QPoint from = f.At({0.5, 0.5}, GripAt(grip, w, h));
    {
        HeldKeys held(&f.viewer, Qt::KeyboardModifiers(mods));
        f.Drag(from, from + QPoint(move.x(), -move.y()), 4);
    }
    Values want = before;
    const bool ctrl = mods & Qt::ControlModifier;
    switch (grip) {
    case G_Center:
        want.center = {0.5 + move.x() / w, 0.5 + move.y() / h};
        if (ctrl)
            want.pivot = want.center;
        break;
    case G_PlusX:
        want.xSize = ctrl ? (w + move.x()) / w : (w / 2 + move.x()) / (w / 2);
        if (mods & Qt::ShiftModifier)
            want.ySize = want.xSize;
        if (ctrl)
            want.center.x += move.x() / 2 / w;
        break;
    case G_MinusY:
        want.ySize = (h / 2 - move.y()) / (h / 2);
        break;
    case G_Corner:
        want.xSize = (w / 2 + move.x()) / (w / 2);
        want.ySize = (h / 2 + move.y()) / (h / 2);
        break;
    case G_Ring:
        want.angle = 90;
        break;
    case G_Shear:
        want.shear = move.x() / (h / 2 + 30.0);
        break;
    }
    const Values got = Read(f);
    QVERIFY2(Same(got, want), Describe(got) + "wanted " + Describe(want));
    QCOMPARE(f.doc.UndoNames(), QStringList{undo});
    QVERIFY(f.doc.Undo());
    QVERIFY2(Same(Read(f), before), Describe(Read(f)));
}

// The knob under the mouse is reported and drawn highlighted; moving on
// within it repaints nothing.
void TransformControlTest::hoverHighlightsTheKnob()
{
    ViewerFixture f;
    Input *c = AddTransform(f, Values());
    QVERIFY(f.Show());
    const QPoint knob = f.At({0.5, 0.5}, QPoint(200, 0));
    const QImage plain = f.Grab();
    f.Hover(knob);
    QCOMPARE(StateOf(f.OverlayOf(c), "hoverPart"), 16.0);
    QApplication::processEvents();
    const int painted = f.viewer.PaintCount();
    f.Hover(knob + QPoint(0, 1));
    QApplication::processEvents();
    QCOMPARE(f.viewer.PaintCount(), painted);
    const QImage hot = f.Grab();
    const QPoint edge = knob + QPoint(-4, 0);
    QVERIFY(qRed(hot.pixel(edge)) > 200 && qBlue(hot.pixel(edge)) < 120);
    QVERIFY(qBlue(plain.pixel(edge)) > 150);
    f.Hover(f.At({0.5, 0.5}, QPoint(120, 40)));
    QCOMPARE(StateOf(f.OverlayOf(c), "hoverPart"), 0.0);
}

void TransformControlTest::badInput_data()
{
    QTest::addColumn<double>("cx");
    QTest::addColumn<double>("size");
    QTest::addColumn<double>("angle");
    QTest::addColumn<double>("shear");
    const double inf = std::numeric_limits<double>::infinity();
    QTest::newRow("centre not a number") << kNaN << 1.0 << 0.0 << 0.0;
    QTest::newRow("size 0: a flat layer") << 0.5 << 0.0 << 0.0 << 0.0;
    QTest::newRow("size not a number") << 0.5 << kNaN << 0.0 << 0.0;
    QTest::newRow("angle infinite") << 0.5 << 1.0 << inf << 0.0;
    QTest::newRow("shear huge") << 0.5 << 1.0 << 30.0 << 1e12;
    QTest::newRow("centre far away") << 1e9 << 1.0 << 0.0 << 0.0;
}

// Hovering, pressing and dragging all over a broken transform: no crash,
// and nothing but finite numbers written.
void TransformControlTest::badInput()
{
    QFETCH(double, cx);
    QFETCH(double, size);
    QFETCH(double, angle);
    QFETCH(double, shear);
    ViewerFixture f;
    Values v;
    v.center.x = cx;
    v.xSize = v.ySize = size;
    v.angle = angle;
    v.shear = shear;
    AddTransform(f, v);
    QVERIFY(f.Show());
    SweepDrags(f);
    const Values now = Read(f);
    const double was[] = {v.center.x, v.center.y, v.angle, v.xSize, v.ySize, v.shear};
    const double got[] = {now.center.x, now.center.y, now.angle, now.xSize, now.ySize, now.shear};
    for (int i = 0; i < 6; ++i)
        QVERIFY2(std::isfinite(got[i]) || Close(got[i], was[i]), Describe(now));
    while (f.doc.CanUndo())
        QVERIFY(f.doc.Undo());
    QVERIFY2(Same(Read(f), v), Describe(Read(f)));
}

// Without a Y size the X size scales both axes; a role named twice goes to
// the first; without roles there is nothing to grab but the centre.
void TransformControlTest::missingRolesHaveNoHandles()
{
    ViewerFixture f;
    Input *c = AddTransform(f, Values(), TagList{{TC_YSizeInput, -1}, {TC_KeepAspect, false}});
    QVERIFY(f.Show());
    const QPoint top = f.At({0.5, 0.5}, QPoint(0, 100));
    f.Drag(top, top + QPoint(0, -50), 4);
    QCOMPARE(NumberOf(f, "XSize"), 1.5);
    QCOMPARE(NumberOf(f, "YSize"), 1.0);
    QCOMPARE(StateOf(f.OverlayOf(c), "sizeY"), 1.5);

    // The shear named on the angle's Input: the angle keeps it, and the
    // shear (no Input of its own) has no bar.
    ViewerFixture twice;
    Values turned;
    turned.angle = 30;
    Input *t = AddTransform(twice, turned, TagList{{TC_ShearInput, 1}});
    QVERIFY(twice.Show());
    QCOMPARE(StateOf(twice.OverlayOf(t), "angle"), 30.0);
    QCOMPARE(StateOf(twice.OverlayOf(t), "shear"), 0.0);
    const OrbPoint bar(-std::sin(M_PI / 6) * 130, std::cos(M_PI / 6) * 130);
    twice.Hover(twice.At({0.5, 0.5}, QPoint(int(std::lround(bar.x)), int(std::lround(bar.y)))));
    QCOMPARE(StateOf(twice.OverlayOf(t), "hoverPart"), 0.0);

    ViewerFixture bare;
    Input *alone = bare.AddPoint("Center", 0.5, 0.5, TagList{{INPA_PreviewControl, OrbID("TransformControl")}});
    QVERIFY(bare.Show());
    bare.Hover(bare.At({0.5, 0.5}, QPoint(200, 0)));
    QCOMPARE(StateOf(bare.OverlayOf(alone), "hoverPart"), 0.0);
    bare.Hover(bare.At({0.5, 0.5}, QPoint(70, 0)));
    QCOMPARE(StateOf(bare.OverlayOf(alone), "hoverPart"), 0.0);
    bare.Hover(bare.At({0.5, 0.5}, QPoint(3, 0)));
    QCOMPARE(StateOf(bare.OverlayOf(alone), "hoverPart"), 1.0);
}

QTEST_MAIN(TransformControlTest)
#include "TransformControlTest.moc"
