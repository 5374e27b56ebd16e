#pragma once

#include "orbane/Types.h"

#include <array>
#include <vector>

namespace Orbane {

class FloatImage;

// Counts of an image's values per channel, in equal bins over 0..1. Values
// below 0 fall in the first bin, above 1 in the last (HDR values pile up at
// the top, where the user sees them), and NaN in the first. Luminance is
// the Rec. 709 weighting of red, green and blue. The values counted are the
// image's as stored: linear light, premultiplied; a grey image counts its
// grey as red, green and blue, one without alpha counts alpha 1.
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

    // Counts every pixel of `image` (none of a null one).
    static Histogram Count(const FloatImage &image, int32 bins = kDefaultBins);
    // The same, its rows shared out over `threads` threads (at least one).
    static Histogram CountParallel(const FloatImage &image, int32 threads, int32 bins = kDefaultBins);

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
    // Counts the rows first .. first + rows - 1.
    static Histogram CountBand(const FloatImage &image, int32 first, int32 rows, int32 bins);

    int32 mBins;
    uint64 mPixels = 0;
    std::array<std::vector<uint32>, ChannelCount> mCounts;
};

} // namespace Orbane
