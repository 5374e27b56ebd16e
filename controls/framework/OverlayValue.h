#pragma once

#include "orbane/Number.h"
#include "orbane/OrbPointT.h"
#include "orbane/Parameter.h"
#include "orbane/Point.h"
#include "orbane/PreviewControl.h"

#include <cmath>

namespace Orbane {

// How overlays read the values they are told of. Only finite numbers are
// taken: an Input that holds no number leaves the overlay's copy where it
// was, so nothing that is not a number is drawn or written back.
class OverlayValue
{
public:
    // Beyond this many viewer units a shape has left every screen; drawing
    // it would only feed the painter huge numbers.
    static constexpr float64 FarAway = 1e7;

    static bool Finite(OrbPoint p) noexcept { return std::isfinite(p.x) && std::isfinite(p.y); }
    // A viewer point worth drawing or grabbing: finite and not far away.
    static bool OnScreen(OrbPoint p) noexcept
    {
        return Finite(p) && std::fabs(p.x) < FarAway && std::fabs(p.y) < FarAway;
    }

    // A Number Input's value, where it is a finite number.
    static bool ReadNumber(const Parameter *value, float64 &out)
    {
        const auto *n = dynamic_cast<const Number *>(value);
        if (!n || !std::isfinite(n->Value))
            return false;
        out = n->Value;
        return true;
    }

    static bool ReadPoint(const Parameter *value, OrbPoint &out)
    {
        const auto *p = dynamic_cast<const Point *>(value);
        if (!p || !std::isfinite(p->X) || !std::isfinite(p->Y))
            return false;
        out = OrbPoint(p->X, p->Y);
        return true;
    }

    // Takes `to` into `copy` where it moved by more than the change threshold.
    static bool Take(float64 &copy, float64 to)
    {
        if (!PreviewControl::Moved(copy, to))
            return false;
        copy = to;
        return true;
    }

    static bool Take(OrbPoint &copy, OrbPoint to)
    {
        const bool x = Take(copy.x, to.x);
        return Take(copy.y, to.y) || x;
    }

    // A Number copy from `value`, where it is one and moved.
    static bool TakeNumber(float64 &copy, const Parameter *value)
    {
        float64 n = 0.0;
        return ReadNumber(value, n) && Take(copy, n);
    }

    // A switch from a Number Input (not 0: on), where it is one and changed.
    static bool TakeFlag(bool &copy, const Parameter *value)
    {
        float64 n = 0.0;
        if (!ReadNumber(value, n) || copy == (n != 0.0))
            return false;
        copy = n != 0.0;
        return true;
    }

    static bool TakePoint(OrbPoint &copy, const Parameter *value)
    {
        OrbPoint p;
        return ReadPoint(value, p) && Take(copy, p);
    }
};

} // namespace Orbane
