#include "orbane/ElideLabel.h"

#include <QtTest>

using namespace Orbane;

namespace {

const QChar kEllipsis(0x2026);
const QString kText = QStringLiteral("Foreground Matte Threshold Softness");

} // namespace

class ElideLabelTest : public QObject
{
    Q_OBJECT
private slots:
    void elides_data();
    void elides();
    void paintsTheElidedText_data();
    void paintsTheElidedText();
    void asksOnlyForAnEllipsis();
};

void ElideLabelTest::elides_data()
{
    QTest::addColumn<int>("mode");
    QTest::addColumn<int>("width");
    QTest::addColumn<QString>("expectStart"); // the shown text starts with this
    QTest::addColumn<QString>("expectEnd");   // and ends with this
    QTest::addColumn<bool>("elided");

    QTest::newRow("right") << 1 << 80 << "Fore" << QString(kEllipsis) << true;
    QTest::newRow("left") << 2 << 80 << QString(kEllipsis) << "ness" << true;
    QTest::newRow("middle") << 3 << 80 << "Fo"
                            << "ss" << true;
    QTest::newRow("none") << 0 << 80 << "Foreground"
                          << "Softness" << false;
    QTest::newRow("right, room enough") << 1 << 1000 << "Foreground"
                                        << "Softness" << false;
    QTest::newRow("middle, room enough") << 3 << 1000 << "Foreground"
                                         << "Softness" << false;
}

void ElideLabelTest::elides()
{
    QFETCH(int, mode);
    QFETCH(int, width);
    QFETCH(QString, expectStart);
    QFETCH(QString, expectEnd);
    QFETCH(bool, elided);

    ElideLabel label(kText);
    label.setElideMode(mode);
    label.resize(width, 20);
    const QString shown = label.displayedText();
    QVERIFY2(shown.startsWith(expectStart), qPrintable(shown));
    QVERIFY2(shown.endsWith(expectEnd), qPrintable(shown));
    QCOMPARE(label.isElided(), elided);
    QCOMPARE(label.text(), kText);
    if (elided) {
        QVERIFY(shown.contains(kEllipsis));
        QVERIFY(label.fontMetrics().horizontalAdvance(shown) <= width);
    }
}

void ElideLabelTest::paintsTheElidedText_data()
{
    QTest::addColumn<int>("mode");
    QTest::newRow("right") << 1;
    QTest::newRow("left") << 2;
    QTest::newRow("middle") << 3;
}

void ElideLabelTest::paintsTheElidedText()
{
    // What is painted is exactly a plain label showing the shortened text.
    QFETCH(int, mode);
    ElideLabel label(kText);
    label.setElideMode(mode);
    label.resize(90, 20);
    QLabel reference(label.displayedText());
    reference.resize(90, 20);
    const QImage painted = label.grab().toImage();
    QCOMPARE(painted, reference.grab().toImage());

    QLabel unelided(kText);
    unelided.resize(90, 20);
    QVERIFY(painted != unelided.grab().toImage());
}

void ElideLabelTest::asksOnlyForAnEllipsis()
{
    ElideLabel label(kText);
    const int full = label.fontMetrics().horizontalAdvance(kText);
    QVERIFY(label.minimumSizeHint().width() >= full);
    label.setElideMode(1);
    QVERIFY(label.minimumSizeHint().width() < full / 4);
    QCOMPARE(label.sizeHint().width(), QLabel(kText).sizeHint().width());
}

QTEST_MAIN(ElideLabelTest)
#include "ElideLabelTest.moc"
