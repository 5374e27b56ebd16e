#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Operator.h"

#include <gtest/gtest.h>

#include <type_traits>

namespace Orbane {
namespace {

// A holder never makes a value out of a pointer to hold, nor out of a value
// of another kind.
static_assert(!std::is_constructible_v<AutoNumber, Text *>);
static_assert(!std::is_constructible_v<AutoNumber, const char *>);
static_assert(!std::is_constructible_v<AutoParameter, float64>);
static_assert(std::is_constructible_v<AutoNumber, Input *, float64>);

class AutoParamTest : public testing::Test
{
protected:
    void SetUp() override
    {
        tool = AutoRef<Operator>(new Operator("Blur1", "Blur"));
        AutoNumber blendDefault(0.25);
        blend = tool->AddInput("Blend", "Blend", CLSID_DataType_Number, {}, blendDefault);
        AutoText labelDefault("Soft");
        label = tool->AddInput("Label", "Label", CLSID_DataType_Text, {}, labelDefault);
    }

    AutoRef<Operator> tool;
    Input *blend = nullptr;
    Input *label = nullptr;
};

TEST_F(AutoParamTest, MakesNewValues)
{
    AutoNumber n(0.5);
    ASSERT_TRUE(n.IsValid());
    EXPECT_EQ(n->Value, 0.5);
    EXPECT_EQ(n->RefCount(), 1);
    AutoNumber zero(0);
    ASSERT_TRUE(zero.IsValid());
    EXPECT_EQ(zero->Value, 0.0);
    AutoPoint p(0.1, 0.2);
    EXPECT_EQ(p->X, 0.1);
    EXPECT_EQ(p->Y, 0.2);
    EXPECT_EQ(p->Z, 0.0);
    AutoText t("Label");
    EXPECT_EQ(t->Value, OrbString("Label"));
}

TEST_F(AutoParamTest, ReadsInputValueOfItsKindOnly)
{
    AutoNumber n(blend, 0.0);
    ASSERT_TRUE(n.IsValid());
    EXPECT_EQ(n->Value, 0.25);

    AutoNumber notNumber(label, 0.0);
    EXPECT_FALSE(notNumber.IsValid());

    AutoParameter any(label, 0.0);
    ASSERT_TRUE(any.IsValid());
    EXPECT_EQ(any->DataType(), CLSID_DataType_Text);

    AutoNumber none(nullptr, 0.0);
    EXPECT_FALSE(none.IsValid());
}

TEST_F(AutoParamTest, ValueReadIsACopyOfTheStoredOne)
{
    AutoNumber n(blend, 0.0);
    n->Value = 9.0;
    EXPECT_EQ(AutoNumber(blend, 0.0)->Value, 0.25);
}

TEST_F(AutoParamTest, CopiesShareAndMovesHandOver)
{
    AutoNumber a(1.0);
    {
        AutoNumber b = a;
        EXPECT_EQ(a.get(), b.get());
        EXPECT_EQ(a->RefCount(), 2);
    }
    EXPECT_EQ(a->RefCount(), 1);

    AutoParameter moved(std::move(a));
    EXPECT_FALSE(a.IsValid());
    ASSERT_TRUE(moved.IsValid());
    EXPECT_EQ(moved->RefCount(), 1);
}

TEST_F(AutoParamTest, AdoptsAndShares)
{
    AutoParameter adopted(blend->GetValue(0.0));
    EXPECT_EQ(adopted->RefCount(), 1);
    AutoParameter shared(AutoRef<Parameter>::Share(adopted));
    EXPECT_EQ(adopted->RefCount(), 2);
    shared.Reset();
    EXPECT_FALSE(shared.IsValid());
    EXPECT_EQ(adopted->RefCount(), 1);

    Parameter *taken = adopted.Take();
    EXPECT_FALSE(adopted.IsValid());
    EXPECT_EQ(taken->RefCount(), 1);
    taken->DecRef();
}

} // namespace
} // namespace Orbane
