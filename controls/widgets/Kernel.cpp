#include "widgets/Kernel.h"

#include <algorithm>
#include <cmath>
#include <numeric>

namespace Orbane {

namespace {

// A sum this close to 0 is 0: a kernel typed as 0.1 + 0.2 - 0.3 sums to
// 5.6e-17, which would scale every cell by 10^16.
constexpr float64 kZeroSum = 1e-12;

std::vector<float64> BinomialRow(int32 size)
{
    std::vector<float64> row(std::size_t(size), 0.0);
    row[0] = 1.0;
    for (int32 n = 1; n < size; ++n)
        for (int32 k = n; k > 0; --k)
            row[std::size_t(k)] += row[std::size_t(k - 1)];
    return row;
}

} // namespace

constexpr int32 Kernel::kSizes[];

Kernel::Kernel(int32 size) : mSize(FitSize(size)), mCells(std::size_t(mSize * mSize), 0.0) {}

int32 Kernel::FitSize(int32 size)
{
    for (int32 s : kSizes)
        if (size <= s)
            return s;
    return kSizes[2];
}

Kernel Kernel::FromRows(const std::vector<std::vector<float64>> &rows)
{
    std::size_t widest = rows.size();
    for (const auto &row : rows)
        widest = std::max(widest, row.size());
    Kernel k(int32(std::min<std::size_t>(widest, 7)));
    for (int32 r = 0; r < std::min(k.mSize, int32(rows.size())); ++r)
        for (int32 c = 0; c < std::min(k.mSize, int32(rows[std::size_t(r)].size())); ++c) {
            const float64 v = rows[std::size_t(r)][std::size_t(c)];
            k.Set(r, c, std::isfinite(v) ? v : 0.0);
        }
    return k;
}

Kernel Kernel::Identity(int32 size)
{
    Kernel k(size);
    k.Set(k.mSize / 2, k.mSize / 2, 1.0);
    return k;
}

Kernel Kernel::Blur(int32 size)
{
    Kernel k(size);
    const std::vector<float64> row = BinomialRow(k.mSize);
    const float64 total = std::pow(2.0, 2 * (k.mSize - 1));
    for (int32 r = 0; r < k.mSize; ++r)
        for (int32 c = 0; c < k.mSize; ++c)
            k.Set(r, c, row[std::size_t(r)] * row[std::size_t(c)] / total);
    return k;
}

Kernel Kernel::Sharpen(int32 size)
{
    Kernel k = Blur(size);
    for (float64 &v : k.mCells)
        v = -v;
    const int32 mid = k.mSize / 2;
    k.Set(mid, mid, k.At(mid, mid) + 2.0);
    return k;
}

Kernel Kernel::Edge(int32 size)
{
    Kernel k(size);
    std::fill(k.mCells.begin(), k.mCells.end(), -1.0);
    const int32 mid = k.mSize / 2;
    k.Set(mid, mid, float64(k.mSize * k.mSize - 1));
    return k;
}

float64 Kernel::Sum() const
{
    return std::accumulate(mCells.begin(), mCells.end(), 0.0);
}

bool Kernel::IsAllZero() const
{
    return std::all_of(mCells.begin(), mCells.end(), [](float64 v) { return v == 0.0; });
}

Kernel Kernel::Resized(int32 size) const
{
    Kernel k(size);
    const int32 shift = (k.mSize - mSize) / 2;
    for (int32 r = 0; r < mSize; ++r)
        for (int32 c = 0; c < mSize; ++c) {
            const int32 rr = r + shift, cc = c + shift;
            if (rr >= 0 && rr < k.mSize && cc >= 0 && cc < k.mSize)
                k.Set(rr, cc, At(r, c));
        }
    return k;
}

Kernel::Normalised Kernel::Normalise()
{
    if (IsAllZero())
        return Normalised::AllZero;
    const float64 sum = Sum();
    if (std::abs(sum) < kZeroSum)
        return Normalised::ZeroSum;
    for (float64 &v : mCells)
        v /= sum;
    return Normalised::Done;
}

} // namespace Orbane
