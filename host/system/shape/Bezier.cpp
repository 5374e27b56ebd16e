#include "Bezier.h"

namespace Orbane {

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

} // namespace Orbane
