#pragma once

#include "orbane/Types.h"

#include <array>
#include <vector>

namespace Orbane {

struct FloatRGBAImage;

// Counts of an image's values per channel, in equal bins over 0..1. Values
// below 0 fall in the first bin, above 1 in the last (HDR values pile up at
// the top, where the user sees them), and NaN in the first. Luminance is
// the Rec. 709 weighting of red, green and blue.
class Histogram
{
public:
    enum Channel : int32
    {
        Red,
        Green,
        Blue,
        Alpha,
        Luma,
        ChannelCount
    };
    static constexpr int32 kDefaultBins = 256;
    // Images up to this many pixels are counted on the calling thread.
    static constexpr std::size_t kSmallImage = 256 * 256;

    explicit Histogram(int32 bins = kDefaultBins);

    // Counts `pixelCount` pixels of four floats each.
    static Histogram Count(const float *rgba, std::size_t pixelCount, int32 bins = kDefaultBins);
    // The same, shared out over `threads` threads (at least one).
    static Histogram CountParallel(const FloatRGBAImage &image, int32 threads, int32 bins = kDefaultBins);

    int32 Bins() const noexcept { return mBins; }
    uint64 Pixels() const noexcept { return mPixels; }
    bool IsEmpty() const noexcept { return mPixels == 0; }
    uint32 At(Channel channel, int32 bin) const { return mCounts[channel][std::size_t(bin)]; }
    const std::vector<uint32> &Counts(Channel channel) const { return mCounts[channel]; }
    uint32 Peak(Channel channel) const;
    // Bar heights 0..1 for drawing: each bin over the channel's peak, or,
    // on the log scale, log(1 + count) over log(1 + peak).
    std::vector<float> Heights(Channel channel, bool logScale) const;

    void Add(const Histogram &other);

private:
    int32 mBins;
    uint64 mPixels = 0;
    std::array<std::vector<uint32>, ChannelCount> mCounts;
};

} // namespace Orbane
