#include "widgets/TransferFunctions.h"

#include <algorithm>
#include <cmath>

namespace Orbane {
namespace TransferFunctions {

namespace {

float64 Finite(float64 v, float64 def)
{
    return std::isfinite(v) ? v : def;
}

} // namespace

float64 Gamma(float64 x, float64 gamma)
{
    if (!(gamma > 0.0))
        gamma = 1.0;
    const float64 magnitude = std::pow(std::abs(x), 1.0 / gamma);
    return x < 0.0 ? -magnitude : magnitude;
}

float64 GammaThrough(float64 y)
{
    return std::log(0.5) / std::log(y);
}

LogSettings LogSettings::Tidy() const
{
    const LogSettings def;
    LogSettings t;
    t.white = std::clamp(Finite(white, def.white), 1.0, kMaxCode);
    t.black = std::clamp(Finite(black, def.black), 0.0, t.white - 1.0);
    t.filmGamma = std::clamp(Finite(filmGamma, def.filmGamma), 0.01, 10.0);
    t.softClip = std::clamp(Finite(softClip, def.softClip), 0.0, 1.0);
    return t;
}

float64 LogToLinear(float64 code, const LogSettings &log)
{
    const LogSettings s = log.Tidy();
    const float64 scale = LogSettings::kDensityPerCode / s.filmGamma;
    const float64 offset = std::pow(10.0, (s.black - s.white) * scale);
    const float64 linear = (std::pow(10.0, (code - s.white) * scale) - offset) / (1.0 - offset);
    const float64 knee = 1.0 - s.softClip;
    if (s.softClip <= 0.0 || linear <= knee)
        return linear;
    // An exponential shoulder from the knee: the same slope there, 1 at infinity.
    return knee + s.softClip * (1.0 - std::exp(-(linear - knee) / s.softClip));
}

std::vector<QPointF> Sample(const std::function<float64(float64)> &f, float64 from, float64 to, int32 count)
{
    std::vector<QPointF> points;
    count = std::max(1, count);
    points.reserve(std::size_t(count) + 1);
    for (int32 i = 0; i <= count; ++i) {
        const float64 x = from + (to - from) * i / count;
        points.emplace_back(x, f(x));
    }
    return points;
}

} // namespace TransferFunctions
} // namespace Orbane
