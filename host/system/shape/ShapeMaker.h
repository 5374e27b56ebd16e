#pragma once

#include "orbane/PolyPoint.h"

#include <vector>

namespace Orbane {

// The key points of ready-made shapes, in image coordinates.
class ShapeMaker
{
public:
    // A closed ellipse of `count` smooth points (at least 3), each quarter
    // turn a cubic whose handles are 4/3 tan(angle / 4) of the radius long.
    static std::vector<PolyPoint> Ellipse(float64 cx, float64 cy, float64 rx, float64 ry, int32 count);
    // A closed rectangle of four corners, counter-clockwise from bottom left.
    static std::vector<PolyPoint> Rectangle(float64 cx, float64 cy, float64 w, float64 h);
    // A closed arrow outline of seven corners from (x0, y0) to the tip at
    // (x1, y1); the head is `headWidth` wide and `headLength` long (at most
    // the arrow's length).
    static std::vector<PolyPoint> Arrow(const OrbPoint &from, const OrbPoint &tip, float64 shaftWidth,
                                        float64 headWidth, float64 headLength);
    // An open Archimedean spiral from radius r0 to r1 over `turns` turns,
    // `perTurn` smooth points a turn.
    static std::vector<PolyPoint> Spiral(float64 cx, float64 cy, float64 r0, float64 r1, float64 turns, int32 perTurn);
};

} // namespace Orbane
