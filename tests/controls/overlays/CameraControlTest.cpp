#include "OverlayProbe.h"
#include "ViewerFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/ViewCamera.h"

#include <QtTest>

#include <cmath>
#include <limits>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

constexpr Tag CC_TargetInput = 0x10068005, CC_KeysAim = 0x1006800d;
constexpr double kD = 50.0 / 36.0; // the default view's distance

// A camera tool: Position (X, Y, Z), then tilt, pan, roll and focal length,
// the roles' default order; a Target Point after them.
Input *AddCamera(ViewerFixture &f, OrbVec3 at, double pan, const TagList &more = TagList())
{
    TagList attrs{{INPA_PreviewControl, OrbID("CameraControl")}};
    for (const char *id : {"RotX", "RotY", "RotZ", "Focal", "Target"})
        attrs.Add(INPA_OverlayInput, OrbID(id));
    attrs.Append(more);
    Input *p =
        f.tool->AddInput(OrbID("Position"), "Position", CLSID_DataType_Point, attrs, AutoPoint(at.x, at.y, at.z));
    for (auto [id, value] : {std::pair{"RotX", 0.0}, {"RotY", pan}, {"RotZ", 0.0}, {"Focal", 50.0}})
        f.tool->AddInput(OrbID(id), id, CLSID_DataType_Number, TagList(), AutoNumber(value));
    f.tool->AddInput(OrbID("Target"), "Target", CLSID_DataType_Point, TagList(), AutoPoint(at.x, at.y, at.z - 1.0));
    return p;
}

OrbVec3 PointIn(const ViewerFixture &f, const char *id)
{
    const AutoPoint p(f.tool->FindInput(OrbID(id)), f.doc.GetCurrentTime());
    return p ? OrbVec3(p->X, p->Y, p->Z) : OrbVec3(-1, -1, -1);
}

OrbPoint ImageOf(OrbVec3 w)
{
    const double k = kD / (kD - w.z);
    return {0.5 + w.x * k, 0.5 + 2.0 * w.y * k};
}

} // namespace

class CameraControlTest : public QObject
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
    void keysAim();
    void insideTheViewerCamera();
};

void CameraControlTest::handles_data()
{
    QTest::addColumn<double>("zoom");
    QTest::addColumn<bool>("aim");    // the aim knob, else the position
    QTest::addColumn<bool>("target"); // the camera looks at a Target Input
    for (const double zoom : {1.0, 0.5}) {
        const QByteArray at = " at zoom " + QByteArray::number(zoom);
        QTest::newRow("position moves" + at) << zoom << false << false;
        QTest::newRow("aim turns the camera" + at) << zoom << true << false;
        QTest::newRow("aim moves the target" + at) << zoom << true << true;
    }
}

// The position knob and the aim knob, one metre ahead, dragged 40 pixels
// right: on the plane of each knob that faces the viewer's camera.
void CameraControlTest::handles()
{
    QFETCH(double, zoom);
    QFETCH(bool, aim);
    QFETCH(bool, target);
    ViewerFixture f;
    const OrbVec3 at(0.2, 0.0, 0.0);
    AddCamera(f, at, 0.0, target ? TagList{{CC_TargetInput, 5}} : TagList());
    QVERIFY(f.Show());
    f.viewer.SetView(zoom);
    QApplication::processEvents();
    const OrbVec3 knob = aim ? at + OrbVec3(0, 0, -1) : at;
    const QPoint from = f.At(ImageOf(knob));
    f.Drag(from, from + QPoint(40, 0), 4);
    const double dx = 40.0 * (kD - knob.z) / kD / (400.0 * zoom);
    if (!aim) {
        QVERIFY((PointIn(f, "Position") - (at + OrbVec3(dx, 0, 0))).Length() < 1e-9);
        QCOMPARE(f.doc.UndoNames(), QStringList{"Move Camera"});
    } else if (target) {
        QVERIFY((PointIn(f, "Target") - (knob + OrbVec3(dx, 0, 0))).Length() < 1e-9);
        QCOMPARE(NumberOf(f, "RotY"), 0.0);
        QCOMPARE(f.doc.UndoNames(), QStringList{"Aim Camera"});
    } else {
        // Looking at (x + dx, 0, -1) from x: panned right by atan(dx).
        QVERIFY(std::fabs(NumberOf(f, "RotY") + std::atan(dx) * 180.0 / M_PI) < 1e-9);
        QCOMPARE(NumberOf(f, "RotX"), 0.0);
        QCOMPARE(f.doc.UndoNames(), QStringList{"Aim Camera"});
    }
    QVERIFY(f.doc.Undo());
    QVERIFY((PointIn(f, "Position") - at).Length() < 1e-12);
    QCOMPARE(NumberOf(f, "RotY"), 0.0);
}

// With CC_KeysAim the arrows pan and tilt by a degree; the run is one step.
void CameraControlTest::keysAim()
{
    ViewerFixture f;
    AddCamera(f, {0, 0, 0}, 10.0, TagList{{CC_KeysAim, 1}});
    QVERIFY(f.Show());
    f.Key(Qt::Key_Left);
    f.Key(Qt::Key_Up, Qt::ShiftModifier);
    QCOMPARE(NumberOf(f, "RotY"), 11.0);
    QCOMPARE(NumberOf(f, "RotX"), 10.0);
    QCOMPARE(f.UndoSteps(), 2);
    QVERIFY((PointIn(f, "Position") - OrbVec3()).Length() == 0.0);
}

// A scene camera where the viewer's camera is, or behind it, or turned
// away: drawn clipped, never through infinity, and every drag writes
// finite numbers.
void CameraControlTest::insideTheViewerCamera()
{
    for (const OrbVec3 at : {OrbVec3(0, 0, kD), OrbVec3(0, 0, 3), OrbVec3(NAN, 0, 0)}) {
        ViewerFixture f;
        Input *p = AddCamera(f, at, 180.0);
        QVERIFY(f.Show());
        SweepDrags(f);
        for (const char *key : {"posX", "aimX", "rotY", "fov"})
            QVERIFY2(std::isfinite(StateOf(f.OverlayOf(p), key)) || std::isnan(at.x), key);
        QVERIFY(std::isfinite(NumberOf(f, "RotY")));
    }
}

QTEST_MAIN(CameraControlTest)
#include "CameraControlTest.moc"
