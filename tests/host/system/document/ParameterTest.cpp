#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"

#include <gtest/gtest.h>

namespace Orbane {
namespace {

ScriptVal Table(std::initializer_list<std::pair<const char *, ScriptVal>> entries)
{
    ScriptVal t = ScriptVal::NewTable();
    for (const auto &e : entries)
        t.SetKey(ScriptVal(e.first), e.second);
    return t;
}

const auto N = [](float64 v) { return AutoParameter(AutoNumber(v)); };
const auto P = [](float64 x, float64 y, float64 z = 0) { return AutoParameter(AutoPoint(x, y, z)); };
const auto T = [](const char *s) { return AutoParameter(AutoText(s)); };
const auto I = [](const char *s) { return AutoParameter(AutoOrbIDParam(s)); };
const auto S = [](ScriptVal v) { return AutoParameter(AutoScriptValParam(v)); };

// Numbers and points blend; text, identifiers and tables step at the end;
// another kind keeps the value it started from.
TEST(ParameterTest, InterpolateBlendsOrSteps)
{
    const struct
    {
        const char *name;
        AutoParameter from, to;
        float64 t;
        AutoParameter expected;
    } cases[] = {
        {"NumberQuarter", N(2), N(6), 0.25, N(3)},
        {"PointHalf", P(0, 1, 2), P(1, 3, -2), 0.5, P(0.5, 2, 0)},
        {"TextHoldsBeforeEnd", T("a"), T("b"), 0.99, T("a")},
        {"TextStepsAtEnd", T("a"), T("b"), 1.0, T("b")},
        {"IDHolds", I("Fast"), I("Slow"), 0.5, I("Fast")},
        {"ScriptValSteps", S(Table({{"k", 1}})), S(Table({{"k", 2}})), 1.0, S(Table({{"k", 2}}))},
        {"NumberToOtherKindKeepsItself", N(4), T("x"), 0.5, N(4)},
    };
    for (const auto &c : cases) {
        AutoParameter got(c.from->Interpolate(*c.to, c.t));
        ASSERT_TRUE(got.IsValid()) << c.name;
        EXPECT_EQ(got->DataType(), c.expected->DataType()) << c.name;
        EXPECT_TRUE(got->Equals(*c.expected)) << c.name;
        EXPECT_TRUE(got.get() != c.from.get() && got.get() != c.to.get()) << c.name << ": a new value";
    }
}

TEST(ParameterTest, EqualsComparesKindAndContentBothWays)
{
    const struct
    {
        const char *name;
        AutoParameter a, b;
        bool equal;
    } cases[] = {
        {"NumberAndText", N(1), T("1"), false},
        {"SamePoint", P(1, 2, 3), P(1, 2, 3), true},
        {"PointZDiffers", P(1, 2, 3), P(1, 2, 0), false},
        {"IDAndText", I("A"), T("A"), false},
        {"TablesInAnyOrder", S(Table({{"a", 1}, {"b", "x"}})), S(Table({{"b", "x"}, {"a", 1}})), true},
        {"NestedTablesDiffer", S(Table({{"a", Table({{"n", 1}})}})), S(Table({{"a", Table({{"n", 2}})}})), false},
        {"TableWithExtraKey", S(Table({{"a", 1}})), S(Table({{"a", 1}, {"b", 2}})), false},
    };
    for (const auto &c : cases) {
        EXPECT_EQ(c.a->Equals(*c.b), c.equal) << c.name;
        EXPECT_EQ(c.b->Equals(*c.a), c.equal) << c.name;
    }
}

TEST(ParameterTest, ScriptValCloneSharesNoTable)
{
    ScriptVal inner = Table({{"n", 1}});
    AutoScriptValParam original(Table({{"inner", inner}}));
    AutoParameter copy(original->Clone());
    inner.SetKey(ScriptVal("n"), ScriptVal(99));
    EXPECT_FALSE(copy->Equals(*original));
    EXPECT_TRUE(copy->Equals(*S(Table({{"inner", Table({{"n", 1}})}}))));
}

} // namespace
} // namespace Orbane
