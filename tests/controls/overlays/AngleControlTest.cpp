#include "OverlayProbe.h"
#include "ViewerFixture.h"

#include "overlays/AngleControl.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/Registry.h"

#include <QtTest>

#include <cmath>
#include <cstring>
#include <limits>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

const OrbID kAngleControl("AngleControl");
constexpr Tag ACD_MinRadius = 0x20058000;
constexpr Tag ACD_RadiusScale = 0x20058001;
constexpr Tag ACD_FollowX = 0x20058002;
constexpr Tag ACD_FollowY = 0x20058003;
constexpr Tag ACD_CurrentAngle = 0x20058005;
constexpr Tag ACID_Center = 0x80058000;
constexpr Tag ACID_Radius = 0x80058001;
constexpr Tag ACID_CenterX = 0x80058002;
constexpr Tag ACID_CenterY = 0x80058003;
constexpr Tag ACID_CenterZ = 0x80058004;
constexpr Tag AC_DialStyle = 0x10058000;
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInf = std::numeric_limits<double>::infinity();

using Path = QVector<QPoint>; // viewer pixels from the centre, Y up; the first is the press

TagList AngleAttrs(int style = 1, const TagList &more = TagList())
{
    TagList attrs{{INPA_PreviewControl, kAngleControl}, {AC_DialStyle, style}};
    attrs.Append(more);
    return attrs;
}

Input *AddNumber(ViewerFixture &f, const char *id, double value, const TagList &attrs = TagList())
{
    const AutoNumber def(value);
    return f.tool->AddInput(OrbID(id), id, CLSID_DataType_Number, attrs, def);
}

double NumberOf(ViewerFixture &f, Input *input)
{
    const AutoNumber n(input, f.doc.GetCurrentTime());
    return n ? n->Value : kNaN;
}

void SetNumber(ViewerFixture &f, Input *input, double value)
{
    AutoNumber n(value);
    input->SetValue(n.get(), f.doc.GetCurrentTime());
}

// The overlay of `input`, where it is an angle overlay.
AngleControl *AngleOf(ViewerFixture &f, Input *input)
{
    PreviewControl *overlay = f.OverlayOf(input);
    const bool isAngle = overlay && std::strcmp(overlay->GetRegistry()->Name(), "AngleControl") == 0;
    return isAngle ? static_cast<AngleControl *>(overlay) : nullptr;
}

double CurrentAngle(AngleControl *angle)
{
    double value = kNaN;
    angle->CopyAttr(ACD_CurrentAngle, &value);
    return value;
}

void DragPath(ViewerFixture &f, OrbPoint centre, const Path &path)
{
    f.Press(f.At(centre, path.front()));
    for (const QPoint &o : path.mid(1))
        f.Move(f.At(centre, o));
    f.Release(f.At(centre, path.back()));
}

// Three turns counter-clockwise at 80 pixels, 30 degrees a move.
Path ThreeTurns()
{
    Path path{{50, 0}};
    for (int step = 1; step <= 36; ++step)
        path << QPoint(int(std::lround(80 * std::cos(step * M_PI / 6))),
                       int(std::lround(80 * std::sin(step * M_PI / 6))));
    return path;
}

} // namespace

class AngleControlTest : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase();

    void drag_data();
    void drag();
    void keys_data();
    void keys();
    void keyRunIsOneUndoStep();
    void startGrab_data();
    void startGrab();
    void fade_data();
    void fade();
    void centreInputs_data();
    void centreInputs();
    void radius_data();
    void radius();
    void centreZLandsInTheAngle();
    void pressOnCentreHandleIsLinked();
    void followCursor();
    void badInputs_data();
    void badInputs();
};

void AngleControlTest::initTestCase()
{
    std::string why;
    QVERIFY2(ViewerFixture::LoadControls(&why), why.c_str());
}

void AngleControlTest::drag_data()
{
    QTest::addColumn<int>("style");
    QTest::addColumn<double>("start");
    QTest::addColumn<Path>("path");
    QTest::addColumn<double>("angle");
    QTest::addColumn<double>("tolerance");
    QTest::newRow("10 to 350 clockwise writes -10")
        << 1 << 10.0 << Path{{49, 9}, {100, 9}, {100, 0}, {100, -9}, {98, -17}} << -10.0 << 0.5;
    QTest::newRow("three turns: about 1080") << 1 << 0.0 << ThreeTurns() << 1080.0 << 0.5;
    QTest::newRow("straight up: 90") << 1 << 0.0 << Path{{50, 0}, {30, 60}, {0, 100}} << 90.0 << 1e-9;
    QTest::newRow("straight down: 270") << 1 << 180.0 << Path{{-50, 0}, {-30, -60}, {0, -100}} << 270.0 << 1e-9;
    QTest::newRow("6 pixels off the ring: hit, circular") << 1 << 0.0 << Path{{56, 0}, {0, 100}} << 93.43 << 0.01;
    QTest::newRow("7 pixels off the ring: miss") << 1 << 0.0 << Path{{57, 0}, {0, 100}} << 0.0 << 0.0;
    QTest::newRow("same direction, farther: nothing") << 1 << 0.0 << Path{{50, 0}, {100, 0}, {200, 0}} << 0.0 << 0.0;
    QTest::newRow("style 0 grabs the arm's end") << 0 << 0.0 << Path{{20, 0}, {0, 100}} << 90.0 << 1e-9;
    QTest::newRow("style 0: the ring takes no press") << 0 << 0.0 << Path{{50, 0}, {0, 100}} << 0.0 << 0.0;
}

// One drag, one undo step named after the Input, undone exactly.
void AngleControlTest::drag()
{
    QFETCH(int, style);
    QFETCH(double, start);
    QFETCH(Path, path);
    QFETCH(double, angle);
    QFETCH(double, tolerance);
    ViewerFixture f;
    Input *a = AddNumber(f, "Angle", start, AngleAttrs(style));
    QVERIFY(f.Show());
    DragPath(f, {0.5, 0.5}, path);
    const double written = NumberOf(f, a);
    QVERIFY2(std::fabs(written - angle) <= tolerance, qPrintable(QString::number(written, 'g', 17)));
    if (written == start) {
        QCOMPARE(f.UndoSteps(), 0);
        return;
    }
    QCOMPARE(f.doc.UndoNames(), QStringList{"Change Angle"});
    QVERIFY(f.doc.Undo());
    QCOMPARE(NumberOf(f, a), start);
}

void AngleControlTest::keys_data()
{
    QTest::addColumn<int>("key");
    QTest::addColumn<int>("mods");
    QTest::addColumn<double>("delta");
    QTest::newRow("left: one counter-clockwise") << int(Qt::Key_Left) << int(Qt::NoModifier) << 1.0;
    QTest::newRow("right: one clockwise") << int(Qt::Key_Right) << int(Qt::NoModifier) << -1.0;
    QTest::newRow("shift: ten") << int(Qt::Key_Left) << int(Qt::ShiftModifier) << 10.0;
    QTest::newRow("control: a tenth") << int(Qt::Key_Right) << int(Qt::ControlModifier) << -0.1;
    QTest::newRow("both: one") << int(Qt::Key_Left) << int(Qt::ShiftModifier | Qt::ControlModifier) << 1.0;
    QTest::newRow("up is not claimed") << int(Qt::Key_Up) << int(Qt::NoModifier) << 0.0;
    QTest::newRow("down is not claimed") << int(Qt::Key_Down) << int(Qt::NoModifier) << 0.0;
}

void AngleControlTest::keys()
{
    QFETCH(int, key);
    QFETCH(int, mods);
    QFETCH(double, delta);
    ViewerFixture f;
    Input *a = AddNumber(f, "Angle", 30.0, AngleAttrs());
    QVERIFY(f.Show());
    f.Key(Qt::Key(key), Qt::KeyboardModifiers(mods));
    QCOMPARE(NumberOf(f, a), 30.0 + delta);
    QCOMPARE(f.UndoSteps(), delta != 0.0 ? 1 : 0);
}

void AngleControlTest::keyRunIsOneUndoStep()
{
    ViewerFixture f;
    Input *a = AddNumber(f, "Angle", 30.0, AngleAttrs());
    QVERIFY(f.Show());
    QTest::keyPress(&f.viewer, Qt::Key_Left, Qt::ShiftModifier);
    QTest::keyPress(&f.viewer, Qt::Key_Left, Qt::ShiftModifier);
    QTest::keyPress(&f.viewer, Qt::Key_Right, Qt::ShiftModifier);
    QTest::keyRelease(&f.viewer, Qt::Key_Right, Qt::NoModifier);
    QTest::keyRelease(&f.viewer, Qt::Key_Left, Qt::NoModifier);
    QVERIFY(!f.doc.CanUndo()); // Shift is still down
    QTest::keyRelease(&f.viewer, Qt::Key_Shift, Qt::NoModifier);
    QCOMPARE(f.doc.UndoNames(), QStringList{"Change Angle"});
    QCOMPARE(NumberOf(f, a), 40.0);
    QVERIFY(f.doc.Undo());
    QCOMPARE(NumberOf(f, a), 30.0);
}

void AngleControlTest::startGrab_data()
{
    QTest::addColumn<bool>("flagged");
    QTest::newRow("press flagged 4: a second dial where it began") << true;
    QTest::newRow("ordinary press: one dial") << false;
}

// A press 6 pixels above the arm's ring point: the second dial is drawn
// 6 pixels above the first while the drag lasts.
void AngleControlTest::startGrab()
{
    QFETCH(bool, flagged);
    ViewerFixture f;
    Input *a = AddNumber(f, "Angle", 0.0, AngleAttrs());
    QVERIFY(f.Show());
    AngleControl *angle = AngleOf(f, a);
    QVERIFY(angle);
    f.viewer.SetPressFlags(flagged ? uint32(PEF_StartGrab) : 0u);
    const OrbPoint c(0.5, 0.5);
    f.Press(f.At(c, {50, 6}));
    f.Move(f.At(c, {-40, 40}));
    QVERIFY(NumberOf(f, a) > 90.0);
    const OrbPoint centre = f.viewer.Info().TransformOut(c);
    QCOMPARE(angle->StartGrab(), flagged ? centre + OrbPoint(0, 6) : OrbPoint());
    // 45 degrees on the second ring, away from both arms and every mark.
    QCOMPARE(Lit(f.Grab(), f.At(c, {35, 41}), 0), flagged);
    f.Release(f.At(c, {-40, 40}));
    QCOMPARE(angle->StartGrab(), OrbPoint());
    QVERIFY(Dark(f.Grab(), f.At(c, {35, 41}), 0));
}

void AngleControlTest::fade_data()
{
    QTest::addColumn<QPoint>("mouse");
    QTest::addColumn<double>("fade");
    QTest::addColumn<bool>("hovered");
    QTest::newRow("10 pixels outside the ring: full") << QPoint(60, 0) << 1.0 << false;
    QTest::newRow("60 pixels outside: half") << QPoint(110, 0) << 0.5 << false;
    QTest::newRow("at the centre, 50 from the ring") << QPoint(0, 0) << 0.6 << false;
    QTest::newRow("on the ring: full, highlighted") << QPoint(0, 50) << 1.0 << true;
}

void AngleControlTest::fade()
{
    QFETCH(QPoint, mouse);
    QFETCH(double, fade);
    QFETCH(bool, hovered);
    ViewerFixture f;
    Input *a = AddNumber(f, "Angle", 0.0, AngleAttrs());
    QVERIFY(f.Show());
    AngleControl *angle = AngleOf(f, a);
    f.Hover(f.At({0.5, 0.5}, mouse));
    QCOMPARE(angle->Fade(), float(fade));
    QCOMPARE(angle->DrawnFade(), float(fade));
    QCOMPARE(angle->Hovered(), hovered);
    // The ring's left point, against the same point drawn highlighted (at full opacity).
    const QPoint left = f.At({0.5, 0.5}, QPoint(-50, 0));
    const int drawn = Level(f.Grab(), left);
    f.viewer.Info().Highlight = 1;
    const int full = Level(f.Grab(), left);
    QVERIFY2(full > 150 && std::fabs(double(drawn) / full - fade) < 0.03,
             qPrintable(QString("%1 of %2").arg(drawn).arg(full)));
}

void AngleControlTest::centreInputs_data()
{
    QTest::addColumn<bool>("asPoint");
    QTest::newRow("a point Input") << true;
    QTest::newRow("X and Y Inputs") << false;
}

// The dial sits on the linked centre and follows its changes.
void AngleControlTest::centreInputs()
{
    QFETCH(bool, asPoint);
    ViewerFixture f;
    Input *x = nullptr;
    if (asPoint) {
        x = f.AddPoint("Center", 0.25, 0.5);
    } else {
        x = AddNumber(f, "CenterX", 0.25);
        AddNumber(f, "CenterY", 0.5);
    }
    const TagList links = asPoint ? TagList{{ACID_Center, OrbID("Center")}}
                                  : TagList{{ACID_CenterX, OrbID("CenterX")}, {ACID_CenterY, OrbID("CenterY")}};
    Input *a = AddNumber(f, "Angle", 0.0, AngleAttrs(1, links));
    QVERIFY(f.Show());
    QCOMPARE(AngleOf(f, a)->Center(), OrbPoint(0.25, 0.5));
    DragPath(f, {0.25, 0.5}, Path{{50, 0}, {0, 100}});
    QCOMPARE(NumberOf(f, a), 90.0);
    if (asPoint) {
        AutoPoint moved(0.75, 0.25);
        x->SetValue(moved.get(), f.doc.GetCurrentTime());
    } else {
        SetNumber(f, x, 0.75);
    }
    QCOMPARE(AngleOf(f, a)->Center().x, 0.75);
}

void AngleControlTest::radius_data()
{
    QTest::addColumn<double>("minRadius");
    QTest::addColumn<double>("scale");
    QTest::addColumn<double>("first");
    QTest::addColumn<double>("second");
    QTest::addColumn<double>("radius");
    QTest::newRow("value times scale") << 0.0 << 0.5 << 0.5 << 0.2 << 0.1;
    QTest::newRow("never under MinRadius") << 0.2 << 0.5 << 0.5 << 0.02 << 0.2;
    QTest::newRow("a change of 2e-6 is kept") << 0.0 << 1.0 << 0.1 << 0.100002 << 0.100002;
    QTest::newRow("a change of 5e-7 is dropped") << 0.0 << 1.0 << 0.1 << 0.1000005 << 0.1;
}

// The radius reaches the arm's end that dial style 0 grabs.
void AngleControlTest::radius()
{
    QFETCH(double, minRadius);
    QFETCH(double, scale);
    QFETCH(double, first);
    QFETCH(double, second);
    QFETCH(double, radius);
    ViewerFixture f;
    Input *r = AddNumber(f, "Radius", first);
    const TagList more{{ACID_Radius, OrbID("Radius")}, {ACD_MinRadius, minRadius}, {ACD_RadiusScale, scale}};
    Input *a = AddNumber(f, "Angle", 0.0, AngleAttrs(0, more));
    QVERIFY(f.Show());
    SetNumber(f, r, second);
    QCOMPARE(AngleOf(f, a)->Radius(), radius);
    const int arm = int(std::lround(radius * 400));
    DragPath(f, {0.5, 0.5}, Path{{arm, 0}, {0, 100}});
    QCOMPARE(NumberOf(f, a), 90.0);
}

// The centre Z Input is watched but has no place of its own: its value is
// taken as the angle. Kept as tools have always seen it.
void AngleControlTest::centreZLandsInTheAngle()
{
    ViewerFixture f;
    Input *z = AddNumber(f, "CenterZ", 0.0);
    Input *a = AddNumber(f, "Angle", 15.0, AngleAttrs(1, TagList{{ACID_CenterZ, OrbID("CenterZ")}}));
    QVERIFY(f.Show());
    AngleControl *angle = AngleOf(f, a);
    QCOMPARE(CurrentAngle(angle), 15.0);
    SetNumber(f, z, 42.0);
    QCOMPARE(CurrentAngle(angle), 42.0);
    QCOMPARE(NumberOf(f, a), 15.0);
}

void AngleControlTest::pressOnCentreHandleIsLinked()
{
    ViewerFixture f;
    Input *c = f.AddPoint("Center", 0.5, 0.5, TagList{{INPA_PreviewControl, OrbID("PointControl")}});
    Input *a = AddNumber(f, "Angle", 20.0, AngleAttrs(1, TagList{{ACID_Center, OrbID("Center")}}));
    QVERIFY(f.Show());
    AngleControl *angle = AngleOf(f, a);
    f.Press(f.At({0.5, 0.5}));
    QCOMPARE(angle->IsDragging(), DRAG_Linked);
    f.Move(f.At({0.5, 0.5}, {40, 20}));
    f.Release(f.At({0.5, 0.5}, {40, 20}));
    QVERIFY(Near(f.PointOf(c), {0.6, 0.6}));
    QVERIFY(Near(angle->Center(), {0.6, 0.6}));
    QCOMPARE(NumberOf(f, a), 20.0);
    QCOMPARE(f.doc.UndoNames(), QStringList{"Change Center"});
}

void AngleControlTest::followCursor()
{
    ViewerFixture f;
    Input *a = AddNumber(f, "Angle", 0.0, AngleAttrs());
    QVERIFY(f.Show());
    AngleControl *angle = AngleOf(f, a);
    const OrbPoint c(0.5, 0.5);
    f.Hover(f.At(c, {50, 0}));
    QVERIFY(f.viewer.BeginFollowCursor(angle, TagList{{ACD_FollowX, 0.5}, {ACD_FollowY, 0.5}}));
    QVERIFY(angle->FollowsCursor());
    f.Hover(f.At(c, {0, 100}));
    QCOMPARE(NumberOf(f, a), 90.0);
    f.Hover(f.At(c, {-100, 0}));
    f.Click(f.At(c, {-100, 0}));
    QCOMPARE(NumberOf(f, a), 180.0);
    QVERIFY(!angle->FollowsCursor());
    QCOMPARE(angle->IsDragging(), DRAG_None);
    QCOMPARE(f.doc.UndoNames(), QStringList{"Change Angle"});
    f.Hover(f.At(c, {0, -100}));
    QCOMPARE(NumberOf(f, a), 180.0);
}

void AngleControlTest::badInputs_data()
{
    QTest::addColumn<int>("style");
    QTest::addColumn<double>("angle");
    QTest::addColumn<double>("centreX");
    QTest::addColumn<double>("radius");
    QTest::addColumn<QPoint>("press");
    QTest::addColumn<double>("written");
    QTest::newRow("an angle of 1e6 degrees") << 1 << 1e6 << 0.5 << 0.1 << QPoint(50, 0) << 1e6 + 90;
    QTest::newRow("a NaN angle: the dial keeps its last") << 1 << kNaN << 0.5 << 0.1 << QPoint(50, 0) << 90.0;
    QTest::newRow("an infinite centre: the dial keeps its last") << 1 << 0.0 << kInf << 0.1 << QPoint(50, 0) << 90.0;
    QTest::newRow("a NaN centre") << 1 << 0.0 << kNaN << 0.1 << QPoint(50, 0) << 90.0;
    // The radius keeps 0.1 × 0.5 of the default: 20 pixels.
    QTest::newRow("an infinite radius") << 0 << 0.0 << 0.5 << kInf << QPoint(20, 0) << 90.0;
    QTest::newRow("a NaN radius") << 0 << 0.0 << 0.5 << kNaN << QPoint(20, 0) << 90.0;
}

void AngleControlTest::badInputs()
{
    QFETCH(int, style);
    QFETCH(double, angle);
    QFETCH(double, centreX);
    QFETCH(double, radius);
    QFETCH(QPoint, press);
    QFETCH(double, written);
    ViewerFixture f;
    AddNumber(f, "CenterX", centreX);
    AddNumber(f, "CenterY", 0.5);
    AddNumber(f, "Radius", radius);
    const TagList links{
        {ACID_CenterX, OrbID("CenterX")}, {ACID_CenterY, OrbID("CenterY")}, {ACID_Radius, OrbID("Radius")}};
    Input *a = AddNumber(f, "Angle", angle, AngleAttrs(style, links));
    QVERIFY(f.Show());
    const QImage shot = f.Grab();
    QCOMPARE(Lit(shot, f.At({0.5, 0.5}, {-50, 0})), style == 1);
    f.Hover(f.At({0.5, 0.5}, {60, 0}));
    QVERIFY(std::isfinite(AngleOf(f, a)->Fade()));
    DragPath(f, {0.5, 0.5}, Path{press, {0, 100}});
    QCOMPARE(NumberOf(f, a), written);
}

QTEST_MAIN(AngleControlTest)
#include "AngleControlTest.moc"
