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
    void reachesWidgets()
    {
        Theme::Apply(*qApp);
        QVERIFY(Theme::IsApplied());
        QCOMPARE(QApplication::style()->objectName().toLower(), QStringLiteral("fusion"));
        QCOMPARE(QApplication::palette().color(QPalette::Highlight), Theme::Accent());
        QVERIFY(QApplication::palette().color(QPalette::Text).lightness() > 170);
        CustomButton button;
        button.resize(80, 22);
        const QImage image = button.grab().toImage();
        // The face is painted in the theme's dark button colour.
        const QColor centre = image.pixelColor(4, image.height() / 2);
        QVERIFY2(centre.lightness() < 90, qPrintable(centre.name()));
        QCOMPARE(button.font().pointSizeF(), Theme::ControlFont().pointSizeF());
    }
};

QTEST_MAIN(ThemeTest)
#include "ThemeTest.moc"
