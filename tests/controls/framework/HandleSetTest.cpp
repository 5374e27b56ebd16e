#include "framework/HandleSet.h"

#include <gtest/gtest.h>

using namespace Orbane;

namespace {

// A rectangle's parts as the rectangle overlay codes them: side bits 1 +X,
// 2 +Y, 4 -X, 8 -Y; corners combine two; 16 the body. Corners are added
// first and the body last: the priority, not the order, decides.
HandleSet Rectangle()
{
    HandleSet set;
    const float64 w = 50, h = 30;
    set.AddDisc({w, h}, 0, 3, HP_Corner);
    set.AddDisc({-w, h}, 0, 6, HP_Corner);
    set.AddDisc({-w, -h}, 0, 12, HP_Corner);
    set.AddDisc({w, -h}, 0, 9, HP_Corner);
    set.AddBand({w, -h}, {w, h}, 0, 1);
    set.AddBand({-w, h}, {w, h}, 0, 2);
    set.AddBand({-w, -h}, {-w, h}, 0, 4);
    set.AddBand({-w, -h}, {w, -h}, 0, 8);
    set.AddBox({}, {-w, -h}, {w, h}, 16, HP_Body, 0);
    return set;
}

TEST(HandleSetTest, EveryPartOfARectangle)
{
    const struct
    {
        OrbPoint mouse;
        uint32 part;
    } rows[] = {
        {{52, 0}, 1},
        {{0, 27}, 2},
        {{-50, 5}, 4},
        {{10, -35}, 8},
        {{50, 30}, 3},
        {{-52, 31}, 6},
        {{-46, -26}, 12},
        {{53, -33}, 9},
        {{0, 0}, 16},
        {{43, 0}, 16},
        {{47, 0}, 1}, // edge above body where both are
                      // hit
        {{57, 0}, 0},
        {{0, 40}, 0},
    };
    const HandleSet set = Rectangle();
    for (const auto &row : rows) {
        SCOPED_TRACE(testing::Message() << row.mouse.x << ", " << row.mouse.y);
        EXPECT_EQ(set.HitTest(row.mouse, 1.0, 6.0, HandleGeometry::Press).part, row.part);
    }
}

TEST(HandleSetTest, EqualPrioritiesGoToTheFirstAdded)
{
    HandleSet set;
    for (int32 i = 0; i < 3; ++i)
        set.AddPixelSquare({4.0 * i, 0}, 1).item = i;
    set.AddPixelSquare({14, 0}, 2, HP_Tangent).item = 7;
    EXPECT_EQ(set.HitTest({2, 0}, 1, 6, HandleGeometry::Press), (HandleHit{1, 0}));
    EXPECT_EQ(set.HitTest({7, 0}, 1, 6, HandleGeometry::Press), (HandleHit{1, 1}));
    EXPECT_EQ(set.HitTest({12, 0}, 1, 6, HandleGeometry::Press), (HandleHit{1, 2})); // a point above a tangent
    EXPECT_EQ(set.HitTest({18, 0}, 1, 6, HandleGeometry::Press), (HandleHit{2, 7}));
    EXPECT_FALSE(set.HitTest({40, 0}, 1, 6, HandleGeometry::Press));
}

TEST(HandleSetTest, StatesReportOnlyChanges)
{
    HandleSet set;
    const HandleHit a{1, -1}, b{1, 4};
    const struct
    {
        HandleHit poised;
        bool changed;
    } steps[] = {{a, true}, {a, false}, {b, true}, {{}, true}, {{}, false}};
    for (const auto &step : steps)
        EXPECT_EQ(set.SetPoised(step.poised), step.changed);
    EXPECT_TRUE(set.SetPoised(a));
    EXPECT_TRUE(set.SetPicked(b));
    EXPECT_FALSE(set.SetPicked(b));
    EXPECT_EQ(set.StateOf(1), HandleSet::HS_Poised);
    EXPECT_EQ(set.StateOf(1, 4), HandleSet::HS_Picked);
    EXPECT_EQ(set.StateOf(2), HandleSet::HS_Idle);
}

TEST(HandleSetTest, HighlightKeepsTheFadedAlpha)
{
    HandleSet set;
    set.SetPoised({2, -1});
    const Graphics::GColor fill(0.9f, 0.9f, 0.9f, 0.5f);
    EXPECT_EQ(set.FillOf(fill, 2), HandleSet::Highlight.WithAlpha(0.5f));
    EXPECT_EQ(set.FillOf(fill, 1), fill);
}

TEST(HandleSetTest, BoundsHoldEveryHandle)
{
    OrbRect bounds;
    EXPECT_FALSE(HandleSet().Bounds(1, 6, bounds));
    EXPECT_LT(bounds.x2, bounds.x1); // empty: never under the mouse
    ASSERT_TRUE(Rectangle().Bounds(1, 6, bounds));
    EXPECT_TRUE(bounds.Contains({-56, -36}) && bounds.Contains({56, 36}));
    EXPECT_FALSE(bounds.Contains({0, 45}));
}

} // namespace
