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
    void skinImages_data()
    {
        QTest::addColumn<QString>("name");
        // Whether the top outline crosses the image's middle column: then its
        // first device rows must be solid at every ratio.
        QTest::addColumn<bool>("solidTopEdge");
        for (const char *name : {"Slider.Knob.1", "Slider.Knob.2", "Slider.Track", "Slider.Reset", "Color.Knob.2.1",
                                 "Color.Knob.2.2", "Color.Knob.3.1", "Color.Knob.3.2", "Color.Knob.4.1",
                                 "Color.Knob.4.2", "Color.Knob.5.1", "Color.Knob.5.2"})
            QTest::newRow(name) << QStringLiteral("Controls.%1").arg(name) << (name != QLatin1String("Slider.Reset"));
    }

    // The same drawing at four times the pixels, not an empty image and not
    // a different one: the covered area scales with the pixel count.
    void skinImages()
    {
        QFETCH(QString, name);
        QFETCH(bool, solidTopEdge);
        const ResDIB *dib = ResDIB::Find(OrbID(name.toStdString()));
        QVERIFY(dib && !dib->Size().isEmpty());
        const QSize size = dib->Size();
        const QImage one = dib->Image(1.0), two = dib->Image(2.0);
        QCOMPARE(one.size(), size);
        QCOMPARE(two.size(), size * 2);
        QCOMPARE(two.devicePixelRatio(), 2.0);
        const int covered1 = OpaquePixels(one), covered2 = OpaquePixels(two);
        QVERIFY(covered1 > 0);
        QVERIFY2(std::abs(covered2 - 4 * covered1) <= 4 * (size.width() + size.height()),
                 qPrintable(QStringLiteral("%1 vs %2").arg(covered2).arg(covered1)));
        if (solidTopEdge) {
            QCOMPARE(qAlpha(two.pixel(two.width() / 2, 0)), 255);
            QCOMPARE(qAlpha(two.pixel(two.width() / 2, 1)), 255);
            QCOMPARE(qAlpha(one.pixel(one.width() / 2, 0)), 255);
        }
        QCOMPARE(dib->Pixmap(2.0).size(), size * 2);
        QCOMPARE(dib->Pixmap(2.0).devicePixelRatio(), 2.0);
    }

    // One image per name and process; the held knob must look held: a
    // different image of the same size. A missing one is a warned-of null.
    void sharedPerProcessAndMissingIsNull()
    {
        const ResDIB *a = ResDIB::Find("Controls.Slider.Knob.1");
        QCOMPARE(a, ResDIB::Find(OrbID(std::string("Controls.Slider.Knob.1"))));
        const QImage held = ResDIB::Get("Controls.Slider.Knob.2").Image(2.0);
        QCOMPARE(held.size(), a->Image(2.0).size());
        QVERIFY(held != a->Image(2.0));

        QTest::ignoreMessage(QtWarningMsg, QRegularExpression("Controls.Slider.Nothing"));
        QVERIFY(!ResDIB::Find("Controls.Slider.Nothing"));
        QVERIFY(ResDIB::Get("Controls.Slider.Nothing").IsNull());
        QVERIFY(ResDIB::Get("Controls.Slider.Nothing").Image(2.0).isNull());
    }
};

QTEST_MAIN(ResDIBTest)
#include "ResDIBTest.moc"
