#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"

#include <gtest/gtest.h>

#include <functional>
#include <string>

namespace Orbane {
namespace {

using Make = std::function<Parameter *()>;

ScriptVal Table(std::initializer_list<std::pair<const char *, ScriptVal>> entries)
{
    ScriptVal t = ScriptVal::NewTable();
    for (const auto &e : entries)
        t.SetKey(ScriptVal(e.first), e.second);
    return t;
}

template <class P, class... A> Make New(A... args)
{
    return [=] { return new P(args...); };
}

struct InterpolateCase
{
    std::string name;
    Make from;
    Make to;
    float64 t;
    Make expected;
};

class InterpolateTest : public testing::TestWithParam<InterpolateCase>
{
};

TEST_P(InterpolateTest, BlendsOrSteps)
{
    const InterpolateCase &c = GetParam();
    AutoParameter from(c.from()), to(c.to()), expected(c.expected());
    AutoParameter got(from->Interpolate(*to, c.t));
    ASSERT_TRUE(got.IsValid());
    EXPECT_EQ(got->DataType(), expected->DataType());
    EXPECT_TRUE(got->Equals(*expected));
    EXPECT_NE(got.get(), from.get());
    EXPECT_NE(got.get(), to.get());
}

INSTANTIATE_TEST_SUITE_P(
    Kinds, InterpolateTest,
    testing::Values(
        InterpolateCase{"NumberQuarter", New<Number>(2), New<Number>(6), 0.25, New<Number>(3)},
        InterpolateCase{"PointHalf", New<Point>(0, 1, 2), New<Point>(1, 3, -2), 0.5, New<Point>(0.5, 2, 0)},
        InterpolateCase{"TextHoldsBeforeEnd", New<Text>("a"), New<Text>("b"), 0.99, New<Text>("a")},
        InterpolateCase{"TextStepsAtEnd", New<Text>("a"), New<Text>("b"), 1.0, New<Text>("b")},
        InterpolateCase{"IDHolds", New<OrbIDParam>("Fast"), New<OrbIDParam>("Slow"), 0.5, New<OrbIDParam>("Fast")},
        InterpolateCase{"ScriptValSteps", New<ScriptValParam>(Table({{"k", 1}})),
                        New<ScriptValParam>(Table({{"k", 2}})), 1.0, New<ScriptValParam>(Table({{"k", 2}}))},
        InterpolateCase{"NumberToOtherKindKeepsItself", New<Number>(4), New<Text>("x"), 0.5, New<Number>(4)}),
    [](const auto &info) { return info.param.name; });

struct EqualsCase
{
    std::string name;
    Make a;
    Make b;
    bool equal;
};

class EqualsTest : public testing::TestWithParam<EqualsCase>
{
};

TEST_P(EqualsTest, ComparesKindAndContent)
{
    const EqualsCase &c = GetParam();
    AutoParameter a(c.a()), b(c.b());
    EXPECT_EQ(a->Equals(*b), c.equal);
    EXPECT_EQ(b->Equals(*a), c.equal);
}

INSTANTIATE_TEST_SUITE_P(
    Kinds, EqualsTest,
    testing::Values(EqualsCase{"NumberAndText", New<Number>(1), New<Text>("1"), false},
                    EqualsCase{"SamePoint", New<Point>(1, 2, 3), New<Point>(1, 2, 3), true},
                    EqualsCase{"PointZDiffers", New<Point>(1, 2, 3), New<Point>(1, 2, 0), false},
                    EqualsCase{"IDAndText", New<OrbIDParam>("A"), New<Text>("A"), false},
                    EqualsCase{"TablesInAnyOrder", New<ScriptValParam>(Table({{"a", 1}, {"b", "x"}})),
                               New<ScriptValParam>(Table({{"b", "x"}, {"a", 1}})), true},
                    EqualsCase{"NestedTablesDiffer", New<ScriptValParam>(Table({{"a", Table({{"n", 1}})}})),
                               New<ScriptValParam>(Table({{"a", Table({{"n", 2}})}})), false},
                    EqualsCase{"TableWithExtraKey", New<ScriptValParam>(Table({{"a", 1}})),
                               New<ScriptValParam>(Table({{"a", 1}, {"b", 2}})), false}),
    [](const auto &info) { return info.param.name; });

TEST(ParameterTest, ScriptValCloneSharesNoTable)
{
    ScriptVal inner = Table({{"n", 1}});
    AutoScriptValParam original(Table({{"inner", inner}}));
    AutoParameter copy(original->Clone());
    inner.SetKey(ScriptVal("n"), ScriptVal(99));
    EXPECT_FALSE(copy->Equals(*original));
    const auto *held = dynamic_cast<ScriptValParam *>(copy.get());
    ASSERT_NE(held, nullptr);
    EXPECT_EQ(held->Value.FindKeyConst(ScriptVal("inner"))->FindKeyConst(ScriptVal("n"))->GetNumber(), 1.0);
}

} // namespace
} // namespace Orbane
