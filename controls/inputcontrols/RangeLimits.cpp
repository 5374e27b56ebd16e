#include "inputcontrols/RangeLimits.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

float64 RangeLimits::Round(float64 value) const
{
    return step > 0.0 ? std::floor(value / step + 0.5) * step : value;
}

float64 RangeLimits::Clamp(float64 value) const
{
    return std::clamp(value, minAllowed, std::max(minAllowed, maxAllowed));
}

std::pair<float64, float64> RangeLimits::Constrain(float64 low, float64 high, End moved) const
{
    low = Round(low);
    high = Round(high);
    // A span keeps its width: it is slid, not clamped end by end.
    if (moved == End_Both)
        return MoveBoth(low, high);
    low = Clamp(low);
    high = Clamp(high);
    return moved == End_Low ? MoveLow(low, high) : MoveHigh(low, high);
}

// The span slides to the edge it hits and keeps its width; one wider than
// the allowed range fills it.
std::pair<float64, float64> RangeLimits::MoveBoth(float64 low, float64 high) const
{
    const float64 width = std::max(high - low, minSpan);
    if (width >= maxAllowed - minAllowed)
        return {minAllowed, maxAllowed};
    if (low < minAllowed)
        return {minAllowed, minAllowed + width};
    if (low + width > maxAllowed)
        return {maxAllowed - width, maxAllowed};
    return {low, low + width};
}

std::pair<float64, float64> RangeLimits::MoveLow(float64 low, float64 high) const
{
    if (high - low >= minSpan)
        return {low, high};
    if (!pushOther)
        return {std::max(minAllowed, high - minSpan), high};
    high = std::min(maxAllowed, low + minSpan);
    return {std::max(minAllowed, high - minSpan), high};
}

std::pair<float64, float64> RangeLimits::MoveHigh(float64 low, float64 high) const
{
    if (high - low >= minSpan)
        return {low, high};
    if (!pushOther)
        return {low, std::min(maxAllowed, low + minSpan)};
    low = std::max(minAllowed, high - minSpan);
    return {low, std::min(maxAllowed, low + minSpan)};
}

} // namespace Orbane
