#include "ShapeMaker.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

constexpr float64 kTwoPi = 6.283185307179586;

PolyPoint Smooth(const OrbPoint &p, const OrbPoint &handle)
{
    PolyPoint k(p.x, p.y);
    k.InX = p.x - handle.x, k.InY = p.y - handle.y, k.OutX = p.x + handle.x, k.OutY = p.y + handle.y;
    return k;
}

} // namespace

std::vector<PolyPoint> ShapeMaker::Ellipse(float64 cx, float64 cy, float64 rx, float64 ry, int32 count)
{
    count = std::max(3, count);
    const float64 step = kTwoPi / count, k = 4.0 / 3.0 * std::tan(step / 4.0);
    std::vector<PolyPoint> pts;
    for (int32 i = 0; i < count; ++i) {
        const float64 a = i * step, c = std::cos(a), s = std::sin(a);
        pts.push_back(Smooth({cx + rx * c, cy + ry * s}, {-rx * s * k, ry * c * k}));
    }
    return pts;
}

std::vector<PolyPoint> ShapeMaker::Rectangle(float64 cx, float64 cy, float64 w, float64 h)
{
    const float64 x0 = cx - w / 2, x1 = cx + w / 2, y0 = cy - h / 2, y1 = cy + h / 2;
    return {PolyPoint(x0, y0), PolyPoint(x1, y0), PolyPoint(x1, y1), PolyPoint(x0, y1)};
}

std::vector<PolyPoint> ShapeMaker::Arrow(const OrbPoint &from, const OrbPoint &tip, float64 shaftWidth,
                                         float64 headWidth, float64 headLength)
{
    const OrbPoint along = tip - from;
    const float64 len = along.Length();
    if (len == 0.0)
        return {};
    const OrbPoint dir = along / len, side(-dir.y, dir.x);
    const OrbPoint neck = tip - dir * std::min(headLength, len);
    const OrbPoint s = side * (shaftWidth / 2), h = side * (headWidth / 2);
    const OrbPoint pts[7] = {from - s, neck - s, neck - h, tip, neck + h, neck + s, from + s};
    std::vector<PolyPoint> out;
    for (const OrbPoint &p : pts)
        out.emplace_back(p.x, p.y);
    return out;
}

std::vector<PolyPoint> ShapeMaker::Spiral(float64 cx, float64 cy, float64 r0, float64 r1, float64 turns, int32 perTurn)
{
    perTurn = std::max(4, perTurn);
    const int32 count = std::max(2, int32(std::ceil(turns * perTurn)) + 1);
    const float64 total = kTwoPi * turns, step = total / (count - 1), dr = (r1 - r0) / total;
    std::vector<PolyPoint> pts;
    for (int32 i = 0; i < count; ++i) {
        const float64 a = i * step, r = r0 + dr * a, c = std::cos(a), s = std::sin(a);
        // dP/da, a third of a step long: the cubic's handles.
        const OrbPoint d(dr * c - r * s, dr * s + r * c);
        pts.push_back(Smooth({cx + r * c, cy + r * s}, d * (step / 3.0)));
    }
    pts.front().InX = pts.front().X, pts.front().InY = pts.front().Y;
    pts.back().OutX = pts.back().X, pts.back().OutY = pts.back().Y;
    return pts;
}

} // namespace Orbane
