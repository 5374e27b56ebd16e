#include "OverlayProbe.h"
#include "ViewerFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Operator.h"
#include "orbane/Registry.h"
#include "orbane/ScriptVal.h"

#include <QtTest>

#include <cmath>
#include <cstring>
#include <limits>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

constexpr Tag ACD_MinRadius = 0x20058000, ACD_RadiusScale = 0x20058001;
constexpr Tag ACD_FollowX = 0x20058002, ACD_FollowY = 0x20058003, ACD_CurrentAngle = 0x20058005;
constexpr Tag ACID_Center = 0x80058000, ACID_Radius = 0x80058001;
constexpr Tag ACID_CenterX = 0x80058002, ACID_CenterY = 0x80058003, ACID_CenterZ = 0x80058004;
constexpr Tag AC_DialStyle = 0x10058000;
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInf = std::numeric_limits<double>::infinity();
const OrbPoint kMid(0.5, 0.5);

using Path = QVector<QPoint>; // viewer pixels from a centre, Y up; the first is the press

// The viewer with the tool's Inputs; the angle Input comes last, so that its
// overlay is asked first.
class AngleView : public ViewerFixture
{
public:
    Input *Number(const char *id, double value, const TagList &attrs = TagList())
    {
        const AutoNumber def(value);
        return tool->AddInput(OrbID(id), id, CLSID_DataType_Number, attrs, def);
    }
    bool ShowAngle(double start, int style = 1, const TagList &more = TagList())
    {
        TagList attrs{{INPA_PreviewControl, OrbID("AngleControl")}, {AC_DialStyle, style}};
        attrs.Append(more);
        angle = Number("Angle", start, attrs);
        PreviewControl *o = Show() ? OverlayOf(angle) : nullptr;
        overlay = o && std::strcmp(o->GetRegistry()->Name(), "AngleControl") == 0 ? o : nullptr;
        return overlay != nullptr;
    }
    // A field of what the user sees (orbane.OverlayState); NaN where absent.
    double State(const char *key) const
    {
        ScriptVal state = ScriptVal::NewTable();
        overlay->GetState(state);
        const ScriptVal *v = state.FindKeyConst(ScriptVal(key));
        return !v ? kNaN : v->IsBool() ? double(v->GetBool()) : v->GetNumber();
    }
    OrbPoint StateAt(const char *x, const char *y) const { return {State(x), State(y)}; }
    double Value(Input *in = nullptr)
    {
        const AutoNumber n(in ? in : angle, doc.GetCurrentTime());
        return n ? n->Value : kNaN;
    }
    void Set(Input *in, double value)
    {
        AutoNumber n(value);
        in->SetValue(n.get(), doc.GetCurrentTime());
    }
    void DragPath(OrbPoint centre, const Path &path)
    {
        Press(At(centre, path.front()));
        for (const QPoint &o : path.mid(1))
            Move(At(centre, o));
        Release(At(centre, path.back()));
    }

    Input *angle = nullptr;
    PreviewControl *overlay = nullptr;
};

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
    void initTestCase()
    {
        std::string why;
        QVERIFY2(ViewerFixture::LoadControls(&why), why.c_str());
    }

    void drag_data()
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
        QTest::newRow("6 pixels off the ring: a hit") << 1 << 0.0 << Path{{56, 0}, {0, 100}} << 93.43 << 0.01;
        QTest::newRow("7 pixels off: a miss") << 1 << 0.0 << Path{{57, 0}, {0, 100}} << 0.0 << 0.0;
        QTest::newRow("same direction, farther: nothing") << 1 << 0.0 << Path{{50, 0}, {200, 0}} << 0.0 << 0.0;
        QTest::newRow("style 0 grabs the arm's end") << 0 << 0.0 << Path{{20, 0}, {0, 100}} << 90.0 << 1e-9;
        QTest::newRow("style 0: the ring takes no press") << 0 << 0.0 << Path{{50, 0}, {0, 100}} << 0.0 << 0.0;
    }
    // One drag, one undo step named after the Input, undone exactly.
    void drag()
    {
        QFETCH(int, style);
        QFETCH(double, start);
        QFETCH(Path, path);
        QFETCH(double, angle);
        QFETCH(double, tolerance);
        AngleView v;
        QVERIFY(v.ShowAngle(start, style));
        v.DragPath(kMid, path);
        const double written = v.Value();
        QVERIFY2(std::fabs(written - angle) <= tolerance, qPrintable(QString::number(written, 'g', 17)));
        QCOMPARE(v.doc.UndoNames(), written == start ? QStringList() : QStringList{"Change Angle"});
        QCOMPARE(v.doc.Undo(), written != start);
        QCOMPARE(v.Value(), start);
    }

    void keys_data()
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
    void keys()
    {
        QFETCH(int, key);
        QFETCH(int, mods);
        QFETCH(double, delta);
        AngleView v;
        QVERIFY(v.ShowAngle(30.0));
        v.Key(Qt::Key(key), Qt::KeyboardModifiers(mods));
        QCOMPARE(v.Value(), 30.0 + delta);
        QCOMPARE(v.UndoSteps(), delta != 0.0 ? 1 : 0);
    }

    void keyRunIsOneUndoStep()
    {
        AngleView v;
        QVERIFY(v.ShowAngle(30.0));
        for (Qt::Key key : {Qt::Key_Left, Qt::Key_Left, Qt::Key_Right})
            QTest::keyPress(&v.viewer, key, Qt::ShiftModifier);
        QTest::keyRelease(&v.viewer, Qt::Key_Right, Qt::NoModifier);
        QTest::keyRelease(&v.viewer, Qt::Key_Left, Qt::NoModifier);
        QVERIFY(!v.doc.CanUndo()); // Shift is still down
        QTest::keyRelease(&v.viewer, Qt::Key_Shift, Qt::NoModifier);
        QCOMPARE(v.doc.UndoNames(), QStringList{"Change Angle"});
        QCOMPARE(v.Value(), 40.0);
        QVERIFY(v.doc.Undo());
        QCOMPARE(v.Value(), 30.0);
    }

    void startGrab_data()
    {
        QTest::addColumn<bool>("flagged");
        QTest::newRow("press flagged 4: a second dial where it began") << true;
        QTest::newRow("ordinary press: one dial") << false;
    }
    // A press 6 pixels above the arm's point on the ring: the second dial is
    // drawn 6 pixels above the first while the drag lasts.
    void startGrab()
    {
        QFETCH(bool, flagged);
        AngleView v;
        QVERIFY(v.ShowAngle(0.0));
        v.viewer.SetPressFlags(flagged ? uint32(PEF_StartGrab) : 0u);
        v.Press(v.At(kMid, {50, 6}));
        v.Move(v.At(kMid, {-40, 40}));
        QVERIFY(v.Value() > 90.0);
        const OrbPoint centre = v.viewer.Info().TransformOut(kMid);
        QCOMPARE(v.StateAt("startGrabX", "startGrabY"), flagged ? centre + OrbPoint(0, 6) : OrbPoint());
        // 45 degrees on the second ring, away from both arms and every mark.
        QCOMPARE(Lit(v.Grab(), v.At(kMid, {35, 41}), 0), flagged);
        v.Release(v.At(kMid, {-40, 40}));
        QCOMPARE(v.StateAt("startGrabX", "startGrabY"), OrbPoint());
        QVERIFY(Dark(v.Grab(), v.At(kMid, {35, 41}), 0));
    }

    void fade_data()
    {
        QTest::addColumn<QPoint>("mouse");
        QTest::addColumn<double>("fade");
        QTest::addColumn<bool>("hovered");
        QTest::newRow("10 pixels outside the ring: full") << QPoint(60, 0) << 1.0 << false;
        QTest::newRow("60 pixels outside: half") << QPoint(110, 0) << 0.5 << false;
        QTest::newRow("at the centre, 50 from the ring") << QPoint(0, 0) << 0.6 << false;
        QTest::newRow("on the ring: full, highlighted") << QPoint(0, 50) << 1.0 << true;
    }
    void fade()
    {
        QFETCH(QPoint, mouse);
        QFETCH(double, fade);
        QFETCH(bool, hovered);
        AngleView v;
        QVERIFY(v.ShowAngle(0.0));
        v.Hover(v.At(kMid, mouse));
        QCOMPARE(float(v.State("fade")), float(fade));
        QCOMPARE(float(v.State("drawnFade")), float(fade));
        QCOMPARE(v.State("hover"), double(hovered));
        // The ring's left point, against the same point drawn at full opacity.
        const QPoint left = v.At(kMid, QPoint(-50, 0));
        const int drawn = Level(v.Grab(), left);
        v.viewer.Info().Highlight = 1;
        const int full = Level(v.Grab(), left);
        QVERIFY2(full > 150 && std::fabs(double(drawn) / full - fade) < 0.03,
                 qPrintable(QString("%1 of %2").arg(drawn).arg(full)));
    }

    void centreInputs_data()
    {
        QTest::addColumn<bool>("asPoint");
        QTest::newRow("a point Input with its own handle") << true;
        QTest::newRow("X and Y Inputs") << false;
    }
    // The dial sits on the linked centre and follows it. A press on the
    // centre's own handle joins the drag as a linked one and writes nothing.
    void centreInputs()
    {
        QFETCH(bool, asPoint);
        AngleView v;
        Input *x = asPoint ? v.AddPoint("Center", 0.25, 0.5, TagList{{INPA_PreviewControl, OrbID("PointControl")}})
                           : v.Number("CenterX", 0.25);
        if (!asPoint)
            v.Number("CenterY", 0.5);
        QVERIFY(v.ShowAngle(0.0, 1,
                            asPoint ? TagList{{ACID_Center, OrbID("Center")}}
                                    : TagList{{ACID_CenterX, OrbID("CenterX")}, {ACID_CenterY, OrbID("CenterY")}}));
        QCOMPARE(v.StateAt("centerX", "centerY"), OrbPoint(0.25, 0.5));
        v.DragPath({0.25, 0.5}, Path{{50, 0}, {0, 100}});
        QCOMPARE(v.Value(), 90.0);
        if (!asPoint) {
            v.Set(x, 0.75);
            QCOMPARE(v.State("centerX"), 0.75);
            return;
        }
        v.Press(v.At({0.25, 0.5}));
        QCOMPARE(v.overlay->IsDragging(), DRAG_Linked);
        v.Move(v.At({0.25, 0.5}, {40, 20}));
        v.Release(v.At({0.25, 0.5}, {40, 20}));
        QVERIFY(Near(v.StateAt("centerX", "centerY"), {0.35, 0.6}));
        QCOMPARE(v.Value(), 90.0);
        QCOMPARE(v.doc.UndoNames(), (QStringList{"Change Angle", "Change Center"}));
    }

    void radius_data()
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
    void radius()
    {
        QFETCH(double, minRadius);
        QFETCH(double, scale);
        QFETCH(double, first);
        QFETCH(double, second);
        QFETCH(double, radius);
        AngleView v;
        Input *r = v.Number("Radius", first);
        QVERIFY(v.ShowAngle(
            0.0, 0, TagList{{ACID_Radius, OrbID("Radius")}, {ACD_MinRadius, minRadius}, {ACD_RadiusScale, scale}}));
        v.Set(r, second);
        QCOMPARE(v.State("radius"), radius);
        v.DragPath(kMid, Path{{int(std::lround(radius * 400)), 0}, {0, 100}});
        QCOMPARE(v.Value(), 90.0);
    }

    // The centre Z Input is watched but has no place of its own: its value
    // is taken as the angle, as tools have always seen it.
    void centreZLandsInTheAngle()
    {
        AngleView v;
        Input *z = v.Number("CenterZ", 0.0);
        QVERIFY(v.ShowAngle(15.0, 1, TagList{{ACID_CenterZ, OrbID("CenterZ")}}));
        v.Set(z, 42.0);
        double current = 0.0;
        QVERIFY(!v.overlay->CopyAttr(ACD_CurrentAngle, &current));
        QCOMPARE(current, 42.0);
        QCOMPARE(v.Value(), 15.0);
    }

    void followCursor()
    {
        AngleView v;
        QVERIFY(v.ShowAngle(0.0));
        v.Hover(v.At(kMid, {50, 0}));
        QVERIFY(v.viewer.BeginFollowCursor(v.overlay, TagList{{ACD_FollowX, 0.5}, {ACD_FollowY, 0.5}}));
        QCOMPARE(v.State("followCursor"), 1.0);
        v.Hover(v.At(kMid, {0, 100}));
        QCOMPARE(v.Value(), 90.0);
        v.Hover(v.At(kMid, {-100, 0}));
        v.Click(v.At(kMid, {-100, 0}));
        QCOMPARE(v.Value(), 180.0);
        QCOMPARE(v.State("followCursor"), 0.0);
        QCOMPARE(v.overlay->IsDragging(), DRAG_None);
        QCOMPARE(v.doc.UndoNames(), QStringList{"Change Angle"});
        v.Hover(v.At(kMid, {0, -100}));
        QCOMPARE(v.Value(), 180.0);
    }

    void badInputs_data()
    {
        QTest::addColumn<int>("style");
        QTest::addColumn<double>("angle");
        QTest::addColumn<double>("centreX");
        QTest::addColumn<double>("radius");
        QTest::addColumn<double>("written");
        QTest::newRow("an angle of 1e6 degrees") << 1 << 1e6 << 0.5 << 0.1 << 1e6 + 90;
        QTest::newRow("a NaN angle: the last is kept") << 1 << kNaN << 0.5 << 0.1 << 90.0;
        QTest::newRow("an infinite centre: the last is kept") << 1 << 0.0 << kInf << 0.1 << 90.0;
        QTest::newRow("a NaN centre") << 1 << 0.0 << kNaN << 0.1 << 90.0;
        // The radius keeps 0.1 × 0.5, its default: the arm ends 20 pixels out.
        QTest::newRow("an infinite radius") << 0 << 0.0 << 0.5 << kInf << 90.0;
        QTest::newRow("a NaN radius") << 0 << 0.0 << 0.5 << kNaN << 90.0;
    }
    void badInputs()
    {
        QFETCH(int, style);
        QFETCH(double, angle);
        QFETCH(double, centreX);
        QFETCH(double, radius);
        QFETCH(double, written);
        AngleView v;
        v.Number("CenterX", centreX);
        v.Number("CenterY", 0.5);
        v.Number("Radius", radius);
        QVERIFY(v.ShowAngle(angle, style,
                            TagList{{ACID_CenterX, OrbID("CenterX")},
                                    {ACID_CenterY, OrbID("CenterY")},
                                    {ACID_Radius, OrbID("Radius")}}));
        QCOMPARE(Lit(v.Grab(), v.At(kMid, {-50, 0})), style == 1);
        v.Hover(v.At(kMid, {60, 0}));
        QVERIFY(std::isfinite(v.State("fade")));
        v.DragPath(kMid, Path{{style == 1 ? 50 : 20, 0}, {0, 100}});
        QCOMPARE(v.Value(), written);
    }
};

QTEST_MAIN(AngleControlTest)
#include "AngleControlTest.moc"
