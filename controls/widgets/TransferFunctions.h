#pragma once

#include "orbane/Types.h"

#include <QPointF>

#include <functional>
#include <vector>

namespace Orbane {

// The transfer curves the gamma and log controls draw: pure functions of
// their settings, so the controls, the tests and the benchmarks agree.
namespace TransferFunctions {

// out = in ^ (1 / gamma): a gamma above 1 lifts the midtones. Negative
// inputs keep their sign; a gamma of 0 or less is taken as 1.
float64 Gamma(float64 x, float64 gamma);
// The gamma that puts `y` over the input 0.5: log(0.5) / log(y).
float64 GammaThrough(float64 y);

// Log-to-linear conversion of 10-bit printing-density code values: the
// black and white code values map to 0 and 1, each code value is 0.002
// density, divided by the film gamma; above 1 - softClip the highlights
// roll off smoothly towards 1 instead of clipping.
struct LogSettings
{
    float64 black = 95.0;
    float64 white = 685.0;
    float64 filmGamma = 0.6;
    float64 softClip = 0.0;

    static constexpr float64 kMaxCode = 1023.0;
    static constexpr float64 kDensityPerCode = 0.002;

    // Black below white, both within 0..1023, film gamma 0.01..10, soft
    // clip 0..1; NaN falls back to the default.
    LogSettings Tidy() const;
};
float64 LogToLinear(float64 code, const LogSettings &log);

// `count` + 1 points of f over from..to, for drawing.
std::vector<QPointF> Sample(const std::function<float64(float64)> &f, float64 from, float64 to, int32 count);

} // namespace TransferFunctions

} // namespace Orbane
