#include "ShapeConvert.h"

#include "orbane/BSplinePolyLine.h"

#include <algorithm>
#include <cmath>
#include <vector>

namespace Orbane {

namespace {

// The system is diagonally dominant (4 against 1 + 1), so each Gauss-Seidel
// sweep at least halves the error; sweeps stop when nothing moves beyond
// rounding.
constexpr int kMaxSweeps = 200;
constexpr float64 kSettled = 1e-15;

std::vector<OrbPoint> SolveControlPoints(const std::vector<OrbPoint> &keys, bool closed)
{
    const int32 n = int32(keys.size());
    std::vector<OrbPoint> p = keys;
    if (n < 2 || (!closed && n < 3))
        return p;
    for (int sweep = 0; sweep < kMaxSweeps; ++sweep) {
        float64 moved = 0.0;
        for (int32 i = closed ? 0 : 1; i < (closed ? n : n - 1); ++i) {
            const OrbPoint &prev = p[std::size_t((i - 1 + n) % n)], &next = p[std::size_t((i + 1) % n)];
            const OrbPoint v = (keys[std::size_t(i)] * 6.0 - prev - next) / 4.0;
            moved = std::max(moved, (v - p[std::size_t(i)]).Length());
            p[std::size_t(i)] = v;
        }
        if (moved <= kSettled)
            break;
    }
    return p;
}

} // namespace

BSplinePolyLine *ShapeConvert::ToBSpline(const PolyLine &bezier)
{
    std::vector<OrbPoint> keys;
    for (const PolyPoint &k : bezier.Points())
        keys.push_back(k.Pos());
    const std::vector<OrbPoint> control = SolveControlPoints(keys, bezier.IsClosed());
    auto *out = new BSplinePolyLine;
    for (std::size_t i = 0; i < control.size(); ++i) {
        PolyPoint p = bezier.Points()[i];
        p.X = p.InX = p.OutX = control[i].x;
        p.Y = p.InY = p.OutY = control[i].y;
        p.Weight = 1.0;
        p.Flags &= ~uint32(PPF_Linear);
        out->AddPoint(p);
    }
    if (bezier.IsClosed())
        out->Close();
    return out;
}

PolyLine *ShapeConvert::ToBezier(const BSplinePolyLine &bspline)
{
    auto *out = new PolyLine;
    const int32 n = bspline.GetCount(), segs = bspline.GetSegmentsCount();
    for (int32 i = 0; i < n; ++i) {
        PolyPoint p = bspline.Points()[std::size_t(i)];
        const OrbPoint at = bspline.ValueAt(i);
        const OrbPoint handle = segs > 0 ? bspline.TangentAt(i) / 3.0 : OrbPoint();
        const bool openStart = !bspline.IsClosed() && i == 0, openEnd = !bspline.IsClosed() && i == n - 1;
        p.X = at.x, p.Y = at.y;
        p.InX = openStart ? at.x : at.x - handle.x, p.InY = openStart ? at.y : at.y - handle.y;
        p.OutX = openEnd ? at.x : at.x + handle.x, p.OutY = openEnd ? at.y : at.y + handle.y;
        p.Weight = 1.0;
        out->AddPoint(p);
    }
    if (bspline.IsClosed())
        out->Close();
    return out;
}

} // namespace Orbane
