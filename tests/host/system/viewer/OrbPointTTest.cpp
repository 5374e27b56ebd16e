#include "orbane/OrbPointT.h"
#include "orbane/OrbRectT.h"

#include <gtest/gtest.h>

namespace Orbane {
namespace {

// Usable in constant expressions: overlays keep constant handle offsets.
constexpr OrbPoint Corner = OrbPoint(2, -2) * 3.0 + OrbPoint(1, 1);
static_assert(Corner == OrbPoint(7, -5));

TEST(OrbPointT, Arithmetic)
{
    OrbPoint a(1.5, -2.0);
    OrbPoint b(0.5, 4.0);
    EXPECT_EQ(a + b, OrbPoint(2.0, 2.0));
    EXPECT_EQ(a - b, OrbPoint(1.0, -6.0));
    EXPECT_EQ(-a, OrbPoint(-1.5, 2.0));
    EXPECT_EQ(a * 2.0, OrbPoint(3.0, -4.0));
    EXPECT_EQ(2.0 * a, a * 2.0);
    EXPECT_EQ(b / 0.5, OrbPoint(1.0, 8.0));
    EXPECT_EQ(a.Mul(b), OrbPoint(0.75, -8.0));
    EXPECT_EQ(b.Div(OrbPoint(0.5, 2.0)), OrbPoint(1.0, 2.0));
    EXPECT_DOUBLE_EQ(a.Dot(b), -7.25);
    EXPECT_DOUBLE_EQ(OrbPoint(3, 4).Length(), 5.0);
    a += b;
    a -= OrbPoint(1, 1);
    a *= 2.0;
    a /= 4.0;
    EXPECT_EQ(a, OrbPoint(0.5, 0.5));
}

TEST(OrbPointT, IntegerPointsConvertExplicitly)
{
    OrbPointI mouse(12, -7);
    OrbPoint precise(mouse);
    EXPECT_EQ(precise, OrbPoint(12.0, -7.0));
    EXPECT_EQ(OrbPointI(OrbPoint(3.9, -3.9)), OrbPointI(3, -3)) << "truncates, like a cast";
    EXPECT_EQ(OrbPointI(3, 4).LengthSquared(), 25);
}

TEST(OrbRectT, NormalisedAndContains)
{
    OrbRect r(5, 8, 1, 2);
    OrbRect n = r.Normalized();
    EXPECT_EQ(n, OrbRect(1, 2, 5, 8));
    EXPECT_DOUBLE_EQ(n.Width(), 4.0);
    EXPECT_DOUBLE_EQ(n.Height(), 6.0);
    EXPECT_EQ(n.Center(), OrbPoint(3, 5));
    EXPECT_TRUE(n.Contains({1, 8}));
    EXPECT_FALSE(n.Contains({0.99, 5}));
    EXPECT_FALSE(r.Contains({3, 5})) << "an unnormalised rectangle contains nothing";
}

} // namespace
} // namespace Orbane
