#include "Counted.h"

#include "orbane/ScriptVal.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace Orbane {

namespace {

std::vector<std::string> KeysOf(const ScriptVal &table)
{
    std::vector<std::string> keys;
    for (const auto &[key, value] : table.GetEntries())
        keys.push_back(key.IsString() ? key.GetString() : std::to_string(int(key.GetNumber())));
    return keys;
}

} // namespace

TEST(ScriptVal, ScalarsKnowTheirTypeAndValue)
{
    EXPECT_TRUE(ScriptVal().IsNil());
    EXPECT_STREQ(ScriptVal().TypeName(), "nil");
    EXPECT_TRUE(ScriptVal(true).GetBool());
    EXPECT_FALSE(ScriptVal(false).GetBool());
    EXPECT_FALSE(ScriptVal().GetBool());
    EXPECT_TRUE(ScriptVal(0).GetBool()) << "as in Lua, only nil and false are false";
    EXPECT_DOUBLE_EQ(ScriptVal(2.5).GetNumber(), 2.5);
    EXPECT_DOUBLE_EQ(ScriptVal(int64(1) << 40).GetNumber(), 1099511627776.0);
    EXPECT_STREQ(ScriptVal("text").GetString(), "text");
    EXPECT_TRUE(ScriptVal(static_cast<const char *>(nullptr)).IsNil());
    EXPECT_DOUBLE_EQ(ScriptVal("3").GetNumber(-1), -1) << "no silent conversion";
    EXPECT_STREQ(ScriptVal(1).GetString("def"), "def");
    int x = 0;
    EXPECT_EQ(ScriptVal::FromPointer(&x).GetPointer(), &x);
    EXPECT_STREQ(ScriptVal::FromPointer(&x).TypeName(), "pointer");
    EXPECT_STREQ(ScriptVal::NewTable().TypeName(), "table");
}

TEST(ScriptVal, TablesKeepInsertionOrder)
{
    ScriptVal t = ScriptVal::NewTable();
    t.SetKey("zeta", 1);
    t.SetKey("alpha", 2);
    t.SetKey(3, "three");
    t.SetKey("mid", 4);
    t.SetKey("alpha", 20);
    EXPECT_EQ(KeysOf(t), (std::vector<std::string>{"zeta", "alpha", "3", "mid"}));
    EXPECT_DOUBLE_EQ(t.FindKeyConst("alpha")->GetNumber(), 20);
    EXPECT_EQ(t.FindKeyConst("missing"), nullptr);
    t.SetKey("zeta", ScriptVal());
    EXPECT_EQ(KeysOf(t), (std::vector<std::string>{"alpha", "3", "mid"})) << "nil removes the key";
}

TEST(ScriptVal, LengthCountsTheUnbrokenArrayPart)
{
    ScriptVal t = ScriptVal::NewTable();
    EXPECT_EQ(t.Length(), 0);
    t.Append("a");
    t.Append("b");
    t.SetKey("name", "x");
    t.SetKey(4, "d");
    EXPECT_EQ(t.Length(), 2);
    t.Append("c");
    EXPECT_EQ(t.Length(), 4) << "appending 3 joins the run up to 4";
    t.SetKey(1.5, "half");
    t.SetKey(-1, "neg");
    EXPECT_EQ(t.Length(), 4);
    EXPECT_STREQ(t.FindKeyConst(3)->GetString(), "c");
    EXPECT_EQ(ScriptVal(5).Length(), 0);
}

TEST(ScriptVal, CopiesShareOneTable)
{
    ScriptVal a = ScriptVal::NewTable();
    ScriptVal b = a;
    b.SetKey("k", "v");
    EXPECT_STREQ(a.FindKeyConst("k")->GetString(), "v");
    EXPECT_EQ(a, b);
    EXPECT_NE(a, ScriptVal::NewTable()) << "tables compare by identity";
    ScriptVal nested = ScriptVal::NewTable();
    a.SetKey("inner", nested);
    nested.Append(7);
    EXPECT_DOUBLE_EQ(a.FindKeyConst("inner")->FindKeyConst(1)->GetNumber(), 7);
}

TEST(ScriptVal, NonTablesIgnoreTableOperations)
{
    ScriptVal s("text");
    s.SetKey("k", 1);
    s.Append(2);
    EXPECT_EQ(s.FindKeyConst("k"), nullptr);
    EXPECT_EQ(s.FindKey("k"), nullptr);
    EXPECT_TRUE(s.GetEntries().empty());
    ScriptVal t = ScriptVal::NewTable();
    t.SetKey(ScriptVal(), 1);
    EXPECT_TRUE(t.GetEntries().empty()) << "nil is no key";
}

TEST(ScriptVal, EqualityComparesValuesOfOneType)
{
    EXPECT_EQ(ScriptVal(), ScriptVal());
    EXPECT_EQ(ScriptVal(1), ScriptVal(1.0));
    EXPECT_NE(ScriptVal(1), ScriptVal(true));
    EXPECT_NE(ScriptVal("1"), ScriptVal(1));
    EXPECT_EQ(ScriptVal("a"), ScriptVal(std::string("a")));
    EXPECT_NE(ScriptVal(true), ScriptVal(false));
}

TEST(ScriptVal, ObjectsHoldOneReference)
{
    int deaths = 0;
    auto *obj = new TestKit::Counted(&deaths);
    {
        ScriptVal v(obj);
        EXPECT_EQ(obj->RefCount(), 2);
        ScriptVal copy = v;
        EXPECT_EQ(obj->RefCount(), 3);
        ScriptVal moved = std::move(copy);
        EXPECT_EQ(obj->RefCount(), 3);
        EXPECT_TRUE(copy.IsNil());
        ScriptVal t = ScriptVal::NewTable();
        t.SetKey("obj", v);
        EXPECT_EQ(obj->RefCount(), 4);
        moved = ScriptVal(1);
        EXPECT_EQ(obj->RefCount(), 3);
        EXPECT_EQ(v.GetObject(), obj);
        EXPECT_STREQ(v.TypeName(), "object");
        v = v;
        EXPECT_EQ(obj->RefCount(), 3);
    }
    EXPECT_EQ(obj->RefCount(), 1);
    obj->DecRef();
    EXPECT_EQ(deaths, 1);
}

} // namespace Orbane
