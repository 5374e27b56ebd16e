#include "OverlayProbe.h"
#include "ViewerFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"

#include <QtTest>

#include <cmath>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

constexpr Tag LC_LightType = 0x10068000;
constexpr double kD = 50.0 / 36.0; // the default view's distance

OrbPoint ImageOf(OrbVec3 w)
{
    const double k = kD / (kD - w.z);
    return {0.5 + w.x * k, 0.5 + 2.0 * w.y * k};
}

OrbVec3 PointIn(const ViewerFixture &f, const char *id)
{
    const AutoPoint p(f.tool->FindInput(OrbID(id)), f.doc.GetCurrentTime());
    return p ? OrbVec3(p->X, p->Y, p->Z) : OrbVec3(-1, -1, -1);
}

} // namespace

class LightControlTest : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase()
    {
        std::string why;
        QVERIFY2(ViewerFixture::LoadControls(&why), why.c_str());
    }

    void drags_data();
    void drags();
};

void LightControlTest::drags_data()
{
    QTest::addColumn<int>("type");
    QTest::addColumn<double>("zoom");
    QTest::addColumn<bool>("aim");
    for (const double zoom : {1.0, 0.5}) {
        const QByteArray at = " at zoom " + QByteArray::number(zoom);
        QTest::newRow("spot: the position moves" + at) << 2 << zoom << false;
        QTest::newRow("spot: the aim moves the target" + at) << 2 << zoom << true;
        QTest::newRow("directional: the aim moves the target" + at) << 0 << zoom << true;
        QTest::newRow("point: no aim to grab" + at) << 1 << zoom << true;
    }
}

// Input 0 the position, 1 the target, 2 the cone; each knob dragged 30
// pixels right on its own depth's plane, one named step.
void LightControlTest::drags()
{
    QFETCH(int, type);
    QFETCH(double, zoom);
    QFETCH(bool, aim);
    ViewerFixture f;
    const OrbVec3 at(-0.2, 0.1, 0.0), target(0.1, -0.1, -0.5);
    Input *p = f.tool->AddInput(OrbID("Position"), "Position", CLSID_DataType_Point,
                                TagList{{INPA_PreviewControl, OrbID("LightControl")},
                                        {INPA_OverlayInput, OrbID("Target")},
                                        {INPA_OverlayInput, OrbID("Cone")},
                                        {LC_LightType, type}},
                                AutoPoint(at.x, at.y, at.z));
    f.tool->AddInput(OrbID("Target"), "Target", CLSID_DataType_Point, TagList(),
                     AutoPoint(target.x, target.y, target.z));
    f.tool->AddInput(OrbID("Cone"), "Cone", CLSID_DataType_Number, TagList(), AutoNumber(40.0));
    QVERIFY(f.Show());
    f.viewer.SetView(zoom);
    QApplication::processEvents();
    QCOMPARE(StateOf(f.OverlayOf(p), "lightType"), double(type));
    const OrbVec3 knob = aim ? target : at;
    const QPoint from = f.At(ImageOf(knob));
    f.Drag(from, from + QPoint(30, 0), 4);
    const OrbVec3 moved = knob + OrbVec3(30.0 * (kD - knob.z) / kD / (400.0 * zoom), 0, 0);
    if (type == 1) {
        QCOMPARE(f.UndoSteps(), 0);
        QVERIFY((PointIn(f, "Target") - target).Length() == 0.0);
        return;
    }
    QVERIFY((PointIn(f, aim ? "Target" : "Position") - moved).Length() < 1e-9);
    QCOMPARE(f.doc.UndoNames(), QStringList{aim ? "Aim Light" : "Move Light"});
    QVERIFY(f.doc.Undo());
    QVERIFY((PointIn(f, "Target") - target).Length() < 1e-12 && (PointIn(f, "Position") - at).Length() < 1e-12);
}

QTEST_MAIN(LightControlTest)
#include "LightControlTest.moc"
