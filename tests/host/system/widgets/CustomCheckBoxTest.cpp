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

class CustomCheckBoxTest : public QObject
{
    Q_OBJECT
private slots:
    // Clicks cycle the states through the check box control
    // (CheckBoxControlTest); the modifiers come from the base button
    // (CustomButtonTest).
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
