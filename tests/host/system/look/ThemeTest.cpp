#include "orbane/Theme.h"
#include "orbane/CustomButton.h"

#include <QApplication>
#include <QStyle>
#include <QtTest>

using namespace Orbane;

class ThemeTest : public QObject
{
    Q_OBJECT
private slots:
    void appliesDarkPalette_data();
    void appliesDarkPalette();
    void reachesWidgets();
};

void ThemeTest::appliesDarkPalette_data()
{
    QTest::addColumn<int>("role");
    QTest::addColumn<bool>("dark");
    QTest::newRow("window") << int(QPalette::Window) << true;
    QTest::newRow("base") << int(QPalette::Base) << true;
    QTest::newRow("button") << int(QPalette::Button) << true;
    QTest::newRow("text") << int(QPalette::Text) << false;
    QTest::newRow("window text") << int(QPalette::WindowText) << false;
    QTest::newRow("button text") << int(QPalette::ButtonText) << false;
}

void ThemeTest::appliesDarkPalette()
{
    QFETCH(int, role);
    QFETCH(bool, dark);
    Theme::Apply(*qApp);
    QVERIFY(Theme::IsApplied());
    const QColor c = QApplication::palette().color(QPalette::Active, QPalette::ColorRole(role));
    if (dark)
        QVERIFY2(c.lightness() < 80, qPrintable(c.name()));
    else
        QVERIFY2(c.lightness() > 170, qPrintable(c.name()));
    QCOMPARE(QApplication::style()->objectName().toLower(), QStringLiteral("fusion"));
    QCOMPARE(QApplication::palette().color(QPalette::Highlight), Theme::Accent());
}

void ThemeTest::reachesWidgets()
{
    Theme::Apply(*qApp);
    CustomButton button;
    button.resize(80, 22);
    const QImage image = button.grab().toImage();
    // The face is painted in the theme's dark button colour.
    const QColor centre = image.pixelColor(4, image.height() / 2);
    QVERIFY2(centre.lightness() < 90, qPrintable(centre.name()));
    QCOMPARE(button.font().pointSizeF(), Theme::ControlFont().pointSizeF());
}

QTEST_MAIN(ThemeTest)
#include "ThemeTest.moc"
