#include <QtTest>
class FontfileControlTest : public QObject
{
    Q_OBJECT
};
QTEST_MAIN(FontfileControlTest)
#include "FontfileControlTest.moc"
