#include "orbane/CustomButton.h"

#include <QSignalSpy>
#include <QtTest>

using namespace Orbane;

class Receiver : public QObject
{
    Q_OBJECT
public:
    uint64 modifiers = 0;
    bool checked = false;
    int calls = 0;
public slots:
    void OnButtonPressed(uint64 m, bool c)
    {
        modifiers = m;
        checked = c;
        ++calls;
    }
};

class CustomButtonTest : public QObject
{
    Q_OBJECT
private slots:
    void clickEmitsModifiers_data();
    void clickEmitsModifiers();
    void keys_data();
    void keys();
    void releaseOutsideDoesNothing();
    void rightButtonDoesNothing();
    void disabledDoesNothing();
    void stylesStepTheCheck_data();
    void stylesStepTheCheck();
    void oldStyleConnect();
    void wrapGrowsHeight();
    void paintsCrisplyAtRatio_data();
    void paintsCrisplyAtRatio();
    void backgroundAndBaseColours();
};

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

void CustomButtonTest::clickEmitsModifiers_data()
{
    QTest::addColumn<int>("modifiers");
    QTest::newRow("none") << int(Qt::NoModifier);
    QTest::newRow("ctrl") << int(Qt::ControlModifier);
    QTest::newRow("shift") << int(Qt::ShiftModifier);
    QTest::newRow("alt") << int(Qt::AltModifier);
    QTest::newRow("ctrl shift") << int(Qt::ControlModifier | Qt::ShiftModifier);
}

void CustomButtonTest::clickEmitsModifiers()
{
    QFETCH(int, modifiers);
    CustomButton button;
    Show(button);
    QSignalSpy pressed(&button, &CustomButton::ButtonPressed);
    QTest::mouseClick(&button, Qt::LeftButton, Qt::KeyboardModifiers(modifiers), QPoint(50, 12));
    QCOMPARE(pressed.count(), 1);
    QCOMPARE(pressed.last().at(0).value<uint64>(), uint64(modifiers));
    QCOMPARE(pressed.last().at(1).toBool(), false);
    QCOMPARE(button.GetCheck(), 0);
}

void CustomButtonTest::keys_data()
{
    QTest::addColumn<int>("key");
    QTest::addColumn<int>("presses");
    QTest::newRow("space") << int(Qt::Key_Space) << 1;
    QTest::newRow("return") << int(Qt::Key_Return) << 1;
    QTest::newRow("enter") << int(Qt::Key_Enter) << 1;
    QTest::newRow("letter") << int(Qt::Key_A) << 0;
    QTest::newRow("tab") << int(Qt::Key_Escape) << 0;
}

void CustomButtonTest::keys()
{
    QFETCH(int, key);
    QFETCH(int, presses);
    CustomButton button;
    Show(button);
    QSignalSpy pressed(&button, &CustomButton::ButtonPressed);
    QTest::keyClick(&button, Qt::Key(key), Qt::ControlModifier);
    QCOMPARE(pressed.count(), presses);
    if (presses)
        QCOMPARE(pressed.last().at(0).value<uint64>(), uint64(Qt::ControlModifier));
    QVERIFY(!button.IsDown());
}

void CustomButtonTest::releaseOutsideDoesNothing()
{
    CustomButton button;
    Show(button);
    QSignalSpy pressed(&button, &CustomButton::ButtonPressed);
    QTest::mousePress(&button, Qt::LeftButton, {}, QPoint(50, 12));
    QVERIFY(button.IsDown());
    QTest::mouseRelease(&button, Qt::LeftButton, {}, QPoint(150, 12));
    QCOMPARE(pressed.count(), 0);
    QVERIFY(!button.IsDown());
}

void CustomButtonTest::rightButtonDoesNothing()
{
    CustomButton button;
    Show(button);
    QSignalSpy pressed(&button, &CustomButton::ButtonPressed);
    QTest::mouseClick(&button, Qt::RightButton, {}, QPoint(50, 12));
    QCOMPARE(pressed.count(), 0);
}

void CustomButtonTest::disabledDoesNothing()
{
    CustomButton button;
    Show(button);
    button.setEnabled(false);
    QSignalSpy pressed(&button, &CustomButton::ButtonPressed);
    QTest::mouseClick(&button, Qt::LeftButton, {}, QPoint(50, 12));
    QTest::keyClick(&button, Qt::Key_Space);
    QCOMPARE(pressed.count(), 0);
}

void CustomButtonTest::stylesStepTheCheck_data()
{
    QTest::addColumn<int>("style");
    QTest::addColumn<QList<bool>>("checked");
    QTest::newRow("push") << 0 << QList<bool>{false, false};
    QTest::newRow("two-state") << 1 << QList<bool>{true, false, true};
    QTest::newRow("tri-state") << 2 << QList<bool>{true, true, false};
}

void CustomButtonTest::stylesStepTheCheck()
{
    QFETCH(int, style);
    QFETCH(QList<bool>, checked);
    CustomButton button;
    Show(button);
    button.SetStyle(style);
    QSignalSpy pressed(&button, &CustomButton::ButtonPressed);
    for (int i = 0; i < checked.size(); ++i) {
        QTest::mouseClick(&button, Qt::LeftButton, {}, QPoint(50, 12));
        QCOMPARE(pressed.last().at(1).toBool(), checked[i]);
        QCOMPARE(button.GetCheck() != 0, checked[i]);
    }
}

void CustomButtonTest::oldStyleConnect()
{
    CustomButton button;
    Show(button);
    Receiver receiver;
    QVERIFY(QObject::connect(&button, "2ButtonPressed(uint64, bool)", &receiver, "1OnButtonPressed(uint64, bool)"));
    QTest::mouseClick(&button, Qt::LeftButton, Qt::AltModifier, QPoint(50, 12));
    QCOMPARE(receiver.calls, 1);
    QCOMPARE(receiver.modifiers, uint64(Qt::AltModifier));
}

void CustomButtonTest::wrapGrowsHeight()
{
    CustomButton button;
    button.SetLabel(QStringLiteral("Bake the whole sequence to disk before playback starts"));
    const int oneLine = button.sizeHint().height();
    QVERIFY(!button.hasHeightForWidth());
    button.AllowWrap(true);
    QVERIFY(button.hasHeightForWidth());
    QVERIFY(button.sizePolicy().hasHeightForWidth());
    QVERIFY(button.heightForWidth(90) > oneLine);
    QVERIFY(button.heightForWidth(90) > button.heightForWidth(200));
    QCOMPARE(button.heightForWidth(5000), oneLine);
}

void CustomButtonTest::paintsCrisplyAtRatio_data()
{
    QTest::addColumn<qreal>("dpr");
    QTest::newRow("1x") << 1.0;
    QTest::newRow("2x") << 2.0;
}

void CustomButtonTest::paintsCrisplyAtRatio()
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

void CustomButtonTest::backgroundAndBaseColours()
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

QTEST_MAIN(CustomButtonTest)
#include "CustomButtonTest.moc"
