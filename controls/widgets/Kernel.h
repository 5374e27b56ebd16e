#pragma once

#include "orbane/Types.h"

#include <vector>

namespace Orbane {

// A square convolution kernel of odd size (3, 5 or 7), row by row. Pure,
// so that the filter control, its tests and scripts agree on presets and
// normalising.
class Kernel
{
public:
    static constexpr int32 kSizes[] = {3, 5, 7};

    explicit Kernel(int32 size = 3);
    // The cells of `rows` (ragged rows padded with 0, NaN and infinities
    // taken as 0) in the smallest allowed size that holds them, 7 at most.
    static Kernel FromRows(const std::vector<std::vector<float64>> &rows);

    static Kernel Identity(int32 size);
    // Binomial weights (a Gaussian's discrete form), summing to 1.
    static Kernel Blur(int32 size);
    // Twice the identity less the blur: sums to 1.
    static Kernel Sharpen(int32 size);
    // A Laplacian: every cell -1, the centre their count less one; sums to 0.
    static Kernel Edge(int32 size);

    // The allowed size nearest `size` from above (7 at most).
    static int32 FitSize(int32 size);

    int32 Size() const noexcept { return mSize; }
    float64 At(int32 row, int32 col) const { return mCells[std::size_t(row * mSize + col)]; }
    void Set(int32 row, int32 col, float64 v) { mCells[std::size_t(row * mSize + col)] = v; }
    const std::vector<float64> &Cells() const noexcept { return mCells; }
    float64 Sum() const;
    bool IsAllZero() const;
    // The same kernel in another size, centred: cropped or padded with 0.
    Kernel Resized(int32 size) const;

    enum class Normalised
    {
        Done,
        AllZero, // nothing to scale
        ZeroSum, // an edge kernel: dividing by its sum is undefined
    };
    // Scales the cells to sum to 1; refused (unchanged) where the sum is 0.
    Normalised Normalise();

    bool operator==(const Kernel &o) const { return mSize == o.mSize && mCells == o.mCells; }
    bool operator!=(const Kernel &o) const { return !(*this == o); }

private:
    int32 mSize;
    std::vector<float64> mCells;
};

} // namespace Orbane
