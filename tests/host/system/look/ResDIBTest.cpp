#include "orbane/ResDIB.h"

#include <QtTest>

using namespace Orbane;

namespace {

int OpaquePixels(const QImage &image)
{
    int count = 0;
    for (int y = 0; y < image.height(); ++y)
        for (int x = 0; x < image.width(); ++x)
            count += qAlpha(image.pixel(x, y)) > 0;
    return count;
}

} // namespace

class ResDIBTest : public QObject
{
    Q_OBJECT
private slots:
    void skinImages_data();
    void skinImages();
    void sharedPerProcess();
    void missingImage();
};

void ResDIBTest::skinImages_data()
{
    QTest::addColumn<QString>("name");
    // Whether the top outline crosses the image's middle column: then its
    // first device rows must be solid at every ratio.
    QTest::addColumn<bool>("solidTopEdge");

    QTest::newRow("knob") << "Controls.Slider.Knob.1" << true;
    QTest::newRow("held knob") << "Controls.Slider.Knob.2" << true;
    QTest::newRow("track") << "Controls.Slider.Track" << true;
    QTest::newRow("reset marker") << "Controls.Slider.Reset" << false;
    for (int knob = 2; knob <= 5; ++knob)
        for (int state = 1; state <= 2; ++state) {
            const QString name = QStringLiteral("Controls.Color.Knob.%1.%2").arg(knob).arg(state);
            QTest::newRow(qPrintable(name)) << name << true;
        }
}

void ResDIBTest::skinImages()
{
    QFETCH(QString, name);
    QFETCH(bool, solidTopEdge);

    const ResDIB *dib = ResDIB::Find(OrbID(name.toStdString()));
    QVERIFY(dib);
    const QSize size = dib->Size();
    QVERIFY(!size.isEmpty());

    const QImage one = dib->Image(1.0);
    const QImage two = dib->Image(2.0);
    QCOMPARE(one.size(), size);
    QCOMPARE(two.size(), size * 2);
    QCOMPARE(two.devicePixelRatio(), 2.0);

    // The same drawing at four times the pixels, not an empty image and not
    // a different one: the covered area scales with the pixel count.
    const int covered1 = OpaquePixels(one);
    const int covered2 = OpaquePixels(two);
    QVERIFY(covered1 > 0);
    QVERIFY2(std::abs(covered2 - 4 * covered1) <= 4 * (size.width() + size.height()),
             qPrintable(QStringLiteral("%1 vs %2").arg(covered2).arg(covered1)));

    if (solidTopEdge) {
        const int mid = two.width() / 2;
        QCOMPARE(qAlpha(two.pixel(mid, 0)), 255);
        QCOMPARE(qAlpha(two.pixel(mid, 1)), 255);
        QCOMPARE(qAlpha(one.pixel(one.width() / 2, 0)), 255);
    }

    const QPixmap pixmap = dib->Pixmap(2.0);
    QCOMPARE(pixmap.size(), size * 2);
    QCOMPARE(pixmap.devicePixelRatio(), 2.0);
}

void ResDIBTest::sharedPerProcess()
{
    const ResDIB *a = ResDIB::Find("Controls.Slider.Knob.1");
    const ResDIB *b = ResDIB::Find(OrbID(std::string("Controls.Slider.Knob.1")));
    QVERIFY(a);
    QCOMPARE(a, b);
    // The held knob must look held: a different image of the same size.
    const QImage held = ResDIB::Get("Controls.Slider.Knob.2").Image(2.0);
    QCOMPARE(held.size(), a->Image(2.0).size());
    QVERIFY(held != a->Image(2.0));
}

void ResDIBTest::missingImage()
{
    QTest::ignoreMessage(QtWarningMsg, QRegularExpression("Controls.Slider.Nothing"));
    QVERIFY(!ResDIB::Find("Controls.Slider.Nothing"));
    const ResDIB &empty = ResDIB::Get("Controls.Slider.Nothing");
    QVERIFY(empty.IsNull());
    QVERIFY(empty.Image(2.0).isNull());
}

QTEST_MAIN(ResDIBTest)
#include "ResDIBTest.moc"
