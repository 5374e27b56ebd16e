#pragma once

#include "orbane/AutoRef.h"
#include "orbane/OrbPointT.h"
#include "orbane/Types.h"

#include <QTransform>

#include <vector>

namespace Orbane {

class Input;
class Operator;
class PolyLine;
class SelMask;

// Geometry of the overlay's edits as pure functions of shapes: each changes
// the shape it is given (a copy the caller will store) and answers whether
// anything changed. Selections are one byte per point, non-zero selected.
class PolyLineShapes
{
public:
    // How far out a new outer polyline lies, in image units.
    static constexpr float64 OuterDistance = 0.02;

    // The selection without the locked points: what moves.
    static std::vector<uint8> Movable(const PolyLine &shape, const SelMask &selection);
    // Mirrors the selected points and their handles about the middle of
    // their box: across X where `acrossX`, else across Y.
    static bool Flip(PolyLine &shape, const uint8 *selected, bool acrossX);
    // Tags the selected points, or untags them where all are tagged; a
    // point without an id takes its number (index + 1).
    static bool ToggleTags(PolyLine &shape, const uint8 *selected);
    static bool SetFlag(PolyLine &shape, const uint8 *selected, uint32 flag, bool on);
    // Applies `t` to the selected points and their handles.
    static bool Transform(PolyLine &shape, const uint8 *selected, const QTransform &t);
    // One step of uniform cubic B-spline refinement: a new point between each
    // two and every old point moved to (prev + 6 * self + next) / 8, in
    // homogeneous coordinates, so the curve stays exactly as it was.
    static bool Subdivide(PolyLine &shape);
    // The selected points as a shape of their own (open).
    static AutoRef<PolyLine> Selected(const PolyLine &shape, const uint8 *selected);
    // `more`'s points after `shape`'s; an empty shape takes `more`'s closure.
    static bool Append(PolyLine &shape, const PolyLine &more);
    // A segment dragged at its parameter `t` by `delta`: the two handles of
    // the segment move so that the curve's point at t moves by exactly
    // `delta` (t kept from the ends, where the handles would fly off).
    static bool ShapeSegment(PolyLine &shape, int32 segment, float64 t, OrbPoint delta);
    // A handle end (part 2 in, 4 out) of point `index` moved to `to`; the
    // other handle turns with it to stay opposite (its length kept) unless
    // `breakTangent`, or the point is a corner.
    static bool MoveHandle(PolyLine &shape, int32 index, uint32 part, OrbPoint to, bool breakTangent);
    // `inner` with every point `distance` out along its normal (free: the
    // points follow nothing until "Follow Inner Polyline").
    static AutoRef<PolyLine> OuterOf(const PolyLine &inner, float64 distance);

    // Publishing: the lowest point number no point Input of `tool` uses.
    static int32 FirstFreePointNumber(const Operator &tool);
    // The selected points take the numbers of the nearest published points
    // of `tool`'s other shapes and move onto them; false where there are none.
    static bool FollowPublished(PolyLine &shape, const uint8 *selected, const Operator &tool, float64 time);
    // The published point `index` of `shape` (an Input of `tool`) animated
    // as a path with a key at each of `times`: its point Input, or with
    // `xy` two Number Inputs "<id>X" and "<id>Y".
    static void AnimatePath(Operator &tool, Input &shape, int32 index, int32 number, const std::vector<float64> &times,
                            bool xy);
};

} // namespace Orbane
