#include "Counted.h"

#include "orbane/ScriptVal.h"

#include <gtest/gtest.h>

namespace Orbane {

TEST(ScriptVal, ScalarsKeepTheirKindAndCompareWithinIt)
{
    EXPECT_STREQ(ScriptVal().TypeName(), "nil");
    EXPECT_FALSE(ScriptVal().GetBool());
    EXPECT_TRUE(ScriptVal(0).GetBool()) << "as in Lua, only nil and false are false";
    EXPECT_TRUE(ScriptVal(static_cast<const char *>(nullptr)).IsNil());
    EXPECT_DOUBLE_EQ(ScriptVal("3").GetNumber(-1), -1) << "no silent conversion";
    EXPECT_STREQ(ScriptVal(1).GetString("def"), "def");
    EXPECT_EQ(ScriptVal(1), ScriptVal(1.0));
    EXPECT_NE(ScriptVal(1), ScriptVal(true));
    EXPECT_NE(ScriptVal("1"), ScriptVal(1));
}

TEST(ScriptVal, ObjectsHoldOneReferencePerValue)
{
    int deaths = 0;
    auto *obj = new TestKit::Counted(&deaths);
    {
        ScriptVal v(obj);
        ScriptVal copy = v;
        EXPECT_EQ(obj->RefCount(), 3);
        ScriptVal moved = std::move(copy);
        EXPECT_EQ(obj->RefCount(), 3);
        ScriptVal t = ScriptVal::NewTable();
        t.SetKey("obj", v);
        EXPECT_EQ(obj->RefCount(), 4);
        moved = ScriptVal(1);
        v = v;
        EXPECT_EQ(obj->RefCount(), 3);
    }
    EXPECT_EQ(obj->RefCount(), 1);
    obj->DecRef();
    EXPECT_EQ(deaths, 1);
}

} // namespace Orbane
