#include "ToolFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Gradient.h"
#include "orbane/Input.h"
#include "orbane/ResDIB.h"
#include "orbane/TimeCodeEdit.h"

#include <QLabel>
#include <QtTest>

#include <cmath>

using namespace Orbane;
using namespace Orbane::Test;

Q_DECLARE_METATYPE(Orbane::TagList)

namespace {

// Input attributes the slider reads.
constexpr Tag kMinAllowed = 0x20030000, kMaxAllowed = 0x20030001;
constexpr Tag kMinScale = 0x20030002, kMaxScale = 0x20030003, kDefault = 0x20030004;
constexpr Tag kCentre = 0x20040006, kIndex = 0x10030007, kInteger = 0x1003000c, kKnobStyle = 0x10030011;
constexpr Tag kStepCount = 0x10040003, kPlaces = 0x10040004, kTimeDisplay = 0x10040006, kSnap = 0x10040007;
constexpr Tag kReadAttrs = 0x10040008, kTickFreq = 0x10050000;
constexpr Tag kLowName = 0x30050000, kMidName = 0x30050001, kHighName = 0x30050002;
constexpr Tag kForwardExpr = 0x30040003, kInverseExpr = 0x30040004, kGradient = 0x40050000;
constexpr Tag kForwardFunc = 0x60040001, kInverseFunc = 0x60040002;

// A control 211 pixels wide gives the slider a 211-pixel track: with the
// 11-pixel knob its centre runs from pixel 5 to 205, 200 pixels.
constexpr int32 kWidth = 211;
constexpr int kKnobY = 7; // inside the knob's rows whether or not a marker is shown

float64 Square(float64 v, void *)
{
    return v * v;
}
float64 Root(float64 t, void *)
{
    return std::sqrt(t);
}

QWidget *SliderOf(const InputControl *c)
{
    return c->findChild<QWidget *>("slider");
}
TimeCodeEdit *EditOf(const InputControl *c)
{
    return c->findChild<TimeCodeEdit *>("edit");
}

// The knob's column for a track fraction (0 at the low end, 1 at the high end).
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

// Press at `fromX`, move in a few steps to `toX`, release there.
void Drag(QWidget *w, int fromX, int toX, Qt::KeyboardModifiers mods = Qt::NoModifier)
{
    QTest::mousePress(w, Qt::LeftButton, mods, QPoint(fromX, kKnobY));
    for (int i = 1; i <= 4; ++i)
        SendMove(w, QPoint(fromX + (toX - fromX) * i / 4, kKnobY), mods);
    QTest::mouseRelease(w, Qt::LeftButton, mods, QPoint(toX, kKnobY));
}

void SendKey(QWidget *w, QEvent::Type type, int key, Qt::KeyboardModifiers mods, bool autoRepeat)
{
    QKeyEvent event(type, key, mods, QString(), autoRepeat);
    QApplication::sendEvent(w, &event);
}

// A press held for `repeats` auto-repeats, then let go.
void HoldKey(QWidget *w, int key, Qt::KeyboardModifiers mods, int repeats)
{
    SendKey(w, QEvent::KeyPress, key, mods, false);
    for (int i = 0; i < repeats; ++i) {
        SendKey(w, QEvent::KeyRelease, key, mods, true);
        SendKey(w, QEvent::KeyPress, key, mods, true);
    }
    SendKey(w, QEvent::KeyRelease, key, mods, false);
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

} // namespace

class SliderControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void geometry();
    void drags_data();
    void drags();
    void snaps_data();
    void snaps();
    void integerSnapTruncates_data();
    void integerSnapTruncates();
    void keys_data();
    void keys();
    void pagePress();
    void altClickResets_data();
    void altClickResets();
    void rangeTags_data();
    void rangeTags();
    void allowedRangeResets();
    void ownTagsSwitch();
    void typedValues_data();
    void typedValues();
    void typingKeepsEditBox();
    void typedExpression();
    void untouchedEditWritesNothing_data();
    void untouchedEditWritesNothing();
    void inputIndexRouting();
    void mappings_data();
    void mappings();
    void knobStyles_data();
    void knobStyles();
    void captions();
    void gradientTrack();
    void undoRenotifies();
};

void SliderControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

// The layout gives the slider the control's whole width: the drags below
// count on 200 pixels of track.
void SliderControlTest::geometry()
{
    ToolFixture f;
    InputControl *c = Slider(f, f.AddNumber("Blend", 0.5, Range(0.0, 1.0)));
    QVERIFY(c);
    QCOMPARE(SliderOf(c)->width(), kWidth);
    QVERIFY(SliderOf(c)->height() >= 19);
    QCOMPARE(KnobX(SliderOf(c), 0.5), 105);
    QCOMPARE(c->findChild<QLabel *>("label")->text(), QString("Blend"));
    QCOMPARE(EditOf(c)->text(), QString("0.5"));
}

void SliderControlTest::drags_data()
{
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<double>("start");
    QTest::addColumn<int>("dx");
    QTest::addColumn<int>("mods");
    QTest::addColumn<double>("written");
    QTest::addColumn<int>("steps");
    const int none = Qt::NoModifier, ctrl = Qt::ControlModifier;
    // 0..1 over 200 pixels: 0.005 a pixel, shown to three places.
    QTest::newRow("plain right") << Range(0, 1) << 0.5 << 20 << none << 0.6 << 1;
    QTest::newRow("plain left") << Range(0, 1) << 0.5 << -37 << none << 0.315 << 1;
    QTest::newRow("plain 3 pixels") << Range(0, 1) << 0.5 << 3 << none << 0.515 << 1;
    QTest::newRow("ctrl ten times slower, one more place") << Range(0, 1) << 0.5 << 3 << ctrl << 0.5015 << 1;
    QTest::newRow("ctrl right") << Range(0, 1) << 0.5 << 20 << ctrl << 0.51 << 1;
    QTest::newRow("clamped at the high end") << Range(0, 1) << 0.5 << 300 << none << 1.0 << 1;
    QTest::newRow("clamped at the low end") << Range(0, 1) << 0.5 << -300 << none << 0.0 << 1;
    QTest::newRow("ctrl clamped at the high end") << Range(0, 1) << 0.99 << 300 << ctrl << 1.0 << 1;
    // 0..0.2: the slider gives 0.123 and 0.127; two places write 0.12 and 0.13.
    QTest::newRow("places 2: 0.123 writes 0.12") << Range(0, 0.2, {{kPlaces, 2}}) << 0.1 << 23 << none << 0.12 << 1;
    QTest::newRow("places 2: 0.127 writes 0.13") << Range(0, 0.2, {{kPlaces, 2}}) << 0.1 << 27 << none << 0.13 << 1;
    QTest::newRow("places -1: 0.123 as it is") << Range(0, 0.2, {{kPlaces, -1}}) << 0.1 << 23 << none << 0.123 << 1;
    QTest::newRow("places 2: ctrl drag rounded") << Range(0, 1, {{kPlaces, 2}}) << 0.5 << 26 << ctrl << 0.51 << 1;
    QTest::newRow("places 2: less than a step writes nothing")
        << Range(0, 1, {{kPlaces, 2}}) << 0.5 << 3 << ctrl << 0.5 << 0;
    // 480 frames over 200 pixels: 2.4 frames a pixel, not rounded to places 0.
    QTest::newRow("time display unrounded")
        << Range(0, 480, {{kTimeDisplay, 1}, {kPlaces, 0}}) << 240.0 << 1 << none << 242.4 << 1;
    QTest::newRow("places 0 without time display") << Range(0, 480, {{kPlaces, 0}}) << 240.0 << 1 << none << 242.0 << 1;
}

void SliderControlTest::drags()
{
    QFETCH(TagList, attrs);
    QFETCH(double, start);
    QFETCH(int, dx);
    QFETCH(int, mods);
    QFETCH(double, written);
    QFETCH(int, steps);
    ToolFixture f;
    Input *in = f.AddNumber("Blend", start, attrs);
    InputControl *c = Slider(f, in);
    QWidget *slider = SliderOf(c);
    const double lo = attrs.GetDouble(kMinAllowed), hi = attrs.GetDouble(kMaxAllowed);
    const int x = KnobX(slider, (start - lo) / (hi - lo));
    Drag(slider, x, x + dx, Qt::KeyboardModifiers(mods));
    QCOMPARE(f.NumberOf(in), written);
    QCOMPARE(f.doc.UndoNames().size(), steps);
    if (steps)
        QCOMPARE(f.doc.UndoNames().last(), QString("Change Blend"));
    QVERIFY(!c->IsUndoOpen());
}

void SliderControlTest::snaps_data()
{
    QTest::addColumn<double>("start");
    QTest::addColumn<double>("def");
    QTest::addColumn<QList<int>>("path");
    QTest::addColumn<double>("written");
    QTest::addColumn<int>("steps");
    // Away and back within half a pixel: exactly the value it started from,
    // and a gesture that changed nothing leaves no undo step.
    QTest::newRow("back to the press value") << 0.123456 << 0.9 << QList<int>{30, 40, 30} << 0.123456 << 0;
    // Pixel 55 is 0.25; the default 0.2523 lies 0.46 pixels away.
    QTest::newRow("onto the default") << 0.5 << 0.2523 << QList<int>{105, 80, 55} << 0.2523 << 1;
    QTest::newRow("past the default") << 0.5 << 0.2523 << QList<int>{105, 80, 54} << 0.245 << 1;
}

void SliderControlTest::snaps()
{
    QFETCH(double, start);
    QFETCH(double, def);
    QFETCH(QList<int>, path);
    QFETCH(double, written);
    QFETCH(int, steps);
    ToolFixture f;
    Input *in = f.AddNumber("Blend", start, Range(0, 1, {{kDefault, def}}));
    QWidget *slider = SliderOf(Slider(f, in));
    QTest::mousePress(slider, Qt::LeftButton, Qt::NoModifier, QPoint(path.first(), kKnobY));
    for (int x : path)
        SendMove(slider, QPoint(x, kKnobY), Qt::NoModifier);
    QTest::mouseRelease(slider, Qt::LeftButton, Qt::NoModifier, QPoint(path.last(), kKnobY));
    QVERIFY2(f.NumberOf(in) == written, qPrintable(QString::number(f.NumberOf(in), 'g', 17)));
    QCOMPARE(f.doc.UndoNames().size(), steps);
}

void SliderControlTest::integerSnapTruncates_data()
{
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<int>("dx");
    QTest::addColumn<double>("written");
    // -10..10 over 200 pixels: 0.1 a pixel; integer display with snapping
    // to the normal step of 1 truncates toward zero after adding a half.
    const TagList snap = Range(-10, 10, {{kInteger, 1}, {kSnap, 1}});
    QTest::newRow("-2.7 stored as -2") << snap << -27 << -2.0;
    QTest::newRow("2.7 stored as 3") << snap << 27 << 3.0;
    QTest::newRow("-0.4 stays 0") << snap << -4 << 0.0;
    QTest::newRow("-7.5 stored as -7") << snap << -75 << -7.0;
    QTest::newRow("no snap, places 0: -2.7 rounds to -3")
        << Range(-10, 10, {{kInteger, 1}, {kPlaces, 0}}) << -27 << -3.0;
}

void SliderControlTest::integerSnapTruncates()
{
    QFETCH(TagList, attrs);
    QFETCH(int, dx);
    QFETCH(double, written);
    ToolFixture f;
    Input *in = f.AddNumber("Count", 0.0, attrs);
    InputControl *c = Slider(f, in);
    Drag(SliderOf(c), 105, 105 + dx);
    QCOMPARE(f.NumberOf(in), written);
    QCOMPARE(EditOf(c)->text(), QString::number(int(written)));
}

void SliderControlTest::keys_data()
{
    QTest::addColumn<int>("key");
    QTest::addColumn<int>("mods");
    QTest::addColumn<int>("repeats");
    QTest::addColumn<double>("written");
    const int none = Qt::NoModifier, ctrl = Qt::ControlModifier, shift = Qt::ShiftModifier;
    // From 0.5 on 0..1 with 100 steps (normal 0.01, fine 0.001) and 11 ticks (coarse 0.1).
    QTest::newRow("Home") << int(Qt::Key_Home) << none << 0 << 0.0;
    QTest::newRow("End") << int(Qt::Key_End) << none << 0 << 1.0;
    QTest::newRow("Right") << int(Qt::Key_Right) << none << 0 << 0.51;
    QTest::newRow("Left") << int(Qt::Key_Left) << none << 0 << 0.49;
    QTest::newRow("Page Up") << int(Qt::Key_PageUp) << none << 0 << 0.51;
    QTest::newRow("Page Down") << int(Qt::Key_PageDown) << none << 0 << 0.49;
    QTest::newRow("Ctrl+Right fine") << int(Qt::Key_Right) << ctrl << 0 << 0.501;
    QTest::newRow("Ctrl+Page Down fine") << int(Qt::Key_PageDown) << ctrl << 0 << 0.499;
    QTest::newRow("Shift+Right coarse") << int(Qt::Key_Right) << shift << 0 << 0.6;
    QTest::newRow("Shift+Page Down coarse") << int(Qt::Key_PageDown) << shift << 0 << 0.4;
    QTest::newRow("Right held, 4 repeats") << int(Qt::Key_Right) << none << 4 << 0.55;
    QTest::newRow("Shift+Left held, 2 repeats") << int(Qt::Key_Left) << shift << 2 << 0.2;
    QTest::newRow("Ctrl+Page Up held, 9 repeats") << int(Qt::Key_PageUp) << ctrl << 9 << 0.51;
    QTest::newRow("End held past the end") << int(Qt::Key_End) << none << 3 << 1.0;
}

void SliderControlTest::keys()
{
    QFETCH(int, key);
    QFETCH(int, mods);
    QFETCH(int, repeats);
    QFETCH(double, written);
    ToolFixture f;
    Input *in = f.AddNumber("Blend", 0.5, Range(0, 1, {{kStepCount, 100}, {kTickFreq, 11}}));
    InputControl *c = Slider(f, in);
    QWidget *slider = SliderOf(c);
    slider->setFocus();
    HoldKey(slider, key, Qt::KeyboardModifiers(mods), repeats);
    QCOMPARE(f.NumberOf(in), written);
    // One press-and-hold, one undo step.
    QCOMPARE(f.doc.UndoNames(), QStringList{"Change Blend"});
    QVERIFY(!c->IsUndoOpen());
    // A second press is a second step.
    HoldKey(slider, Qt::Key_Home, Qt::NoModifier, 0);
    QCOMPARE(f.doc.UndoNames().size(), written == 0.0 ? 1 : 2);
}

void SliderControlTest::pagePress()
{
    ToolFixture f;
    Input *in = f.AddNumber("Blend", 0.5, Range(0, 1, {{kTickFreq, 11}, {kDefault, 0.9}}));
    QWidget *slider = SliderOf(Slider(f, in));
    // Left of the knob: one coarse page down at once.
    QTest::mousePress(slider, Qt::LeftButton, Qt::NoModifier, QPoint(20, kKnobY));
    QCOMPARE(f.NumberOf(in), 0.4);
    QTest::mouseRelease(slider, Qt::LeftButton, Qt::NoModifier, QPoint(20, kKnobY));
    QCOMPARE(f.doc.UndoNames().size(), 1);
    QTest::mouseClick(slider, Qt::LeftButton, Qt::NoModifier, QPoint(200, kKnobY));
    QCOMPARE(f.NumberOf(in), 0.5);
    QCOMPARE(f.doc.UndoNames().size(), 2);
}

void SliderControlTest::altClickResets_data()
{
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<int>("x");
    QTest::addColumn<double>("written");
    QTest::newRow("on the knob") << Range(0, 1, {{kDefault, 0.25}}) << 145 << 0.25;
    QTest::newRow("on the track") << Range(0, 1, {{kDefault, 0.25}}) << 190 << 0.25;
    QTest::newRow("no default tag: 0") << Range(-1, 1) << 190 << 0.0;
}

void SliderControlTest::altClickResets()
{
    QFETCH(TagList, attrs);
    QFETCH(int, x);
    QFETCH(double, written);
    ToolFixture f;
    Input *in = f.AddNumber("Blend", 0.7, attrs);
    QWidget *slider = SliderOf(Slider(f, in));
    QTest::mouseClick(slider, Qt::LeftButton, Qt::AltModifier, QPoint(x, kKnobY));
    QCOMPARE(f.NumberOf(in), written);
    QCOMPARE(f.doc.UndoNames(), QStringList{"Change Blend"});
    f.doc.Undo();
    QCOMPARE(f.NumberOf(in), 0.7);
}

void SliderControlTest::rangeTags_data()
{
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<double>("minAllowed");
    QTest::addColumn<double>("maxAllowed");
    QTest::addColumn<double>("home");
    QTest::addColumn<double>("end");
    QTest::newRow("no tags: allowed +-1e6, track 0..1") << TagList{} << -1e6 << 1e6 << 0.0 << 1.0;
    QTest::newRow("the track follows the allowed range") << Range(-5, 5) << -5.0 << 5.0 << -5.0 << 5.0;
    QTest::newRow("scale tags narrow the track")
        << Range(-10, 10, {{kMinScale, -1.0}, {kMaxScale, 1.0}}) << -10.0 << 10.0 << -1.0 << 1.0;
    QTest::newRow("one scale tag") << Range(-10, 10, {{kMaxScale, 2.0}}) << -10.0 << 10.0 << -10.0 << 2.0;
    QTest::newRow("the allowed range clips the track")
        << Range(0, 1, {{kMinScale, -5.0}, {kMaxScale, 5.0}}) << 0.0 << 1.0 << 0.0 << 1.0;
    QTest::newRow("reversed pairs are ordered") << Range(3, -3) << -3.0 << 3.0 << -3.0 << 3.0;
}

void SliderControlTest::rangeTags()
{
    QFETCH(TagList, attrs);
    QFETCH(double, minAllowed);
    QFETCH(double, maxAllowed);
    QFETCH(double, home);
    QFETCH(double, end);
    ToolFixture f;
    Input *in = f.AddNumber("Blend", 0.5, attrs);
    InputControl *c = Slider(f, in);
    QCOMPARE(std::min(CopyDouble(c, kMinAllowed), CopyDouble(c, kMaxAllowed)), minAllowed);
    QCOMPARE(std::max(CopyDouble(c, kMinAllowed), CopyDouble(c, kMaxAllowed)), maxAllowed);
    QWidget *slider = SliderOf(c);
    slider->setFocus();
    HoldKey(slider, Qt::Key_Home, Qt::NoModifier, 0);
    QCOMPARE(f.NumberOf(in), home);
    HoldKey(slider, Qt::Key_End, Qt::NoModifier, 0);
    QCOMPARE(f.NumberOf(in), end);
}

// Every call without the allowed range resets it; places, centre and the
// counts keep what they had; the default falls back to 0.
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
    // The track keeps 0..1 (its tags only ever narrow it here).
    QWidget *slider = SliderOf(c);
    slider->setFocus();
    HoldKey(slider, Qt::Key_End, Qt::NoModifier, 0);
    QCOMPARE(f.NumberOf(in), 1.0);
}

void SliderControlTest::ownTagsSwitch()
{
    ToolFixture f;
    Input *in = f.AddNumber("Blend", 0.5, Range(0, 1));
    InputControl *c = Slider(f, in);
    c->SetAttrsTagList(in, TagList{{kReadAttrs, 0}, {kMinAllowed, -4.0}, {kMaxAllowed, 4.0}});
    QCOMPARE(CopyDouble(c, kMaxAllowed), 1.0);
    c->SetAttrsTagList(in, TagList{{kReadAttrs, 1}, {kMinAllowed, -4.0}, {kMaxAllowed, 4.0}});
    QCOMPARE(CopyDouble(c, kMaxAllowed), 4.0);
}

void SliderControlTest::typedValues_data()
{
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<QString>("typed");
    QTest::addColumn<double>("written");
    QTest::addColumn<QString>("shown");
    QTest::newRow("places 2: 0.123 writes 0.12") << Range(0, 1, {{kPlaces, 2}}) << "0.123" << 0.12 << "0.12";
    QTest::newRow("places 2: 0.127 writes 0.13") << Range(0, 1, {{kPlaces, 2}}) << "0.127" << 0.13 << "0.13";
    QTest::newRow("places -1: step 1e-7") << Range(0, 1, {{kPlaces, -1}}) << "0.12345678" << 0.1234568 << "0.123457";
    QTest::newRow("places -2: steps of 100") << Range(0, 1000, {{kPlaces, -2}}) << "449" << 400.0 << "400";
    QTest::newRow("arithmetic") << Range(0, 1, {{kPlaces, 3}}) << "1/8" << 0.125 << "0.125";
    QTest::newRow("time code") << Range(0, 480, {{kTimeDisplay, 1}, {kPlaces, 0}}) << "00:00:02:06" << 54.0
                               << "00:00:02:06";
}

void SliderControlTest::typedValues()
{
    QFETCH(TagList, attrs);
    QFETCH(QString, typed);
    QFETCH(double, written);
    QFETCH(QString, shown);
    ToolFixture f;
    Input *in = f.AddNumber("Blend", 0.5, attrs);
    InputControl *c = Slider(f, in);
    Type(EditOf(c), typed);
    QTest::keyClick(EditOf(c), Qt::Key_Return);
    QCOMPARE(f.NumberOf(in), written);
    QCOMPARE(EditOf(c)->text(), shown);
    QCOMPARE(f.doc.UndoNames(), QStringList{"Change Blend"});
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

void SliderControlTest::typedExpression()
{
    ToolFixture f;
    Input *in = f.AddNumber("Blend", 0.25, Range(0, 1, {{kPlaces, 3}}));
    InputControl *c = Slider(f, in);
    Type(EditOf(c), "= value * 2 + 0.1");
    QTest::keyClick(EditOf(c), Qt::Key_Return);
    QCOMPARE(f.NumberOf(in), 0.6);
    QCOMPARE(QString::fromStdString(c->GetExpressionData(0).str()), QString("value * 2 + 0.1"));
    QCOMPARE(EditOf(c)->text(), QString("0.600"));
    QCOMPARE(f.doc.UndoNames().size(), 1);
    f.doc.Undo();
    QCOMPARE(f.NumberOf(in), 0.25);
}

void SliderControlTest::untouchedEditWritesNothing_data()
{
    QTest::addColumn<int>("places");
    QTest::addColumn<double>("value");
    QTest::addColumn<QString>("shown");
    QTest::newRow("places 2") << 2 << 0.123456 << "0.12";
    QTest::newRow("automatic places show six") << -1 << 0.12345678 << "0.123457";
}

// Clicking into the box and leaving it is no edit, even where the box shows
// fewer places than the Input holds.
void SliderControlTest::untouchedEditWritesNothing()
{
    QFETCH(int, places);
    QFETCH(double, value);
    QFETCH(QString, shown);
    ToolFixture f;
    Input *in = f.AddNumber("Blend", value, Range(0, 1, {{kPlaces, places}}));
    InputControl *c = Slider(f, in);
    QVERIFY(QTest::qWaitForWindowActive(&f.page));
    TimeCodeEdit *edit = EditOf(c);
    QSignalSpy finished(edit, SIGNAL(editingFinished()));
    QTest::mouseClick(edit, Qt::LeftButton);
    QVERIFY(edit->hasFocus());
    QCOMPARE(edit->text(), shown);
    SliderOf(c)->setFocus();
    QCOMPARE(finished.count(), 1);
    QVERIFY(f.NumberOf(in) == value);
    QVERIFY(f.doc.UndoNames().isEmpty());
}

void SliderControlTest::inputIndexRouting()
{
    ToolFixture f;
    Input *first = f.AddNumber("Red", 0.5, Range(0, 1, {{kPlaces, 2}, {kIndex, 0}}));
    Input *second = f.AddNumber("Green", 0.9, Range(0, 1, {{kIndex, 1}}));
    InputControl *c = Slider(f, first);
    c->NotifyChanged(second, AutoNumber(0.9), nullptr);
    QCOMPARE(EditOf(c)->text(), QString("0.50"));
    c->NotifyChanged(first, AutoNumber(0.8), nullptr);
    QCOMPARE(EditOf(c)->text(), QString("0.80"));
    // Less than half a step is no change.
    c->NotifyChanged(first, AutoNumber(0.804), nullptr);
    QCOMPARE(EditOf(c)->text(), QString("0.80"));
}

void SliderControlTest::mappings_data()
{
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<int>("from");
    QTest::addColumn<double>("written");
    // 0.5 sits at a quarter of a squared track (pixel 55); 50 pixels right
    // is half way along it: sqrt(0.5) = 0.7071, two places 0.71.
    const TagList places = Range(0, 1, {{kPlaces, 2}});
    TagList callbacks = places;
    callbacks.Add(kForwardFunc, &Square);
    callbacks.Add(kInverseFunc, &Root);
    TagList expressions = places;
    expressions.Add(kForwardExpr, "value^2");
    expressions.Add(kInverseExpr, "sqrt(value)");
    QTest::newRow("linear") << places << 105 << 0.75;
    QTest::newRow("callbacks") << callbacks << 55 << 0.71;
    QTest::newRow("expressions") << expressions << 55 << 0.71;
}

void SliderControlTest::mappings()
{
    QFETCH(TagList, attrs);
    QFETCH(int, from);
    QFETCH(double, written);
    ToolFixture f;
    Input *in = f.AddNumber("Blend", 0.5, attrs);
    Drag(SliderOf(Slider(f, in)), from, from + 50);
    QCOMPARE(f.NumberOf(in), written);
}

void SliderControlTest::knobStyles_data()
{
    QTest::addColumn<int>("style");
    QTest::addColumn<bool>("red");
    QTest::newRow("0 ordinary") << 0 << false;
    QTest::newRow("5 ordinary") << 5 << false;
    QTest::newRow("6 red channel") << 6 << true;
    QTest::newRow("10 ordinary") << 10 << false;
}

void SliderControlTest::knobStyles()
{
    QFETCH(int, style);
    QFETCH(bool, red);
    ToolFixture f;
    InputControl *c = Slider(f, f.AddNumber("Blend", 0.5, Range(0, 1, {{kKnobStyle, style}})));
    const QImage image = SliderOf(c)->grab().toImage();
    const QColor knob = image.pixelColor(105 + 2, kKnobY);
    QCOMPARE(knob.red() > knob.green() + 60, red);
}

void SliderControlTest::captions()
{
    ToolFixture f;
    Input *in = f.AddNumber("Balance", 0.0, Range(-1, 1, {{kLowName, "Shadows"}, {kHighName, "Highlights"}}));
    InputControl *c = Slider(f, in);
    auto *low = c->findChild<QLabel *>("minlabel");
    auto *mid = c->findChild<QLabel *>("midlabel");
    auto *high = c->findChild<QLabel *>("maxlabel");
    QCOMPARE(low->text(), QString("Shadows"));
    QCOMPARE(high->text(), QString("Highlights"));
    QVERIFY(low->isVisible() && high->isVisible() && !mid->isVisible());
    QVERIFY(high->geometry().right() > SliderOf(c)->width() / 2);
    QVERIFY(!SliderOf(c)->testAttribute(Qt::WA_OpaquePaintEvent));
    c->SetAttrsTagList(in, Range(-1, 1, {{kMidName, "Midtones"}}));
    QCOMPARE(mid->text(), QString("Midtones"));
    QVERIFY(mid->isVisible());
    QCOMPARE(low->text(), QString("Shadows"));
}

namespace {

// Does column x of the slider show the ramp's blue in any row?
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

// The ramp fills the track from end to end, also after the inspector grows.
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

void SliderControlTest::undoRenotifies()
{
    ToolFixture f;
    Input *in = f.AddNumber("Blend", 0.5, Range(0, 1, {{kPlaces, 3}}));
    InputControl *c = Slider(f, in);
    Drag(SliderOf(c), 105, 125);
    Drag(SliderOf(c), 125, 145);
    QCOMPARE(f.NumberOf(in), 0.7);
    QCOMPARE(f.doc.UndoNames().size(), 2);
    f.doc.Undo();
    QCOMPARE(f.NumberOf(in), 0.6);
    QCOMPARE(EditOf(c)->text(), QString("0.600"));
    f.doc.Undo();
    QCOMPARE(EditOf(c)->text(), QString("0.500"));
    f.doc.Redo();
    QCOMPARE(f.NumberOf(in), 0.6);
}

QTEST_MAIN(SliderControlTest)
#include "SliderControlTest.moc"
