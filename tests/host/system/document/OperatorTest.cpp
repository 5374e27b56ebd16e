#include "orbane/Operator.h"
#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/ScriptError.h"

#include <gtest/gtest.h>

namespace Orbane {
namespace {

TEST(OperatorTest, InputsStayInDeclarationOrder)
{
    AutoRef<Operator> tool(new Operator("Merge1", "Merge"));
    const char *ids[] = {"Blend", "Center", "Angle", "Apply"};
    for (const char *id : ids)
        ASSERT_NE(tool->AddInput(id, id, CLSID_DataType_Number, {}, AutoNumber(0.0)), nullptr);
    ASSERT_EQ(tool->Inputs().size(), 4u);
    for (std::size_t i = 0; i < 4; ++i) {
        EXPECT_EQ(tool->FindInput(ids[i]), tool->Inputs()[i]);
        EXPECT_EQ(tool->Inputs()[i]->GetOperator(), tool.get());
    }
    EXPECT_EQ(tool->FindInput("Missing"), nullptr);
}

TEST(OperatorTest, BadInputsAreRefusedWithAMessage)
{
    const struct
    {
        const char *id;
        AutoParameter def;
        const char *error;
    } cases[] = {
        {"", AutoParameter(AutoNumber(1.0)), "An Input of tool \"Merge1\" needs an id"},
        {"Blend", AutoParameter(AutoNumber(1.0)), "Input \"Blend\" of tool \"Merge1\" is declared twice"},
        {"Size", AutoParameter(AutoPoint(1, 1)), "Input \"Size\" of tool \"Merge1\" takes Number, not Point"},
    };
    AutoRef<Operator> tool(new Operator("Merge1", "Merge"));
    ASSERT_NE(tool->AddInput("Blend", "Blend", CLSID_DataType_Number, {}, nullptr), nullptr);
    TakeScriptError();
    for (const auto &c : cases) {
        EXPECT_EQ(tool->AddInput(c.id, c.id, CLSID_DataType_Number, {}, c.def), nullptr);
        EXPECT_EQ(TakeScriptError(), c.error);
    }
    EXPECT_EQ(tool->Inputs().size(), 1u);
}

} // namespace
} // namespace Orbane
