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

constexpr Tag SLA_MinScale = 0x20030002, SLA_MaxScale = 0x20030003;

// Gain, 0..2, the tool's first Input: its slider's track runs from 20 to
// 220 viewer pixels, 20 up from the viewer's bottom; the knob sits at 70.
Input *AddSlider(ViewerFixture &f, double value = 0.5)
{
    const TagList attrs{{INPA_PreviewControl, OrbID("SliderOverlay")}, {SLA_MinScale, 0.0}, {SLA_MaxScale, 2.0}};
    return f.tool->AddInput(OrbID("Gain"), "Gain", CLSID_DataType_Number, attrs, AutoNumber(value));
}

// Widget pixel of a point `x` viewer pixels along the first row's track.
QPoint Along(const ViewerFixture &, double x)
{
    return QPoint(int(std::lround(20 + x)), ViewerFixture::kViewHeight - 20);
}

} // namespace

class SliderOverlayTest : public QObject
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
        QTest::addColumn<double>("zoom");
        QTest::addColumn<double>("from"); // along the track, viewer pixels
        QTest::addColumn<int>("by");
        QTest::addColumn<int>("mods");
        QTest::addColumn<double>("value");
        QTest::newRow("the knob, 40 right") << 1.0 << 50.0 << 40 << 0 << 0.9;
        QTest::newRow("the knob at zoom 3: the same on screen") << 3.0 << 50.0 << 40 << 0 << 0.9;
        QTest::newRow("grabbed off centre") << 1.0 << 54.0 << -20 << 0 << 0.3;
        QTest::newRow("ctrl: ten times finer") << 1.0 << 50.0 << 40 << int(Qt::ControlModifier) << 0.54;
        QTest::newRow("past the end: the maximum") << 1.0 << 50.0 << 400 << 0 << 2.0;
        QTest::newRow("a click on the track jumps there") << 1.0 << 150.0 << 0 << 0 << 1.5;
        QTest::newRow("the track, then dragged") << 1.0 << 150.0 << 20 << 0 << 1.7;
    }
    // The value the knob is left at, one undo step named for the Input.
    void drag()
    {
        QFETCH(double, zoom);
        QFETCH(double, from);
        QFETCH(int, by);
        QFETCH(int, mods);
        QFETCH(double, value);
        ViewerFixture f;
        AddSlider(f);
        QVERIFY(f.Show());
        f.viewer.SetView(zoom);
        QApplication::processEvents();
        {
            HeldKeys held(&f.viewer, Qt::KeyboardModifiers(mods));
            f.Drag(Along(f, from), Along(f, from + by), 4);
        }
        QVERIFY2(std::fabs(NumberOf(f, "Gain") - value) < 1e-9, qPrintable(QString::number(NumberOf(f, "Gain"))));
        QCOMPARE(f.doc.UndoNames(), QStringList{"Slide Gain"});
        QVERIFY(f.doc.Undo());
        QCOMPARE(NumberOf(f, "Gain"), 0.5);
    }

    // The knob and the track under the mouse; the knob follows a value
    // written elsewhere.
    void hover()
    {
        ViewerFixture f;
        Input *gain = AddSlider(f);
        QVERIFY(f.Show());
        f.Hover(Along(f, 50));
        QCOMPARE(StateOf(f.OverlayOf(gain), "hoverPart"), 1.0);
        f.Hover(Along(f, 120));
        QCOMPARE(StateOf(f.OverlayOf(gain), "hoverPart"), 2.0);
        f.Hover(Along(f, 250));
        QCOMPARE(StateOf(f.OverlayOf(gain), "hoverPart"), 0.0);
        gain->SetValue(AutoNumber(1.2).get(), f.doc.GetCurrentTime());
        QApplication::processEvents();
        f.Hover(Along(f, 120));
        QCOMPARE(StateOf(f.OverlayOf(gain), "hoverPart"), 1.0);
        QCOMPARE(StateOf(f.OverlayOf(gain), "maximum"), 2.0);
    }

    void keys_data()
    {
        QTest::addColumn<int>("key");
        QTest::addColumn<int>("mods");
        QTest::addColumn<double>("value");
        QTest::newRow("right: a hundredth of the range") << int(Qt::Key_Right) << 0 << 0.52;
        QTest::newRow("left with shift: a tenth") << int(Qt::Key_Left) << int(Qt::ShiftModifier) << 0.3;
        QTest::newRow("right with ctrl: a thousandth") << int(Qt::Key_Right) << int(Qt::ControlModifier) << 0.502;
        QTest::newRow("up is not claimed") << int(Qt::Key_Up) << 0 << 0.5;
    }
    void keys()
    {
        QFETCH(int, key);
        QFETCH(int, mods);
        QFETCH(double, value);
        ViewerFixture f;
        AddSlider(f);
        QVERIFY(f.Show());
        f.Hover(Along(f, 50));
        f.Key(Qt::Key(key), Qt::KeyboardModifiers(mods));
        QVERIFY2(std::fabs(NumberOf(f, "Gain") - value) < 1e-9, qPrintable(QString::number(NumberOf(f, "Gain"))));
        QCOMPARE(f.UndoSteps(), value != 0.5 ? 1 : 0);
    }

    // A value that is no number puts the knob at the track's start: a press
    // there writes nothing, a click on the track writes a number.
    void notANumber()
    {
        ViewerFixture f;
        AddSlider(f, std::nan(""));
        QVERIFY(f.Show());
        f.Grab();
        f.Drag(Along(f, 0), Along(f, 0), 1);
        f.Drag(Along(f, 100), Along(f, 100), 1);
        QCOMPARE(NumberOf(f, "Gain"), 1.0);
    }
};

QTEST_MAIN(SliderOverlayTest)
#include "SliderOverlayTest.moc"
