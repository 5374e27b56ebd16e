#pragma once

#include "orbane/AutoRef.h"
#include "orbane/Types.h"

#include <vector>

namespace Orbane {

class PolyLine;

// The geometry behind smoothing, easing and the cardinal conversion: pure
// functions of shapes (and of a shape's keyframes), so the overlay's
// commands only gather the shapes and write them back as one undo step.
// A selection is one byte per key point, non-zero for selected; null
// means every point.
class PolyLineAnimation
{
public:
    // "Smooth Points": each selected point moves `amount` (0..1) of the way
    // to the middle of its two neighbours, `passes` times, its handles with
    // it. The ends of an open shape stay where they are.
    static bool SmoothPoints(PolyLine &shape, const uint8 *selected, float64 amount, int32 passes);
    // "Cardinal to Bezier": the selected points take the handles that draw
    // the cardinal spline through the key points (tension 0: Catmull-Rom;
    // 1: corners). An open shape's end points aim at their one neighbour.
    static bool CardinalToBezier(PolyLine &shape, const uint8 *selected, float64 tension);
    // "Smooth Animation": on every key but the first and the last, each
    // selected point (and its handles) moves `amount` of the way towards
    // where an even motion between its neighbouring keys would put it at
    // that key's time, `passes` times. False where fewer than three keys
    // or their point counts differ.
    static bool SmoothKeys(std::vector<AutoRef<PolyLine>> &keys, const std::vector<float64> &times,
                           const uint8 *selected, float64 amount, int32 passes);
    // The eased fraction of a fraction `u` (0..1) of a motion: it leaves
    // with the slope 1 - `in` and arrives with 1 - `out` (0 and 0: no
    // easing, 1 and 1: a smooth start and stop); never overshoots.
    static float64 Ease(float64 u, float64 in, float64 out) noexcept;
    // Copies the selected points (with their handles) of `from` into `to`;
    // false where the counts differ or nothing changed.
    static bool CopyPoints(PolyLine &to, const PolyLine &from, const uint8 *selected);
};

} // namespace Orbane
