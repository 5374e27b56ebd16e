#include "Bezier.h"

#include <cmath>

namespace Orbane {

namespace {

// Ten-point Gauss-Legendre nodes and weights on [-1, 1] (positive half).
constexpr float64 kNodes[5] = {0.1488743389816312, 0.4333953941292472, 0.6794095682990244, 0.8650633666889845,
                               0.9739065285171717};
constexpr float64 kWeights[5] = {0.2955242247147529, 0.2692667193099963, 0.2190863625159820, 0.1494513491505806,
                                 0.0666713443086881};
// Relative agreement at which a span's length is taken as found; far below
// anything a viewer shows or a test of 1e-4 checks.
constexpr float64 kLengthTolerance = 1e-10;
constexpr int kMaxDepth = 16;

float64 Gauss(const OrbPoint c[4], float64 a, float64 b)
{
    const float64 mid = 0.5 * (a + b), half = 0.5 * (b - a);
    float64 sum = 0.0;
    for (int i = 0; i < 5; ++i)
        sum += kWeights[i] *
               (Bezier::Deriv(c, mid - half * kNodes[i]).Length() + Bezier::Deriv(c, mid + half * kNodes[i]).Length());
    return sum * half;
}

float64 Adaptive(const OrbPoint c[4], float64 a, float64 b, float64 whole, int depth)
{
    const float64 mid = 0.5 * (a + b);
    const float64 left = Gauss(c, a, mid), right = Gauss(c, mid, b);
    if (depth >= kMaxDepth || std::abs(left + right - whole) <= kLengthTolerance * std::max(1e-12, whole))
        return left + right;
    return Adaptive(c, a, mid, left, depth + 1) + Adaptive(c, mid, b, right, depth + 1);
}

} // namespace

OrbPoint Bezier::Eval(const OrbPoint c[4], float64 t) noexcept
{
    const float64 u = 1.0 - t;
    return c[0] * (u * u * u) + c[1] * (3.0 * u * u * t) + c[2] * (3.0 * u * t * t) + c[3] * (t * t * t);
}

OrbPoint Bezier::Deriv(const OrbPoint c[4], float64 t) noexcept
{
    const float64 u = 1.0 - t;
    return (c[1] - c[0]) * (3.0 * u * u) + (c[2] - c[1]) * (6.0 * u * t) + (c[3] - c[2]) * (3.0 * t * t);
}

void Bezier::Split(const OrbPoint c[4], float64 t, OrbPoint left[4], OrbPoint right[4]) noexcept
{
    const OrbPoint ab = c[0] + (c[1] - c[0]) * t, bc = c[1] + (c[2] - c[1]) * t, cd = c[2] + (c[3] - c[2]) * t;
    const OrbPoint abc = ab + (bc - ab) * t, bcd = bc + (cd - bc) * t;
    const OrbPoint mid = abc + (bcd - abc) * t;
    left[0] = c[0], left[1] = ab, left[2] = abc, left[3] = mid;
    right[0] = mid, right[1] = bcd, right[2] = cd, right[3] = c[3];
}

float64 Bezier::Length(const OrbPoint c[4], float64 t) noexcept
{
    if (t <= 0.0)
        return 0.0;
    return Adaptive(c, 0.0, t, Gauss(c, 0.0, t), 0);
}

} // namespace Orbane
