#include "SliderFixture.h"
#include "WidgetTestSupport.h"

#include "orbane/TimeCodeEdit.h"

#include <QtTest>

#include <cmath>

using namespace Orbane;

namespace {

double Cube(double v, void *)
{
    return v * v * v;
}
double CubeRoot(double t, void *)
{
    return std::cbrt(t);
}

// A slider shown in its owner, range 0..1 over 200 pixels (0.005 a pixel),
// with spies on its four signals.
struct Shown
{
    TestOwner owner;
    SliderFixture f;
    CustomSlider *s;
    QSignalSpy valueChanged, drag, pressed, released;

    explicit Shown(double min = 0.0, double max = 1.0)
        : f(min, max), s(f.slider), valueChanged(s, SIGNAL(ValueChanged(float64))),
          drag(s, SIGNAL(dragSlider(CustomController *, int))), pressed(s, SIGNAL(Pressed(CustomController *))),
          released(s, SIGNAL(Released(CustomController *)))
    {
        s->setParent(&owner);
        s->SetOwner(&owner);
        s->move(0, 0);
        owner.resize(SliderFixture::Width, SliderFixture::Height);
        owner.show();
        QApplication::setActiveWindow(&owner);
        owner.resetUndos = 0;
    }
    ~Shown() { s->setParent(nullptr); }

    // The row through the middle of the knob.
    int KnobY() const { return s->GetTrackRect().y1 + s->GetKnobTop() + 7; }
    QPoint At(int x) const { return QPoint(x, KnobY()); }
    void Press(int x, Qt::KeyboardModifiers m = Qt::NoModifier) { QTest::mousePress(s, Qt::LeftButton, m, At(x)); }
    void Move(int x, Qt::KeyboardModifiers m = Qt::NoModifier) { MoveMouse(s, At(x), m); }
    void Release(int x, Qt::KeyboardModifiers m = Qt::NoModifier) { QTest::mouseRelease(s, Qt::LeftButton, m, At(x)); }
    QList<double> Values() const
    {
        QList<double> out;
        for (const QList<QVariant> &args : valueChanged)
            out << args.at(0).toDouble();
        return out;
    }
    QList<int> Firsts() const
    {
        QList<int> out;
        for (const QList<QVariant> &args : drag) {
            if (PointerArg<CustomController>(args.at(0)) != s)
                return {};
            out << args.at(1).toInt();
        }
        return out;
    }
};

} // namespace

class CustomSliderInteractionTest : public QObject
{
    Q_OBJECT
private slots:
    void pressDoesNotMoveKnob();
    void dragMovesByPixels();
    void dragBackSnapsToPressValue();
    void dragSnapsToDefault();
    void dragClamps_data();
    void dragClamps();
    void ctrlDragIsTenTimesSlower();
    void ctrlReleaseReAnchors();
    void ctrlPressReAnchors();
    void integerSnappingTruncates();
    void keys_data();
    void keys();
    void keyRepeatIsOneGesture();
    void integerStepsAtLeastOne();
    void twoSegmentStepsStopAtCentre();
    void mappedStepsMoveByTrackFractions();
    void altClickResets();
    void altClickWithoutDefault();
    void markerClickResets();
    void markerPressReleasedElsewhere();
    void trackPressPages_data();
    void trackPressPages();
    void trackHoldRepeats();
    void disabledIgnoresInput();
    void hover();
    void dragDrivesDocument();
    void editDrag();
};

void CustomSliderInteractionTest::pressDoesNotMoveKnob()
{
    Shown w;
    w.s->SetValue(0.123456, false);
    QCOMPARE(w.s->KnobX(), 30);
    w.Press(33);
    QCOMPARE(w.pressed.count(), 1);
    QCOMPARE(PointerArg<CustomController>(w.pressed.at(0).at(0)), w.s);
    QVERIFY(w.s->IsDragging());
    QCOMPARE(w.s->GetScaleAnchor(), 0.123456);
    w.Move(33);
    w.Release(33);
    QCOMPARE(w.s->GetValue(), 0.123456);
    QCOMPARE(w.valueChanged.count(), 0);
    QCOMPARE(w.released.count(), 1);
    QCOMPARE(PointerArg<CustomController>(w.released.at(0).at(0)), w.s);
    QCOMPARE(w.owner.resetUndos, 1);
    QVERIFY(!w.s->IsDragging());
}

void CustomSliderInteractionTest::dragMovesByPixels()
{
    Shown w;
    w.s->SetValue(0.25, false);
    w.Press(57); // two pixels right of the knob's centre
    w.Move(77);
    w.Move(97);
    w.Release(97);
    QCOMPARE(w.Values(), QList<double>({0.35, 0.45}));
    QCOMPARE(w.Firsts(), QList<int>({1, 0}));
    QCOMPARE(w.s->GetValue(), 0.45);
    QCOMPARE(w.owner.resetUndos, 1);
}

void CustomSliderInteractionTest::dragBackSnapsToPressValue()
{
    Shown w;
    w.s->SetValue(0.123456, false);
    w.Press(30);
    w.Move(50);
    QCOMPARE(w.s->GetValue(), 0.223);
    w.Move(30);
    w.Release(30);
    QCOMPARE(w.s->GetValue(), 0.123456);
}

void CustomSliderInteractionTest::dragSnapsToDefault()
{
    Shown w;
    w.s->SetDefault(0.5003, false);
    w.s->SetValue(0.2, false);
    w.Press(45);
    w.Move(105);
    QCOMPARE(w.s->GetValue(), 0.5003);
    w.Move(107);
    QCOMPARE(w.s->GetValue(), 0.51);
    w.Release(107);
}

void CustomSliderInteractionTest::dragClamps_data()
{
    QTest::addColumn<int>("x");
    QTest::addColumn<double>("value");
    QTest::newRow("past the start") << -100 << 0.0;
    QTest::newRow("past the end") << 500 << 1.0;
    QTest::newRow("first pixel") << 5 << 0.0;
    QTest::newRow("last pixel") << 205 << 1.0;
}

void CustomSliderInteractionTest::dragClamps()
{
    QFETCH(int, x);
    QFETCH(double, value);
    Shown w;
    w.s->SetValue(0.5, false);
    w.Press(105);
    w.Move(x);
    QCOMPARE(w.s->GetValue(), value);
    w.Release(x);
    QCOMPARE(w.s->GetValue(), value);
}

void CustomSliderInteractionTest::ctrlDragIsTenTimesSlower()
{
    Shown plain, fine;
    for (Shown *w : {&plain, &fine}) {
        w->s->SetValue(0.5, false);
        w->Press(105);
    }
    plain.Move(156);
    fine.Move(156, Qt::ControlModifier);
    QCOMPARE(plain.s->GetValue(), 0.755);
    // A tenth of the travel, kept to one more decimal.
    QCOMPARE(fine.s->GetValue(), 0.5255);
    plain.Release(156);
    fine.Release(156, Qt::ControlModifier);
}

void CustomSliderInteractionTest::ctrlReleaseReAnchors()
{
    Shown w;
    w.s->SetValue(0.5, false);
    w.Press(105);
    w.Move(155, Qt::ControlModifier);
    QCOMPARE(w.s->GetValue(), 0.525);
    QTest::keyRelease(w.s, Qt::Key_Control);
    QCOMPARE(w.s->GetValue(), 0.525); // the knob stays under the cursor
    QCOMPARE(w.s->GetScaleAnchor(), 0.525);
    w.Move(165);
    QCOMPARE(w.s->GetValue(), 0.575);
    w.Release(165);
    QCOMPARE(w.owner.resetUndos, 1);
}

void CustomSliderInteractionTest::ctrlPressReAnchors()
{
    Shown w;
    w.s->SetValue(0.5, false);
    w.Press(105);
    w.Move(125);
    QCOMPARE(w.s->GetValue(), 0.6);
    QTest::keyPress(w.s, Qt::Key_Control, Qt::ControlModifier);
    w.Move(135, Qt::ControlModifier);
    QCOMPARE(w.s->GetValue(), 0.605);
    w.Release(135, Qt::ControlModifier);
}

void CustomSliderInteractionTest::integerSnappingTruncates()
{
    Shown w(-10.0, 10.0);
    w.s->SetInteger(true);
    w.s->SetSnapToStep(true);
    w.s->SetValue(0.0, false);
    w.Press(105);
    w.Move(78); // -2.7 on this track
    QCOMPARE(w.Values(), QList<double>({-2.0}));
    QCOMPARE(w.s->GetValue(), -2.0);
    w.Release(78);
}

void CustomSliderInteractionTest::keys_data()
{
    QTest::addColumn<int>("key");
    QTest::addColumn<int>("modifiers");
    QTest::addColumn<double>("start");
    QTest::addColumn<double>("expected");
    const int none = Qt::NoModifier, shift = Qt::ShiftModifier, ctrl = Qt::ControlModifier;
    QTest::newRow("right") << int(Qt::Key_Right) << none << 0.5 << 0.6;
    QTest::newRow("shift right") << int(Qt::Key_Right) << shift << 0.5 << 0.75;
    QTest::newRow("ctrl right") << int(Qt::Key_Right) << ctrl << 0.5 << 0.51;
    QTest::newRow("ctrl wins over shift") << int(Qt::Key_Right) << (ctrl | shift) << 0.5 << 0.51;
    QTest::newRow("left") << int(Qt::Key_Left) << none << 0.5 << 0.4;
    QTest::newRow("shift left") << int(Qt::Key_Left) << shift << 0.5 << 0.25;
    QTest::newRow("ctrl left") << int(Qt::Key_Left) << ctrl << 0.5 << 0.49;
    QTest::newRow("page up") << int(Qt::Key_PageUp) << none << 0.5 << 0.6;
    QTest::newRow("shift page up") << int(Qt::Key_PageUp) << shift << 0.5 << 0.75;
    QTest::newRow("ctrl page down") << int(Qt::Key_PageDown) << ctrl << 0.5 << 0.49;
    QTest::newRow("page down") << int(Qt::Key_PageDown) << none << 0.5 << 0.4;
    QTest::newRow("home") << int(Qt::Key_Home) << none << 0.5 << 0.0;
    QTest::newRow("end") << int(Qt::Key_End) << shift << 0.5 << 1.0;
    QTest::newRow("clamped at the end") << int(Qt::Key_Right) << shift << 0.95 << 1.0;
    QTest::newRow("clamped at the start") << int(Qt::Key_Left) << none << 0.05 << 0.0;
}

void CustomSliderInteractionTest::keys()
{
    QFETCH(int, key);
    QFETCH(int, modifiers);
    QFETCH(double, start);
    QFETCH(double, expected);
    Shown w;
    w.s->SetSteps(0.01, 0.1, 0.25);
    w.s->SetValue(start, false);
    w.s->setFocus();
    QTest::keyClick(w.s, Qt::Key(key), Qt::KeyboardModifiers(modifiers));
    QCOMPARE(w.s->GetValue(), expected);
    QCOMPARE(w.Values(), QList<double>({expected}));
    QCOMPARE(w.Firsts(), QList<int>({1}));
    QCOMPARE(w.owner.resetUndos, 1);
}

void CustomSliderInteractionTest::keyRepeatIsOneGesture()
{
    Shown w;
    w.s->SetSteps(0.01, 0.1, 0.25);
    w.s->setFocus();
    QTest::keyPress(w.s, Qt::Key_Right);
    QKeyEvent repeat(QEvent::KeyPress, Qt::Key_Right, Qt::NoModifier, QString(), true);
    QApplication::sendEvent(w.s, &repeat);
    QKeyEvent repeatRelease(QEvent::KeyRelease, Qt::Key_Right, Qt::NoModifier, QString(), true);
    QApplication::sendEvent(w.s, &repeatRelease);
    QCOMPARE(w.owner.resetUndos, 0);
    QTest::keyRelease(w.s, Qt::Key_Right);
    QCOMPARE(w.Firsts(), QList<int>({1, 0}));
    QCOMPARE(w.owner.resetUndos, 1);
    QTest::keyClick(w.s, Qt::Key_Left);
    QCOMPARE(w.Firsts(), QList<int>({1, 0, 1}));
    QCOMPARE(w.owner.resetUndos, 2);
    QTest::keyClick(w.s, Qt::Key_Up); // not the slider's: no gesture
    QCOMPARE(w.owner.resetUndos, 2);
}

void CustomSliderInteractionTest::integerStepsAtLeastOne()
{
    Shown w(0.0, 10.0);
    w.s->SetSteps(0.01, 0.1, 0.25);
    w.s->SetInteger(true);
    w.s->SetValue(5.0, false);
    w.s->setFocus();
    QTest::keyClick(w.s, Qt::Key_Right, Qt::ControlModifier);
    QCOMPARE(w.s->GetValue(), 6.0);
    QTest::keyClick(w.s, Qt::Key_Left, Qt::ShiftModifier);
    QCOMPARE(w.s->GetValue(), 5.0);
}

void CustomSliderInteractionTest::twoSegmentStepsStopAtCentre()
{
    Shown w(0.0, 10.0);
    w.s->SetCentre(1.0);
    w.s->SetStepsDown(0.1, 0.5, 1.0);
    w.s->SetStepsUp(1.0, 3.0, 5.0);
    w.s->SetValue(0.8, false);
    w.s->setFocus();
    QTest::keyClick(w.s, Qt::Key_Right);
    QCOMPARE(w.s->GetValue(), 1.0);
    QTest::keyClick(w.s, Qt::Key_Right);
    QCOMPARE(w.s->GetValue(), 4.0);
    QTest::keyClick(w.s, Qt::Key_Left);
    QCOMPARE(w.s->GetValue(), 1.0);
    QTest::keyClick(w.s, Qt::Key_Left);
    QCOMPARE(w.s->GetValue(), 0.5);
    w.s->SetValue(2.0, false);
    QTest::keyClick(w.s, Qt::Key_Left);
    QCOMPARE(w.s->GetValue(), 1.0);
}

void CustomSliderInteractionTest::mappedStepsMoveByTrackFractions()
{
    Shown w(0.0, 2.0);
    w.s->SetMappingCallbacks(Cube, nullptr, CubeRoot, nullptr);
    w.s->SetValue(1.0, false); // pixel 30
    w.s->setFocus();
    // Each level moves the knob by a fraction of the track, give or take
    // the rounding of the value.
    struct Row
    {
        Qt::Key key;
        Qt::KeyboardModifiers modifiers;
        double pixels, tolerance;
    };
    for (const Row &row :
         {Row{Qt::Key_Right, Qt::NoModifier, 2.0, 0.2}, Row{Qt::Key_Right, Qt::ShiftModifier, 20.0, 0.2},
          Row{Qt::Key_Left, Qt::ControlModifier, -0.2, 0.03}}) {
        const double before = w.s->ValueToPixel(w.s->GetValue());
        QTest::keyClick(w.s, row.key, row.modifiers);
        QVERIFY(qAbs(w.s->ValueToPixel(w.s->GetValue()) - before - row.pixels) < row.tolerance);
    }
}

void CustomSliderInteractionTest::altClickResets()
{
    Shown w;
    w.s->SetDefault(0.3, false);
    w.s->SetValue(0.8, false);
    QTest::mouseClick(w.s, Qt::LeftButton, Qt::AltModifier, w.At(150));
    QCOMPARE(w.s->GetValue(), 0.3);
    QCOMPARE(w.Values(), QList<double>({0.3}));
    QCOMPARE(w.Firsts(), QList<int>({1}));
    QCOMPARE(w.pressed.count(), 1);
    QCOMPARE(w.released.count(), 1);
    QCOMPARE(w.owner.resetUndos, 1);
}

void CustomSliderInteractionTest::altClickWithoutDefault()
{
    Shown w;
    w.s->SetValue(0.8, false);
    QTest::mouseClick(w.s, Qt::LeftButton, Qt::AltModifier, w.At(165));
    QCOMPARE(w.s->GetValue(), 0.8);
    QCOMPARE(w.valueChanged.count(), 0);
}

void CustomSliderInteractionTest::markerClickResets()
{
    Shown w;
    w.s->SetDefault(0.3, false);
    w.s->SetValue(0.8, false);
    const QPoint marker(65, w.s->GetTrackRect().y1 + w.s->GetResetTop() + 2);
    QTest::mousePress(w.s, Qt::LeftButton, Qt::NoModifier, marker);
    QVERIFY(w.s->IsResetArmed());
    QCOMPARE(w.s->GetValue(), 0.8);
    QTest::mouseRelease(w.s, Qt::LeftButton, Qt::NoModifier, marker);
    QCOMPARE(w.s->GetValue(), 0.3);
    QCOMPARE(w.Firsts(), QList<int>({1}));
}

void CustomSliderInteractionTest::markerPressReleasedElsewhere()
{
    Shown w;
    w.s->SetDefault(0.3, false);
    w.s->SetValue(0.8, false);
    const int markerY = w.s->GetTrackRect().y1 + w.s->GetResetTop() + 2;
    QTest::mousePress(w.s, Qt::LeftButton, Qt::NoModifier, QPoint(65, markerY));
    QTest::mouseRelease(w.s, Qt::LeftButton, Qt::NoModifier, QPoint(120, markerY));
    QCOMPARE(w.s->GetValue(), 0.8);
    QCOMPARE(w.owner.resetUndos, 1);
}

void CustomSliderInteractionTest::trackPressPages_data()
{
    QTest::addColumn<int>("x");
    QTest::addColumn<int>("modifiers");
    QTest::addColumn<double>("expected");
    QTest::newRow("left of the knob") << 20 << int(Qt::NoModifier) << 0.25;
    QTest::newRow("right of the knob") << 190 << int(Qt::NoModifier) << 0.75;
    QTest::newRow("ctrl pages finely") << 190 << int(Qt::ControlModifier) << 0.51;
    QTest::newRow("just left of the widget") << -9 << int(Qt::NoModifier) << 0.25;
}

void CustomSliderInteractionTest::trackPressPages()
{
    QFETCH(int, x);
    QFETCH(int, modifiers);
    QFETCH(double, expected);
    Shown w;
    w.s->SetSteps(0.01, 0.1, 0.25);
    w.s->SetValue(0.5, false);
    w.Press(x, Qt::KeyboardModifiers(modifiers));
    QCOMPARE(w.s->GetValue(), expected);
    w.Release(x, Qt::KeyboardModifiers(modifiers));
    QCOMPARE(w.s->GetValue(), expected);
    QCOMPARE(w.Firsts(), QList<int>({1}));
    QCOMPARE(w.owner.resetUndos, 1);
}

void CustomSliderInteractionTest::trackHoldRepeats()
{
    Shown w;
    w.s->SetSteps(0.01, 0.1, 0.1);
    w.s->SetValue(0.9, false);
    w.Press(20);
    QCOMPARE(w.s->GetValue(), 0.8);
    QTRY_VERIFY_WITH_TIMEOUT(w.s->GetValue() < 0.65, 10000);
    w.Release(20);
    const double stopped = w.s->GetValue();
    QTest::qWait(4 * CustomSlider::RepeatInterval * (CustomSlider::RepeatDelay + 2));
    QCOMPARE(w.s->GetValue(), stopped);
    QCOMPARE(w.Firsts().value(0), 1);
    QVERIFY(!w.Firsts().mid(1).contains(1));
}

void CustomSliderInteractionTest::disabledIgnoresInput()
{
    Shown w;
    w.s->SetValue(0.5, false);
    w.s->SetDisabled(true);
    w.Press(105);
    w.Move(150);
    w.Release(150);
    w.s->setFocus();
    QTest::keyClick(w.s, Qt::Key_Right);
    QCOMPARE(w.s->GetValue(), 0.5);
    QCOMPARE(w.pressed.count(), 0);
    QCOMPARE(w.valueChanged.count(), 0);
}

void CustomSliderInteractionTest::hover()
{
    Shown w;
    w.s->SetDefault(0.3, false);
    w.s->SetValue(0.5, false);
    QEvent enter(QEvent::Enter);
    QApplication::sendEvent(w.s, &enter);
    QVERIFY(w.s->hasMouseTracking());
    MoveMouse(w.s, w.At(105), Qt::NoModifier, Qt::NoButton);
    QVERIFY(w.s->IsHoverKnob());
    MoveMouse(w.s, w.At(160), Qt::NoModifier, Qt::NoButton);
    QVERIFY(!w.s->IsHoverKnob());
    QVERIFY(w.s->IsHoverTrack());
    const QPoint marker(65, w.s->GetTrackRect().y1 + w.s->GetResetTop() + 2);
    MoveMouse(w.s, marker, Qt::AltModifier, Qt::NoButton); // Alt: no hover tracking
    QVERIFY(w.s->IsHoverTrack());
    MoveMouse(w.s, marker, Qt::NoModifier, Qt::NoButton);
    QVERIFY(w.s->IsHoverReset());
    QEvent leave(QEvent::Leave);
    QApplication::sendEvent(w.s, &leave);
    QVERIFY(!w.s->IsHoverReset() && !w.s->IsHoverKnob() && !w.s->IsHoverTrack());
    QVERIFY(!w.s->hasMouseTracking());
}

void CustomSliderInteractionTest::dragDrivesDocument()
{
    OrbaneDoc doc;
    QSignalSpy renders(&doc, SIGNAL(syncRenderRequested()));
    Shown w;
    w.owner.doc = &doc;
    w.s->SetValue(0.5, false);
    w.Press(105);
    QVERIFY(doc.GetAutoProxy());
    w.Move(125);
    w.Release(125);
    QVERIFY(!doc.GetAutoProxy());
    QCOMPARE(renders.count(), 1);
    // A page step is no drag: no proxy, no render.
    w.Press(20);
    QVERIFY(!doc.GetAutoProxy());
    w.Release(20);
    QCOMPARE(renders.count(), 1);
}

void CustomSliderInteractionTest::editDrag()
{
    Shown w;
    TimeCodeEdit *edit = new TimeCodeEdit(&w.owner);
    edit->setGeometry(0, 0, 100, 20);
    edit->show();
    w.s->AttachEdit(edit);
    w.s->SetValue(0.5, false);
    QTest::mousePress(edit, Qt::LeftButton, Qt::NoModifier, QPoint(10, 10));
    MoveMouse(edit, QPoint(40, 10)); // a unit of 0.001 a pixel for a range of 1
    QCOMPARE(w.s->GetValue(), 0.53);
    MoveMouse(edit, QPoint(640, 10));
    QCOMPARE(w.s->GetValue(), 1.0);
    QCOMPARE(edit->GetDragDistance(), 500.0);
    MoveMouse(edit, QPoint(630, 10)); // turns round at once
    QCOMPARE(w.s->GetValue(), 0.99);
    QTest::mouseRelease(edit, Qt::LeftButton, Qt::NoModifier, QPoint(630, 10));
    QCOMPARE(w.Firsts(), QList<int>({1, 0, 0}));
    QCOMPARE(w.owner.resetUndos, 1);
}

QTEST_MAIN(CustomSliderInteractionTest)
#include "CustomSliderInteractionTest.moc"
