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
    testing::Values(InterpolateCase{"NumberStart", [] { return new Number(2); }, [] { return new Number(6); }, 0.0,
                                    [] { return new Number(2); }},
                    InterpolateCase{"NumberQuarter", [] { return new Number(2); }, [] { return new Number(6); }, 0.25,
                                    [] { return new Number(3); }},
                    InterpolateCase{"NumberEnd", [] { return new Number(2); }, [] { return new Number(6); }, 1.0,
                                    [] { return new Number(6); }},
                    InterpolateCase{"NumberDown", [] { return new Number(1); }, [] { return new Number(-1); }, 0.5,
                                    [] { return new Number(0); }},
                    InterpolateCase{"PointHalf", [] { return new Point(0, 1, 2); }, [] { return new Point(1, 3, -2); },
                                    0.5, [] { return new Point(0.5, 2, 0); }},
                    InterpolateCase{"TextHoldsBeforeEnd", [] { return new Text("a"); }, [] { return new Text("b"); },
                                    0.99, [] { return new Text("a"); }},
                    InterpolateCase{"TextStepsAtEnd", [] { return new Text("a"); }, [] { return new Text("b"); }, 1.0,
                                    [] { return new Text("b"); }},
                    InterpolateCase{"IDHolds", [] { return new OrbIDParam("Fast"); },
                                    [] { return new OrbIDParam("Slow"); }, 0.5, [] { return new OrbIDParam("Fast"); }},
                    InterpolateCase{"ScriptValSteps",
                                    [] {
                                        return new ScriptValParam(Table({{"k", 1}}));
                                    },
                                    [] {
                                        return new ScriptValParam(Table({{"k", 2}}));
                                    },
                                    1.0,
                                    [] {
                                        return new ScriptValParam(Table({{"k", 2}}));
                                    }},
                    InterpolateCase{"NumberToOtherKindKeepsItself", [] { return new Number(4); },
                                    [] { return new Text("x"); }, 0.5, [] { return new Number(4); }},
                    InterpolateCase{"TextToOtherKindKeepsItself", [] { return new Text("x"); },
                                    [] { return new Number(4); }, 1.0, [] { return new Text("x"); }}),
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
    testing::Values(
        EqualsCase{"SameNumber", [] { return new Number(0.5); }, [] { return new Number(0.5); }, true},
        EqualsCase{"OtherNumber", [] { return new Number(0.5); }, [] { return new Number(0.50001); }, false},
        EqualsCase{"NumberAndText", [] { return new Number(1); }, [] { return new Text("1"); }, false},
        EqualsCase{"SamePoint", [] { return new Point(1, 2, 3); }, [] { return new Point(1, 2, 3); }, true},
        EqualsCase{"PointZDiffers", [] { return new Point(1, 2, 3); }, [] { return new Point(1, 2, 0); }, false},
        EqualsCase{"SameText", [] { return new Text("Blur"); }, [] { return new Text("Blur"); }, true},
        EqualsCase{"OtherText", [] { return new Text("Blur"); }, [] { return new Text("blur"); }, false},
        EqualsCase{"SameID", [] { return new OrbIDParam("A"); }, [] { return new OrbIDParam("A"); }, true},
        EqualsCase{"IDAndText", [] { return new OrbIDParam("A"); }, [] { return new Text("A"); }, false},
        EqualsCase{"TablesInAnyOrder",
                   [] {
                       return new ScriptValParam(Table({{"a", 1}, {"b", "x"}}));
                   },
                   [] {
                       return new ScriptValParam(Table({{"b", "x"}, {"a", 1}}));
                   },
                   true},
        EqualsCase{"NestedTablesDiffer",
                   [] {
                       return new ScriptValParam(Table({{"a", Table({{"n", 1}})}}));
                   },
                   [] {
                       return new ScriptValParam(Table({{"a", Table({{"n", 2}})}}));
                   },
                   false},
        EqualsCase{"TableWithExtraKey",
                   [] {
                       return new ScriptValParam(Table({{"a", 1}}));
                   },
                   [] {
                       return new ScriptValParam(Table({{"a", 1}, {"b", 2}}));
                   },
                   false}),
    [](const auto &info) { return info.param.name; });

TEST(ParameterTest, DataTypesAndScriptNames)
{
    EXPECT_EQ(AutoNumber(1.0)->DataType(), CLSID_DataType_Number);
    EXPECT_EQ(AutoPoint(1.0, 2.0)->DataType(), CLSID_DataType_Point);
    EXPECT_EQ(AutoText("t")->DataType(), CLSID_DataType_Text);
    EXPECT_EQ(AutoOrbIDParam("i")->DataType(), CLSID_DataType_ID);
    EXPECT_EQ(AutoScriptValParam(ScriptVal::NewTable())->DataType(), CLSID_DataType_ScriptVal);
    EXPECT_STREQ(AutoNumber(1.0)->ScriptTypeName(), "Number");
    EXPECT_STREQ(AutoPoint(1.0, 2.0)->ScriptTypeName(), "Point");
}

TEST(ParameterTest, CloneIsEqualButSeparate)
{
    AutoPoint p(0.25, 0.75, 1.0);
    AutoParameter copy(p->Clone());
    EXPECT_TRUE(copy->Equals(*p));
    p->X = 0.5;
    EXPECT_FALSE(copy->Equals(*p));
    EXPECT_EQ(copy->RefCount(), 1);
}

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
