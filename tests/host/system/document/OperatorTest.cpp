#include "orbane/Operator.h"
#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/ScriptError.h"

#include <gtest/gtest.h>

namespace Orbane {
namespace {

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
