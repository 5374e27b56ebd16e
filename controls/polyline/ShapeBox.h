#pragma once

#include "orbane/Object.h"
#include "orbane/OrbRectT.h"

#include <QTransform>

#include <vector>

namespace Orbane {

// The box round the selected points of a shape, which moves, scales and
// turns them together. Its handles are the four corners and the four edge
// middles (numbered anticlockwise from the bottom-left corner), the inside
// (a move) and a ring just outside the corners (a turn). All of it in
// viewer units, Y up, so that the box is square on screen whatever the
// image's pixels; the overlay maps the points in and out.
class ShapeBox : public Object
{
public:
    enum Part : int32
    {
        SBP_None = -1,
        SBP_BottomLeft = 0,
        SBP_Bottom,
        SBP_BottomRight,
        SBP_Right,
        SBP_TopRight,
        SBP_Top,
        SBP_TopLeft,
        SBP_Left,
        SBP_Inside,
        SBP_Rotate,
    };
    // How far outside a corner a press still turns the box, in tolerances.
    static constexpr float64 RotateReach = 3.0;

    ShapeBox(const Registry *reg, const ScriptVal &args, const TagList &tags);

    std::size_t SizeOf() const override { return sizeof(ShapeBox); }

    // The box round `points`; empty (no handles) for none.
    void SetPoints(const std::vector<OrbPoint> &points);
    bool IsEmpty() const { return mEmpty; }
    const OrbRect &Bounds() const { return mBounds; }
    // Where handle `part` (a corner or an edge middle) is.
    OrbPoint HandleAt(int32 part) const;
    // The part a press at `mouse` takes: a handle within `tolerance` on both
    // axes (a corner before an edge), the inside, the turning ring, or none.
    int32 HitTest(OrbPoint mouse, float64 tolerance) const;
    // The index of the overlay's cursor (PolyLineControl::CursorShapes) for
    // `part`: the size cursors along the handle's axis, size-all inside, the
    // cross for turning, the arrow for none.
    static int32 CursorOf(int32 part) noexcept;
    // What a drag of `part` from `from` to `to` does to the points: inside,
    // a move; a corner, a scale about the opposite corner (by the larger of
    // both factors where `keepAspect`); an edge, a scale of its axis about
    // the opposite edge; the ring, a turn about the middle.
    QTransform Drag(int32 part, OrbPoint from, OrbPoint to, bool keepAspect) const;

private:
    OrbRect mBounds;
    bool mEmpty = true;
};

} // namespace Orbane
