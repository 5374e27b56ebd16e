#include "framework/HandleGeometry.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace Orbane {

namespace {

// A whole viewer unit around every extent: the hit tests compare in doubles
// that a rectangle of the same numbers may round the other way.
constexpr float64 kExtentMargin = 1.0;

float64 Grown(uint8 grow, uint8 side, float64 t) noexcept
{
    return (grow & side) ? t : 0.0;
}

// The whole outline's reach taken back out of the frame: its four corners
// through the frame's inverse. A frame that flattens the plane has none.
OrbRect OutlineExtent(const Handle &h) noexcept
{
    const float64 det = h.frameX.x * h.frameY.y - h.frameX.y * h.frameY.x;
    constexpr float64 inf = std::numeric_limits<float64>::infinity();
    if (!std::isfinite(det) || det == 0.0)
        return {-inf, -inf, inf, inf};
    const OrbPoint out(std::fabs(h.half.x) + h.reach.x, std::fabs(h.half.y) + h.reach.y);
    OrbRect r(inf, inf, -inf, -inf);
    for (const OrbPoint c :
         {OrbPoint(out.x, out.y), OrbPoint(-out.x, out.y), OrbPoint(out.x, -out.y), OrbPoint(-out.x, -out.y)}) {
        const OrbPoint v(h.at.x + (h.frameY.y * c.x - h.frameX.y * c.y) / det,
                         h.at.y + (-h.frameY.x * c.x + h.frameX.x * c.y) / det);
        r = OrbRect(std::min(r.x1, v.x), std::min(r.y1, v.y), std::max(r.x2, v.x), std::max(r.y2, v.y));
    }
    if (!std::isfinite(r.x1) || !std::isfinite(r.y1) || !std::isfinite(r.x2) || !std::isfinite(r.y2))
        return {-inf, -inf, inf, inf};
    return {r.x1 - kExtentMargin, r.y1 - kExtentMargin, r.x2 + kExtentMargin, r.y2 + kExtentMargin};
}

} // namespace

bool HandleGeometry::InBox(OrbPoint m, OrbPoint lo, OrbPoint hi, float64 s, float64 t, uint8 grow) noexcept
{
    return lo.x * s - Grown(grow, HG_Left, t) < m.x && m.x < hi.x * s + Grown(grow, HG_Right, t) &&
           lo.y * s - Grown(grow, HG_Bottom, t) < m.y && m.y < hi.y * s + Grown(grow, HG_Top, t);
}

bool HandleGeometry::InPixelSquare(OrbPoint m, float64 t) noexcept
{
    return std::fabs(std::trunc(m.x)) < t && std::fabs(std::trunc(m.y)) < t;
}

bool HandleGeometry::OnRing(OrbPoint m, float64 r, float64 t) noexcept
{
    return std::fabs(m.Length() - r) <= t;
}

bool HandleGeometry::InDisc(OrbPoint m, float64 r, float64 t) noexcept
{
    return m.Length() <= r + t;
}

bool HandleGeometry::OnBand(OrbPoint m, OrbPoint along, float64 extend, float64 t) noexcept
{
    const float64 length = along.Length();
    if (length <= 0.0)
        return m.Length() < t + extend;
    const OrbPoint dir = along / length;
    const float64 u = m.Dot(dir);
    const float64 across = std::fabs(m.x * dir.y - m.y * dir.x);
    return across < t && u >= -extend && u <= length + extend;
}

OrbPointI HandleGeometry::OutlineSides(OrbPoint local, OrbPoint half, OrbPoint t, float64 r) noexcept
{
    const float64 ax = std::fabs(local.x), ay = std::fabs(local.y);
    const float64 hw = std::fabs(half.x), hh = std::fabs(half.y);
    const bool xEdge = std::fabs(ax - hw) < t.x && ay <= hh + t.y - r;
    const bool yEdge = std::fabs(ay - hh) < t.y && ax <= hw + t.x - r;
    bool corner = false;
    if (!xEdge && !yEdge && hw - r < ax && ax < hw + t.x && hh - r < ay && ay < hh + t.y)
        corner = std::hypot(ax - (hw - r), ay - (hh - r)) < std::hypot(t.x, t.y);
    return {xEdge || corner ? (local.x >= 0.0 ? 1 : -1) : 0, yEdge || corner ? (local.y >= 0.0 ? 1 : -1) : 0};
}

OrbPoint HandleGeometry::InFrame(const Handle &h, OrbPoint m) noexcept
{
    return {h.frameX.Dot(m), h.frameY.Dot(m)};
}

float64 HandleGeometry::ToleranceOf(const Handle &h, float64 viewerTolerance) noexcept
{
    return h.tolerance >= 0.0 ? h.tolerance : viewerTolerance;
}

bool HandleGeometry::Hits(const Handle &h, OrbPoint mouse, float64 s, float64 viewerTolerance, Reach reach) noexcept
{
    const float64 t = ToleranceOf(h, viewerTolerance);
    const OrbPoint m = mouse - h.at;
    switch (h.shape) {
    case HSH_Box:
        return InBox(m, h.lo, h.hi, s, t, reach == Hover ? uint8(HG_All) : h.grow);
    case HSH_PixelSquare:
        return InPixelSquare(m, t);
    case HSH_Ring:
        return OnRing(m, h.radius * s, t);
    case HSH_Disc:
        return InDisc(m, h.radius * s, t);
    case HSH_Band:
        return OnBand(m, h.end - h.at, h.radius * s, t);
    case HSH_Outline: {
        const OrbPointI sides = OutlineSides(InFrame(h, m), h.half, h.reach, h.radius);
        return sides.x == h.sideX && sides.y == h.sideY && (sides.x || sides.y);
    }
    case HSH_Inside: {
        const OrbPoint local = InFrame(h, m);
        return std::fabs(local.x) <= std::fabs(h.half.x) + h.reach.x &&
               std::fabs(local.y) <= std::fabs(h.half.y) + h.reach.y;
    }
    }
    return false;
}

OrbRect HandleGeometry::Extent(const Handle &h, float64 s, float64 viewerTolerance) noexcept
{
    const float64 t = ToleranceOf(h, viewerTolerance) + kExtentMargin;
    switch (h.shape) {
    case HSH_Box:
        return {h.at.x + h.lo.x * s - t, h.at.y + h.lo.y * s - t, h.at.x + h.hi.x * s + t, h.at.y + h.hi.y * s + t};
    case HSH_PixelSquare:
        // Truncation lets a whole unit more through on each side.
        return {h.at.x - t - 1.0, h.at.y - t - 1.0, h.at.x + t + 1.0, h.at.y + t + 1.0};
    case HSH_Ring:
    case HSH_Disc: {
        const float64 r = h.radius * s + t;
        return {h.at.x - r, h.at.y - r, h.at.x + r, h.at.y + r};
    }
    case HSH_Band: {
        const float64 r = h.radius * s + t;
        return {std::min(h.at.x, h.end.x) - r, std::min(h.at.y, h.end.y) - r, std::max(h.at.x, h.end.x) + r,
                std::max(h.at.y, h.end.y) + r};
    }
    case HSH_Outline:
    case HSH_Inside:
        return OutlineExtent(h);
    }
    return {};
}

} // namespace Orbane
