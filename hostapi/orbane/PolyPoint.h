#pragma once

#include "orbane/OrbPointT.h"
#include "orbane/Types.h"

namespace Orbane {

class PolyLine;

// What a key point is besides its position.
enum PolyPointFlags : uint32
{
    PPF_Linear = 1u << 0,       // a corner: both handles lie on the point
    PPF_Tagged = 1u << 1,       // shows its TagID in the viewer
    PPF_Published = 1u << 2,    // offered to the tool as a point Input (TagID is its number)
    PPF_Following = 1u << 3,    // keeps its offset to a point of another shape
    PPF_Discontinual = 1u << 4, // the segment that starts here is a gap, not drawn
    PPF_Locked = 1u << 5,       // held where it is: edits of the selection leave it
};

// Flags of PolyPoint::Next1 and PolyLine::First.
enum PolyWalkFlags : uint32
{
    // On a closed shape the point after the last is the first again, so a
    // walk also visits the closing segment; the caller stops at its start.
    PWF_Wrap = 1024,
};

// One key point of a shape: its position, the absolute positions of its in
// and out handles, and the pen values a freehand stroke recorded there. All
// positions are image coordinates, 0..1 across each axis with Y up. The
// point knows the shape that holds it only so that Next1 can walk on; a
// point copied out of a shape walks nowhere.
struct PolyPoint
{
    using KeyPoint = PolyPoint;

    float64 X = 0.0, Y = 0.0;
    float64 InX = 0.0, InY = 0.0;
    float64 OutX = 0.0, OutY = 0.0;
    float64 Weight = 1.0; // of a B-spline control point
    float64 Time = TIME_UNDEFINED;
    float64 Pressure = 1.0;
    float64 Height = 0.0, AngleXY = 0.0, AngleZ = 0.0, Rotation = 0.0;
    uint32 Flags = 0;
    int32 TagID = 0;
    // A following point's offset to the point it follows, and the index
    // of that point in the other shape.
    float64 DispX = 0.0, DispY = 0.0;
    int32 FollowIndex = -1;

    PolyPoint() = default;
    // A corner at (x, y): both handles on the point.
    PolyPoint(float64 x, float64 y) noexcept : X(x), Y(y), InX(x), InY(y), OutX(x), OutY(y) {}
    PolyPoint(const PolyPoint &o) noexcept { Assign(o); }
    PolyPoint &operator=(const PolyPoint &o) noexcept
    {
        Assign(o);
        return *this;
    }

    OrbPoint Pos() const noexcept { return {X, Y}; }
    OrbPoint In() const noexcept { return {InX, InY}; }
    OrbPoint Out() const noexcept { return {OutX, OutY}; }
    // Moves the point and both handles together.
    void Offset(float64 dx, float64 dy) noexcept;

    // The point `step` places on in its shape (negative: back), or null past
    // either end; with PWF_Wrap a closed shape is walked round.
    PolyPoint *Next1(int32 step = 1, uint32 flags = 0) const;
    const PolyLine *Owner() const noexcept { return mOwner; }

    // Every field but the owner.
    bool operator==(const PolyPoint &o) const noexcept;
    bool operator!=(const PolyPoint &o) const noexcept { return !(*this == o); }

private:
    friend class PolyLine;
    void Assign(const PolyPoint &o) noexcept;

    const PolyLine *mOwner = nullptr;
};

using KeyPoint = PolyPoint;

} // namespace Orbane
