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
    void elides_data()
    {
        QTest::addColumn<int>("mode");
        QTest::addColumn<int>("width");
        QTest::addColumn<QStringList>("ends"); // the shown text starts and ends so
        QTest::addColumn<bool>("elided");
        QTest::newRow("right") << 1 << 80 << QStringList{"Fore", kEllipsis} << true;
        QTest::newRow("left") << 2 << 80 << QStringList{kEllipsis, "ness"} << true;
        QTest::newRow("middle") << 3 << 80 << QStringList{"Fo", "ss"} << true;
        QTest::newRow("none") << 0 << 80 << QStringList{"Foreground", "Softness"} << false;
        QTest::newRow("middle, room enough") << 3 << 1000 << QStringList{"Foreground", "Softness"} << false;
    }

    void elides()
    {
        QFETCH(int, mode);
        QFETCH(int, width);
        QFETCH(QStringList, ends);
        QFETCH(bool, elided);
        ElideLabel label(kText);
        label.setElideMode(mode);
        label.resize(width, 20);
        const QString shown = label.displayedText();
        QVERIFY2(shown.startsWith(ends[0]) && shown.endsWith(ends[1]), qPrintable(shown));
        QCOMPARE(label.isElided(), elided);
        QCOMPARE(label.text(), kText);
        if (!elided)
            return;
        QVERIFY(shown.contains(kEllipsis));
        QVERIFY(label.fontMetrics().horizontalAdvance(shown) <= width);
        // What is painted is exactly a plain label showing the shortened text.
        QLabel reference(shown), unelided(kText);
        reference.resize(width, 20);
        unelided.resize(width, 20);
        const QImage painted = label.grab().toImage();
        QCOMPARE(painted, reference.grab().toImage());
        QVERIFY(painted != unelided.grab().toImage());
    }

    void asksOnlyForAnEllipsis()
    {
        ElideLabel label(kText);
        const int full = label.fontMetrics().horizontalAdvance(kText);
        QVERIFY(label.minimumSizeHint().width() >= full);
        label.setElideMode(1);
        QVERIFY(label.minimumSizeHint().width() < full / 4);
        QCOMPARE(label.sizeHint().width(), QLabel(kText).sizeHint().width());
    }
};

QTEST_MAIN(ElideLabelTest)
#include "ElideLabelTest.moc"
