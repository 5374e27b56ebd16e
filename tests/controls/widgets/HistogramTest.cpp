#include "widgets/HistogramFeed.h"

#include "orbane/OrbaneDoc.h"
#include "orbane/ViewedImage.h"
#include "orbane/ViewerPanel.h"

#include <QtTest>

#include <random>

Q_DECLARE_METATYPE(Orbane::FloatImage)

using namespace Orbane;

namespace {

// A horizontal ramp of linear values, each pixel in the middle of its bin
// when there are as many bins as columns; alpha 1.
FloatImage Ramp(int width, int height)
{
    std::vector<float> rgba;
    for (int y = 0; y < height; ++y)
        for (int x = 0; x < width; ++x) {
            const float v = (x + 0.5f) / float(width);
            rgba.insert(rgba.end(), {v, v, v, 1.0f});
        }
    return FloatImage(width, height, 4, std::move(rgba));
}

FloatImage Pixels(int width, int channels, std::vector<float> values)
{
    return FloatImage(width, 1, channels, std::move(values));
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
    void viewerFeedsWhatThePickerSamples();
};

void HistogramTest::counts_data()
{
    QTest::addColumn<FloatImage>("image");
    QTest::addColumn<int>("bins");
    QTest::addColumn<int>("channel");
    QTest::addColumn<int>("bin");
    QTest::addColumn<int>("count");
    const FloatImage red = Pixels(1, 4, {1, 0, 0, 0.5f});
    QTest::newRow("empty image") << FloatImage() << 256 << int(Histogram::Red) << 0 << 0;
    QTest::newRow("red in the top red bin") << red << 256 << int(Histogram::Red) << 255 << 1;
    QTest::newRow("red: green at the bottom") << red << 256 << int(Histogram::Green) << 0 << 1;
    QTest::newRow("red: half alpha") << red << 256 << int(Histogram::Alpha) << 128 << 1;
    // Luma of pure red: 0.2126 * 256 bins = 54.4 -> bin 54.
    QTest::newRow("red: luma") << red << 256 << int(Histogram::Luma) << 54 << 1;
    QTest::newRow("256 ramp: one pixel a bin") << Ramp(256, 3) << 256 << int(Histogram::Blue) << 77 << 3;
    QTest::newRow("256 ramp in 4 bins") << Ramp(256, 1) << 4 << int(Histogram::Green) << 2 << 64;
    QTest::newRow("grey counts as blue") << Pixels(2, 1, {0.5f, 0.25f}) << 4 << int(Histogram::Blue) << 2 << 1;
    QTest::newRow("grey: no alpha is 1") << Pixels(2, 1, {0.5f, 0.25f}) << 4 << int(Histogram::Alpha) << 3 << 2;
    QTest::newRow("grey and alpha") << Pixels(2, 2, {0.5f, 0.25f, 0.5f, 0.75f}) << 4 << int(Histogram::Alpha) << 1 << 1;
    QTest::newRow("RGB: green") << Pixels(1, 3, {0, 0.5f, 1}) << 4 << int(Histogram::Green) << 2 << 1;
}

void HistogramTest::counts()
{
    QFETCH(FloatImage, image);
    QFETCH(int, bins);
    QFETCH(int, channel);
    QFETCH(int, bin);
    QFETCH(int, count);
    const Histogram h = Histogram::Count(image, bins);
    QCOMPARE(h.Pixels(), uint64(image.Width()) * uint64(image.Height()));
    QCOMPARE(int(h.At(Histogram::Channel(channel), bin)), count);
}

// HDR and negative values pile up at the ends, NaN at the bottom.
void HistogramTest::outOfRangeValues()
{
    const Histogram h = Histogram::Count(Pixels(1, 4, {4.0f, -1.0f, std::numeric_limits<float>::quiet_NaN(), 1.0f}), 8);
    QCOMPARE(h.At(Histogram::Red, 7), 1u);
    QCOMPARE(h.At(Histogram::Green, 0), 1u);
    QCOMPARE(h.At(Histogram::Blue, 0), 1u);
    QCOMPARE(h.At(Histogram::Alpha, 7), 1u);
    QCOMPARE(h.Heights(Histogram::Red, false)[7], 1.0f);
}

// Rows shared out over threads, in bands that do not divide the height,
// count what one pass counts.
void HistogramTest::parallelMatchesPlain()
{
    std::mt19937 random(3);
    std::uniform_real_distribution<float> value(-0.2f, 1.2f);
    for (int channels = 1; channels <= 4; ++channels) {
        std::vector<float> pixels(std::size_t(301) * 7 * std::size_t(channels));
        for (float &v : pixels)
            v = value(random);
        const FloatImage image(301, 7, channels, std::move(pixels));
        const Histogram plain = Histogram::Count(image);
        const Histogram shared = Histogram::CountParallel(image, 3);
        QCOMPARE(shared.Pixels(), plain.Pixels());
        for (int c = 0; c < Histogram::ChannelCount; ++c)
            QCOMPARE(shared.Counts(Histogram::Channel(c)), plain.Counts(Histogram::Channel(c)));
    }
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
    QCOMPARE(feed.Current()->At(Histogram::Red, 255), 512u); // the last two columns of each row
    ViewedImage::Instance().Set(Ramp(4, 4));
    QCOMPARE(updated.count(), 2); // a small one is counted at once
    QCOMPARE(feed.Current()->Pixels(), uint64(16));
}

// An 8-bit picture in the viewer: the histogram counts the linear values
// the picker samples, from the very same pixels.
void HistogramTest::viewerFeedsWhatThePickerSamples()
{
    HistogramFeed &feed = HistogramFeed::Instance();
    QSignalSpy updated(&feed, &HistogramFeed::Updated);
    OrbaneDoc doc;
    ViewerPanel viewer(&doc);
    QImage grey(2, 2, QImage::Format_RGB32);
    grey.fill(QColor(0x80, 0x80, 0x80));
    viewer.SetImage(grey);
    QCOMPARE(ViewedImage::Instance().Image().Pixels(), viewer.LinearImage().Pixels());
    std::array<float64, 4> picked{};
    QVERIFY(viewer.SampleLinear(QRect(0, 0, 2, 2), picked));
    QVERIFY(qAbs(picked[0] - 0.2158605) < 1e-6);
    QCOMPARE(picked[3], 1.0);
    QCOMPARE(updated.count(), 1);
    // 0.2158605 * 256 bins = 55.3: the code value 0x80 would lie in bin 128.
    QCOMPARE(feed.Current()->At(Histogram::Red, 55), 4u);
    viewer.SetImage(QImage());
    QCOMPARE(feed.Current()->Pixels(), uint64(0));
}

QTEST_MAIN(HistogramTest)
#include "HistogramTest.moc"
