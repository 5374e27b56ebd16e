#pragma once

#include "orbane/Types.h"

#include <utility>

namespace Orbane {

// The rules a range's two ends keep, as one pure value: both inside the
// allowed range, rounded to the step, and the low end at least the least
// span below the high one. An end the user moves into the other stops there
// or, with push, takes the other along; a moved span keeps its width.
struct RangeLimits
{
    enum End : int32
    {
        End_Low = 1,
        End_High = 2,
        End_Both = End_Low | End_High,
    };

    float64 minAllowed = -1000000.0;
    float64 maxAllowed = 1000000.0;
    float64 minSpan = 0.0;
    float64 step = 0.001; // 1 for whole numbers
    bool pushOther = false;

    float64 Round(float64 value) const;
    // The ends after the user asked for (low, high) by moving `moved`.
    std::pair<float64, float64> Constrain(float64 low, float64 high, End moved) const;

private:
    float64 Clamp(float64 value) const;
    std::pair<float64, float64> MoveBoth(float64 low, float64 high) const;
    std::pair<float64, float64> MoveLow(float64 low, float64 high) const;
    std::pair<float64, float64> MoveHigh(float64 low, float64 high) const;
};

} // namespace Orbane
