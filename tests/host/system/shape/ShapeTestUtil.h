#pragma once

#include "orbane/AutoRef.h"
#include "orbane/BSplinePolyLine.h"
#include "orbane/PolyLine.h"

#include <initializer_list>
#include <utility>

namespace Orbane::ShapeTests {

// A corner point per pair, or a point with handles.
struct P
{
    float64 x, y, inX, inY, outX, outY;
    P(float64 px, float64 py) : x(px), y(py), inX(px), inY(py), outX(px), outY(py) {}
    P(float64 px, float64 py, float64 ix, float64 iy, float64 ox, float64 oy)
        : x(px), y(py), inX(ix), inY(iy), outX(ox), outY(oy)
    {
    }
    PolyPoint Make() const
    {
        PolyPoint p(x, y);
        p.InX = inX, p.InY = inY, p.OutX = outX, p.OutY = outY;
        return p;
    }
};

template <class Shape = PolyLine> AutoRef<Shape> MakeShape(std::initializer_list<P> points, bool closed)
{
    AutoRef<Shape> s(new Shape);
    for (const P &p : points)
        s->AddPoint(p.Make());
    if (closed)
        s->Close();
    return s;
}

} // namespace Orbane::ShapeTests
