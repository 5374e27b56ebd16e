#include "CurveMeasure.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

// Ten-point Gauss-Legendre nodes and weights on [-1, 1] (positive half).
constexpr float64 kNodes[5] = {0.1488743389816312, 0.4333953941292472, 0.6794095682990244, 0.8650633666889845,
                               0.9739065285171717};
constexpr float64 kWeights[5] = {0.2955242247147529, 0.2692667193099963, 0.2190863625159820, 0.1494513491505806,
                                 0.0666713443086881};
// Relative agreement at which a span's length is taken as found: far below
// what a viewer shows; the depth cap bounds the work on a cusp.
constexpr float64 kTolerance = 1e-10;
constexpr int kMaxDepth = 12;

float64 Gauss(const CurveMeasure::Derivative &d, float64 a, float64 b)
{
    const float64 mid = 0.5 * (a + b), half = 0.5 * (b - a);
    float64 sum = 0.0;
    for (int i = 0; i < 5; ++i)
        sum += kWeights[i] * (d(mid - half * kNodes[i]).Length() + d(mid + half * kNodes[i]).Length());
    return sum * half;
}

float64 Adaptive(const CurveMeasure::Derivative &d, float64 a, float64 b, float64 whole, int depth)
{
    const float64 mid = 0.5 * (a + b);
    const float64 left = Gauss(d, a, mid), right = Gauss(d, mid, b);
    if (depth >= kMaxDepth || std::abs(left + right - whole) <= kTolerance * std::max(1e-12, whole))
        return left + right;
    return Adaptive(d, a, mid, left, depth + 1) + Adaptive(d, mid, b, right, depth + 1);
}

} // namespace

float64 CurveMeasure::Length(const Derivative &d, float64 from, float64 to)
{
    if (!(to > from))
        return 0.0;
    return Adaptive(d, from, to, Gauss(d, from, to), 0);
}

} // namespace Orbane
