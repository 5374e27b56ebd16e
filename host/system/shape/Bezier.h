#pragma once

#include "orbane/OrbPointT.h"

namespace Orbane {

// Pure cubic Bezier arithmetic on four control points.
class Bezier
{
public:
    static OrbPoint Eval(const OrbPoint c[4], float64 t) noexcept;
    static OrbPoint Deriv(const OrbPoint c[4], float64 t) noexcept;
    // Splits at `t` into `left` and `right` (de Casteljau).
    static void Split(const OrbPoint c[4], float64 t, OrbPoint left[4], OrbPoint right[4]) noexcept;
};

} // namespace Orbane
