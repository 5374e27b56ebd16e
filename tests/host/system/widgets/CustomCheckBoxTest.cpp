#include "orbane/CustomCheckBox.h"

#include <QSignalSpy>
#include <QtTest>

using namespace Orbane;

// Receives through old-style string connections, as controls connect.
class Receiver : public QObject
{
    Q_OBJECT
public:
    int32 lastState = -1;
    uint64 lastModifiers = 0;
    int calls = 0;
    int presses = 0;
public slots:
    void OnButtonPressed() { ++presses; }
    void OnCheckChanged(int32 state, uint64 modifiers)
    {
        lastState = state;
        lastModifiers = modifiers;
        ++calls;
    }
};

namespace {

// Renders the box at a device pixel ratio, as a dense screen would show it.
QImage Render(QWidget &w, qreal dpr)
{
    QImage image(w.size() * dpr, QImage::Format_ARGB32_Premultiplied);
    image.setDevicePixelRatio(dpr);
    image.fill(Qt::black);
    w.render(&image);
    return image;
}

} // namespace

using StateList = QList<int>;

class CustomCheckBoxTest : public QObject
{
    Q_OBJECT
private slots:
    void clicksCycleStates_data();
    void clicksCycleStates();
    void setCheckEmitsNothing_data();
    void setCheckEmitsNothing();
    void releaseOutsideDoesNotToggle();
    void spaceToggles();
    void styleChangeTakesEffectAtOnce();
    void oldStyleConnect();
    void paintsStates_data();
    void paintsStates();
    void wrapMeasuresLikeTheControl();
};

void CustomCheckBoxTest::clicksCycleStates_data()
{
    QTest::addColumn<int>("style");
    QTest::addColumn<int>("start");
    QTest::addColumn<int>("modifiers");
    QTest::addColumn<StateList>("states");

    QTest::newRow("two-state") << 1 << 0 << int(Qt::NoModifier) << StateList{1, 0, 1};
    QTest::newRow("two-state from mixed") << 1 << 2 << int(Qt::NoModifier) << StateList{1, 0};
    QTest::newRow("tri-state") << 2 << 0 << int(Qt::NoModifier) << StateList{1, 2, 0, 1};
    QTest::newRow("tri-state from mixed") << 2 << 2 << int(Qt::NoModifier) << StateList{0, 1};
    QTest::newRow("ctrl held") << 1 << 0 << int(Qt::ControlModifier) << StateList{1, 0};
    QTest::newRow("shift held") << 2 << 1 << int(Qt::ShiftModifier) << StateList{2, 0};
    QTest::newRow("ctrl and shift held") << 2 << 0 << int(Qt::ControlModifier | Qt::ShiftModifier) << StateList{1};
}

void CustomCheckBoxTest::clicksCycleStates()
{
    QFETCH(int, style);
    QFETCH(int, start);
    QFETCH(int, modifiers);
    QFETCH(StateList, states);

    CustomCheckBox box;
    box.SetLabel(QStringLiteral("Invert"));
    box.resize(160, 22);
    box.show();
    box.SetStyle(style);
    box.SetCheck(start);
    QSignalSpy changed(&box, &CustomCheckBox::CheckChanged);
    QSignalSpy pressed(&box, &CustomButton::ButtonPressed);

    for (int i = 0; i < states.size(); ++i) {
        QTest::mouseClick(&box, Qt::LeftButton, Qt::KeyboardModifiers(modifiers), box.rect().center());
        QCOMPARE(changed.count(), i + 1);
        QCOMPARE(changed.last().at(0).value<int32>(), states[i]);
        QCOMPARE(changed.last().at(1).value<uint64>(), uint64(modifiers));
        QCOMPARE(box.GetCheck(), states[i]);
        QCOMPARE(pressed.last().at(1).toBool(), states[i] != 0);
    }
}

void CustomCheckBoxTest::setCheckEmitsNothing_data()
{
    QTest::addColumn<int>("value");
    QTest::addColumn<int>("shown");
    QTest::newRow("on") << 1 << 1;
    QTest::newRow("mixed") << 2 << 2;
    QTest::newRow("off after on") << 0 << 0;
    QTest::newRow("above range") << 7 << 2;
    QTest::newRow("below range") << -3 << 0;
}

void CustomCheckBoxTest::setCheckEmitsNothing()
{
    QFETCH(int, value);
    QFETCH(int, shown);
    CustomCheckBox box;
    box.SetStyle(2);
    box.SetCheck(1);
    QSignalSpy changed(&box, &CustomCheckBox::CheckChanged);
    QSignalSpy pressed(&box, &CustomButton::ButtonPressed);
    box.SetCheck(value);
    QCOMPARE(box.GetCheck(), shown);
    QCOMPARE(changed.count(), 0);
    QCOMPARE(pressed.count(), 0);
}

void CustomCheckBoxTest::releaseOutsideDoesNotToggle()
{
    CustomCheckBox box;
    box.resize(160, 22);
    box.show();
    QSignalSpy changed(&box, &CustomCheckBox::CheckChanged);
    QTest::mousePress(&box, Qt::LeftButton, {}, box.rect().center());
    QVERIFY(box.IsDown());
    QTest::mouseRelease(&box, Qt::LeftButton, {}, QPoint(300, 40));
    QCOMPARE(changed.count(), 0);
    QCOMPARE(box.GetCheck(), 0);
    QVERIFY(!box.IsDown());
}

void CustomCheckBoxTest::spaceToggles()
{
    CustomCheckBox box;
    box.show();
    QSignalSpy changed(&box, &CustomCheckBox::CheckChanged);
    QTest::keyClick(&box, Qt::Key_Space, Qt::ShiftModifier);
    QCOMPARE(changed.count(), 1);
    QCOMPARE(changed.last().at(0).value<int32>(), 1);
    QCOMPARE(changed.last().at(1).value<uint64>(), uint64(Qt::ShiftModifier));
    QTest::keyClick(&box, Qt::Key_X);
    QCOMPARE(changed.count(), 1);
}

void CustomCheckBoxTest::styleChangeTakesEffectAtOnce()
{
    CustomCheckBox box;
    box.resize(160, 22);
    box.show();
    box.SetStyle(2);
    box.SetCheck(1);
    box.SetStyle(1); // tri-state would go on to 2
    QTest::mouseClick(&box, Qt::LeftButton, {}, box.rect().center());
    QCOMPARE(box.GetCheck(), 0);
    QCOMPARE(box.GetStyle(), 1);
}

void CustomCheckBoxTest::oldStyleConnect()
{
    CustomCheckBox box;
    box.resize(160, 22);
    box.show();
    Receiver receiver;
    QVERIFY(QObject::connect(&box, "2CheckChanged(int32, uint64)", &receiver, "1OnCheckChanged(int32, uint64)"));
    QVERIFY(QObject::connect(&box, "2ButtonPressed(uint64, bool)", &receiver, "1OnButtonPressed()"));

    QTest::mouseClick(&box, Qt::LeftButton, Qt::ControlModifier, box.rect().center());
    QCOMPARE(receiver.calls, 1);
    QCOMPARE(receiver.lastState, 1);
    QCOMPARE(receiver.lastModifiers, uint64(Qt::ControlModifier));
    QCOMPARE(receiver.presses, 1);
}

void CustomCheckBoxTest::paintsStates_data()
{
    QTest::addColumn<int>("state");
    QTest::addColumn<qreal>("dpr");
    for (qreal dpr : {1.0, 2.0}) {
        for (int state : {0, 1, 2}) {
            const QString row = QStringLiteral("state %1 at %2x").arg(state).arg(dpr);
            QTest::newRow(qPrintable(row)) << state << dpr;
        }
    }
}

void CustomCheckBoxTest::paintsStates()
{
    QFETCH(int, state);
    QFETCH(qreal, dpr);

    CustomCheckBox box;
    box.SetStyle(2);
    box.resize(120, 22);
    box.SetCheck(state);
    const QImage image = Render(box, dpr);
    QCOMPARE(image.size(), box.size() * dpr);

    const QRect b = box.BoxRect();
    const QColor base = box.palette().color(QPalette::Base);
    const QColor accent = box.palette().color(QPalette::Active, QPalette::Highlight);
    auto at = [&](qreal x, qreal y) { return image.pixelColor(int(x * dpr), int(y * dpr)); };
    // Inside the box, just right of its frame, on the middle row.
    const qreal side = b.left() + 2;
    const qreal middle = b.top() + b.height() / 2;
    const qreal centre = b.left() + b.width() / 2;

    switch (state) {
    case 0:
        QCOMPARE(at(side, middle), base);
        QCOMPARE(at(centre, middle), base);
        break;
    case 1:
        QCOMPARE(at(side, b.top() + 3), accent);
        QCOMPARE(at(centre, b.top() + 3), accent);
        break;
    default: {
        // The dash: whole device pixels of the base colour, with the accent
        // right above and below it, no blended rows between.
        QCOMPARE(at(side, middle), accent);
        QCOMPARE(at(centre, middle), base);
        const int dashTop = int((b.top() + b.height() / 2 - 1) * dpr);
        const int dashBottom = int((b.top() + b.height() / 2 + 1) * dpr) - 1;
        const int x = int(centre * dpr);
        QCOMPARE(image.pixelColor(x, dashTop), base);
        QCOMPARE(image.pixelColor(x, dashBottom), base);
        QCOMPARE(image.pixelColor(x, dashTop - 1), accent);
        QCOMPARE(image.pixelColor(x, dashBottom + 1), accent);
    }
    }
}

void CustomCheckBoxTest::wrapMeasuresLikeTheControl()
{
    // The check box control measures the label in (width - 25) pixels; the
    // box's own height for a width must follow the same wrapping.
    CustomCheckBox box;
    box.AllowWrap(true);
    box.SetLabel(QStringLiteral("Keep the alpha channel of the foreground where the background is empty"));
    QVERIFY(box.hasHeightForWidth());
    const int width = 140;
    const QFontMetrics fm = box.fontMetrics();
    const int single = fm.boundingRect(QRect(0, 0, width - 25, 1000), 0x321, box.GetLabel()).height();
    const int wrapped = fm.boundingRect(QRect(0, 0, width - 25, 1000), 0x1021, box.GetLabel()).height();
    QVERIFY(wrapped > single);
    QCOMPARE(CustomCheckBox::kBoxRoom + CustomCheckBox::kRightMargin, 25);
    // The control's height (row height + wrapped - single) holds the text.
    const int rowHeight = box.sizeHint().height();
    QVERIFY(box.heightForWidth(width) > rowHeight);
    QVERIFY(rowHeight + wrapped - single >= box.heightForWidth(width));
    QCOMPARE(box.heightForWidth(10000), rowHeight);

    box.AllowWrap(false);
    QVERIFY(!box.hasHeightForWidth());
}

QTEST_MAIN(CustomCheckBoxTest)
#include "CustomCheckBoxTest.moc"
