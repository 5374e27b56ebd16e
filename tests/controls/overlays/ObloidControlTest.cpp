#include "OverlayProbe.h"
#include "ViewerFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/ScriptValParam.h"
#include "orbane/ViewCamera.h"

#include <QtTest>

#include <cmath>
#include <limits>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

constexpr Tag OBC_KeysDepth = 0x10058013, OBC_AxisMove = 0x10058011, OBCID_Camera = 0x80058003;
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
// The default view's distance from the image plane, in image widths.
constexpr double kD = 50.0 / 36.0;

struct Box
{
    OrbVec3 center;
    OrbVec3 size{0.5, 0.5, 0.5};
    double rotY = 0.0;
};

// A cube tool: Center (the overlay's main Input, X, Y and Z), then the
// three sizes and three turns, the roles' default order.
Input *AddBox(ViewerFixture &f, const Box &b, const TagList &more = TagList())
{
    TagList attrs{{INPA_PreviewControl, OrbID("CubeControl")}};
    for (const char *id : {"SizeX", "SizeY", "SizeZ", "RotX", "RotY", "RotZ"})
        attrs.Add(INPA_OverlayInput, OrbID(id));
    attrs.Append(more);
    Input *c = f.tool->AddInput(OrbID("Center"), "Center", CLSID_DataType_Point, attrs,
                                AutoPoint(b.center.x, b.center.y, b.center.z));
    for (auto [id, value] : {std::pair{"SizeX", b.size.x},
                             {"SizeY", b.size.y},
                             {"SizeZ", b.size.z},
                             {"RotX", 0.0},
                             {"RotY", b.rotY},
                             {"RotZ", 0.0}})
        f.tool->AddInput(OrbID(id), id, CLSID_DataType_Number, TagList(), AutoNumber(value));
    return c;
}

OrbVec3 CenterOf(const ViewerFixture &f)
{
    const AutoPoint p(f.tool->FindInput(OrbID("Center")), f.doc.GetCurrentTime());
    return p ? OrbVec3(p->X, p->Y, p->Z) : OrbVec3(-1, -1, -1);
}

Box Read(const ViewerFixture &f, double rotY = 0.0)
{
    return Box{CenterOf(f), {NumberOf(f, "SizeX"), NumberOf(f, "SizeY"), NumberOf(f, "SizeZ")}, rotY};
}

QByteArray Describe(const Box &b)
{
    QByteArray out;
    for (double n : {b.center.x, b.center.y, b.center.z, b.size.x, b.size.y, b.size.z})
        out += QByteArray::number(n, 'g', 12) + " ";
    return out;
}

bool Same(const Box &a, const Box &b)
{
    return (a.center - b.center).Length() < 1e-9 && (a.size - b.size).Length() < 1e-9;
}

// The default view's image point of a world point.
OrbPoint ImageOf(OrbVec3 w)
{
    const double k = kD / (kD - w.z);
    return {0.5 + w.x * k, 0.5 + 2.0 * w.y * k};
}

enum Grip
{
    G_Center,
    G_PlusX,
    G_MinusX,
    G_PlusY,
    G_TurnedPlusZ, // the +Z face of a box turned a quarter about Y lies at +X
};

} // namespace

Q_DECLARE_METATYPE(Grip)

class ObloidControlTest : public QObject
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
    void hoverHighlightsTheFace();
    void nudges_data();
    void nudges();
    void badInput_data();
    void badInput();
    void cameraInputTakesOver();
};

void ObloidControlTest::handles_data()
{
    QTest::addColumn<double>("zoom");
    QTest::addColumn<double>("depth"); // the box's centre Z
    QTest::addColumn<Grip>("grip");
    QTest::addColumn<int>("mods");
    QTest::addColumn<QPoint>("move"); // viewer pixels, Y up
    QTest::addColumn<QString>("undo");
    for (const double zoom : {1.0, 0.5})
        for (const double depth : {0.0, -kD}) {
            const QByteArray at = " at zoom " + QByteArray::number(zoom) + ", depth " + QByteArray::number(depth);
            auto row = [&](const char *name, Grip g, int mods, QPoint move, const char *undo) {
                QTest::newRow(name + at) << zoom << depth << g << mods << move << QString(undo);
            };
            row("centre moves in the view's plane", G_Center, Qt::NoModifier, {40, 20}, "Move Box");
            row("+X face moves its side", G_PlusX, Qt::NoModifier, {40, 0}, "Resize Box");
            row("-X face moves its side", G_MinusX, Qt::NoModifier, {-30, 0}, "Resize Box");
            row("ctrl: both sides", G_PlusX, Qt::ControlModifier, {40, 0}, "Resize Box");
            row("shift: every size alike", G_PlusX, Qt::ShiftModifier, {40, 0}, "Resize Box");
            row("+Y face", G_PlusY, Qt::NoModifier, {0, 20}, "Resize Box");
            row("a turned box's +Z face", G_TurnedPlusZ, Qt::NoModifier, {40, 0}, "Resize Box");
        }
}

// Each handle dragged by `move`: the values it writes, worked out by hand
// from the pinhole (at depth z the world spans (d - z) / d times as much per
// pixel), one undo step that puts them all back.
void ObloidControlTest::handles()
{
    QFETCH(double, zoom);
    QFETCH(double, depth);
    QFETCH(Grip, grip);
    QFETCH(int, mods);
    QFETCH(QPoint, move);
    QFETCH(QString, undo);
    ViewerFixture f;
    Box before;
    before.center = OrbVec3(0.0, 0.0, depth);
    before.rotY = grip == G_TurnedPlusZ ? 90.0 : 0.0;
    AddBox(f, before);
    QVERIFY(f.Show());
    f.viewer.SetView(zoom);
    QApplication::processEvents();
    const OrbVec3 knobs[] = {{0, 0, 0}, {0.25, 0, 0}, {-0.25, 0, 0}, {0, 0.25, 0}, {0.25, 0, 0}};
    const QPoint from = f.At(ImageOf(before.center + knobs[grip]));
    {
        HeldKeys held(&f.viewer, Qt::KeyboardModifiers(mods));
        f.Drag(from, from + QPoint(move.x(), -move.y()), 4);
    }
    // World units per viewer pixel at the box's depth: across, and up (an
    // image height is half a width here).
    const double perPixel = (kD - depth) / kD / (400.0 * zoom);
    const double dx = move.x() * perPixel, dy = move.y() * perPixel;
    Box want = before;
    switch (grip) {
    case G_Center:
        want.center = before.center + OrbVec3(dx, dy, 0);
        break;
    case G_PlusX:
    case G_MinusX: {
        const double side = grip == G_PlusX ? 1.0 : -1.0;
        const bool ctrl = mods & Qt::ControlModifier;
        want.size.x = 0.5 + side * dx * (ctrl ? 2.0 : 1.0);
        if (mods & Qt::ShiftModifier)
            want.size.y = want.size.z = want.size.x;
        if (!ctrl)
            want.center.x += dx / 2;
        break;
    }
    case G_PlusY:
        want.size.y = 0.5 + dy;
        want.center.y += dy / 2;
        break;
    case G_TurnedPlusZ:
        want.size.z = 0.5 + dx;
        want.center.x += dx / 2;
        break;
    }
    const Box got = Read(f, before.rotY);
    QVERIFY2(Same(got, want), Describe(got) + "wanted " + Describe(want));
    QCOMPARE(f.doc.UndoNames(), QStringList{undo});
    QVERIFY(f.doc.Undo());
    QVERIFY2(Same(Read(f), before), Describe(Read(f)));
}

// The face under the mouse is reported and its knob drawn highlighted; the
// scripts' handle table says where each knob is.
void ObloidControlTest::hoverHighlightsTheFace()
{
    ViewerFixture f;
    Input *c = AddBox(f, Box());
    QVERIFY(f.Show());
    const QPoint knob = f.At(ImageOf({0.25, 0, 0}));
    const QImage plain = f.Grab();
    f.Hover(knob);
    QCOMPARE(StateOf(f.OverlayOf(c), "hoverPart"), 2.0);
    QCOMPARE(StateOf(f.OverlayOf(c), "highlight"), 1.0);
    const QImage hot = f.Grab();
    // The +X face turns away from the camera: its knob is the smaller one.
    const QPoint edge = knob + QPoint(-3, 0);
    QVERIFY(qRed(hot.pixel(edge)) > 200 && qBlue(hot.pixel(edge)) < 120);
    QVERIFY(qBlue(plain.pixel(edge)) > 150);
    // Seen straight on in perspective, only the front face faces the camera.
    QCOMPARE(StateOf(f.OverlayOf(c), "frontFaces"), 1.0);
    ScriptVal state = ScriptVal::NewTable();
    f.OverlayOf(c)->GetState(state);
    const ScriptVal *handles = state.FindKeyConst(ScriptVal("handles"));
    QVERIFY(handles && handles->IsTable());
    const ScriptVal *plusX = handles->FindKeyConst(ScriptVal(int64(2)));
    QVERIFY(plusX && plusX->IsTable());
    QCOMPARE(plusX->FindKeyConst(ScriptVal("ix"))->GetNumber(), 0.75);
    f.Hover(f.At(ImageOf({0.1, 0.1, 0})));
    QCOMPARE(StateOf(f.OverlayOf(c), "hoverPart"), 0.0);
}

void ObloidControlTest::nudges_data()
{
    QTest::addColumn<int>("key");
    QTest::addColumn<int>("mods");
    QTest::addColumn<bool>("depthKeys");
    QTest::addColumn<double>("dx"); // image pixels
    QTest::addColumn<double>("dy");
    QTest::addColumn<double>("dz");
    QTest::newRow("right") << int(Qt::Key_Right) << int(Qt::NoModifier) << false << 1.0 << 0.0 << 0.0;
    QTest::newRow("up is +Y") << int(Qt::Key_Up) << int(Qt::NoModifier) << false << 0.0 << 1.0 << 0.0;
    QTest::newRow("left with shift: ten")
        << int(Qt::Key_Left) << int(Qt::ShiftModifier) << false << -10.0 << 0.0 << 0.0;
    QTest::newRow("up with depth keys: away") << int(Qt::Key_Up) << int(Qt::NoModifier) << true << 0.0 << 0.0 << -1.0;
    QTest::newRow("down with control: a tenth nearer")
        << int(Qt::Key_Down) << int(Qt::ControlModifier) << true << 0.0 << 0.0 << 0.1;
}

// An image pixel across is 1/400 of a world unit; up, a pixel of the 200
// high image is the same length as displayed.
void ObloidControlTest::nudges()
{
    QFETCH(int, key);
    QFETCH(int, mods);
    QFETCH(bool, depthKeys);
    QFETCH(double, dx);
    QFETCH(double, dy);
    QFETCH(double, dz);
    ViewerFixture f;
    AddBox(f, Box(), TagList{{OBC_KeysDepth, depthKeys}});
    QVERIFY(f.Show());
    f.Key(Qt::Key(key), Qt::KeyboardModifiers(mods));
    QVERIFY((CenterOf(f) - OrbVec3(dx / 400, dy / 400, dz / 400)).Length() < 1e-12);
    QCOMPARE(f.UndoSteps(), 1);
}

void ObloidControlTest::badInput_data()
{
    QTest::addColumn<double>("cz");
    QTest::addColumn<double>("size");
    QTest::addColumn<double>("turn"); // the viewer camera's pan
    QTest::addColumn<int>("axisMove");
    QTest::newRow("centre not a number") << kNaN << 0.5 << 0.0 << 0;
    QTest::newRow("zero size") << 0.0 << 0.0 << 0.0 << 0;
    QTest::newRow("the camera inside the box") << kD << 4.0 << 0.0 << 0;
    QTest::newRow("behind the camera") << 5.0 << 0.5 << 0.0 << 0;
    QTest::newRow("the camera looking away") << 0.0 << 0.5 << 180.0 << 0;
    QTest::newRow("seen edge on, dragged along Z") << 0.0 << 0.5 << 0.0 << 3;
    QTest::newRow("size huge") << 0.0 << 1e12 << 0.0 << 4;
}

// Hovering, pressing and dragging all over a broken or badly seen box: no
// crash, and nothing but finite numbers written.
void ObloidControlTest::badInput()
{
    QFETCH(double, cz);
    QFETCH(double, size);
    QFETCH(double, turn);
    QFETCH(int, axisMove);
    ViewerFixture f;
    Box b;
    b.center.z = cz;
    b.size = OrbVec3(size, size, size);
    Input *c = AddBox(f, b, TagList{{OBC_AxisMove, axisMove}});
    QVERIFY(f.Show());
    ViewCamera camera = ViewCamera::Default();
    camera.rotation.y = turn;
    QVERIFY(f.viewer.SetCamera(camera));
    SweepDrags(f);
    for (const char *key : {"centerX", "centerY", "sizeX", "sizeY", "sizeZ"})
        QVERIFY2(std::isfinite(StateOf(f.OverlayOf(c), key)) || std::isnan(cz), key);
    while (f.doc.CanUndo())
        QVERIFY(f.doc.Undo());
    QVERIFY2(Same(Read(f), b) || std::isnan(cz), Describe(Read(f)));
}

// A camera Input (a table over the viewer's camera) replaces the view:
// from X = 2 looking down -X, the +Z face's knob lies left of the centre.
void ObloidControlTest::cameraInputTakesOver()
{
    ViewerFixture f;
    Input *c = AddBox(f, Box(), TagList{{OBCID_Camera, OrbID("View")}});
    ScriptVal view = ScriptVal::NewTable();
    ScriptVal position = ScriptVal::NewTable(), rotation = ScriptVal::NewTable();
    for (double v : {2.0, 0.0, 0.0})
        position.Append(ScriptVal(v));
    for (double v : {0.0, 90.0, 0.0})
        rotation.Append(ScriptVal(v));
    view.SetKey(ScriptVal("position"), position);
    view.SetKey(ScriptVal("rotation"), rotation);
    const AutoParam<ScriptValParam> table(view);
    f.tool->AddInput(OrbID("View"), "View", CLSID_DataType_ScriptVal, TagList(), table);
    QVERIFY(f.Show());
    const OrbPoint plusZ(0.5 - kD * 0.25 / 2.0, 0.5);
    f.Hover(f.At(plusZ));
    QCOMPARE(StateOf(f.OverlayOf(c), "hoverPart"), 6.0);
    QCOMPARE(StateOf(f.OverlayOf(c), "frontFaces"), 1.0);
}

QTEST_MAIN(ObloidControlTest)
#include "ObloidControlTest.moc"
