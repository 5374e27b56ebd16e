#pragma once

#include "orbane/Types.h"

#include <vector>

namespace Orbane {

struct CurvePoint
{
    float64 x = 0.0;
    float64 y = 0.0;
    bool operator==(const CurvePoint &o) const noexcept { return x == o.x && y == o.y; }
};

// A tone curve through control points: smooth (a monotone cubic, which
// never overshoots between points, so a curve that rises everywhere keeps
// rising) or straight segments. Outside its points the curve is flat at the
// end values. With no point it is the identity; with one, flat.
//
// Points arrive from scripts and tool files in any order: Tidy sorts them by
// x, drops points that are not numbers, and merges points of the same x into
// one at their mean y, so a curve is always a function of x.
class Curve
{
public:
    Curve() = default;
    explicit Curve(std::vector<CurvePoint> points, bool linear = false);

    // The identity: (0, 0) and (1, 1).
    static Curve Identity(bool linear = false);

    const std::vector<CurvePoint> &Points() const noexcept { return mPoints; }
    bool IsLinear() const noexcept { return mLinear; }
    void SetLinear(bool linear);
    bool operator==(const Curve &o) const noexcept { return mLinear == o.mLinear && mPoints == o.mPoints; }
    bool operator!=(const Curve &o) const noexcept { return !(*this == o); }

    float64 Evaluate(float64 x) const;

    // Editing keeps the order: a moved point stays between its neighbours
    // (at least kMinGap from them), an added point goes in its place.
    // Insert answers the index the point took.
    int32 Insert(CurvePoint p);
    // Moves point `index` to `p`, clamped between its neighbours; false
    // where the index is out of range or the point stayed.
    bool Move(int32 index, CurvePoint p);
    bool Remove(int32 index);
    // The nearest point within `tolerance` of `p`, measured by `scaleX` and
    // `scaleY` (pixels per unit); -1 where none.
    int32 Nearest(CurvePoint p, float64 scaleX, float64 scaleY, float64 tolerance) const;

    // The least x distance between neighbouring points: the same x twice
    // would make a step that the smooth form cannot follow.
    static constexpr float64 kMinGap = 1e-4;

private:
    void Tidy();
    void UpdateSlopes();
    float64 Segment(std::size_t i, float64 x) const;

    std::vector<CurvePoint> mPoints;
    std::vector<float64> mSlopes; // the tangent at each point (smooth form)
    bool mLinear = false;
};

} // namespace Orbane
