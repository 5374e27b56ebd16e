#include "framework/HandleGeometry.h"

#include <gtest/gtest.h>

#include <string>

using namespace Orbane;

namespace {

Handle Box(OrbPoint lo, OrbPoint hi, uint8 grow = HG_All)
{
    Handle h;
    h.shape = HSH_Box;
    h.lo = lo;
    h.hi = hi;
    h.grow = grow;
    return h;
}

Handle Shaped(HandleShape shape, float64 radius, OrbPoint end = {}, float64 tolerance = -1)
{
    Handle h;
    h.shape = shape;
    h.radius = radius;
    h.end = end;
    h.tolerance = tolerance;
    return h;
}

// One part of the outline of a box of half sides 40 x 20, in the frame that
// `frameX`, `frameY` take the mouse into.
Handle Outline(int8 sideX, int8 sideY, OrbPoint frameX = {1, 0}, OrbPoint frameY = {0, 1}, OrbPoint reach = {6, 6},
               float64 round = 0)
{
    Handle h;
    h.shape = HSH_Outline;
    h.sideX = sideX;
    h.sideY = sideY;
    h.frameX = frameX;
    h.frameY = frameY;
    h.half = {40, 20};
    h.reach = reach;
    h.radius = round;
    return h;
}

Handle Inside(OrbPoint frameX, OrbPoint frameY)
{
    Handle h = Outline(0, 0, frameX, frameY);
    h.shape = HSH_Inside;
    return h;
}

// A quarter turn: the frame's X runs up the viewer.
constexpr OrbPoint kUp{0, 1}, kLeft{-1, 0};

// The crosshair's Y arm: a press reaches to its tip, a hover a tolerance on.
const Handle kArm = Box({}, {0, 23}, HG_Left | HG_Right | HG_Bottom);

struct Row
{
    const char *name;
    Handle handle;
    OrbPoint mouse; // minus the anchor at 0, 0; viewer units
    float64 scale;
    HandleGeometry::Reach reach;
    bool hit;
};

// The viewer's tolerance is 6 in every row.
const Row kRows[] = {
    {"centre: 5, 5 is in (a square, not a circle)", Box({}, {}), {5, 5}, 1, HandleGeometry::Press, true},
    {"centre: 6 across is out (strict)", Box({}, {}), {6, 0}, 1, HandleGeometry::Press, false},
    {"centre: -5.9 is in", Box({}, {}), {-5.9, 0}, 1, HandleGeometry::Press, true},
    {"arm: a press 22 up grabs", kArm, {0, 22}, 1, HandleGeometry::Press, true},
    {"arm: a press at the tip, 23, does not", kArm, {0, 23}, 1, HandleGeometry::Press, false},
    {"arm: a hover 28 up still does", kArm, {0, 28}, 1, HandleGeometry::Hover, true},
    {"arm: a hover at 23 + 6 does not", kArm, {0, 29}, 1, HandleGeometry::Hover, false},
    {"arm: scale 2 reaches 46", kArm, {0, 45}, 2, HandleGeometry::Press, true},
    {"arm: below the centre, the tolerance", kArm, {0, -6}, 1, HandleGeometry::Press, false},
    {"pixel square: 5.9 truncates to 5", Shaped(HSH_PixelSquare, 0), {5.9, -5.9}, 1, HandleGeometry::Press, true},
    {"pixel square: 6 is out", Shaped(HSH_PixelSquare, 0), {0, 6}, 1, HandleGeometry::Press, false},
    {"pixel square: 5.7 within 5.5, by truncation",
     Shaped(HSH_PixelSquare, 0, {}, 5.5),
     {5.7, 0},
     1,
     HandleGeometry::Press,
     true},
    {"box: 5.7 not within 5.5",
     [] {
         Handle h = Box({}, {});
         h.tolerance = 5.5;
         return h;
     }(),
     {5.7, 0},
     1,
     HandleGeometry::Press,
     false},
    {"ring 50: 56 out is on it (closed)", Shaped(HSH_Ring, 50), {56, 0}, 1, HandleGeometry::Press, true},
    {"ring 50: 57 out is off", Shaped(HSH_Ring, 50), {0, 57}, 1, HandleGeometry::Press, false},
    {"ring 50: 43 in is off", Shaped(HSH_Ring, 50), {-43, 0}, 1, HandleGeometry::Press, false},
    {"ring 50 at scale 2: 100 out", Shaped(HSH_Ring, 50), {60, 80}, 2, HandleGeometry::Press, true},
    {"disc 4: 10 away", Shaped(HSH_Disc, 4), {6, 8}, 1, HandleGeometry::Press, true},
    {"disc 4: 10.1 away", Shaped(HSH_Disc, 4), {10.1, 0}, 1, HandleGeometry::Press, false},
    {"band: 5.9 beside it", Shaped(HSH_Band, 0, {100, 0}), {50, 5.9}, 1, HandleGeometry::Press, true},
    {"band: 6 beside it", Shaped(HSH_Band, 0, {100, 0}), {50, -6}, 1, HandleGeometry::Press, false},
    {"band: past its end", Shaped(HSH_Band, 0, {100, 0}), {101, 0}, 1, HandleGeometry::Press, false},
    {"band: runs on by 3 handle pixels", Shaped(HSH_Band, 3, {100, 0}), {-3, 0}, 1, HandleGeometry::Press, true},
    {"band: slanted", Shaped(HSH_Band, 0, {30, 40}), {15 + 4, 20 - 3}, 1, HandleGeometry::Press, true},
    {"outline turned: the +X edge is above", Outline(1, 0, kUp, kLeft), {0, 43}, 1, HandleGeometry::Press, true},
    {"outline turned: 46 up is past its reach", Outline(1, 0, kUp, kLeft), {0, 46}, 1, HandleGeometry::Hover, false},
    {"outline: where both edges meet, not the edge",
     Outline(1, 0, kUp, kLeft),
     {-22, 42},
     1,
     HandleGeometry::Press,
     false},
    {"outline: where both edges meet, the corner",
     Outline(1, 1, kUp, kLeft),
     {-22, 42},
     1,
     HandleGeometry::Press,
     true},
    {"outline: reach per frame axis", Outline(0, 1, {1, 0}, {0, 1}, {3, 12}), {0, 31}, 1, HandleGeometry::Press, true},
    {"outline: a frame stretched twice across",
     Outline(1, 0, {0.5, 0}, {0, 1}),
     {85, 0},
     1,
     HandleGeometry::Press,
     true},
    {"inside turned: 45 up is within the reach", Inside(kUp, kLeft), {-25, 45}, 1, HandleGeometry::Press, true},
    {"inside turned: 47 up is past it", Inside(kUp, kLeft), {0, 47}, 1, HandleGeometry::Press, false},
    {"inside turned: 27 across is past it", Inside(kUp, kLeft), {27, 0}, 1, HandleGeometry::Hover, false},
    {"outline: a rounded edge stops short",
     Outline(1, 0, {1, 0}, {0, 1}, {6, 6}, 10),
     {40, 17},
     1,
     HandleGeometry::Press,
     false},
    {"outline: the rounded corner reaches in",
     Outline(1, 1, {1, 0}, {0, 1}, {6, 6}, 10),
     {32, 12},
     1,
     HandleGeometry::Press,
     true},
};

TEST(HandleGeometryTest, HitsByShape)
{
    for (const Row &row : kRows) {
        SCOPED_TRACE(row.name);
        EXPECT_EQ(HandleGeometry::Hits(row.handle, row.mouse, row.scale, 6.0, row.reach), row.hit);
    }
}

struct OutlineRow
{
    const char *name;
    OrbPoint local; // frame units from the middle of a box of half sides 100 x 50
    OrbPoint reach;
    float64 round; // corner radius
    OrbPointI sides;
};

const OutlineRow kOutlineRows[] = {
    {"+X edge", {100, 0}, {6, 6}, 0, {1, 0}},
    {"+X edge, just inside the reach", {105.9, 20}, {6, 6}, 0, {1, 0}},
    {"+X edge, at the reach: a miss", {106, 0}, {6, 6}, 0, {0, 0}},
    {"-X edge from inside", {-95, -10}, {6, 6}, 0, {-1, 0}},
    {"+Y edge", {0, 50}, {6, 6}, 0, {0, 1}},
    {"-Y edge", {30, -53}, {6, 6}, 0, {0, -1}},
    {"corner +X+Y", {102, 48}, {6, 6}, 0, {1, 1}},
    {"corner -X+Y", {-100, 50}, {6, 6}, 0, {-1, 1}},
    {"corner -X-Y", {-104, -55}, {6, 6}, 0, {-1, -1}},
    {"corner +X-Y", {99, -51}, {6, 6}, 0, {1, -1}},
    {"inside", {0, 0}, {6, 6}, 0, {0, 0}},
    {"past the end of an edge", {100, 57}, {6, 6}, 0, {0, 0}},
    {"reach per axis: Y wide", {0, 61}, {3, 12}, 0, {0, 1}},
    {"reach per axis: X narrow", {103.5, 0}, {3, 12}, 0, {0, 0}},
    // Rounded by 25: the edges stop that far short of the corners.
    {"rounded: the edge stops short", {100, 40}, {6, 6}, 25, {0, 0}},
    {"rounded: by the rounding centre", {80, 30}, {6, 6}, 25, {1, 1}},
    {"rounded: -X-Y likewise", {-80, -30}, {6, 6}, 25, {-1, -1}},
};

TEST(HandleGeometryTest, OutlineSides)
{
    for (const OutlineRow &row : kOutlineRows) {
        SCOPED_TRACE(row.name);
        EXPECT_EQ(HandleGeometry::OutlineSides(row.local, {100, 50}, row.reach, row.round), row.sides);
        // Negative half sides draw the same box, so they hit the same.
        EXPECT_EQ(HandleGeometry::OutlineSides(row.local, {-100, -50}, row.reach, row.round), row.sides);
    }
}

// Whatever a handle answers, the viewer's spatial index must find it by its
// extent: every hit lies inside.
TEST(HandleGeometryTest, EveryHitLiesInTheExtent)
{
    for (const Row &row : kRows) {
        SCOPED_TRACE(row.name);
        Handle h = row.handle;
        h.at = {100.25, -40.5};
        if (h.shape == HSH_Band)
            h.end = h.end + h.at;
        const OrbRect extent = HandleGeometry::Extent(h, row.scale, 6.0);
        int hits = 0;
        for (float64 y = -130; y <= 130; y += 0.75)
            for (float64 x = -130; x <= 130; x += 0.75) {
                const OrbPoint mouse = h.at + OrbPoint(x, y);
                if (HandleGeometry::Hits(h, mouse, row.scale, 6.0, HandleGeometry::Hover)) {
                    ++hits;
                    ASSERT_TRUE(extent.Contains(mouse)) << x << ", " << y;
                }
            }
        EXPECT_GT(hits, 0);
    }
}

} // namespace
