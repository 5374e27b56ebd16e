#include "widgets/Histogram.h"

#include "orbane/FloatImage.h"

#include <algorithm>
#include <cmath>
#include <future>

namespace Orbane {

namespace {

// Rec. 709 luma coefficients (ITU-R BT.709-6, item 3.2).
constexpr float kLumaR = 0.2126f, kLumaG = 0.7152f, kLumaB = 0.0722f;
// Pixels whose bins are found before they are counted: finding is plain
// arithmetic that the compiler turns into vector code, counting is not.
constexpr std::size_t kChunk = 512;

inline int32 BinOf(float v, float scale, float last)
{
    // max first: NaN compares false and leaves 0.
    return int32(std::min(std::max(0.0f, v * scale), last));
}

// Counts `pixels` pixels of C channels: grey spreads over red, green and
// blue, a missing alpha is 1.
template <int C>
void CountPixels(const float *p, std::size_t pixels, float scale, float last, uint32 *const (&counts)[5])
{
    int32 bins[5][kChunk];
    while (pixels > 0) {
        const std::size_t n = std::min(pixels, kChunk);
        for (std::size_t i = 0; i < n; ++i) {
            const float *q = p + i * C;
            const float r = q[0], g = q[C >= 3 ? 1 : 0], b = q[C >= 3 ? 2 : 0];
            const float a = C == 2 ? q[1] : C == 4 ? q[3] : 1.0f;
            bins[0][i] = BinOf(r, scale, last);
            bins[1][i] = BinOf(g, scale, last);
            bins[2][i] = BinOf(b, scale, last);
            bins[3][i] = BinOf(a, scale, last);
            bins[4][i] = BinOf(kLumaR * r + kLumaG * g + kLumaB * b, scale, last);
        }
        for (int c = 0; c < 5; ++c)
            for (std::size_t i = 0; i < n; ++i)
                ++counts[c][bins[c][i]];
        p += n * C;
        pixels -= n;
    }
}

// Counts the rows first .. first + rows - 1 of `image` in `bins` bins.
void CountRows(const FloatImage &image, int32 first, int32 rows, int32 bins, uint32 *const (&counts)[5])
{
    const std::size_t rowValues = std::size_t(image.Width()) * std::size_t(image.Channels());
    const float *p = image.Pixels() + std::size_t(first) * rowValues;
    const std::size_t pixels = std::size_t(image.Width()) * std::size_t(rows);
    const float scale = float(bins), last = float(bins - 1);
    switch (image.Channels()) {
    case 1:
        return CountPixels<1>(p, pixels, scale, last, counts);
    case 2:
        return CountPixels<2>(p, pixels, scale, last, counts);
    case 3:
        return CountPixels<3>(p, pixels, scale, last, counts);
    default:
        return CountPixels<4>(p, pixels, scale, last, counts);
    }
}

} // namespace

Histogram::Histogram(int32 bins) : mBins(std::max(1, bins))
{
    for (auto &counts : mCounts)
        counts.assign(std::size_t(mBins), 0);
}

Histogram Histogram::CountBand(const FloatImage &image, int32 first, int32 rows, int32 bins)
{
    Histogram h(bins);
    if (image.IsNull() || rows <= 0)
        return h;
    uint32 *const counts[5] = {h.mCounts[Red].data(), h.mCounts[Green].data(), h.mCounts[Blue].data(),
                               h.mCounts[Alpha].data(), h.mCounts[Luma].data()};
    CountRows(image, first, rows, h.mBins, counts);
    h.mPixels = uint64(image.Width()) * uint64(rows);
    return h;
}

Histogram Histogram::Count(const FloatImage &image, int32 bins)
{
    return CountBand(image, 0, image.Height(), bins);
}

Histogram Histogram::CountParallel(const FloatImage &image, int32 threads, int32 bins)
{
    const int32 height = image.Height();
    const int32 parts = std::clamp(threads, 1, std::max(1, height));
    const int32 step = (height + parts - 1) / std::max(1, parts);
    std::vector<std::future<Histogram>> others;
    for (int32 first = step; first < height; first += step)
        others.push_back(std::async(std::launch::async, [&image, first, step, height, bins] {
            return CountBand(image, first, std::min(step, height - first), bins);
        }));
    Histogram total = CountBand(image, 0, std::min(step, height), bins);
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
