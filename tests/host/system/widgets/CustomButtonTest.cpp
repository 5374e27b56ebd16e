#include "orbane/CustomButton.h"

#include <QSignalSpy>
#include <QtTest>

using namespace Orbane;

namespace {

void Show(CustomButton &button)
{
    button.SetLabel(QStringLiteral("Render"));
    button.resize(100, 24);
    button.show();
}

QImage Render(QWidget &w, qreal dpr)
{
    QImage image(w.size() * dpr, QImage::Format_ARGB32_Premultiplied);
    image.setDevicePixelRatio(dpr);
    image.fill(Qt::magenta);
    w.render(&image);
    return image;
}

} // namespace

class CustomButtonTest : public QObject
{
    Q_OBJECT
private slots:
    void gestures_data()
    {
        QTest::addColumn<int>("key"); // 0: a mouse click
        QTest::addColumn<int>("button");
        QTest::addColumn<QPoint>("release");
        QTest::addColumn<int>("modifiers");
        QTest::addColumn<bool>("enabled");
        QTest::addColumn<int>("presses");
        const int left = Qt::LeftButton, ctrl = Qt::ControlModifier, none = Qt::NoModifier;
        const QPoint in(50, 12), out(150, 12);
        QTest::newRow("click") << 0 << left << in << none << true << 1;
        QTest::newRow("click, ctrl shift") << 0 << left << in << int(ctrl | Qt::ShiftModifier) << true << 1;
        QTest::newRow("space, ctrl") << int(Qt::Key_Space) << 0 << in << ctrl << true << 1;
        QTest::newRow("return") << int(Qt::Key_Return) << 0 << in << none << true << 1;
        QTest::newRow("letter") << int(Qt::Key_A) << 0 << in << none << true << 0;
        QTest::newRow("released outside") << 0 << left << out << none << true << 0;
        QTest::newRow("right button") << 0 << int(Qt::RightButton) << in << none << true << 0;
        QTest::newRow("disabled") << 0 << left << in << none << false << 0;
        QTest::newRow("disabled, space") << int(Qt::Key_Space) << 0 << in << none << false << 0;
    }

    void gestures()
    {
        QFETCH(int, key);
        QFETCH(int, button);
        QFETCH(QPoint, release);
        QFETCH(int, modifiers);
        QFETCH(bool, enabled);
        QFETCH(int, presses);
        CustomButton b;
        Show(b);
        b.setEnabled(enabled);
        // By signature, as controls connect.
        QSignalSpy pressed(&b, SIGNAL(ButtonPressed(uint64, bool)));
        const auto held = Qt::KeyboardModifiers(modifiers);
        if (key) {
            QTest::keyClick(&b, Qt::Key(key), held);
        } else {
            QTest::mousePress(&b, Qt::MouseButton(button), held, QPoint(50, 12));
            QTest::mouseRelease(&b, Qt::MouseButton(button), held, release);
        }
        QCOMPARE(pressed.count(), presses);
        if (presses) {
            QCOMPARE(pressed.last().at(0).value<uint64>(), uint64(modifiers));
            QCOMPARE(pressed.last().at(1).toBool(), false);
        }
        QVERIFY(!b.IsDown());
        QCOMPARE(b.GetCheck(), 0);
    }

    void paintsCrisplyAtRatio_data()
    {
        QTest::addColumn<qreal>("dpr");
        QTest::newRow("1x") << 1.0;
        QTest::newRow("2x") << 2.0;
    }

    void paintsCrisplyAtRatio()
    {
        QFETCH(qreal, dpr);
        CustomButton button;
        button.resize(100, 24);
        button.SetBasicCols(OrbColor(60, 60, 60), OrbColor(220, 220, 220), OrbColor(10, 10, 10));
        const QImage image = Render(button, dpr);
        QCOMPARE(image.size(), QSize(100, 24) * dpr);
        // The top frame line is exactly one logical pixel of the frame colour:
        // solid device rows, then the face, with nothing blended between.
        const int x = image.width() / 2;
        for (int row = 0; row < int(dpr); ++row)
            QCOMPARE(image.pixelColor(x, row), QColor(10, 10, 10));
        QVERIFY(image.pixelColor(x, int(dpr)).lightness() > 40);
    }

    void backgroundAndBaseColours()
    {
        CustomButton button;
        button.resize(100, 24);
        button.SetBackgroundColor(OrbColor(0, 200, 0));
        QImage image = Render(button, 1.0);
        // The rounded corner shows the background, not the magenta behind.
        QCOMPARE(image.pixelColor(0, 0).green(), 200);
        QVERIFY(image.pixelColor(0, 0).red() < 100);

        button.SetBasicCols(OrbColor(200, 0, 0));
        image = Render(button, 1.0);
        const QColor face = image.pixelColor(10, 12);
        QVERIFY2(face.red() > 150 && face.green() < 60, qPrintable(face.name()));
    }
};

QTEST_MAIN(CustomButtonTest)
#include "CustomButtonTest.moc"
