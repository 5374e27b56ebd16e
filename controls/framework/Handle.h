#pragma once

#include "framework/HandleHit.h"

#include "orbane/OrbPointT.h"
#include "orbane/Types.h"

namespace Orbane {

// How a handle decides that the mouse is over it. Offsets are mouse minus
// the handle's anchor, in viewer units; `t` is the pick tolerance and `s`
// the handle scale (viewer units per handle pixel).
enum HandleShape : int32
{
    // An axis-aligned box from `lo` to `hi` (handle pixels) widened by t on
    // the sides that `grow` names; strict comparisons on every side.
    HSH_Box,
    // The point's square: the offset, handle minus mouse, is truncated to
    // whole viewer units before |offset| < t on both axes.
    HSH_PixelSquare,
    // Within t of a circle of `radius` handle pixels about the anchor (at
    // most t: a closed test).
    HSH_Ring,
    // Within `radius` handle pixels plus t of the anchor (closed).
    HSH_Disc,
    // Closer than t to the segment from the anchor to `end` (viewer units),
    // running on past each end by `radius` handle pixels.
    HSH_Band,
    // One part of a box's outline in a turned frame: the mouse is taken into
    // the frame by `frameX`, `frameY` (frame units per viewer unit, rows of
    // the map), about the anchor at the box's middle. The part is an edge
    // (one of `sideX`, `sideY` is 0) or a corner (neither is): edges within
    // `reach` of their side and along it up to `reach` less the corner
    // radius `radius` past their ends; where both edges meet, the corner;
    // beyond the edges' ends a rounded corner reaches as far as the length
    // of `reach` from the rounding circle's centre. Lengths in frame units;
    // `reach` stands for the tolerance, one per axis of the frame.
    HSH_Outline,
    // Inside the same turned box as HSH_Outline, out to `reach` beyond its
    // sides (closed): the body of a box that is dragged as a whole.
    HSH_Inside,
};

// Sides of a box that the tolerance widens.
enum HandleGrow : uint8
{
    HG_Left = 1,
    HG_Right = 2,
    HG_Bottom = 4,
    HG_Top = 8,
    HG_All = 15,
};

// Fixed priorities among overlapping handles of one overlay: the higher
// wins, and among equals the one added first. A point sits above the
// corner it may share, a corner above its edges, an edge above the body.
enum HandlePriority : int32
{
    HP_Body = 0,
    HP_Edge = 10,
    HP_Corner = 20,
    HP_Tangent = 30,
    HP_Point = 40,
};

// One grabbable part of an overlay, placed in viewer units. `part` holds
// the overlay's own part bits (an axis, an edge, a corner) and `item` a
// number among many alike (a polyline's point), or -1.
struct Handle
{
    HandleShape shape = HSH_Box;
    OrbPoint at;          // anchor, viewer units
    OrbPoint lo, hi;      // HSH_Box: extent about the anchor, handle pixels
    OrbPoint end;         // HSH_Band: the segment's other end, viewer units
    float64 radius = 0.0; // HSH_Ring, HSH_Disc, HSH_Band: handle pixels; HSH_Outline: frame units
    // HSH_Outline, HSH_Inside: the frame's rows, the box's half sides, the tolerance per
    // axis (frame units) and the part's sides (+1, -1 or 0 each).
    OrbPoint frameX{1.0, 0.0}, frameY{0.0, 1.0};
    OrbPoint half;
    OrbPoint reach;
    int8 sideX = 0, sideY = 0;
    float64 tolerance = -1; // viewer units; negative: the viewer's pick tolerance
    uint8 grow = HG_All;    // HSH_Box
    uint32 part = 1;        // non-zero
    int32 item = -1;
    int32 priority = HP_Point;
};

} // namespace Orbane
