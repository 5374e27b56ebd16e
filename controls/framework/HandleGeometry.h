#pragma once

#include "framework/Handle.h"

#include "orbane/OrbRectT.h"

namespace Orbane {

// Pure hit geometry of overlay handles, all in viewer units: `m` is the
// mouse minus the handle's anchor, `t` the pick tolerance and `s` the handle
// scale. Kept apart from any overlay so that each shape is tested alone and
// every overlay shares the same comparisons.
class HandleGeometry
{
public:
    // Hover reaches as far as the tolerance on every side of a box; a press
    // only on the sides the handle grows (the crosshair's arm tips).
    enum Reach : int32
    {
        Press,
        Hover,
    };

    // lo.x * s - t < m.x < hi.x * s + t (and so on), each tolerance only on
    // a side that `grow` names.
    static bool InBox(OrbPoint m, OrbPoint lo, OrbPoint hi, float64 s, float64 t, uint8 grow) noexcept;
    // The point's square: handle minus mouse truncated to whole units, then
    // strictly within t on both axes.
    static bool InPixelSquare(OrbPoint m, float64 t) noexcept;
    // Within t of the circle of radius r (closed).
    static bool OnRing(OrbPoint m, float64 r, float64 t) noexcept;
    // Within r + t of the anchor (closed).
    static bool InDisc(OrbPoint m, float64 r, float64 t) noexcept;
    // Closer than t to the segment from 0 to `along`, which runs on by
    // `extend` past either end.
    static bool OnBand(OrbPoint m, OrbPoint along, float64 extend, float64 t) noexcept;

    // The sides of a box's outline (half sides `half`, tolerance `t` per
    // axis, corners rounded by `r`) at `local` (frame units from its middle):
    // the X side hit (+1, -1, or 0) and the Y side; both for a corner. An
    // edge is hit within t of it and along it up to t - r past its ends;
    // where neither edge is, the corner band is hit closer than |t| to the
    // rounding circle's centre. Negative half sides draw the same box.
    static OrbPointI OutlineSides(OrbPoint local, OrbPoint half, OrbPoint t, float64 r) noexcept;
    // `m` (viewer units) in the frame of an HSH_Outline handle.
    static OrbPoint InFrame(const Handle &h, OrbPoint m) noexcept;

    // The tolerance a handle uses: its own, or the viewer's.
    static float64 ToleranceOf(const Handle &h, float64 viewerTolerance) noexcept;
    static bool Hits(const Handle &h, OrbPoint mouse, float64 s, float64 viewerTolerance, Reach reach) noexcept;
    // A rectangle (viewer units) outside which `h` is never hit, at hover reach.
    static OrbRect Extent(const Handle &h, float64 s, float64 viewerTolerance) noexcept;
};

} // namespace Orbane
