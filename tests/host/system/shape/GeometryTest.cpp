#include "ShapeTestUtil.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"

#include <gtest/gtest.h>

#include <cmath>

namespace Orbane::ShapeTests {

namespace {

constexpr float64 kPi = 3.14159265358979323846;

struct ClosestCase
{
    const char *name;
    OrbPoint query;
    OrbPoint expect;
    float64 par;
};

class Closest : public ::testing::TestWithParam<ClosestCase>
{
};

TEST_P(Closest, FindsTheNearestPlaceOnASquare)
{
    const ClosestCase &c = GetParam();
    AutoRef<PolyLine> square = MakeShape({{0, 0}, {1, 0}, {1, 1}, {0, 1}}, true);
    float64 px = 0, py = 0, par = 0;
    const float64 d = square->CalcClosestPoint(c.query.x, c.query.y, px, py, &par);
    EXPECT_NEAR(px, c.expect.x, 1e-7);
    EXPECT_NEAR(py, c.expect.y, 1e-7);
    // Straight segments with handles on their ends are not evenly
    // parameterised: check the place the parameter names.
    EXPECT_EQ(int(par), int(c.par));
    EXPECT_NEAR((square->ValueAt(par) - c.expect).Length(), 0.0, 1e-7);
    EXPECT_NEAR(d, (c.query - c.expect).Length(), 1e-7);
}

INSTANTIATE_TEST_SUITE_P(Square, Closest,
                         ::testing::Values(ClosestCase{"Below", {0.5, -1}, {0.5, 0}, 0.5},
                                           ClosestCase{"Right", {2, 0.25}, {1, 0.25}, 1.25},
                                           ClosestCase{"InsideNearBottom", {0.3, 0.2}, {0.3, 0}, 0.3},
                                           ClosestCase{"InsideNearLeft", {0.1, 0.7}, {0, 0.7}, 3.3},
                                           ClosestCase{"OnTheClosingEdge", {0, 0.5}, {0, 0.5}, 3.5}),
                         [](const auto &info) { return std::string(info.param.name); });

// The segment index must find what a walk over every segment finds.
TEST(ClosestIndex, AgreesWithDenseSamplingOnAWigglyShape)
{
    AutoRef<PolyLine> s(new PolyLine);
    for (int i = 0; i < 400; ++i) {
        const float64 a = i * 2 * kPi / 400, r = 0.3 + 0.1 * std::sin(7 * a);
        s->AddPoint(PolyPoint(0.5 + r * std::cos(a), 0.5 + r * std::sin(a)));
    }
    s->Close();
    s->Smooth(nullptr);
    const std::vector<OrbPoint> dense = s->GetSamplePoints(200);
    for (int q = 0; q < 50; ++q) {
        const OrbPoint p(0.1 + 0.8 * ((q * 37) % 50) / 50.0, 0.1 + 0.8 * ((q * 13) % 50) / 50.0);
        float64 best = 1e9;
        for (const OrbPoint &d : dense)
            best = std::min(best, (d - p).Length());
        float64 px, py;
        EXPECT_NEAR(s->CalcClosestPoint(p.x, p.y, px, py), best, 1e-5) << p.x << "," << p.y;
    }
}

TEST(Length, CircleOfEightArcsWithinATenThousandth)
{
    AutoRef<PolyLine> circle(new PolyLine);
    ASSERT_TRUE(circle->MakeEllipse(0.5, 0.5, 0.25, 0.25, 8));
    EXPECT_NEAR(circle->CalcLength(), 2 * kPi * 0.25, 1e-4);
    // Half-way along the path from the start (angle 0) is the opposite side.
    float64 par = 0;
    const OrbPoint half = circle->GetPointOnPath(circle->CalcLength() / 2, &par);
    EXPECT_NEAR(half.x, 0.25, 1e-4);
    EXPECT_NEAR(half.y, 0.5, 1e-4);
    EXPECT_NEAR(par, 4.0, 1e-4);
    EXPECT_NEAR(circle->Distance(0, 2), circle->CalcLength() / 4, 1e-9);
}

TEST(Convert, BSplineToBezierToBSplineRoundTrip)
{
    AutoRef<BSplinePolyLine> bs =
        MakeShape<BSplinePolyLine>({{0.1, 0.1}, {0.9, 0.2}, {0.7, 0.8}, {0.2, 0.6}, {0.4, 0.4}}, true);
    AutoRef<PolyLine> bez(bs->Convert(CLSID_DataType_Polyline));
    ASSERT_TRUE(bez.IsValid());
    EXPECT_EQ(bez->DataType(), CLSID_DataType_Polyline);
    // The same curve everywhere, not only at the knots.
    for (float64 par = 0; par <= 5.0; par += 0.125)
        EXPECT_NEAR((bez->ValueAt(par) - bs->ValueAt(par)).Length(), 0.0, 1e-12) << par;
    AutoRef<PolyLine> back(bez->Convert(CLSID_DataType_BSplinePolyline));
    ASSERT_EQ(back->GetCount(), bs->GetCount());
    for (int32 i = 0; i < bs->GetCount(); ++i)
        EXPECT_NEAR((back->GetPoint(i)->Pos() - bs->GetPoint(i)->Pos()).Length(), 0.0, 1e-12) << i;
    AutoRef<PolyLine> again(back->Convert(CLSID_DataType_Polyline));
    for (int32 i = 0; i < bez->GetCount(); ++i) {
        EXPECT_NEAR((again->GetPoint(i)->Out() - bez->GetPoint(i)->Out()).Length(), 0.0, 1e-12) << i;
        EXPECT_NEAR((again->GetPoint(i)->In() - bez->GetPoint(i)->In()).Length(), 0.0, 1e-12) << i;
    }
}

TEST(Convert, OpenBSplineKeepsItsEndsThroughBezier)
{
    AutoRef<BSplinePolyLine> bs = MakeShape<BSplinePolyLine>({{0, 0}, {0.5, 1}, {1, 0}, {1.5, 0.5}}, false);
    AutoRef<PolyLine> bez(bs->Convert(CLSID_DataType_Polyline));
    EXPECT_EQ(bez->First()->Pos(), OrbPoint(0, 0));
    EXPECT_NEAR((bez->Last()->Pos() - OrbPoint(1.5, 0.5)).Length(), 0.0, 1e-12);
    for (float64 par = 0; par <= 3.0; par += 0.25)
        EXPECT_NEAR((bez->ValueAt(par) - bs->ValueAt(par)).Length(), 0.0, 1e-12) << par;
}

// A wobbly freehand circle of 5000 samples with pen pressure.
std::vector<PolyPoint> Stroke(int count)
{
    std::vector<PolyPoint> samples;
    for (int i = 0; i < count; ++i) {
        const float64 a = i * 2 * kPi / count;
        PolyPoint p(500 + 200 * std::cos(a) + 3 * std::sin(40 * a), 400 + 150 * std::sin(a));
        p.Pressure = 0.5 + 0.5 * i / count;
        p.Time = i * 0.01;
        samples.push_back(p);
    }
    return samples;
}

struct ReduceCase
{
    const char *name;
    float64 tolerance;
    int maxKeys;
};

class Reduce : public ::testing::TestWithParam<ReduceCase>
{
};

TEST_P(Reduce, FewKeysWithinTolerance)
{
    const ReduceCase &c = GetParam();
    const std::vector<PolyPoint> samples = Stroke(5000);
    AutoRef<PolyLine> s(new PolyLine);
    // Pixels two image units across: the tolerance is in pixels.
    std::vector<PolyPoint> image = samples;
    for (PolyPoint &p : image)
        p.X *= 2.0, p.Y *= 2.0;
    ASSERT_TRUE(s->SetReducedPoints(image, c.tolerance, 2.0, 2.0));
    EXPECT_LE(s->GetCount(), c.maxKeys);
    EXPECT_GE(s->GetCount(), 4);
    for (std::size_t i = 0; i < image.size(); i += 7) {
        float64 px, py;
        s->CalcClosestPoint(image[i].X, image[i].Y, px, py);
        const float64 pixels = std::hypot(px - image[i].X, py - image[i].Y) / 2.0;
        ASSERT_LE(pixels, c.tolerance * 1.01) << i;
    }
    EXPECT_EQ(s->First()->Time, 0.0);
    EXPECT_DOUBLE_EQ(s->Last()->Pressure, samples.back().Pressure);
}

INSTANTIATE_TEST_SUITE_P(Stroke, Reduce,
                         ::testing::Values(ReduceCase{"Loose", 4.0, 120}, ReduceCase{"Tight", 1.0, 400},
                                           ReduceCase{"Smooth", 8.0, 60}),
                         [](const auto &info) { return std::string(info.param.name); });

TEST(Expand, GrowsACircleByTheAmountAndShrinksItAway)
{
    AutoRef<PolyLine> circle(new PolyLine);
    circle->MakeEllipse(0.5, 0.5, 0.1, 0.1, 8);
    AutoRef<PolyLine> outer(circle->Expand(0.05));
    ASSERT_TRUE(outer.IsValid());
    EXPECT_TRUE(outer->IsClosed());
    for (const OrbPoint &p : outer->GetSamplePoints(8))
        EXPECT_NEAR((p - OrbPoint(0.5, 0.5)).Length(), 0.15, 5e-4);
    EXPECT_EQ(AutoRef<PolyLine>(circle->Expand(-0.2)).get(), nullptr);
}

TEST(Handles, LinearSmoothAndTension)
{
    AutoRef<PolyLine> s = MakeShape({{0, 0}, {1, 0}, {2, 1}}, false);
    const uint8 middle[] = {0, 1, 0};
    ASSERT_TRUE(s->Smooth(middle));
    const PolyPoint &m = *s->GetPoint(1);
    // Along the line from the previous to the next point.
    EXPECT_NEAR((m.Out() - m.Pos()).x * 1.0, (m.Out() - m.Pos()).y * 2.0, 1e-12);
    EXPECT_NEAR((m.Out() - m.Pos()).Length(), std::sqrt(2.0) / 3, 1e-12);
    EXPECT_NEAR((m.In() - m.Pos()).Length(), 1.0 / 3, 1e-12);
    ASSERT_TRUE(s->Tensioning(middle, 0.5));
    EXPECT_NEAR((s->GetPoint(1)->In() - m.Pos()).Length(), 1.0 / 6, 1e-12);
    ASSERT_TRUE(s->Linear(middle));
    EXPECT_EQ(s->GetPoint(1)->Out(), s->GetPoint(1)->Pos());
    EXPECT_TRUE(s->GetPoint(1)->Flags & PPF_Linear);
    EXPECT_FALSE(s->Linear(middle));
}

TEST(Following, OuterShapeKeepsItsOffsetsWhenTheInnerMoves)
{
    AutoRef<PolyLine> inner = MakeShape({{0.4, 0.4}, {0.6, 0.4}, {0.5, 0.6}}, true);
    AutoRef<PolyLine> outer(inner->Expand(0.0));
    outer->Copy(*inner);
    outer->MovePoints(nullptr, 0.0, -0.05);
    ASSERT_TRUE(outer->SetFollowingPointsOrg(*inner));
    const uint8 first[] = {1, 0, 0};
    inner->MovePoints(first, 0.1, 0.0);
    ASSERT_TRUE(outer->UpdateShape(*inner));
    EXPECT_NEAR(outer->GetPoint(0)->X, 0.5, 1e-12);
    EXPECT_NEAR(outer->GetPoint(0)->Y, 0.35, 1e-12);
    EXPECT_NEAR(outer->GetPoint(1)->X, 0.6, 1e-12);
    EXPECT_EQ(outer->FindExternFollowingPoint(*inner, 2), 2);
}

TEST(Publishing, NumbersPointsAndFindsThem)
{
    AutoRef<PolyLine> s = MakeShape({{0, 0}, {1, 0}, {1, 1}}, true);
    const uint8 ends[] = {1, 0, 1};
    EXPECT_EQ(s->PublishPoints(ends), 2);
    EXPECT_EQ(s->GetPublishedPoint(2), 2);
    const uint8 second[] = {0, 1, 0};
    EXPECT_EQ(s->PublishPoints(second), 1);
    EXPECT_EQ(s->GetPoint(1)->TagID, 3);
    EXPECT_EQ(s->GetSelectedPublishedPoint(second), 3);
    EXPECT_TRUE(s->UnpublishPoints(ends));
    EXPECT_EQ(s->GetPublishedPoint(1), -1);
    EXPECT_EQ(PolyLine::PublishedPointInputID(3), OrbID("Point3"));
}

// A published point and the tool's point Input of its number move each other.
TEST(Publishing, PointInputsFollowAndLead)
{
    AutoRef<Operator> tool(new Operator("Roto1", "Roto"));
    Input *in = tool->AddInput(OrbID("Point3"), "Point3", CLSID_DataType_Point, TagList(), AutoPoint(0, 0).get());
    AutoRef<PolyLine> s = MakeShape({{0, 0}, {1, 0, 0.9, 0, 1.1, 0}, {1, 1}}, true);
    const uint8 second[] = {0, 1, 0};
    s->PublishPoints(second, 3);
    EXPECT_EQ(s->UpdatePublishedPointInputs(*tool, 0.0), 1);
    EXPECT_EQ(AutoPoint(in, 0.0)->X, 1.0);
    in->SetValue(AutoPoint(0.5, 0.25).get(), 0.0);
    ASSERT_TRUE(s->UpdatePublish(*tool, 0.0));
    EXPECT_EQ(s->GetPoint(1)->Pos(), OrbPoint(0.5, 0.25));
    EXPECT_NEAR((s->GetPoint(1)->Out() - OrbPoint(0.6, 0.25)).Length(), 0.0, 1e-12);
    EXPECT_FALSE(s->UpdatePublish(*tool, 0.0));
}

TEST(Makers, SpiralRunsFromInnerToOuterRadius)
{
    AutoRef<PolyLine> s(new PolyLine);
    ASSERT_TRUE(s->MakeSpiral(0.5, 0.5, 0.05, 0.25, 2.0, 8));
    EXPECT_FALSE(s->IsClosed());
    EXPECT_EQ(s->GetCount(), 17);
    EXPECT_NEAR((s->First()->Pos() - OrbPoint(0.55, 0.5)).Length(), 0.0, 1e-12);
    EXPECT_NEAR((s->Last()->Pos() - OrbPoint(0.75, 0.5)).Length(), 0.0, 1e-12);
    // Half way round the first turn the radius has grown by a quarter of the way.
    EXPECT_NEAR((s->ValueAt(4.0) - OrbPoint(0.5, 0.5)).Length(), 0.1, 1e-12);
    ASSERT_TRUE(s->MakeArrow(0, 0, 1, 0, 0.1, 0.3, 0.2));
    EXPECT_EQ(s->GetCount(), 7);
    EXPECT_EQ(s->GetPoint(3)->Pos(), OrbPoint(1, 0));
    EXPECT_FALSE(s->MakeRectangle(0.5, std::nan(""), 1, 1));
    EXPECT_EQ(s->GetCount(), 7);
}

} // namespace

} // namespace Orbane::ShapeTests
