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

constexpr Tag EC_Circle = 0x10058006, EC_KeysResize = 0x10058014, ECD_MinRadius = 0x20058000;
constexpr Tag ECD_MaxRadius = 0x20058001, ECD_AngleStep = 0x20058002, ECD_RadiusScale = 0x20058006;
constexpr Tag ECD_AspectLock = 0x20058010, ECD_AngleOffset = 0x20058013, ECID_Visible = 0x80058000;
constexpr Tag ECID_Lock = 0x80058001;

struct Values
{
    OrbPoint center{0.5, 0.5};
    double rx = 0.2, ry = 0.1, angle = 0.0, soft = 0.05;
};

// Center (the overlay's Input), then the radii, angle and softness in the
// roles' default order; a Visible and a Lock switch to link.
Input *AddEllipse(ViewerFixture &f, const Values &v, const TagList &more = TagList())
{
    TagList attrs{{INPA_PreviewControl, OrbID("EllipseControl")}};
    for (const char *id : {"RX", "RY", "Angle", "Soft"})
        attrs.Add(INPA_OverlayInput, OrbID(id));
    attrs.Append(more);
    Input *c = f.AddPoint("Center", v.center.x, v.center.y, attrs);
    for (auto [id, value] :
         {std::pair{"RX", v.rx}, {"RY", v.ry}, {"Angle", v.angle}, {"Soft", v.soft}, {"Visible", 1.0}, {"Lock", 0.0}})
        f.tool->AddInput(OrbID(id), id, CLSID_DataType_Number, TagList(), AutoNumber(value));
    return c;
}

Values Read(const ViewerFixture &f)
{
    return {f.PointOf(f.tool->FindInput(OrbID("Center"))), NumberOf(f, "RX"), NumberOf(f, "RY"), NumberOf(f, "Angle"),
            NumberOf(f, "Soft")};
}

bool Same(const Values &a, const Values &b)
{
    auto close = [](double x, double y) { return std::fabs(x - y) < 1e-9; };
    return close(a.center.x, b.center.x) && close(a.center.y, b.center.y) && close(a.rx, b.rx) && close(a.ry, b.ry) &&
           close(a.angle, b.angle) && close(a.soft, b.soft);
}

QByteArray Describe(const Values &v)
{
    QByteArray out;
    for (double n : {v.center.x, v.center.y, v.rx, v.ry, v.angle, v.soft})
        out += QByteArray::number(n, 'g', 12) + " ";
    return out;
}

enum Grip
{
    G_Center,
    G_PlusX,
    G_MinusY,
    G_Rotate,
    G_Soft,
};

// Where a knob is, in viewer pixels from the centre, for an upright
// ellipse of `v` in a view of `span` viewer pixels per image width.
QPoint GripAt(Grip g, const Values &v, double span)
{
    switch (g) {
    case G_Center:
        return {};
    case G_PlusX:
        return QPoint(int(std::lround(v.rx * span)), 0);
    case G_MinusY:
        return QPoint(0, -int(std::lround(v.ry * span)));
    case G_Rotate:
        return QPoint(int(std::lround(v.rx * span)) + 24, 0);
    case G_Soft:
        return QPoint(0, int(std::lround((v.ry + v.soft / 2) * span)) + 12);
    }
    return {};
}

} // namespace

Q_DECLARE_METATYPE(Grip)
Q_DECLARE_METATYPE(Orbane::TagList)

class EllipseControlTest : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase()
    {
        std::string why;
        QVERIFY2(ViewerFixture::LoadControls(&why), why.c_str());
    }

    void knobs_data();
    void knobs();
    void limits_data();
    void limits();
    void switches_data();
    void switches();
    void keysResize();
    void softEdgeIsDrawn();
    void badInput_data();
    void badInput();
};

void EllipseControlTest::knobs_data()
{
    QTest::addColumn<double>("zoom");
    QTest::addColumn<double>("pixelAspect");
    QTest::addColumn<Grip>("grip");
    QTest::addColumn<int>("mods");
    QTest::addColumn<QPoint>("move"); // viewer pixels, Y up
    QTest::addColumn<QString>("undo");
    for (auto [zoom, aspect] : {std::pair{1.0, 1.0}, {0.5, 2.0}, {1.5, 1.0}}) {
        const QByteArray at = " at zoom " + QByteArray::number(zoom) + ", pixel aspect " + QByteArray::number(aspect);
        auto row = [&](const char *name, Grip g, int mods, QPoint move, const char *undo) {
            QTest::newRow(name + at) << zoom << aspect << g << mods << move << QString(undo);
        };
        row("centre", G_Center, 0, {30, 20}, "Move Ellipse");
        row("+X knob", G_PlusX, 0, {20, 5}, "Resize Ellipse");
        row("-Y knob", G_MinusY, 0, {3, -10}, "Resize Ellipse");
        row("shift: both radii", G_PlusX, Qt::ShiftModifier, {20, 0}, "Resize Ellipse");
        row("ctrl: about the opposite knob", G_PlusX, Qt::ControlModifier, {20, 0}, "Resize Ellipse");
        row("rotation knob", G_Rotate, 0, {0, 0}, "Rotate Ellipse");
        row("soft knob", G_Soft, 0, {0, 10}, "Soften Ellipse");
    }
}

// Each knob dragged: the values it writes, worked out from where it is on
// screen; one undo step puts them back.
void EllipseControlTest::knobs()
{
    QFETCH(double, zoom);
    QFETCH(double, pixelAspect);
    QFETCH(Grip, grip);
    QFETCH(int, mods);
    QFETCH(QPoint, move);
    QFETCH(QString, undo);
    ViewerFixture f;
    const Values before;
    AddEllipse(f, before);
    QVERIFY(f.Show());
    f.viewer.SetPixelAspect(pixelAspect);
    f.viewer.SetView(zoom);
    QApplication::processEvents();
    const double span = 400 * zoom * pixelAspect, h = 200 * zoom;
    const QPoint from = f.At(before.center, GripAt(grip, before, span));
    {
        HeldKeys held(&f.viewer, Qt::KeyboardModifiers(mods));
        if (grip == G_Rotate) {
            // A quarter turn about the centre, along the ring the knob is on.
            const double r = before.rx * span + 24;
            f.Press(from);
            for (int i = 1; i <= 6; ++i)
                f.Move(f.At(before.center, QPoint(int(std::lround(r * std::cos(i * M_PI / 12))),
                                                  int(std::lround(r * std::sin(i * M_PI / 12))))));
            f.Release(f.At(before.center, QPoint(0, int(std::lround(r)))));
        } else {
            f.Drag(from, from + QPoint(move.x(), -move.y()), 4);
        }
    }
    Values want = before;
    switch (grip) {
    case G_Center:
        want.center = {0.5 + move.x() / span, 0.5 + move.y() / h};
        break;
    case G_PlusX:
        want.rx = mods & Qt::ControlModifier ? 0.2 + move.x() / span / 2 : 0.2 + move.x() / span;
        if (mods & Qt::ShiftModifier)
            want.ry = 0.1 * want.rx / 0.2;
        if (mods & Qt::ControlModifier)
            want.center.x += move.x() / span / 2;
        break;
    case G_MinusY:
        want.ry = 0.1 - move.y() / span;
        break;
    case G_Rotate:
        want.angle = 90;
        break;
    case G_Soft:
        want.soft = 0.05 + 2 * move.y() / span;
        break;
    }
    QVERIFY2(Same(Read(f), want), Describe(Read(f)) + "wanted " + Describe(want));
    QCOMPARE(f.doc.UndoNames(), QStringList{undo});
    QVERIFY(f.doc.Undo());
    QVERIFY2(Same(Read(f), before), Describe(Read(f)));
}

void EllipseControlTest::limits_data()
{
    QTest::addColumn<TagList>("tags");
    QTest::addColumn<Grip>("grip");
    QTest::addColumn<QPoint>("move");
    QTest::addColumn<double>("rx");
    QTest::addColumn<double>("ry");
    QTest::addColumn<double>("angle");
    QTest::newRow("at most the maximum") << TagList{{ECD_MaxRadius, 0.25}} << G_PlusX << QPoint(40, 0) << 0.25 << 0.1
                                         << 0.0;
    QTest::newRow("at least the minimum")
        << TagList{{ECD_MinRadius, 0.15}} << G_PlusX << QPoint(-60, 0) << 0.15 << 0.1 << 0.0;
    QTest::newRow("aspect held at 1") << TagList{{ECD_AspectLock, 1.0}} << G_PlusX << QPoint(20, 0) << 0.25 << 0.25
                                      << 0.0;
    QTest::newRow("turns snap to 45") << TagList{{ECD_AngleStep, 45.0}} << G_Rotate << QPoint(-30, 70) << 0.2 << 0.1
                                      << 45.0;
    QTest::newRow("a circle: the Y knob sizes X")
        << TagList{{EC_Circle, true}} << G_Rotate << QPoint() << 0.2 << 0.1 << 0.0;
}

// The tags that bound a drag. (The circle row drags its +Y knob, which sits
// at the X radius, by 20 pixels up.)
void EllipseControlTest::limits()
{
    QFETCH(TagList, tags);
    QFETCH(Grip, grip);
    QFETCH(QPoint, move);
    QFETCH(double, rx);
    QFETCH(double, ry);
    QFETCH(double, angle);
    ViewerFixture f;
    const Values v;
    AddEllipse(f, v, tags);
    QVERIFY(f.Show());
    if (tags.FindQuery(EC_Circle)) {
        const QPoint top = f.At(v.center, QPoint(0, 80));
        f.Drag(top, top + QPoint(0, -20), 4);
        QCOMPARE(NumberOf(f, "RX"), 0.25);
        QCOMPARE(NumberOf(f, "RY"), 0.1);
        return;
    }
    const QPoint from = f.At(v.center, GripAt(grip, v, 400));
    f.Drag(from, from + QPoint(move.x(), -move.y()), 4);
    QVERIFY2(std::fabs(NumberOf(f, "RX") - rx) < 1e-9, qPrintable(QString::number(NumberOf(f, "RX"))));
    QVERIFY2(std::fabs(NumberOf(f, "RY") - ry) < 1e-9, qPrintable(QString::number(NumberOf(f, "RY"))));
    QVERIFY2(std::fabs(NumberOf(f, "Angle") - angle) < 1e-9, qPrintable(QString::number(NumberOf(f, "Angle"))));
}

void EllipseControlTest::switches_data()
{
    QTest::addColumn<TagList>("tags");
    QTest::addColumn<QPoint>("hover"); // viewer pixels from the centre
    QTest::addColumn<int>("part");
    QTest::newRow("the +X knob") << TagList() << QPoint(80, 0) << 2;
    QTest::newRow("turned by the angle offset: +X is up") << TagList{{ECD_AngleOffset, 90.0}} << QPoint(0, 80) << 2;
    QTest::newRow("radius scale 2: twice as far") << TagList{{ECD_RadiusScale, 2.0}} << QPoint(160, 0) << 2;
    QTest::newRow("hidden by its Input: nothing") << TagList{{ECID_Visible, OrbID("Lock")}} << QPoint() << 0;
    QTest::newRow("locked by its Input: nothing") << TagList{{ECID_Lock, OrbID("Visible")}} << QPoint() << 0;
}

// What is under the mouse as the tags place and switch the ellipse. (The
// switches are linked crosswise: Lock holds 0 and Visible 1.)
void EllipseControlTest::switches()
{
    QFETCH(TagList, tags);
    QFETCH(QPoint, hover);
    QFETCH(int, part);
    ViewerFixture f;
    Input *c = AddEllipse(f, Values(), tags);
    QVERIFY(f.Show());
    f.Hover(f.At({0.5, 0.5}, hover));
    QCOMPARE(StateOf(f.OverlayOf(c), "hoverPart"), double(part));
}

// With the keys resizing, Right widens by an image pixel and Up heightens
// by one; the nudges are one undo step.
void EllipseControlTest::keysResize()
{
    ViewerFixture f;
    AddEllipse(f, Values(), TagList{{EC_KeysResize, true}});
    QVERIFY(f.Show());
    f.Click(f.At({0.5, 0.5}));
    f.Key(Qt::Key_Right);
    f.Key(Qt::Key_Up, Qt::ShiftModifier);
    QCOMPARE(NumberOf(f, "RX"), 0.2 + 1.0 / 400);
    QCOMPARE(NumberOf(f, "RY"), 0.1 + 10.0 / 400);
    QCOMPARE(f.doc.UndoNames().size(), 2);
}

// Eight pixels above the -X knob: the ellipse (radii 80 x 40 pixels) at
// 78, the soft edge's half a softness (10 pixels) out and in on both radii
// at 89 and 67, nothing between.
void EllipseControlTest::softEdgeIsDrawn()
{
    ViewerFixture f;
    AddEllipse(f, Values());
    QVERIFY(f.Show());
    const QImage shot = f.Grab();
    for (int x : {-78, -89, -67})
        QVERIFY2(Lit(shot, f.At({0.5, 0.5}, QPoint(x, 8))), qPrintable(QString::number(x)));
    for (int x : {-84, -73, -100})
        QVERIFY2(Dark(shot, f.At({0.5, 0.5}, QPoint(x, 8))), qPrintable(QString::number(x)));
}

void EllipseControlTest::badInput_data()
{
    const double nan = std::numeric_limits<double>::quiet_NaN(), inf = std::numeric_limits<double>::infinity();
    QTest::addColumn<double>("cx");
    QTest::addColumn<double>("rx");
    QTest::addColumn<double>("angle");
    QTest::newRow("zero radius") << 0.5 << 0.0 << 0.0;
    QTest::newRow("centre not a number") << nan << 0.2 << 0.0;
    QTest::newRow("radius not a number") << 0.5 << nan << 0.0;
    QTest::newRow("angle infinite") << 0.5 << 0.2 << inf;
    QTest::newRow("radius huge") << 0.5 << 1e200 << 30.0;
}

// Hovering, pressing and dragging all over a broken ellipse: no crash,
// only finite numbers written.
void EllipseControlTest::badInput()
{
    QFETCH(double, cx);
    QFETCH(double, rx);
    QFETCH(double, angle);
    ViewerFixture f;
    Values v;
    v.center.x = cx;
    v.rx = rx;
    v.angle = angle;
    AddEllipse(f, v);
    QVERIFY(f.Show());
    SweepDrags(f);
    const Values now = Read(f);
    const double was[] = {v.center.x, v.center.y, v.rx, v.ry, v.angle, v.soft};
    const double got[] = {now.center.x, now.center.y, now.rx, now.ry, now.angle, now.soft};
    for (int i = 0; i < 6; ++i)
        QVERIFY2(std::isfinite(got[i]) || got[i] == was[i] || (std::isnan(got[i]) && std::isnan(was[i])),
                 Describe(now));
}

QTEST_MAIN(EllipseControlTest)
#include "EllipseControlTest.moc"
