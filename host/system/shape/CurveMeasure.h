#pragma once

#include "orbane/OrbPointT.h"

#include <functional>

namespace Orbane {

// Arc length of a smooth curve piece from its derivative: ten-point
// Gauss-Legendre quadrature on halves until the halves agree with their
// whole. Accurate to far below a pixel for any cubic piece.
class CurveMeasure
{
public:
    using Derivative = std::function<OrbPoint(float64)>;
    static float64 Length(const Derivative &d, float64 from, float64 to);
};

} // namespace Orbane
