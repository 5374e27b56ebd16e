#include "orbane/Operator.h"
#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/ScriptError.h"

#include <gtest/gtest.h>

namespace Orbane {
namespace {

class OperatorTest : public testing::Test
{
protected:
    void SetUp() override { TakeScriptError(); }

    AutoRef<Operator> tool{new Operator("Merge1", "Merge")};
};

TEST_F(OperatorTest, InputsStayInDeclarationOrder)
{
    const char *ids[] = {"Blend", "Center", "Angle", "Apply"};
    for (const char *id : ids)
        ASSERT_NE(tool->AddInput(id, id, CLSID_DataType_Number, {}, AutoNumber(0.0)), nullptr);
    ASSERT_EQ(tool->Inputs().size(), 4u);
    for (std::size_t i = 0; i < 4; ++i) {
        EXPECT_EQ(tool->Inputs()[i]->GetID(), OrbID(ids[i]));
        EXPECT_EQ(tool->FindInput(ids[i]), tool->Inputs()[i]);
        EXPECT_EQ(tool->Inputs()[i]->GetOperator(), tool.get());
    }
    EXPECT_EQ(tool->FindInput("Missing"), nullptr);
}

struct BadInputCase
{
    const char *name;
    const char *id;
    std::function<Parameter *()> def;
    const char *error;
};

class BadInputTest : public OperatorTest, public testing::WithParamInterface<BadInputCase>
{
};

TEST_P(BadInputTest, IsRefusedWithAMessage)
{
    ASSERT_NE(tool->AddInput("Blend", "Blend", CLSID_DataType_Number, {}, nullptr), nullptr);
    const BadInputCase &c = GetParam();
    AutoParameter def(c.def());
    EXPECT_EQ(tool->AddInput(c.id, c.id, CLSID_DataType_Number, {}, def), nullptr);
    EXPECT_EQ(TakeScriptError(), c.error);
    EXPECT_EQ(tool->Inputs().size(), 1u);
}

INSTANTIATE_TEST_SUITE_P(Cases, BadInputTest,
                         testing::Values(BadInputCase{"EmptyId", "", [] { return new Number(1); },
                                                      "An Input of tool \"Merge1\" needs an id"},
                                         BadInputCase{"TakenId", "Blend", [] { return new Number(1); },
                                                      "Input \"Blend\" of tool \"Merge1\" is declared twice"},
                                         BadInputCase{"DefaultOfOtherType", "Size", [] { return new Point(1, 1); },
                                                      "Input \"Size\" of tool \"Merge1\" takes Number, not Point"}),
                         [](const auto &info) { return std::string(info.param.name); });

} // namespace
} // namespace Orbane
