#include "orbane/CustomCheckBox.h"

#include <QSignalSpy>
#include <QtTest>

using namespace Orbane;

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
    // Press and release come from the base button (see CustomButtonTest);
    // the box cycles its states and reports the modifiers held.
    void clicksCycleStates_data()
    {
        QTest::addColumn<int>("style");
        QTest::addColumn<int>("start");
        QTest::addColumn<int>("modifiers");
        QTest::addColumn<StateList>("states");
        QTest::newRow("two-state") << 1 << 0 << int(Qt::NoModifier) << StateList{1, 0, 1};
        QTest::newRow("tri-state") << 2 << 0 << int(Qt::NoModifier) << StateList{1, 2, 0, 1};
        QTest::newRow("ctrl and shift held") << 2 << 0 << int(Qt::ControlModifier | Qt::ShiftModifier) << StateList{1};
    }

    void clicksCycleStates()
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
        // By signature, as controls connect.
        QSignalSpy changed(&box, SIGNAL(CheckChanged(int32, uint64)));
        QSignalSpy pressed(&box, SIGNAL(ButtonPressed(uint64, bool)));
        for (int i = 0; i < states.size(); ++i) {
            QTest::mouseClick(&box, Qt::LeftButton, Qt::KeyboardModifiers(modifiers), box.rect().center());
            QCOMPARE(changed.count(), i + 1);
            QCOMPARE(changed.last().at(0).value<int32>(), states[i]);
            QCOMPARE(changed.last().at(1).value<uint64>(), uint64(modifiers));
            QCOMPARE(box.GetCheck(), states[i]);
            QCOMPARE(pressed.last().at(1).toBool(), states[i] != 0);
        }
    }

    // A program's SetCheck clamps to the style's states and tells no one.
    void setCheckClampsAndEmitsNothing()
    {
        CustomCheckBox box;
        box.SetStyle(2);
        QSignalSpy changed(&box, &CustomCheckBox::CheckChanged);
        QSignalSpy pressed(&box, &CustomButton::ButtonPressed);
        for (const auto &[value, shown] : {std::pair{1, 1}, {2, 2}, {7, 2}, {-3, 0}}) {
            box.SetCheck(value);
            QCOMPARE(box.GetCheck(), shown);
        }
        QCOMPARE(changed.count() + pressed.count(), 0);
    }

    void paintsStates_data()
    {
        QTest::addColumn<int>("state");
        QTest::addColumn<qreal>("dpr");
        for (qreal dpr : {1.0, 2.0})
            for (int state : {0, 1, 2})
                QTest::addRow("state %d at %.0fx", state, dpr) << state << dpr;
    }

    void paintsStates()
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
        const QColor fill = state ? accent : base;
        auto at = [&](qreal x, qreal y) { return image.pixelColor(int(x * dpr), int(y * dpr)); };
        // Inside the box, just right of its frame and in the middle.
        const qreal side = b.left() + 2, centre = b.left() + b.width() / 2, middle = b.top() + b.height() / 2;
        QCOMPARE(at(side, state == 1 ? b.top() + 3 : middle), fill);
        QCOMPARE(at(centre, state == 1 ? b.top() + 3 : middle), state == 1 ? accent : base);
        if (state != 2)
            return;
        // The dash: whole device pixels of the base colour, with the accent right
        // above and below it, no blended rows between.
        const int dashTop = int((middle - 1) * dpr), dashBottom = int((middle + 1) * dpr) - 1, x = int(centre * dpr);
        QCOMPARE(image.pixelColor(x, dashTop), base);
        QCOMPARE(image.pixelColor(x, dashBottom), base);
        QCOMPARE(image.pixelColor(x, dashTop - 1), accent);
        QCOMPARE(image.pixelColor(x, dashBottom + 1), accent);
    }
};

QTEST_MAIN(CustomCheckBoxTest)
#include "CustomCheckBoxTest.moc"
