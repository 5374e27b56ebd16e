#include "widgets/CustomController.h"

#include "orbane/DIB.h"
#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

#include <QtTest>

using namespace Orbane;

namespace {

class Probe : public CustomController
{
public:
    Probe() : CustomController(nullptr, ScriptVal(), TagList()) {}

    int redraws = 0;

    void Redraw(bool) override { ++redraws; }
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
    void layoutKnob_data();
    void layoutKnob();
    void defaultGivesMarkerRoom_data();
    void defaultGivesMarkerRoom();
    void knobImageUses();
};

void CustomControllerTest::layoutKnob_data()
{
    QTest::addColumn<int>("track");
    QTest::addColumn<int>("reset");
    QTest::addColumn<int>("offset");
    QTest::addColumn<int>("knobTop");
    QTest::addColumn<int>("resetTop");
    // A knob 14 pixels high.
    QTest::newRow("centred, no marker") << 24 << 0 << 0 << 5 << 19;
    QTest::newRow("room for the marker") << 24 << 5 << 0 << 2 << 16;
    QTest::newRow("odd space rounds toward zero") << 25 << 0 << 0 << 5 << 19;
    QTest::newRow("offset below the track") << 24 << 5 << 2 << 1 << 17;
    QTest::newRow("lifted knob ignores the marker") << 24 << 5 << -4 << 7 << 3;
    QTest::newRow("track lower than the knob") << 10 << 0 << 0 << -2 << 12;
}

void CustomControllerTest::layoutKnob()
{
    QFETCH(int, track);
    QFETCH(int, reset);
    QFETCH(int, offset);
    QFETCH(int, knobTop);
    QFETCH(int, resetTop);
    int32 gotKnob = -99, gotReset = -99;
    CustomController::LayoutKnob(track, 14, reset, offset, gotKnob, gotReset);
    QCOMPARE(gotKnob, knobTop);
    QCOMPARE(gotReset, resetTop);
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
    // Order does not matter: a marker set after the default gets its room too.
    Probe later;
    later.SetDefault(def, false);
    if (image)
        later.SetResetImage(reset.dib);
    QCOMPARE(later.GetResetHeight(), height);
}

// Swapping knob images releases the old ones; the knob's rectangle follows
// the new image, an odd extra pixel to the right.
void CustomControllerTest::knobImageUses()
{
    Image a(11, 14), b(11, 14), c2(9, 9), reset(7, 5);
    {
        Probe c;
        c.SetKnobImage(a.dib, b.dib);
        c.SetResetImage(reset.dib);
        c.SetKnobImage(c2.dib, nullptr);
        QCOMPARE(a.dib->UseCount(), 1);
        QCOMPARE(b.dib->UseCount(), 1);
        QCOMPARE(c.GetKnobImagePressed(), nullptr);
        QCOMPARE(c.GetKnobRect(), OrbRectT<int32>(-4, 0, 5, 9));
    }
    QCOMPARE(c2.dib->UseCount(), 1);
    QCOMPARE(reset.dib->UseCount(), 1);
}

QTEST_MAIN(CustomControllerTest)
#include "CustomControllerTest.moc"
