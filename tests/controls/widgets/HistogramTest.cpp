#include "widgets/HistogramFeed.h"

#include "orbane/ViewedImage.h"

#include <QtTest>

using namespace Orbane;

namespace {

// A horizontal grey ramp, `width` pixels of values 0 .. 255 spread evenly.
QImage Ramp(int width, int height)
{
    QImage image(width, height, QImage::Format_RGBA8888);
    for (int y = 0; y < height; ++y)
        for (int x = 0; x < width; ++x) {
            const int v = width > 1 ? x * 255 / (width - 1) : 0;
            image.setPixel(x, y, qRgba(v, v, v, 255));
        }
    return image;
}

Histogram CountOf(const QImage &image, int bins = Histogram::kDefaultBins)
{
    const FloatRGBAImage pixels = ViewedImage::ToFloatRGBA(image);
    return Histogram::Count(pixels.rgba.data(), pixels.PixelCount(), bins);
}

} // namespace

class HistogramTest : public QObject
{
    Q_OBJECT
private slots:
    void counts_data();
    void counts();
    void outOfRangeValues();
    void parallelMatchesPlain();
    void feedCountsLargeImagesOffThread();
};

void HistogramTest::counts_data()
{
    QTest::addColumn<QImage>("image");
    QTest::addColumn<int>("bins");
    QTest::addColumn<int>("channel");
    QTest::addColumn<int>("bin");
    QTest::addColumn<int>("count");
    QTest::addColumn<int>("pixels");
    QImage red(1, 1, QImage::Format_RGBA8888);
    red.fill(QColor(255, 0, 0, 128));
    QTest::newRow("empty image") << QImage() << 256 << int(Histogram::Red) << 0 << 0 << 0;
    QTest::newRow("1x1 red in the top red bin") << red << 256 << int(Histogram::Red) << 255 << 1 << 1;
    QTest::newRow("1x1 red: green at the bottom") << red << 256 << int(Histogram::Green) << 0 << 1 << 1;
    QTest::newRow("1x1 red: half alpha") << red << 256 << int(Histogram::Alpha) << 128 << 1 << 1;
    // Luma of pure red: 0.2126 * 256 bins = 54.4 -> bin 54.
    QTest::newRow("1x1 red: luma") << red << 256 << int(Histogram::Luma) << 54 << 1 << 1;
    QTest::newRow("256 ramp: one pixel a bin") << Ramp(256, 3) << 256 << int(Histogram::Blue) << 77 << 3 << 768;
    QTest::newRow("256 ramp in 4 bins") << Ramp(256, 1) << 4 << int(Histogram::Green) << 2 << 64 << 256;
}

void HistogramTest::counts()
{
    QFETCH(QImage, image);
    QFETCH(int, bins);
    QFETCH(int, channel);
    QFETCH(int, bin);
    QFETCH(int, count);
    QFETCH(int, pixels);
    const Histogram h = CountOf(image, bins);
    QCOMPARE(int(h.Pixels()), pixels);
    QCOMPARE(int(h.At(Histogram::Channel(channel), bin)), count);
}

// HDR and negative values pile up at the ends, NaN at the bottom.
void HistogramTest::outOfRangeValues()
{
    const float rgba[] = {4.0f, -1.0f, std::numeric_limits<float>::quiet_NaN(), 1.0f};
    const Histogram h = Histogram::Count(rgba, 1, 8);
    QCOMPARE(h.At(Histogram::Red, 7), 1u);
    QCOMPARE(h.At(Histogram::Green, 0), 1u);
    QCOMPARE(h.At(Histogram::Blue, 0), 1u);
    QCOMPARE(h.At(Histogram::Alpha, 7), 1u);
    QCOMPARE(h.Heights(Histogram::Red, false)[7], 1.0f);
}

void HistogramTest::parallelMatchesPlain()
{
    const FloatRGBAImage pixels = ViewedImage::ToFloatRGBA(Ramp(301, 7));
    const Histogram plain = Histogram::Count(pixels.rgba.data(), pixels.PixelCount());
    const Histogram shared = Histogram::CountParallel(pixels, 3);
    QCOMPARE(shared.Pixels(), plain.Pixels());
    for (int c = 0; c < Histogram::ChannelCount; ++c)
        QCOMPARE(shared.Counts(Histogram::Channel(c)), plain.Counts(Histogram::Channel(c)));
}

// A large image is counted on a worker; the result arrives as a queued call.
void HistogramTest::feedCountsLargeImagesOffThread()
{
    HistogramFeed &feed = HistogramFeed::Instance();
    QSignalSpy updated(&feed, &HistogramFeed::Updated);
    ViewedImage::Instance().Set(Ramp(512, 256));
    QCOMPARE(updated.count(), 0); // not on the spot: the image is large
    QTRY_COMPARE(updated.count(), 1);
    QCOMPARE(feed.Current()->Pixels(), uint64(512 * 256));
    QCOMPARE(feed.Current()->At(Histogram::Red, 255), 256u); // the last column of each row
    ViewedImage::Instance().Set(Ramp(4, 4));
    QCOMPARE(updated.count(), 2); // a small one is counted at once
    QCOMPARE(feed.Current()->Pixels(), uint64(16));
}

QTEST_MAIN(HistogramTest)
#include "HistogramTest.moc"
