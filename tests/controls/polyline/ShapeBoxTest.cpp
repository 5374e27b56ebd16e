#include "polyline/ShapeBox.h"

#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

#include <gtest/gtest.h>

#include <cmath>

using namespace Orbane;

namespace {

// A box from (100, 50) to (300, 150), viewer units.
class ShapeBoxTest : public ::testing::Test
{
protected:
    void SetUp() override { box->SetPoints({{100, 150}, {300, 50}, {180, 90}}); }
    void TearDown() override { box->DecRef(); }

    OrbPoint Apply(const QTransform &t, OrbPoint p) const
    {
        const QPointF q = t.map(QPointF(p.x, p.y));
        return {q.x(), q.y()};
    }

    ShapeBox *box = new ShapeBox(nullptr, ScriptVal(), TagList());
};

struct HitRow
{
    const char *name;
    OrbPoint mouse;
    int32 part;
    int32 cursor;
};

class ShapeBoxHit : public ShapeBoxTest, public ::testing::WithParamInterface<HitRow>
{
};

TEST_P(ShapeBoxHit, PartAndCursorUnderTheMouse)
{
    EXPECT_EQ(box->HitTest(GetParam().mouse, 6.0), GetParam().part);
    EXPECT_EQ(ShapeBox::CursorOf(GetParam().part), GetParam().cursor);
}

INSTANTIATE_TEST_SUITE_P(Rows, ShapeBoxHit,
                         ::testing::Values(HitRow{"BottomLeftCorner", {102, 53}, ShapeBox::SBP_BottomLeft, 6},
                                           HitRow{"TopRightCorner", {296, 150}, ShapeBox::SBP_TopRight, 6},
                                           HitRow{"TopLeftCorner", {100, 146}, ShapeBox::SBP_TopLeft, 5},
                                           HitRow{"BottomEdgeMiddle", {200, 45}, ShapeBox::SBP_Bottom, 4},
                                           HitRow{"RightEdgeMiddle", {305, 100}, ShapeBox::SBP_Right, 3},
                                           HitRow{"SixPixelsOffMisses", {200, 156}, ShapeBox::SBP_None, 0},
                                           HitRow{"Inside", {150, 120}, ShapeBox::SBP_Inside, 7},
                                           HitRow{"JustOutsideACornerTurns", {88, 40}, ShapeBox::SBP_Rotate, 1},
                                           HitRow{"FarOutside", {60, 100}, ShapeBox::SBP_None, 0}),
                         [](const ::testing::TestParamInfo<HitRow> &row) { return std::string(row.param.name); });

TEST_F(ShapeBoxTest, EmptyHasNoHandles)
{
    box->SetPoints({});
    EXPECT_TRUE(box->IsEmpty());
    EXPECT_EQ(box->HitTest({200, 100}, 6.0), ShapeBox::SBP_None);
    EXPECT_TRUE(box->Drag(ShapeBox::SBP_Inside, {0, 0}, {10, 10}, false).isIdentity());
}

struct DragRow
{
    const char *name;
    int32 part;
    OrbPoint to; // from the handle (or the middle for inside), moved by
    bool keepAspect;
    OrbPoint point, expected; // a point of the selection before and after
};

class ShapeBoxDrag : public ShapeBoxTest, public ::testing::WithParamInterface<DragRow>
{
};

TEST_P(ShapeBoxDrag, MovesScalesAndTurns)
{
    const DragRow &row = GetParam();
    const OrbPoint from = row.part < 8 ? box->HandleAt(row.part) : OrbPoint(200, 100);
    const OrbPoint got = Apply(box->Drag(row.part, from, from + row.to, row.keepAspect), row.point);
    EXPECT_NEAR(got.x, row.expected.x, 1e-9);
    EXPECT_NEAR(got.y, row.expected.y, 1e-9);
}

INSTANTIATE_TEST_SUITE_P(
    Rows, ShapeBoxDrag,
    ::testing::Values(
        DragRow{"InsideMoves", ShapeBox::SBP_Inside, {15, -5}, false, {180, 90}, {195, 85}},
        // The right edge out by 100 doubles X about the left edge; Y stays.
        DragRow{"RightEdgeScalesXAboutTheLeft", ShapeBox::SBP_Right, {200, 40}, false, {200, 120}, {300, 120}},
        DragRow{"TopEdgeScalesYAboutTheBottom", ShapeBox::SBP_Top, {30, -50}, false, {200, 150}, {200, 100}},
        DragRow{"CornerScalesBothAboutTheOpposite", ShapeBox::SBP_TopRight, {-100, 100}, false, {300, 150}, {200, 250}},
        // Kept aspect: the larger factor (2 in Y) on both axes.
        DragRow{"CornerKeepingTheAspect", ShapeBox::SBP_TopRight, {-100, 100}, true, {300, 150}, {500, 250}},
        DragRow{"EdgeOntoItsOppositeFlattens", ShapeBox::SBP_Left, {200, 0}, false, {100, 60}, {300, 60}}));

// A quarter turn about the middle: from right of it to above it.
TEST_F(ShapeBoxTest, RingTurnsAboutTheMiddle)
{
    const QTransform t = box->Drag(ShapeBox::SBP_Rotate, {260, 100}, {200, 180}, false);
    const OrbPoint got = Apply(t, {300, 100});
    EXPECT_NEAR(got.x, 200, 1e-9);
    EXPECT_NEAR(got.y, 200, 1e-9);
}

} // namespace
