#include "ToolFixture.h"

#include "widgets/HueHexagon.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"

#include <QLineEdit>
#include <QtTest>

#include <cmath>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

constexpr Tag kLabel = 0x30040000;
const OrbID kSuppression("ColorSuppressionControl");
const char *const kHues[6] = {"Red", "Yellow", "Green", "Cyan", "Blue", "Magenta"};

// Six hue Inputs at 0; without `withMagenta` the last has no Input linked.
struct Suppress
{
    explicit Suppress(bool withMagenta = true)
    {
        TagList attrs{{kLabel, "Suppress"}};
        for (int i = 1; i < 6; ++i) {
            inputs[i] = f.AddNumber(kHues[i], 0.0);
            if (i < 5 || withMagenta)
                attrs.Add(Tag(0x40050000 + i - 1), static_cast<ScriptObject *>(inputs[i]));
        }
        inputs[0] = f.AddNumber("Red", 0.0, attrs);
        control = f.Create(kSuppression, {inputs[0]});
        hexagon = control->findChild<HueHexagon *>("hexagon");
    }
    QPoint Along(int spoke, double value) const
    {
        return (hexagon->Centre() + HueHexagon::Direction(spoke) * (value * hexagon->Radius())).toPoint();
    }

    ToolFixture f;
    Input *inputs[6] = {};
    InputControl *control = nullptr;
    HueHexagon *hexagon = nullptr;
};

} // namespace

class ColorSuppressionControlTest : public QObject
{
    Q_OBJECT
private slots:
    void initTestCase();
    void drags_data();
    void drags();
    void typedAndUnlinked();
};

void ColorSuppressionControlTest::initTestCase()
{
    std::string error;
    QVERIFY2(ToolFixture::LoadControls(&error), error.c_str());
}

// A press on a spoke at `at` (fraction of the radius), then a drag to `to`
// along it; the value lands on the hue pressed, one step, the rest stay 0.
void ColorSuppressionControlTest::drags_data()
{
    QTest::addColumn<int>("spoke");
    QTest::addColumn<double>("at");
    QTest::addColumn<double>("to");
    QTest::addColumn<bool>("fine");
    QTest::addColumn<double>("value");
    QTest::newRow("red press") << 0 << 0.5 << 0.5 << false << 0.5;
    QTest::newRow("green drag out") << 2 << 0.25 << 0.75 << false << 0.75;
    QTest::newRow("blue past the end stops at the maximum") << 4 << 0.5 << 1.5 << false << 1.0;
    QTest::newRow("cyan back past the centre stops at 0") << 3 << 0.5 << -0.5 << false << 0.0;
    QTest::newRow("yellow fine keeps the value pressed") << 1 << 0.2 << 0.7 << true << 0.05;
}

void ColorSuppressionControlTest::drags()
{
    QFETCH(int, spoke);
    QFETCH(double, at);
    QFETCH(double, to);
    QFETCH(bool, fine);
    QFETCH(double, value);
    Suppress s;
    const Qt::KeyboardModifiers mods = fine ? Qt::ControlModifier : Qt::NoModifier;
    const QPoint from = s.Along(spoke, at), end = s.Along(spoke, to);
    QTest::mousePress(s.hexagon, Qt::LeftButton, mods, from);
    QMouseEvent move(QEvent::MouseMove, end, s.hexagon->mapToGlobal(end), Qt::NoButton, Qt::LeftButton, mods);
    QApplication::sendEvent(s.hexagon, &move);
    QTest::mouseRelease(s.hexagon, Qt::LeftButton, mods, end);
    for (int i = 0; i < 6; ++i) {
        const double expected = i == spoke ? value : 0.0;
        QVERIFY2(std::fabs(s.f.NumberOf(s.inputs[i]) - expected) < 0.02,
                 qPrintable(QString("%1: %2").arg(kHues[i]).arg(s.f.NumberOf(s.inputs[i]))));
    }
    QCOMPARE(s.f.doc.UndoNames(), value == 0.0 ? QStringList{} : QStringList{"Change Suppress"});
}

// A typed box is one step; a hue without an Input cannot be set.
void ColorSuppressionControlTest::typedAndUnlinked()
{
    Suppress s(false);
    auto *green = s.control->findChild<QLineEdit *>("green");
    green->selectAll();
    QTest::keyClicks(green, "0.3");
    QTest::keyClick(green, Qt::Key_Return);
    QCOMPARE(s.f.NumberOf(s.inputs[2]), 0.3);
    QVERIFY(!s.control->findChild<QLineEdit *>("magenta")->isEnabled());
    QTest::mouseClick(s.hexagon, Qt::LeftButton, Qt::NoModifier, s.Along(5, 0.8));
    QCOMPARE(s.hexagon->Values()[5], 0.0);
    QCOMPARE(s.f.doc.UndoNames().size(), 1);
}

QTEST_MAIN(ColorSuppressionControlTest)
#include "ColorSuppressionControlTest.moc"
