#pragma once

#include "widgets/ColorMath.h"

#include "orbane/ScriptVal.h"

#include <string>
#include <vector>

namespace Orbane {

// The value of a gradient control: colour stops at positions 0..1, ordered
// by position, and how the colour runs between two stops. As a script table:
//   { interpolation = "linear" | "smooth", stops = { { pos, r, g, b, a }, ... } }
// Pure data with its edits, so that the editing rules are tested alone.
struct GradientStops
{
    struct Stop
    {
        float64 pos = 0.0;
        ColorRGBA color;
    };
    // Fewer stops than this are no gradient: the last two cannot be deleted.
    static constexpr int32 kMinStops = 2;

    std::vector<Stop> stops;
    bool smooth = false; // smoothstep between stops instead of a straight line

    // Black to white, linear.
    static GradientStops Default();
    // Reads a script table. Stops out of order are sorted, positions outside
    // 0..1 clamped, missing channels 0 (alpha 1); NaN positions are dropped.
    // False, with `why` set and `out` untouched, where the table is no
    // gradient at all (not a table, or fewer than two usable stops).
    static bool FromScript(const ScriptVal &value, GradientStops &out, std::string *why);
    ScriptVal ToScript() const;

    ColorRGBA Evaluate(float64 pos) const;
    // Adds a stop at `pos` with the colour the gradient has there; its index.
    int32 Add(float64 pos);
    // Moves stop `index` to `pos` (clamped), keeping the order; its new index.
    int32 Move(int32 index, float64 pos);
    // False where the gradient would have too few stops.
    bool Remove(int32 index);
    bool operator==(const GradientStops &o) const;
    bool operator!=(const GradientStops &o) const { return !(*this == o); }
};

} // namespace Orbane
