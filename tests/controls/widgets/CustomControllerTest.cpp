#include "widgets/CustomController.h"

#include "WidgetTestSupport.h"

#include "orbane/DIB.h"
#include "orbane/StateDIBs.h"
#include "orbane/TimeCodeEdit.h"

#include <QtTest>

using namespace Orbane;

Q_DECLARE_METATYPE(OrbRectT<int32>)

namespace {

// The base controller with its edit slots recorded.
class Probe : public CustomController
{
public:
    Probe() : CustomController(nullptr, ScriptVal(), TagList()) {}

    QStringList calls;
    QList<double> distances;
    int redraws = 0;

    void Redraw(bool) override { ++redraws; }
    void OnEditStartDrag(TimeCodeEdit *) override { calls << "start"; }
    void OnEditEndDrag(TimeCodeEdit *) override { calls << "end"; }
    void OnEditDrag(float64 dist, TimeCodeEdit *) override
    {
        calls << "drag";
        distances << dist;
    }
};

struct Image
{
    DIB *dib;
    Image(int w, int h) : dib(new DIB(w, h)) {}
    ~Image() { dib->Recycle(); }
};

} // namespace

class CustomControllerTest : public QObject
{
    Q_OBJECT
private slots:
    void initialState();
    void imageRect_data();
    void imageRect();
    void layoutKnob_data();
    void layoutKnob();
    void trackRectLaysOutKnob();
    void defaultGivesMarkerRoom_data();
    void defaultGivesMarkerRoom();
    void knobImageUses();
    void knobImagesFromStates();
    void imagesReleasedOnDestruction();
    void attachedEditDrives();
};

void CustomControllerTest::initialState()
{
    Probe c;
    QCOMPARE(c.GetValue(), 0.0);
    QCOMPARE(c.GetDefault(), 1.7976931348623157e308);
    QVERIFY(!c.HasDefault());
    QCOMPARE(c.GetExponent(), 1.0);
    QCOMPARE(c.MapValue(-2.7), -2.7);
    QCOMPARE(c.GetKnobImage(), nullptr);
    QCOMPARE(c.GetResetHeight(), 0);
}

void CustomControllerTest::imageRect_data()
{
    QTest::addColumn<int>("w");
    QTest::addColumn<int>("h");
    QTest::addColumn<OrbRectT<int32>>("rect");
    QTest::newRow("even") << 10 << 4 << OrbRectT<int32>(-5, 0, 5, 4);
    QTest::newRow("odd puts extra pixel right") << 11 << 14 << OrbRectT<int32>(-5, 0, 6, 14);
    QTest::newRow("one pixel") << 1 << 1 << OrbRectT<int32>(0, 0, 1, 1);
}

void CustomControllerTest::imageRect()
{
    QFETCH(int, w);
    QFETCH(int, h);
    QFETCH(OrbRectT<int32>, rect);
    Image image(w, h);
    QCOMPARE(CustomController::ImageRect(image.dib), rect);
    QCOMPARE(CustomController::ImageRect(nullptr), OrbRectT<int32>());
}

void CustomControllerTest::layoutKnob_data()
{
    QTest::addColumn<int>("track");
    QTest::addColumn<int>("knob");
    QTest::addColumn<int>("reset");
    QTest::addColumn<int>("offset");
    QTest::addColumn<int>("knobTop");
    QTest::addColumn<int>("resetTop");
    QTest::newRow("centred, no marker") << 24 << 14 << 0 << 0 << 5 << 19;
    QTest::newRow("room for the marker") << 24 << 14 << 5 << 0 << 2 << 16;
    QTest::newRow("odd space rounds toward zero") << 25 << 14 << 0 << 0 << 5 << 19;
    QTest::newRow("offset below the track") << 24 << 14 << 5 << 2 << 1 << 17;
    QTest::newRow("lifted knob ignores the marker") << 24 << 14 << 5 << -4 << 7 << 3;
    QTest::newRow("track lower than the knob") << 10 << 14 << 0 << 0 << -2 << 12;
}

void CustomControllerTest::layoutKnob()
{
    QFETCH(int, track);
    QFETCH(int, knob);
    QFETCH(int, reset);
    QFETCH(int, offset);
    QFETCH(int, knobTop);
    QFETCH(int, resetTop);
    int32 gotKnob = -99, gotReset = -99;
    CustomController::LayoutKnob(track, knob, reset, offset, gotKnob, gotReset);
    QCOMPARE(gotKnob, knobTop);
    QCOMPARE(gotReset, resetTop);
}

void CustomControllerTest::trackRectLaysOutKnob()
{
    Probe c;
    c.SetTrackRect(OrbRectT<int32>(0, 10, 100, 34));
    QCOMPARE(c.GetKnobTop(), 0); // no knob yet: nothing laid out
    Image knob(11, 14), reset(7, 5);
    c.SetResetImage(reset.dib);
    c.SetDefault(0.5, false);
    c.SetKnobOffset(2);
    QCOMPARE(c.GetKnobTop(), 0); // the offset waits for the next layout
    c.SetKnobImage(knob.dib, nullptr);
    QCOMPARE(c.GetKnobTop(), 1);
    QCOMPARE(c.GetResetTop(), 17);
    QCOMPARE(c.GetKnobRect(), OrbRectT<int32>(-5, 0, 6, 14));
    QCOMPARE(c.GetTrackRect(), OrbRectT<int32>(0, 10, 100, 34));
}

void CustomControllerTest::defaultGivesMarkerRoom_data()
{
    QTest::addColumn<bool>("image");
    QTest::addColumn<double>("def");
    QTest::addColumn<int>("height");
    QTest::newRow("default and marker") << true << 0.25 << 5;
    QTest::newRow("no default") << true << 1.7976931348623157e308 << 0;
    QTest::newRow("no marker image") << false << 0.25 << 0;
}

void CustomControllerTest::defaultGivesMarkerRoom()
{
    QFETCH(bool, image);
    QFETCH(double, def);
    QFETCH(int, height);
    Image reset(7, 5);
    Probe c;
    if (image)
        c.SetResetImage(reset.dib);
    const int redraws = c.redraws;
    c.SetDefault(def, true);
    QCOMPARE(c.redraws, redraws + 1);
    QCOMPARE(c.GetResetHeight(), height);
    QCOMPARE(c.GetResetRect(), image ? OrbRectT<int32>(-3, 0, 4, 5) : OrbRectT<int32>());
    c.SetDefault(def, false);
    QCOMPARE(c.redraws, redraws + 1);
    // Order does not matter: a marker set after the default gets its room too.
    Probe later;
    later.SetDefault(def, false);
    if (image)
        later.SetResetImage(reset.dib);
    QCOMPARE(later.GetResetHeight(), height);
}

void CustomControllerTest::knobImageUses()
{
    Image a(11, 14), b(11, 14), c2(9, 9);
    {
        Probe c;
        c.SetKnobImage(a.dib, b.dib);
        QCOMPARE(a.dib->UseCount(), 4); // knob, second, third
        QCOMPARE(b.dib->UseCount(), 2);
        QCOMPARE(c.GetKnobImagePressed(), b.dib);
        c.SetKnobImage(c2.dib, nullptr);
        QCOMPARE(a.dib->UseCount(), 1);
        QCOMPARE(b.dib->UseCount(), 1);
        QCOMPARE(c.GetKnobImage(), c2.dib);
        QCOMPARE(c.GetKnobImagePressed(), nullptr);
        QCOMPARE(c.GetKnobRect(), OrbRectT<int32>(-4, 0, 5, 9));
    }
    QCOMPARE(c2.dib->UseCount(), 1);
}

void CustomControllerTest::knobImagesFromStates()
{
    Image a(11, 14), b(11, 14), c3(11, 14), d(11, 14);
    StateDIBs first, second;
    first.SetState(0, a.dib);
    first.SetState(1, b.dib);
    second.SetState(0, c3.dib);
    second.SetState(1, d.dib);
    Probe c;
    const int redraws = c.redraws;
    c.SetKnobImages(&first, &second);
    QCOMPARE(c.GetKnobImage(), a.dib);
    QCOMPARE(c.GetKnobImagePressed(), d.dib);
    QCOMPARE(b.dib->UseCount(), 3); // the test, the states, the widget
    QCOMPARE(c3.dib->UseCount(), 3);
    QCOMPARE(c.redraws, redraws + 1);
}

void CustomControllerTest::imagesReleasedOnDestruction()
{
    Image knob(11, 14), held(11, 14), reset(7, 5);
    {
        Probe c;
        c.SetKnobImage(knob.dib, held.dib);
        c.SetResetImage(reset.dib);
    }
    QCOMPARE(knob.dib->UseCount(), 1);
    QCOMPARE(held.dib->UseCount(), 1);
    QCOMPARE(reset.dib->UseCount(), 1);
}

void CustomControllerTest::attachedEditDrives()
{
    QWidget window;
    TimeCodeEdit *edit = new TimeCodeEdit(&window);
    edit->resize(100, 20);
    Probe *c = new Probe;
    c->setParent(&window);
    c->AttachEdit(edit);
    QVERIFY(edit->IsVirtual());
    window.show();
    QTest::mousePress(edit, Qt::LeftButton, Qt::NoModifier, QPoint(10, 10));
    MoveMouse(edit, QPoint(30, 10));
    QTest::mouseRelease(edit, Qt::LeftButton, Qt::NoModifier, QPoint(30, 10));
    QCOMPARE(c->calls, QStringList({"start", "drag", "end"}));
    QCOMPARE(c->distances, QList<double>({20.0}));
}

QTEST_MAIN(CustomControllerTest)
#include "CustomControllerTest.moc"
