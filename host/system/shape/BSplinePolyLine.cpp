#include "orbane/BSplinePolyLine.h"

#include "orbane/ClassIDs.h"

#include <algorithm>

namespace Orbane {

namespace {

// Uniform cubic B-spline basis at t and its derivative.
void Basis(float64 t, float64 b[4], float64 d[4])
{
    const float64 u = 1.0 - t, t2 = t * t, t3 = t2 * t;
    b[0] = u * u * u / 6.0;
    b[1] = (3.0 * t3 - 6.0 * t2 + 4.0) / 6.0;
    b[2] = (-3.0 * t3 + 3.0 * t2 + 3.0 * t + 1.0) / 6.0;
    b[3] = t3 / 6.0;
    d[0] = -u * u / 2.0;
    d[1] = (3.0 * t2 - 4.0 * t) / 2.0;
    d[2] = (-3.0 * t2 + 2.0 * t + 1.0) / 2.0;
    d[3] = t2 / 2.0;
}

struct Homog
{
    float64 xw, yw, w;
};

} // namespace

BSplinePolyLine::~BSplinePolyLine() = default;

const OrbID &BSplinePolyLine::DataType() const noexcept
{
    return CLSID_DataType_BSplinePolyline;
}

Parameter *BSplinePolyLine::Clone() const
{
    return new BSplinePolyLine(*this);
}

void BSplinePolyLine::ControlPoint(int32 k, float64 &xw, float64 &yw, float64 &w) const
{
    const int32 n = GetCount();
    auto at = [this](int32 i, float64 &px, float64 &py, float64 &pw) {
        const PolyPoint &p = mPoints[std::size_t(i)];
        pw = p.Weight, px = p.X * p.Weight, py = p.Y * p.Weight;
    };
    if (IsClosed()) {
        at(((k % n) + n) % n, xw, yw, w);
        return;
    }
    if (k >= 0 && k < n) {
        at(k, xw, yw, w);
        return;
    }
    // The phantom past an end mirrors its neighbour in homogeneous space,
    // so the curve ends exactly on the end point; where that would give the
    // phantom no positive weight it mirrors the position instead.
    const int32 end = k < 0 ? 0 : n - 1, in = k < 0 ? std::min(1, n - 1) : std::max(0, n - 2);
    float64 ex, ey, ew, ix, iy, iw;
    at(end, ex, ey, ew);
    at(in, ix, iy, iw);
    if (2.0 * ew - iw > 0.0) {
        xw = 2.0 * ex - ix, yw = 2.0 * ey - iy, w = 2.0 * ew - iw;
        return;
    }
    const float64 px = 2.0 * ex / ew - ix / iw, py = 2.0 * ey / ew - iy / iw;
    w = ew, xw = px * ew, yw = py * ew;
}

bool BSplinePolyLine::CalcXYZ(float64 par, float64 &x, float64 &y, float64 &z) const
{
    if (GetSegmentsCount() == 0)
        return PolyLine::CalcXYZ(par, x, y, z);
    int32 seg;
    float64 t, b[4], d[4];
    SegmentOf(par, seg, t);
    Basis(t, b, d);
    float64 sx = 0.0, sy = 0.0, sw = 0.0;
    for (int32 i = 0; i < 4; ++i) {
        float64 xw, yw, w;
        ControlPoint(seg - 1 + i, xw, yw, w);
        sx += b[i] * xw, sy += b[i] * yw, sw += b[i] * w;
    }
    x = sx / sw, y = sy / sw, z = 0.0;
    return true;
}

OrbPoint BSplinePolyLine::TangentAt(float64 par) const
{
    if (GetSegmentsCount() == 0)
        return {};
    int32 seg;
    float64 t, b[4], d[4];
    SegmentOf(par, seg, t);
    Basis(t, b, d);
    Homog c{0, 0, 0}, dc{0, 0, 0};
    for (int32 i = 0; i < 4; ++i) {
        float64 xw, yw, w;
        ControlPoint(seg - 1 + i, xw, yw, w);
        c.xw += b[i] * xw, c.yw += b[i] * yw, c.w += b[i] * w;
        dc.xw += d[i] * xw, dc.yw += d[i] * yw, dc.w += d[i] * w;
    }
    // The quotient rule on (x*w, y*w) / w.
    const OrbPoint p(c.xw / c.w, c.yw / c.w);
    return {(dc.xw - p.x * dc.w) / c.w, (dc.yw - p.y * dc.w) / c.w};
}

void BSplinePolyLine::SegmentHull(int32 seg, OrbPoint hull[4]) const
{
    // With positive weights a rational segment stays inside the hull of its
    // four projected control points.
    for (int32 i = 0; i < 4; ++i) {
        float64 xw, yw, w;
        ControlPoint(seg - 1 + i, xw, yw, w);
        hull[i] = {xw / w, yw / w};
    }
}

} // namespace Orbane
