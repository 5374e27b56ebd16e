#include "orbane/ViewCamera.h"
#include "orbane/ScriptVal.h"

#include <gtest/gtest.h>

#include <ostream>

namespace Orbane {
namespace {

// A 400 x 200 image at zoom 1: one world unit (an image width) is 400
// viewer units across, and a Y offset of one world unit is two image
// heights. Pixels twice as wide double that share again.
ViewMapping Square()
{
    return ViewMapping(400, 200, 1.0, 1.0, {0.0, 0.0}, 200.0);
}

ViewMapping Anamorphic()
{
    return ViewMapping(400, 200, 2.0, 1.0, {0.0, 0.0}, 200.0);
}

ViewCamera At(OrbVec3 position, OrbVec3 rotation, float64 focal = 36.0)
{
    ViewCamera c;
    c.position = position;
    c.rotation = rotation;
    c.focal = focal;
    return c;
}

struct ProjectCase
{
    const char *name;
    ViewCamera camera;
    bool anamorphic;
    OrbVec3 world;
    bool seen;
    OrbPoint image; // worked by hand: 0.5 + (f / A) * x / depth across, Y times SpanX / SpanY
};

std::ostream &operator<<(std::ostream &os, const ProjectCase &c)
{
    return os << c.name;
}

constexpr float64 kD = 50.0 / 36.0; // the default view's distance

class Projection : public testing::TestWithParam<ProjectCase>
{
};

TEST_P(Projection, MatchesThePinhole)
{
    const ProjectCase &c = GetParam();
    OrbPoint image(-7, -7);
    ASSERT_EQ(c.camera.Project(c.world, c.anamorphic ? Anamorphic() : Square(), image), c.seen);
    if (!c.seen)
        return;
    EXPECT_NEAR(image.x, c.image.x, 1e-12);
    EXPECT_NEAR(image.y, c.image.y, 1e-12);
}

INSTANTIATE_TEST_SUITE_P(
    ViewCamera, Projection,
    testing::Values(
        ProjectCase{"default view: the origin is the image's centre",
                    ViewCamera::Default(),
                    false,
                    {0, 0, 0},
                    true,
                    {0.5, 0.5}},
        ProjectCase{"default view: the plane z = 0 lies on the image",
                    ViewCamera::Default(),
                    false,
                    {0.25, 0.1, 0},
                    true,
                    {0.75, 0.7}},
        ProjectCase{"twice as far: half as far out", ViewCamera::Default(), false, {0.25, 0, -kD}, true, {0.625, 0.5}},
        ProjectCase{"focal = aperture at the origin", At({0, 0, 0}, {0, 0, 0}), false, {1, 0.5, -2}, true, {1.0, 1.0}},
        ProjectCase{
            "panned a quarter turn: looks down -X", At({0, 0, 0}, {0, 90, 0}), false, {-2, 0, 1}, true, {0.0, 0.5}},
        ProjectCase{"tilted a quarter turn: looks up",
                    At({0, 0, 0}, {90, 0, 0}),
                    false,
                    {0, 3, 0.5},
                    true,
                    {0.5, 0.5 + 2.0 * 0.5 / 3.0}},
        ProjectCase{"rolled a quarter turn: X goes up",
                    At({0, 0, 0}, {0, 0, 90}),
                    false,
                    {0.5, 0, -1},
                    true,
                    {0.5, 0.5 - 2.0 * 0.5}},
        ProjectCase{"wide pixels: Y reaches four image heights",
                    At({0, 0, 0}, {0, 0, 0}),
                    true,
                    {0, 0.5, -2},
                    true,
                    {0.5, 0.5 + 4.0 * 0.25}},
        ProjectCase{"behind the camera: clipped", ViewCamera::Default(), false, {0, 0, 5}, false, {}},
        ProjectCase{"nearer than the near plane: clipped", ViewCamera::Default(), false, {0, 0, kD - 0.005}, false, {}},
        ProjectCase{"not a number: nothing", ViewCamera::Default(), false, {NAN, 0, 0}, false, {}},
        ProjectCase{
            "a camera with no focal length: nothing", At({0, 0, 0}, {0, 0, 0}, 0.0), false, {0, 0, -1}, false, {}}));

TEST(ViewCamera, SegmentsAreClippedAtTheNearPlane)
{
    const ViewCamera c = ViewCamera::Default();
    OrbPoint a, b;
    // Half of it behind the camera: the far end is cut where it crosses the
    // near plane, a finite point well off the image.
    ASSERT_TRUE(c.ProjectSegment({0.1, 0, 0}, {0.1, 0, 3}, Square(), a, b));
    EXPECT_NEAR(a.x, 0.6, 1e-12);
    EXPECT_NEAR(b.x, 0.5 + kD * 0.1 / c.nearPlane, 1e-9);
    // The same the other way round.
    ASSERT_TRUE(c.ProjectSegment({0.1, 0, 3}, {0.1, 0, 0}, Square(), a, b));
    EXPECT_NEAR(b.x, 0.6, 1e-12);
    EXPECT_NEAR(a.x, 0.5 + kD * 0.1 / c.nearPlane, 1e-9);
    // Wholly behind: nothing.
    EXPECT_FALSE(c.ProjectSegment({0, 0, 2}, {1, 1, 3}, Square(), a, b));
}

// Rays, planes and lines are the projection run backwards.
TEST(ViewCamera, RaysFindWhatWasProjected)
{
    const ViewCamera c = At({0.3, -0.2, 2}, {10, -20, 5}, 40);
    const OrbVec3 world(0.1, 0.2, -0.4);
    OrbPoint image;
    ASSERT_TRUE(c.Project(world, Anamorphic(), image));
    OrbVec3 hit;
    ASSERT_TRUE(c.OnPlane(image, Anamorphic(), world, {0.3, 0.4, 0.5}, hit));
    EXPECT_NEAR((hit - world).Length(), 0.0, 1e-9);
    float64 t = 0.0;
    ASSERT_TRUE(c.OnLine(image, Anamorphic(), world - OrbVec3(1, 0, 0) * 0.7, {1, 0, 0}, t));
    EXPECT_NEAR(t, 0.7, 1e-9);
    // A plane seen edge on, and a line along the ray, give no answer.
    OrbVec3 o, d;
    ASSERT_TRUE(c.Ray(image, Anamorphic(), o, d));
    EXPECT_FALSE(c.OnPlane(image, Anamorphic(), world, d.Cross({0, 1, 0}), hit));
    EXPECT_FALSE(c.OnLine(image, Anamorphic(), world, d, t));
}

TEST(ViewCamera, AimsAtAPoint)
{
    for (const OrbVec3 to : {OrbVec3(1, 0, 0), OrbVec3(0, 1, 0), OrbVec3(-0.3, 0.2, 0.9), OrbVec3(0, 0, -4)}) {
        ViewCamera c;
        c.position = OrbVec3(0.2, 0.1, -0.3);
        c.rotation = ViewCamera::AimAt(c.position, c.position + to, 0.0);
        EXPECT_NEAR((c.Forward() - to.Normalized()).Length(), 0.0, 1e-12);
        OrbPoint image;
        ASSERT_TRUE(c.Project(c.position + to, Square(), image));
        EXPECT_NEAR(image.x, 0.5, 1e-12);
        EXPECT_NEAR(image.y, 0.5, 1e-12);
    }
    EXPECT_EQ(ViewCamera::AimAt({1, 2, 3}, {1, 2, 3}, 7.0), OrbVec3(0, 0, 7.0)) << "no direction: level";
}

TEST(ViewCamera, ReadsAndWritesTables)
{
    ScriptVal t = ScriptVal::NewTable();
    ScriptVal p = ScriptVal::NewTable();
    p.Append(ScriptVal(1.0));
    p.Append(ScriptVal(2.0));
    p.Append(ScriptVal(3.0));
    t.SetKey(ScriptVal("position"), p);
    t.SetKey(ScriptVal("fov"), ScriptVal(90.0));
    t.SetKey(ScriptVal("near"), ScriptVal("far")); // not a number: kept
    const ViewCamera c = ViewCamera::FromTable(t);
    EXPECT_EQ(c.position, OrbVec3(1, 2, 3));
    EXPECT_NEAR(c.focal, 18.0, 1e-12);
    EXPECT_NEAR(c.FieldOfView(), 90.0, 1e-12);
    EXPECT_EQ(c.nearPlane, ViewCamera::Default().nearPlane);
    EXPECT_EQ(ViewCamera::FromTable(c.ToTable(), ViewCamera()), c) << "a round trip";
}

} // namespace
} // namespace Orbane
