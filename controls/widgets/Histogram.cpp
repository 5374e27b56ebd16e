#include "widgets/Histogram.h"

#include "orbane/ViewedImage.h"

#include <algorithm>
#include <cmath>
#include <future>

namespace Orbane {

namespace {

// Rec. 709 luma coefficients (ITU-R BT.709-6, item 3.2).
constexpr float kLumaR = 0.2126f, kLumaG = 0.7152f, kLumaB = 0.0722f;

inline std::size_t BinOf(float v, float scale, float last)
{
    // max first: NaN compares false and leaves 0.
    return std::size_t(std::min(std::max(0.0f, v * scale), last));
}

} // namespace

Histogram::Histogram(int32 bins) : mBins(std::max(1, bins))
{
    for (auto &counts : mCounts)
        counts.assign(std::size_t(mBins), 0);
}

Histogram Histogram::Count(const float *rgba, std::size_t pixelCount, int32 bins)
{
    Histogram h(bins);
    const float scale = float(h.mBins), last = float(h.mBins - 1);
    uint32 *r = h.mCounts[Red].data(), *g = h.mCounts[Green].data(), *b = h.mCounts[Blue].data();
    uint32 *a = h.mCounts[Alpha].data(), *l = h.mCounts[Luma].data();
    for (std::size_t i = 0; i < pixelCount; ++i, rgba += 4) {
        ++r[BinOf(rgba[0], scale, last)];
        ++g[BinOf(rgba[1], scale, last)];
        ++b[BinOf(rgba[2], scale, last)];
        ++a[BinOf(rgba[3], scale, last)];
        ++l[BinOf(kLumaR * rgba[0] + kLumaG * rgba[1] + kLumaB * rgba[2], scale, last)];
    }
    h.mPixels = pixelCount;
    return h;
}

Histogram Histogram::CountParallel(const FloatRGBAImage &image, int32 threads, int32 bins)
{
    const std::size_t pixels = image.PixelCount();
    const std::size_t parts = std::size_t(std::max(1, threads));
    const std::size_t step = (pixels + parts - 1) / parts;
    std::vector<std::future<Histogram>> others;
    for (std::size_t start = step; start < pixels; start += step) {
        const std::size_t count = std::min(step, pixels - start);
        others.push_back(std::async(std::launch::async, [&image, start, count, bins] {
            return Count(image.rgba.data() + start * 4, count, bins);
        }));
    }
    Histogram total = Count(image.rgba.data(), std::min(step, pixels), bins);
    for (auto &other : others)
        total.Add(other.get());
    return total;
}

void Histogram::Add(const Histogram &other)
{
    if (other.mBins != mBins)
        return;
    for (int32 c = 0; c < ChannelCount; ++c)
        for (int32 i = 0; i < mBins; ++i)
            mCounts[c][std::size_t(i)] += other.mCounts[c][std::size_t(i)];
    mPixels += other.mPixels;
}

uint32 Histogram::Peak(Channel channel) const
{
    const auto &counts = mCounts[channel];
    return *std::max_element(counts.begin(), counts.end());
}

std::vector<float> Histogram::Heights(Channel channel, bool logScale) const
{
    std::vector<float> heights(std::size_t(mBins), 0.0f);
    const uint32 peak = Peak(channel);
    if (peak == 0)
        return heights;
    const float top = logScale ? std::log1p(float(peak)) : float(peak);
    for (int32 i = 0; i < mBins; ++i) {
        const float count = float(mCounts[channel][std::size_t(i)]);
        heights[std::size_t(i)] = (logScale ? std::log1p(count) : count) / top;
    }
    return heights;
}

} // namespace Orbane
