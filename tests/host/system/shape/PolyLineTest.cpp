#include "ShapeTestUtil.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/ScriptVal.h"
#include "orbane/Tags.h"
#include "orbane/ToolLoader.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace Orbane::ShapeTests {

namespace {

constexpr float64 kEps = 1e-9;

struct EvalCase
{
    const char *name;
    bool bspline;
    bool closed;
    std::vector<P> points;
    std::vector<float64> weights;
    float64 par;
    OrbPoint expect;
};

AutoRef<PolyLine> Build(const EvalCase &c)
{
    AutoRef<PolyLine> s(c.bspline ? new BSplinePolyLine : new PolyLine);
    for (std::size_t i = 0; i < c.points.size(); ++i) {
        PolyPoint p = c.points[i].Make();
        if (i < c.weights.size())
            p.Weight = c.weights[i];
        s->AddPoint(p);
    }
    if (c.closed)
        s->Close();
    return s;
}

class Evaluation : public ::testing::TestWithParam<EvalCase>
{
};

TEST_P(Evaluation, MeetsKnownPoint)
{
    const EvalCase &c = GetParam();
    const OrbPoint at = Build(c)->ValueAt(c.par);
    EXPECT_NEAR(at.x, c.expect.x, kEps);
    EXPECT_NEAR(at.y, c.expect.y, kEps);
}

const P kArchA(0, 0, 0, 0, 0, 1), kArchB(1, 0, 1, 1, 1, 0);
const std::vector<P> kSquare = {{0, 0}, {1, 0}, {1, 1}, {0, 1}};

INSTANTIATE_TEST_SUITE_P(
    Shapes, Evaluation,
    ::testing::Values(EvalCase{"BezierStart", false, false, {kArchA, kArchB}, {}, 0.0, {0, 0}},
                      EvalCase{"BezierMiddle", false, false, {kArchA, kArchB}, {}, 0.5, {0.5, 0.75}},
                      EvalCase{"BezierQuarter", false, false, {kArchA, kArchB}, {}, 0.25, {0.15625, 0.5625}},
                      EvalCase{"BezierPastEndClamps", false, false, {kArchA, kArchB}, {}, 7.0, {1, 0}},
                      EvalCase{"CornersGiveStraightLines", false, true, kSquare, {}, 2.5, {0.5, 1}},
                      EvalCase{"ClosingSegment", false, true, kSquare, {}, 3.5, {0, 0.5}},
                      EvalCase{"SinglePoint", false, false, {{0.3, 0.4}}, {}, 0.5, {0.3, 0.4}},
                      EvalCase{"BSplineClosedKnot", true, true, kSquare, {}, 0.0, {1.0 / 6, 1.0 / 6}},
                      EvalCase{"BSplineClosedMiddle", true, true, kSquare, {}, 0.5, {0.5, 1.0 / 24}},
                      EvalCase{"BSplineWeightPulls", true, true, kSquare, {2, 1, 1, 1}, 0.0, {0.1, 0.1}},
                      EvalCase{"BSplineOpenStartsOnEnd", true, false, kSquare, {}, 0.0, {0, 0}},
                      EvalCase{"BSplineOpenEndsOnEnd", true, false, kSquare, {}, 3.0, {0, 1}},
                      EvalCase{"BSplineOpenWeightedEnd", true, false, kSquare, {3, 1, 1, 1}, 0.0, {0, 0}}),
    [](const auto &info) { return std::string(info.param.name); });

TEST(PolyLineWalk, Next1StopsAtTheEndUnlessWrappingAClosedShape)
{
    AutoRef<PolyLine> open = MakeShape({{0, 0}, {1, 0}, {1, 1}}, false);
    int visited = 0;
    for (PolyPoint *p = open->First(); p; p = p->Next1(1, PWF_Wrap))
        ++visited;
    EXPECT_EQ(visited, 3);
    EXPECT_EQ(open->Last()->Next1(-2), open->First());

    AutoRef<PolyLine> closed = MakeShape({{0, 0}, {1, 0}, {1, 1}}, true);
    EXPECT_EQ(closed->Last()->Next1(1, PWF_Wrap), closed->First());
    EXPECT_EQ(closed->Last()->Next1(1, 0), nullptr);
    EXPECT_EQ(closed->GetSegmentsCount(), 3);
    EXPECT_EQ(open->GetSegmentsCount(), 2);
    PolyPoint copied = *open->First();
    EXPECT_EQ(copied.Next1(), nullptr);
}

TEST(PolyLineEdit, RefusesNonFiniteCoordinatesAndKeepsTheShape)
{
    AutoRef<PolyLine> s = MakeShape({{0, 0}, {1, 0}}, false);
    const float64 nan = std::numeric_limits<float64>::quiet_NaN();
    EXPECT_FALSE(s->AddPoint(PolyPoint(nan, 0.5)));
    PolyPoint badHandle(0.5, 0.5);
    badHandle.OutX = std::numeric_limits<float64>::infinity();
    EXPECT_FALSE(s->InsertPoint(1, badHandle));
    EXPECT_FALSE(s->MovePoints(nullptr, nan, 0.0));
    EXPECT_EQ(s->GetCount(), 2);
    EXPECT_EQ(s->ValueAt(1.0), OrbPoint(1, 0));
}

TEST(PolyLineEdit, InsertPointAtKeepsTheCurve)
{
    AutoRef<PolyLine> s = MakeShape({kArchA, kArchB}, false);
    AutoRef<PolyLine> before(static_cast<PolyLine *>(s->Clone()));
    ASSERT_EQ(s->InsertPointAt(0.3), 1);
    ASSERT_EQ(s->GetCount(), 3);
    for (float64 u : {0.1, 0.3, 0.6, 0.9}) {
        // The first half of the old segment is the new first segment.
        const float64 par = u <= 0.3 ? u / 0.3 : 1.0 + (u - 0.3) / 0.7;
        EXPECT_NEAR((s->ValueAt(par) - before->ValueAt(u)).Length(), 0.0, 1e-12) << u;
    }
}

TEST(PolyLineEdit, MoveAndDeleteFollowTheSelection)
{
    AutoRef<PolyLine> s = MakeShape({{0, 0}, {1, 0, 0.9, 0, 1.1, 0}, {1, 1}}, false);
    const uint8 middle[] = {0, 1, 0};
    ASSERT_TRUE(s->MovePoints(middle, 0.0, 0.5));
    EXPECT_EQ(s->GetPoint(1)->Pos(), OrbPoint(1, 0.5));
    EXPECT_EQ(s->GetPoint(1)->Out(), OrbPoint(1.1, 0.5));
    EXPECT_EQ(s->GetPoint(0)->Pos(), OrbPoint(0, 0));
    ASSERT_TRUE(s->DeletePoints(middle));
    EXPECT_EQ(s->GetCount(), 2);
    EXPECT_EQ(s->GetPoint(1)->Pos(), OrbPoint(1, 1));
    EXPECT_EQ(s->Last()->Next1(-1), s->First());
    const uint8 none[] = {0, 0};
    EXPECT_FALSE(s->DeletePoints(none));
}

struct MixCase
{
    const char *name;
    float64 t;
    OrbPoint first;
    OrbPoint handle;
};

class Interpolation : public ::testing::TestWithParam<MixCase>
{
};

// An animated shape Input blends its keys point by point, handles included.
TEST_P(Interpolation, BetweenKeysOfAnInput)
{
    const MixCase &c = GetParam();
    AutoRef<Operator> tool(new Operator("Roto1", "Roto"));
    AutoRef<PolyLine> empty(new PolyLine);
    Input *in = tool->AddInput(OrbID("Shape"), "Shape", CLSID_DataType_Polyline, TagList(), empty.get());
    ASSERT_TRUE(in);
    in->SetAnimated(true);
    AutoRef<PolyLine> a = MakeShape({{0, 0, 0, 0, 0.2, 0}, {1, 1}}, true);
    AutoRef<PolyLine> b = MakeShape({{1, 0, 1, 0, 1, 0.4}, {1, 1}}, true);
    ASSERT_TRUE(in->SetValue(a.get(), 10.0, SETVALUE_NoUndo));
    ASSERT_TRUE(in->SetValue(b.get(), 20.0, SETVALUE_NoUndo));
    AutoParam<PolyLine> at(in, 10.0 + 10.0 * c.t);
    ASSERT_TRUE(at.IsValid());
    EXPECT_NEAR(at->First()->X, c.first.x, kEps);
    EXPECT_NEAR(at->First()->Y, c.first.y, kEps);
    EXPECT_NEAR(at->First()->OutX, c.handle.x, kEps);
    EXPECT_NEAR(at->First()->OutY, c.handle.y, kEps);
    EXPECT_TRUE(at->IsClosed());
    EXPECT_EQ(at->IsFromSplineList(), c.t > 0.0 && c.t < 1.0);
}

INSTANTIATE_TEST_SUITE_P(Keys, Interpolation,
                         ::testing::Values(MixCase{"AtFirstKey", 0.0, {0, 0}, {0.2, 0}},
                                           MixCase{"Quarter", 0.25, {0.25, 0}, {0.4, 0.1}},
                                           MixCase{"Half", 0.5, {0.5, 0}, {0.6, 0.2}},
                                           MixCase{"AtLastKey", 1.0, {1, 0}, {1, 0.4}}),
                         [](const auto &info) { return std::string(info.param.name); });

TEST(PolyLineValue, DifferentPointCountsHoldTheEarlierKey)
{
    AutoRef<PolyLine> a = MakeShape({{0, 0}, {1, 1}}, false);
    AutoRef<PolyLine> b = MakeShape({{0, 0}, {1, 1}, {2, 0}}, false);
    AutoRef<PolyLine> mid(a->InterpolateWith(*b, 0.5));
    EXPECT_TRUE(*mid == *a);
    AutoRef<PolyLine> end(a->InterpolateWith(*b, 1.0));
    EXPECT_TRUE(*end == *b);
}

TEST(PolyLineValue, KindsAreDistinctValues)
{
    AutoRef<PolyLine> bezier = MakeShape({{0, 0}, {1, 1}}, false);
    AutoRef<BSplinePolyLine> bspline = MakeShape<BSplinePolyLine>({{0, 0}, {1, 1}}, false);
    EXPECT_FALSE(bezier->Equals(*bspline));
    AutoRef<Parameter> copy(bspline->Clone());
    EXPECT_EQ(copy->DataType(), CLSID_DataType_BSplinePolyline);
    EXPECT_TRUE(copy->Equals(*bspline));
}

// A tool file's shape Input: an empty shape without a default, and the
// readOnly mark as an attribute the overlay reads.
TEST(PolyLineValue, ToolFileDeclaresShapeInputs)
{
    ScriptVal guide = ScriptVal::NewTable();
    guide.SetKey("id", "Guide");
    guide.SetKey("type", "BSplinePolyLine");
    guide.SetKey("readOnly", true);
    ScriptVal mask = ScriptVal::NewTable();
    mask.SetKey("id", "Mask");
    mask.SetKey("type", "PolyLine");
    ScriptVal inputs = ScriptVal::NewTable();
    inputs.Append(guide);
    inputs.Append(mask);
    ScriptVal desc = ScriptVal::NewTable();
    desc.SetKey("inputs", inputs);
    std::string why;
    AutoRef<Operator> tool(ToolLoader::FromTable(desc, "Roto1", &why, "."));
    ASSERT_TRUE(tool.IsValid()) << why;
    Input *g = tool->FindInput(OrbID("Guide")), *m = tool->FindInput(OrbID("Mask"));
    EXPECT_TRUE(g->GetAttrs().GetBool(INPA_ReadOnly, false));
    EXPECT_FALSE(m->GetAttrs().GetBool(INPA_ReadOnly, false));
    AutoParam<BSplinePolyLine> value(g, 0.0);
    ASSERT_TRUE(value.IsValid());
    EXPECT_EQ(value->GetCount(), 0);
    EXPECT_EQ(AutoParam<PolyLine>(m, 0.0)->DataType(), CLSID_DataType_Polyline);
}

} // namespace

} // namespace Orbane::ShapeTests
