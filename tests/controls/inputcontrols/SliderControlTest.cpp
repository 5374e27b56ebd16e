#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Gradient.h"
#include "orbane/Input.h"
#include "orbane/ResDIB.h"
#include "orbane/TimeCodeEdit.h"

#include <QtTest>

#include <cmath>

using namespace Orbane;
using namespace Orbane::Test;

Q_DECLARE_METATYPE(Orbane::TagList)

namespace {

constexpr Tag kMinAllowed = 0x20030000, kMaxAllowed = 0x20030001;
constexpr Tag kMinScale = 0x20030002, kMaxScale = 0x20030003, kDefault = 0x20030004;
constexpr Tag kInteger = 0x1003000c;
constexpr Tag kStepCount = 0x10040003, kPlaces = 0x10040004, kTimeDisplay = 0x10040006, kSnap = 0x10040007;
constexpr Tag kReadAttrs = 0x10040008, kTickFreq = 0x10050000;
constexpr Tag kLowName = 0x30050000;
constexpr Tag kForwardExpr = 0x30040003, kInverseExpr = 0x30040004, kGradient = 0x40050000;

// A control 211 pixels wide gives the slider a 211-pixel track: with the
// 11-pixel knob its centre runs from pixel 5 to 205, 200 pixels.
constexpr int32 kWidth = 211;
constexpr int kKnobY = 7; // inside the knob's rows whether or not a marker is shown

QWidget *SliderOf(const InputControl *c)
{
    return c->findChild<QWidget *>("slider");
}
TimeCodeEdit *EditOf(const InputControl *c)
{
    return c->findChild<TimeCodeEdit *>("edit");
}

int KnobX(const QWidget *slider, double fraction)
{
    const int knob = ResDIB::Get(OrbID("Controls.Slider.Knob.1")).Size().width();
    const double lo = knob / 2, hi = slider->width() - (knob - knob / 2);
    return int(std::floor(lo + (hi - lo) * fraction + 0.5));
}

TagList Range(double lo, double hi, TagList more = TagList())
{
    TagList tags{{kMinAllowed, lo}, {kMaxAllowed, hi}};
    tags.Append(more);
    return tags;
}

InputControl *Slider(ToolFixture &f, Input *in)
{
    f.page.activateWindow();
    InputControl *c = f.Create(CLSID_InputControl_Slider, {in}, kWidth);
    if (c)
        QApplication::processEvents();
    return c;
}

void SendMove(QWidget *w, QPoint pos, Qt::KeyboardModifiers mods)
{
    QMouseEvent move(QEvent::MouseMove, pos, w->mapToGlobal(pos), Qt::NoButton, Qt::LeftButton, mods);
    QApplication::sendEvent(w, &move);
}

// A press held for `repeats` auto-repeats, then let go.
void HoldKey(QWidget *w, int key, Qt::KeyboardModifiers mods, int repeats)
{
    const auto send = [&](QEvent::Type type, bool autoRepeat) {
        QKeyEvent event(type, key, mods, QString(), autoRepeat);
        QApplication::sendEvent(w, &event);
    };
    send(QEvent::KeyPress, false);
    for (int i = 0; i < repeats; ++i) {
        send(QEvent::KeyRelease, true);
        send(QEvent::KeyPress, true);
    }
    send(QEvent::KeyRelease, false);
}

void Type(TimeCodeEdit *edit, const QString &text)
{
    QTest::mouseClick(edit, Qt::LeftButton);
    QTest::keyClicks(edit, text);
}

double CopyDouble(InputControl *c, Tag tag)
{
    double value = -12345.0;
    c->CopyAttr(tag, &value);
    return value;
}

bool BlueAt(const QImage &image, int x)
{
    for (int y = 0; y < image.height(); ++y) {
        const QColor colour = image.pixelColor(x, y);
        if (colour.blue() > 200 && colour.red() < 60)
            return true;
    }
    return false;
}

} // namespace

class SliderControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void gestures_data();
    void gestures();
    void allowedRangeResets();
    void typedValues_data();
    void typedValues();
    void typingKeepsEditBox();
    void liveExpressions_data();
    void liveExpressions();
    void gradientTrack();
};

void SliderControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

// What the user does, one step a string: "drag DX DX... [ctrl|alt]" presses
// on the knob, moves by DX pixels from the press and lets go; "key K [shift|
// ctrl] [xN]" presses K held for N auto-repeats; "is V" checks the value
// written so far. Every gesture that changes the value is one "Change Blend"
// step, closed at its end.
void SliderControlTest::gestures_data()
{
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<double>("start");
    QTest::addColumn<QStringList>("steps");
    QTest::addColumn<double>("written");
    QTest::addColumn<int>("undoSteps");
    using S = QStringList;
    // 0..1 over 200 pixels: 0.005 a pixel, shown to three places.
    QTest::newRow("plain right") << Range(0, 1) << 0.5 << S{"drag 10 20"} << 0.6 << 1;
    // Back within half a pixel: exactly the press value, and no undo step.
    QTest::newRow("back to the press value") << Range(0, 1) << 0.123456 << S{"drag 10 0"} << 0.123456 << 0;
    QTest::newRow("Alt-click resets") << Range(0, 1, {{kDefault, 0.2523}}) << 0.5 << S{"drag 0 alt"} << 0.2523 << 1;
    QTest::newRow("Alt-click without a default tag: 0") << Range(-1, 1) << 0.5 << S{"drag 0 alt"} << 0.0 << 1;
    QTest::newRow("places 2: 0.127 writes 0.13") << Range(0, 0.2, {{kPlaces, 2}}) << 0.1 << S{"drag 27"} << 0.13 << 1;
    QTest::newRow("places -1: 0.123 as it is") << Range(0, 0.2, {{kPlaces, -1}}) << 0.1 << S{"drag 23"} << 0.123 << 1;
    QTest::newRow("places 2: less than a step writes nothing")
        << Range(0, 1, {{kPlaces, 2}}) << 0.5 << S{"drag 3 ctrl"} << 0.5 << 0;
    // Integer snapping adds a half, then truncates toward zero; it needs both tags.
    QTest::newRow("integer snap: -2.7 stored as -2")
        << Range(-10, 10, {{kInteger, 1}, {kSnap, 1}}) << 0.0 << S{"drag -27"} << -2.0 << 1;
    QTest::newRow("snap without integer") << Range(-10, 10, {{kSnap, 1}}) << 0.0 << S{"drag -27"} << -2.7 << 1;
    // The track fraction is the value squared: half way along it is sqrt(0.5).
    QTest::newRow("expression mapping") << Range(0, 1, {{kForwardExpr, "value^2"}, {kInverseExpr, "sqrt(value)"}})
                                        << 0.0 << S{"drag 100"} << 0.707 << 1;
    // 100 steps (normal 0.01, fine 0.001) and 11 ticks (coarse 0.1).
    const TagList steps = Range(0, 1, {{kStepCount, 100}, {kTickFreq, 11}});
    QTest::newRow("Home, and Home again writes nothing") << steps << 0.5 << S{"key Home", "key Home"} << 0.0 << 1;
    QTest::newRow("End") << steps << 0.5 << S{"key End"} << 1.0 << 1;
    QTest::newRow("Shift+Page Up coarse") << steps << 0.5 << S{"key PageUp shift"} << 0.6 << 1;
    QTest::newRow("Ctrl+Page Down fine") << steps << 0.5 << S{"key PageDown ctrl"} << 0.499 << 1;
    QTest::newRow("Right held, 4 repeats") << steps << 0.5 << S{"key Right x4"} << 0.55 << 1;
    QTest::newRow("Shift+Left held, 2 repeats") << steps << 0.5 << S{"key Left shift x2"} << 0.2 << 1;
    QTest::newRow("Ctrl+Page Up held, 9 repeats, then Home")
        << steps << 0.5 << S{"key PageUp ctrl x9", "is 0.51", "key Home"} << 0.0 << 2;
    // Home and End go to the track's ends: the scale tags within the allowed range.
    QTest::newRow("no tags: track 0..1") << TagList{} << 0.5 << S{"key Home", "is 0", "key End"} << 1.0 << 2;
    QTest::newRow("scale tags narrow the track") << Range(-10, 10, {{kMinScale, -1.0}, {kMaxScale, 1.0}}) << 0.5
                                                 << S{"key Home", "is -1", "key End"} << 1.0 << 2;
    QTest::newRow("the allowed range clips the track")
        << Range(0, 1, {{kMinScale, -5.0}, {kMaxScale, 5.0}}) << 0.5 << S{"key Home", "is 0", "key End"} << 1.0 << 2;
    QTest::newRow("reversed pairs are ordered") << Range(3, -3) << 0.5 << S{"key Home", "is -3", "key End"} << 3.0 << 2;
}

void SliderControlTest::gestures()
{
    QFETCH(TagList, attrs);
    QFETCH(double, start);
    QFETCH(QStringList, steps);
    QFETCH(double, written);
    QFETCH(int, undoSteps);
    ToolFixture f;
    Input *in = f.AddNumber("Blend", start, attrs);
    InputControl *c = Slider(f, in);
    QWidget *slider = SliderOf(c);
    slider->setFocus();
    const QHash<QString, int> keys{{"Home", Qt::Key_Home},         {"End", Qt::Key_End},   {"PageUp", Qt::Key_PageUp},
                                   {"PageDown", Qt::Key_PageDown}, {"Left", Qt::Key_Left}, {"Right", Qt::Key_Right}};
    for (const QString &step : steps) {
        QStringList words = step.split(' ');
        const QString verb = words.takeFirst();
        if (verb == "is") {
            QCOMPARE(f.NumberOf(in), words[0].toDouble());
            continue;
        }
        int repeats = 0;
        if (words.last().startsWith('x'))
            repeats = words.takeLast().mid(1).toInt();
        const QString mod = words.last();
        const Qt::KeyboardModifiers m(mod == "ctrl"    ? Qt::ControlModifier
                                      : mod == "alt"   ? Qt::AltModifier
                                      : mod == "shift" ? Qt::ShiftModifier
                                                       : Qt::NoModifier);
        if (verb == "key") {
            HoldKey(slider, keys.value(words[0]), m, repeats);
            continue;
        }
        if (m != Qt::NoModifier)
            words.removeLast();
        const double lo = attrs.GetDouble(kMinAllowed), hi = attrs.GetDouble(kMaxAllowed);
        const int x = KnobX(slider, (start - lo) / (hi - lo));
        QTest::mousePress(slider, Qt::LeftButton, m, QPoint(x, kKnobY));
        for (const QString &dx : words)
            SendMove(slider, QPoint(x + dx.toInt(), kKnobY), m);
        QTest::mouseRelease(slider, Qt::LeftButton, m, QPoint(x + words.last().toInt(), kKnobY));
    }
    QVERIFY2(f.NumberOf(in) == written, qPrintable(QString::number(f.NumberOf(in), 'g', 17)));
    QCOMPARE(f.doc.UndoNames(), QStringList(QVector<QString>(undoSteps, "Change Blend").toList()));
    QVERIFY(!c->IsUndoOpen());
}

// A call without the allowed range resets it and the default; places and
// counts stay.
void SliderControlTest::allowedRangeResets()
{
    ToolFixture f;
    Input *in = f.AddNumber("Blend", 0.5, Range(0, 1, {{kPlaces, 2}, {kDefault, 0.75}, {kTickFreq, 5}}));
    InputControl *c = Slider(f, in);
    QCOMPARE(CopyDouble(c, kMaxAllowed), 1.0);
    QCOMPARE(CopyDouble(c, kDefault), 0.75);
    c->SetAttrsTagList(in, TagList{{kLowName, "Low"}});
    QCOMPARE(CopyDouble(c, kMinAllowed), -1e6);
    QCOMPARE(CopyDouble(c, kMaxAllowed), 1e6);
    QCOMPARE(CopyDouble(c, kDefault), 0.0);
    int32 places = 0, ticks = 0;
    QCOMPARE(c->CopyAttr(kPlaces, &places), false);
    QCOMPARE(places, 2);
    QCOMPARE(c->CopyAttr(kTickFreq, &ticks), false);
    QCOMPARE(ticks, 5);
    QWidget *slider = SliderOf(c);
    slider->setFocus();
    HoldKey(slider, Qt::Key_End, Qt::NoModifier, 0);
    QCOMPARE(f.NumberOf(in), 1.0);
    // With the read-attributes switch off the control keeps its own tags.
    c->SetAttrsTagList(in, TagList{{kReadAttrs, 0}, {kMinAllowed, -4.0}, {kMaxAllowed, 4.0}});
    QCOMPARE(CopyDouble(c, kMaxAllowed), 1e6);
    c->SetAttrsTagList(in, TagList{{kReadAttrs, 1}, {kMinAllowed, -4.0}, {kMaxAllowed, 4.0}});
    QCOMPARE(CopyDouble(c, kMaxAllowed), 4.0);
}

void SliderControlTest::typedValues_data()
{
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<QString>("typed");
    QTest::addColumn<double>("written");
    QTest::addColumn<QString>("shown");
    QTest::newRow("places 2: 0.127 writes 0.13") << Range(0, 1, {{kPlaces, 2}}) << "0.127" << 0.13 << "0.13";
    QTest::newRow("places -1: step 1e-7") << Range(0, 1, {{kPlaces, -1}}) << "0.12345678" << 0.1234568 << "0.123457";
    QTest::newRow("time code") << Range(0, 480, {{kTimeDisplay, 1}, {kPlaces, 0}}) << "00:00:02:06" << 54.0
                               << "00:00:02:06";
    QTest::newRow("expression") << Range(0, 2, {{kPlaces, 3}}) << "= value * 2 + 0.1" << 1.1 << "1.100";
}

// What is typed is one undo step; undo shows the value before it again.
void SliderControlTest::typedValues()
{
    QFETCH(TagList, attrs);
    QFETCH(QString, typed);
    QFETCH(double, written);
    QFETCH(QString, shown);
    ToolFixture f;
    Input *in = f.AddNumber("Blend", 0.5, attrs);
    InputControl *c = Slider(f, in);
    const QString before = EditOf(c)->text();
    Type(EditOf(c), typed);
    QTest::keyClick(EditOf(c), Qt::Key_Return);
    QCOMPARE(f.NumberOf(in), written);
    QCOMPARE(EditOf(c)->text(), shown);
    if (typed.startsWith('='))
        QCOMPARE(QString::fromStdString(c->GetExpressionData(0).str()), typed.mid(2));
    QCOMPARE(f.doc.UndoNames(), QStringList{"Change Blend"});
    f.doc.Undo();
    QCOMPARE(f.NumberOf(in), 0.5);
    QCOMPARE(EditOf(c)->text(), before);
}

void SliderControlTest::liveExpressions_data()
{
    QTest::addColumn<QString>("typed");
    QTest::addColumn<bool>("kept");
    QTest::addColumn<double>("now");      // Blend after Enter (Size 2, time 5)
    QTest::addColumn<double>("followed"); // Blend after Size 4 and time 10
    QTest::addColumn<QString>("tip");
    QTest::newRow("another Input") << "=Size / 4" << true << 0.5 << 1.0 << "";
    QTest::newRow("the time") << "= time / 10" << true << 0.5 << 1.0 << "";
    QTest::newRow("both, other tool's name") << "=Tool1.Size * time / 20" << true << 0.5 << 2.0 << "";
    QTest::newRow("itself") << "=Blend + 1" << false << 0.25 << 0.25 << "cycle: Tool1.Blend -> Tool1.Blend";
    QTest::newRow("a missing Input") << "=Blur1.Size" << false << 0.25 << 0.25 << "no Input \"Blur1.Size\"";
}

// Typed with "=", an expression stays on the Input: the field under the
// slider shows it and the value follows; a refused one shows red with the
// reason as tip. Undo takes the expression and its value back.
void SliderControlTest::liveExpressions()
{
    QFETCH(QString, typed);
    QFETCH(bool, kept);
    QFETCH(double, now);
    QFETCH(double, followed);
    QFETCH(QString, tip);
    ToolFixture f;
    f.doc.SetCurrentTime(5.0);
    Input *size = f.AddNumber("Size", 2.0, Range(0, 100));
    Input *blend = f.AddNumber("Blend", 0.25, Range(0, 2, {{kPlaces, 3}}));
    InputControl *c = Slider(f, blend);
    Type(EditOf(c), typed);
    QTest::keyClick(EditOf(c), Qt::Key_Return);
    QCOMPARE(QString(blend->GetExpression()), kept ? typed.mid(1).trimmed() : QString());
    QCOMPARE(f.NumberOf(blend), now);
    const QLineEdit *field = c->GetExpressionEdit(0);
    QVERIFY(field && field->isVisible());
    QCOMPARE(field->text(), typed.mid(1).trimmed());
    QCOMPARE(field->toolTip().isEmpty(), tip.isEmpty());
    QVERIFY2(field->toolTip().contains(tip), qPrintable(field->toolTip()));
    QCOMPARE(field->palette().color(QPalette::Base) != c->palette().color(QPalette::Base), !tip.isEmpty());
    QVERIFY(size->SetValue(AutoNumber(4.0), 0.0));
    f.doc.SetCurrentTime(10.0);
    QCOMPARE(f.NumberOf(blend), followed);
    QCOMPARE(EditOf(c)->text(), QString::number(followed, 'f', 3));
    QCOMPARE(f.doc.UndoNames().size(), kept ? 2 : 1);
    f.doc.Undo();
    f.doc.Undo();
    QCOMPARE(QString(blend->GetExpression()), QString());
    QCOMPARE(f.NumberOf(blend), 0.25);
    QCOMPARE(field->isVisible(), !kept); // a refused text stays for the user to mend
}

// A value that arrives while the user types leaves the text alone; Enter
// then writes what was typed.
void SliderControlTest::typingKeepsEditBox()
{
    ToolFixture f;
    Input *in = f.AddNumber("Blend", 0.5, Range(0, 1, {{kPlaces, 3}}));
    InputControl *c = Slider(f, in);
    TimeCodeEdit *edit = EditOf(c);
    in->SetValue(AutoNumber(0.25), f.doc.GetCurrentTime());
    QCOMPARE(edit->text(), QString("0.250"));
    Type(edit, "0.7");
    in->SetValue(AutoNumber(0.3), f.doc.GetCurrentTime());
    QCOMPARE(edit->text(), QString("0.7"));
    QCOMPARE(f.NumberOf(in), 0.3);
    QTest::keyClick(edit, Qt::Key_Return);
    QCOMPARE(f.NumberOf(in), 0.7);
    QCOMPARE(edit->text(), QString("0.700"));
    in->SetValue(AutoNumber(0.4), f.doc.GetCurrentTime());
    QCOMPARE(edit->text(), QString("0.400"));
}

// The ramp once painted no colour until a resize.
void SliderControlTest::gradientTrack()
{
    ToolFixture f;
    AutoRef<Gradient> ramp(new Gradient);
    ramp->AddStop(0.0, GradientColor{0.0, 0.0, 1.0, 1.0});
    ramp->AddStop(1.0, GradientColor{0.0, 0.0, 1.0, 1.0});
    InputControl *c = Slider(f, f.AddNumber("Hue", 0.0, Range(0, 1, {{kGradient, ramp.get()}})));
    for (int width : {kWidth, 300}) {
        f.Resize(c, width);
        QWidget *slider = SliderOf(c);
        QCOMPARE(slider->width(), width);
        const QImage image = slider->grab().toImage();
        for (double along : {0.1, 0.5, 0.95})
            QVERIFY2(BlueAt(image, KnobX(slider, along)), qPrintable(QString("width %1 at %2").arg(width).arg(along)));
    }
}

QTEST_MAIN(SliderControlTest)
#include "SliderControlTest.moc"
