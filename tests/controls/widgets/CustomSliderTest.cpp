#include "widgets/CustomSlider.h"

#include "WidgetTestSupport.h"

#include "orbane/AutoRef.h"
#include "orbane/DIB.h"
#include "orbane/Gradient.h"
#include "orbane/TimeCodeEdit.h"

#include <QPaintEvent>
#include <QtTest>

using namespace Orbane;

namespace {

const QColor kKnob(200, 200, 200), kHeld(240, 160, 60), kMarker(150, 150, 150);

// A mouse move with modifiers and the button held, which QTest::mouseMove
// cannot send.
void MoveMouse(QWidget *widget, const QPoint &pos, Qt::KeyboardModifiers modifiers = Qt::NoModifier)
{
    QMouseEvent event(QEvent::MouseMove, pos, widget->mapToGlobal(pos), Qt::NoButton, Qt::LeftButton, modifiers);
    QApplication::sendEvent(widget, &event);
}

template <class T> QList<T> Column(const QSignalSpy &spy, int argument)
{
    QList<T> out;
    for (const QList<QVariant> &args : spy)
        out << args.at(argument).value<T>();
    return out;
}

// A pointer argument of a spied signal as it was emitted. QVariant's own
// conversion would treat it as a QObject pointer, which a class whose first
// base is the host Object is not at the same address.
template <class T> T *PointerArg(const QVariant &arg)
{
    return *static_cast<T *const *>(arg.constData());
}

class RecordingSlider : public CustomSlider
{
public:
    QList<QRect> painted;

protected:
    void paintEvent(QPaintEvent *event) override
    {
        painted << event->rect();
        CustomSlider::paintEvent(event);
    }
};

// A slider shown in its owner, with spies on its signals. Its track runs
// from pixel 5 to pixel 205 (an 11-pixel knob on a 211-pixel widget): the
// range 0..1 is 0.005 a pixel.
struct Shown
{
    static constexpr int Width = 211, Height = 24;

    TestOwner owner;
    DIB *knob = new DIB(11, 14), *held = new DIB(11, 14), *marker = new DIB(7, 5);
    CustomSlider *s;
    QSignalSpy valueChanged, drag, pressed;

    explicit Shown(double min = 0.0, double max = 1.0, CustomSlider *slider = new CustomSlider)
        : s(slider), valueChanged(s, SIGNAL(ValueChanged(float64))),
          drag(s, SIGNAL(dragSlider(CustomController *, int))), pressed(s, SIGNAL(Pressed(CustomController *)))
    {
        knob->Fill(kKnob);
        held->Fill(kHeld);
        marker->Fill(kMarker);
        s->SetKnobImage(knob, held);
        s->SetResetImage(marker);
        s->SetAllowedRange(min, max, false);
        s->SetScale(min, max, false);
        s->SetRange(min, max);
        s->SetTrackRect(OrbRectT<int32>(0, 0, Width, Height));
        s->resize(Width, Height);
        s->setParent(&owner);
        s->SetOwner(&owner);
        owner.resize(Width, Height);
        owner.show();
        QVERIFY(QTest::qWaitForWindowExposed(&owner));
        QApplication::setActiveWindow(&owner);
        s->setFocus();
        owner.resetUndos = 0;
    }
    ~Shown()
    {
        s->setParent(nullptr);
        delete s;
        for (DIB *dib : {knob, held, marker})
            dib->Recycle();
    }

    // The row through the middle of the knob, and the reset marker's row.
    int KnobY() const { return s->GetTrackRect().y1 + s->GetKnobTop() + 7; }
    QPoint At(int x) const { return QPoint(x, KnobY()); }
    QPoint Marker(int x) const { return QPoint(x, s->GetTrackRect().y1 + s->GetResetTop() + 2); }
    void Key(Qt::Key key, Qt::KeyboardModifiers m = Qt::NoModifier) { QTest::keyClick(s, key, m); }
    QColor Pixel(int x, int y) const
    {
        const qreal r = s->devicePixelRatioF();
        return s->grab().toImage().pixelColor(int(x * r), int(y * r));
    }
    QColor OnTrack(int x) const { return Pixel(x, KnobY()); }
    QList<double> Values() const { return Column<double>(valueChanged, 0); }
    // The "first of a gesture" flag of each drag signal.
    QList<int> Firsts() const { return Column<int>(drag, 1); }
};

// One step of a gesture: "press X", "move X" or "release X" on the knob's
// row, or on the marker's row after "marker", with "ctrl" at the end for the
// Control key held; "ctrl down" and "ctrl up" press and let go of it.
void Run(Shown &w, const QString &step)
{
    if (step == "ctrl down")
        return QTest::keyPress(w.s, Qt::Key_Control, Qt::ControlModifier);
    if (step == "ctrl up")
        return QTest::keyRelease(w.s, Qt::Key_Control);
    QStringList words = step.split(' ');
    const bool marker = words.first() == "marker";
    if (marker)
        words.removeFirst();
    const Qt::KeyboardModifiers m(words.last() == "ctrl" ? Qt::ControlModifier : Qt::NoModifier);
    const QPoint at = marker ? w.Marker(words[1].toInt()) : w.At(words[1].toInt());
    if (words[0] == "press")
        QTest::mousePress(w.s, Qt::LeftButton, m, at);
    else if (words[0] == "move")
        MoveMouse(w.s, at, m);
    else
        QTest::mouseRelease(w.s, Qt::LeftButton, m, at);
}

bool Close(const QColor &a, const QColor &b, int tol = 3)
{
    return qAbs(a.red() - b.red()) <= tol && qAbs(a.green() - b.green()) <= tol && qAbs(a.blue() - b.blue()) <= tol;
}

Gradient *Ramp(const GradientColor &from, const GradientColor &to)
{
    Gradient *ramp = new Gradient;
    ramp->AddStop(0.0, from);
    ramp->AddStop(1.0, to);
    return ramp;
}

} // namespace

class CustomSliderTest : public QObject
{
    Q_OBJECT
private slots:
    void scaleRange();
    void steps_data();
    void steps();
    void gestures_data();
    void gestures();
    void keySteps();
    void dragDrivesDocument();
    void editDrag();
    void knobPixels();
    void gradientPaintsTrack();
    void repaintsOnlyWhatChanged();
};

// SetRange orders its ends and clamps value and centre into them; where an
// end stays, the scale the user set at that end is kept.
void CustomSliderTest::scaleRange()
{
    Shown w(-100.0, 100.0);
    w.s->SetValue(50.0, false);
    w.s->SetCentre(-60.0);
    w.s->SetRange(10.0, -10.0);
    QCOMPARE(w.s->GetMinScale(), -10.0);
    QCOMPARE(w.s->GetMaxScale(), 10.0);
    QCOMPARE(w.s->GetValue(), 10.0);
    QCOMPARE(w.s->GetCentre(), -10.0);
    // A centre at an end of the range leaves the track linear.
    w.s->SetCentre(-10.0);
    QVERIFY(!w.s->IsTwoSegment());
    w.s->SetScale(-20.0, 20.0, false);
    w.s->SetRange(-10.0, 50.0);
    QCOMPARE(w.s->GetMinScale(), -20.0);
    QCOMPARE(w.s->GetMaxScale(), 50.0);
}

// Step and tick counts divide each side of the centre; one tick counts as two.
void CustomSliderTest::steps_data()
{
    QTest::addColumn<double>("centre");
    QTest::addColumn<int>("stepCount");
    QTest::addColumn<int>("tickCount");
    QTest::addColumn<QList<double>>("expected"); // normal down, up; coarse down, up
    QTest::newRow("no counts change nothing") << -1.0 << 0 << 0 << QList<double>{1, 1, 1, 1};
    QTest::newRow("one tick becomes two") << -1.0 << 0 << 1 << QList<double>{1, 1, 8, 8};
    QTest::newRow("sixteen steps, five ticks") << -1.0 << 16 << 5 << QList<double>{0.5, 0.5, 2, 2};
    QTest::newRow("two segments") << 2.0 << 4 << 5 << QList<double>{0.5, 1.5, 0.5, 1.5};
}

void CustomSliderTest::steps()
{
    QFETCH(double, centre);
    QFETCH(int, stepCount);
    QFETCH(int, tickCount);
    QFETCH(QList<double>, expected);
    Shown w(0.0, 8.0);
    if (centre >= 0.0)
        w.s->SetCentre(centre);
    w.s->SetStepCount(stepCount);
    w.s->SetTickCount(tickCount);
    const auto normal = CustomSlider::STEP_Normal, coarse = CustomSlider::STEP_Coarse;
    QCOMPARE(QList<double>(
                 {w.s->GetStepDown(normal), w.s->GetStepUp(normal), w.s->GetStepDown(coarse), w.s->GetStepUp(coarse)}),
             expected);
}

// Mouse gestures on a slider with the default 0.3 (its marker at x 65) and
// the steps 0.01, 0.1 and 0.25: the values signalled; the first change of a
// gesture says so; every release closes the owner's undo step.
void CustomSliderTest::gestures_data()
{
    QTest::addColumn<double>("start");
    QTest::addColumn<QStringList>("steps");
    QTest::addColumn<QList<double>>("values");
    using Steps = QStringList;
    using Values = QList<double>;
    // The knob of 0.123456 is at x 30: a press at 33 keeps the 3 pixels.
    QTest::newRow("press off the knob's centre")
        << 0.123456 << Steps{"press 33", "move 33", "move 53", "move 73", "release 73"} << Values{0.223, 0.323};
    // A change of Ctrl re-anchors at the current value, the knob under the cursor.
    QTest::newRow("Ctrl let go") << 0.5 << Steps{"press 105", "move 155 ctrl", "ctrl up", "move 165", "release 165"}
                                 << Values{0.525, 0.575};
    QTest::newRow("Ctrl pressed") << 0.5
                                  << Steps{"press 105", "move 155", "ctrl down", "move 165 ctrl", "release 165 ctrl"}
                                  << Values{0.75, 0.755};
    QTest::newRow("marker let go elsewhere") << 0.8 << Steps{"marker press 65", "marker release 120"} << Values{};
    QTest::newRow("marker click resets") << 0.8 << Steps{"marker press 65", "marker release 65"} << Values{0.3};
    QTest::newRow("page left of the knob") << 0.5 << Steps{"press 20", "release 20"} << Values{0.25};
    QTest::newRow("page right of the knob") << 0.5 << Steps{"press 190", "release 190"} << Values{0.75};
    QTest::newRow("Ctrl pages finely") << 0.5 << Steps{"press 190 ctrl", "release 190 ctrl"} << Values{0.51};
    QTest::newRow("page from just left of the widget") << 0.5 << Steps{"press -9", "release -9"} << Values{0.25};
}

void CustomSliderTest::gestures()
{
    QFETCH(double, start);
    QFETCH(QStringList, steps);
    QFETCH(QList<double>, values);
    Shown w;
    QSignalSpy released(w.s, SIGNAL(Released(CustomController *)));
    w.s->SetSteps(0.01, 0.1, 0.25);
    w.s->SetDefault(0.3, false);
    w.s->SetValue(start, false);
    for (const QString &step : steps)
        Run(w, step);
    QCOMPARE(w.Values(), values);
    QList<int> firsts;
    for (int i = 0; i < values.size(); ++i)
        firsts << (i == 0 ? 1 : 0);
    QCOMPARE(w.Firsts(), firsts);
    if (!values.isEmpty())
        QCOMPARE(PointerArg<CustomController>(w.drag.at(0).at(0)), w.s);
    QCOMPARE(PointerArg<CustomController>(w.pressed.at(0).at(0)), w.s);
    const int releases = steps.filter("release").size();
    QCOMPARE(released.count(), releases);
    QCOMPARE(w.owner.resetUndos, releases);
    QVERIFY(!w.s->IsDragging());
}

// Integer sliders step by at least 1 at every level; on two segments a step
// stops at the centre before taking the other side's size.
void CustomSliderTest::keySteps()
{
    Shown w(0.0, 10.0);
    w.s->SetSteps(0.01, 0.1, 0.25);
    w.s->SetInteger(true);
    w.s->SetValue(5.0, false);
    w.Key(Qt::Key_Right, Qt::ControlModifier);
    QCOMPARE(w.s->GetValue(), 6.0);
    w.Key(Qt::Key_Left, Qt::ShiftModifier);
    QCOMPARE(w.s->GetValue(), 5.0);
    w.s->SetInteger(false);
    w.s->SetCentre(1.0);
    w.s->SetStepsDown(0.1, 0.5, 1.0);
    w.s->SetStepsUp(1.0, 3.0, 5.0);
    w.s->SetValue(0.8, false);
    QList<double> values;
    for (Qt::Key key : {Qt::Key_Right, Qt::Key_Right, Qt::Key_Left, Qt::Key_Left}) {
        w.Key(key);
        values << w.s->GetValue();
    }
    QCOMPARE(values, QList<double>({1.0, 4.0, 1.0, 0.5}));
    w.s->SetValue(2.0, false);
    w.Key(Qt::Key_Left);
    QCOMPARE(w.s->GetValue(), 1.0);
}

// A knob drag turns the document's automatic proxy on while it lasts and
// asks for one render at the end; a page step does neither.
void CustomSliderTest::dragDrivesDocument()
{
    OrbaneDoc doc;
    QSignalSpy renders(&doc, SIGNAL(syncRenderRequested()));
    Shown w;
    w.owner.doc = &doc;
    w.s->SetValue(0.5, false);
    Run(w, "press 105");
    QVERIFY(doc.GetAutoProxy());
    Run(w, "move 125");
    Run(w, "release 125");
    QVERIFY(!doc.GetAutoProxy());
    QCOMPARE(renders.count(), 1);
    Run(w, "press 20");
    QVERIFY(!doc.GetAutoProxy());
    Run(w, "release 20");
    QCOMPARE(renders.count(), 1);
}

void CustomSliderTest::editDrag()
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

// The knob is drawn at the value, the marker at the default while the value
// is elsewhere. Pressed, the knob shows its held image; let go over it, it
// is lit; away from it, plain again; disabled, faded and deaf to mouse and keys.
void CustomSliderTest::knobPixels()
{
    Shown w;
    w.s->SetDefault(0.3, true);
    w.s->SetValue(0.8, true);
    const int markerY = w.Marker(65).y();
    QVERIFY(Close(w.OnTrack(165), kKnob));
    QVERIFY(Close(w.Pixel(165, 0), w.owner.background));
    QVERIFY(Close(w.Pixel(65, markerY), kMarker));
    w.s->SetValue(0.3, true);
    QVERIFY(Close(w.OnTrack(65), kKnob));
    QVERIFY(!Close(w.OnTrack(165), kKnob));
    QVERIFY(Close(w.Pixel(65, markerY), w.owner.background));
    const QPoint knob = w.At(65);
    QEvent enter(QEvent::Enter), leave(QEvent::Leave); // hover needs the tracking that entering turns on
    QApplication::sendEvent(w.s, &enter);
    QTest::mousePress(w.s, Qt::LeftButton, Qt::NoModifier, knob);
    QVERIFY(Close(w.OnTrack(65), kHeld));
    QTest::mouseRelease(w.s, Qt::LeftButton, Qt::NoModifier, knob);
    QVERIFY(w.OnTrack(65).lightness() > kKnob.lightness() + 10);
    QApplication::sendEvent(w.s, &leave);
    QVERIFY(Close(w.OnTrack(65), kKnob));
    w.s->SetDisabled(true);
    QVERIFY(w.OnTrack(65).lightness() < kKnob.lightness() - 10);
    for (const char *step : {"press 65", "move 150", "release 150"})
        Run(w, step);
    w.Key(Qt::Key_Right);
    QCOMPARE(w.pressed.count(), 1);
    QCOMPARE(w.valueChanged.count(), 0);
}

// A ramp paints the track in its colour space; a second one takes the half
// right of the centre; without ramps the track is plain again.
void CustomSliderTest::gradientPaintsTrack()
{
    Shown w;
    w.s->SetValue(0.5, true);
    const QColor plain = w.OnTrack(20);
    AutoRef<Gradient> ramp(Ramp({1, 0, 0, 1}, {0, 0, 1, 1}));
    w.s->SetGradients(ramp.get(), nullptr);
    const QColor left = w.OnTrack(20), right = w.OnTrack(190);
    QVERIFY(left.red() > 200 && left.blue() < 60);
    QVERIFY(right.blue() > 200 && right.red() < 60);
    w.s->SetColorSpaces(GCS_HSV, GCS_RGB);
    QVERIFY(w.OnTrack(85).green() < 40); // hue runs through magenta, never green
    w.s->SetColorSpaces(GCS_RGB, GCS_RGB);
    AutoRef<Gradient> green(Ramp({0, 1, 0, 1}, {0, 1, 0, 1}));
    w.s->SetCentre(0.5);
    w.s->SetGradients(ramp.get(), green.get());
    QVERIFY(w.OnTrack(12).red() > 200); // the first ramp, squeezed into the left half
    QVERIFY(w.OnTrack(170).green() > 200);
    w.s->SetGradients(nullptr, nullptr);
    QVERIFY(Close(w.OnTrack(20), plain));
}

// A new value repaints the strip the knob swept, from the same back buffer;
// the same value repaints nothing.
void CustomSliderTest::repaintsOnlyWhatChanged()
{
    RecordingSlider *s = new RecordingSlider;
    Shown w(0.0, 1.0, s);
    s->SetValue(0.5, true);
    QApplication::processEvents();
    const DIB *buffer = s->GetBackBuffer();
    QVERIFY(buffer);
    s->painted.clear();
    s->SetValue(0.55, true); // the knob moves 10 pixels
    QApplication::processEvents();
    QCOMPARE(s->painted.size(), 1);
    const QRect r = s->painted.first();
    QCOMPARE(r.height(), s->GetKnobRect().Height());
    QCOMPARE(r.width(), s->GetKnobRect().Width() + 2 + 10);
    QCOMPARE(r.left(), s->KnobX() - 10 + s->GetKnobRect().x1 - 1);
    QCOMPARE(s->GetBackBuffer(), buffer);
    s->painted.clear();
    s->SetValue(0.55, true);
    s->SetDisabled(false);
    QApplication::processEvents();
    QCOMPARE(s->painted.size(), 0);
}

QTEST_MAIN(CustomSliderTest)
#include "CustomSliderTest.moc"
