#include "Counted.h"

#include "orbane/OrbColor.h"
#include "orbane/OrbID.h"
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

TEST(ScriptVal, ScalarsKeepTheirKindAndCompareWithinIt)
{
    EXPECT_STREQ(ScriptVal().TypeName(), "nil");
    EXPECT_FALSE(ScriptVal().GetBool());
    EXPECT_TRUE(ScriptVal(0).GetBool()) << "as in Lua, only nil and false are false";
    EXPECT_DOUBLE_EQ(ScriptVal(int64(1) << 40).GetNumber(), 1099511627776.0);
    EXPECT_TRUE(ScriptVal(static_cast<const char *>(nullptr)).IsNil());
    EXPECT_DOUBLE_EQ(ScriptVal("3").GetNumber(-1), -1) << "no silent conversion";
    EXPECT_STREQ(ScriptVal(1).GetString("def"), "def");
    EXPECT_EQ(ScriptVal(1), ScriptVal(1.0));
    EXPECT_NE(ScriptVal(1), ScriptVal(true));
    EXPECT_NE(ScriptVal("1"), ScriptVal(1));
}

TEST(ScriptVal, TablesKeepInsertionOrderAndCopiesShareThem)
{
    ScriptVal t = ScriptVal::NewTable();
    ScriptVal alias = t;
    t.SetKey("zeta", 1);
    t.SetKey("alpha", 2);
    t.SetKey(3, "three");
    alias.SetKey("alpha", 20);
    t.SetKey(ScriptVal(), 1);
    EXPECT_EQ(KeysOf(t), (std::vector<std::string>{"zeta", "alpha", "3"})) << "nil is no key";
    EXPECT_DOUBLE_EQ(t.FindKeyConst("alpha")->GetNumber(), 20);
    t.SetKey("zeta", ScriptVal());
    EXPECT_EQ(KeysOf(t), (std::vector<std::string>{"alpha", "3"})) << "nil removes the key";
    EXPECT_EQ(t, alias);
    EXPECT_NE(t, ScriptVal::NewTable()) << "tables compare by identity";

    ScriptVal s("text");
    s.SetKey("k", 1);
    EXPECT_EQ(s.FindKeyConst("k"), nullptr) << "a string is no table";
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

TEST(OrbID, EqualTextsAreOneIdentifierAndCaseMatters)
{
    EXPECT_EQ(OrbID("CheckboxControl"), OrbID(std::string("Check") + "boxControl"));
    EXPECT_NE(OrbID("CheckBoxControl"), OrbID("CheckboxControl"));
    EXPECT_EQ(OrbID(""), OrbID(static_cast<const char *>(nullptr)));
    EXPECT_TRUE(OrbID() == nullptr);
    EXPECT_LT(OrbID("Apple"), OrbID("Banana"));
}

TEST(OrbColor, PacksChannelsAsABGRAndOpaqueWhiteMeansNone)
{
    EXPECT_EQ(OrbColor(0x11, 0x22, 0x33, 0x44).Packed(), 0x44332211u);
    EXPECT_TRUE(OrbColor().IsNone());
    EXPECT_FALSE(OrbColor(255, 255, 255, 254).IsNone());
    EXPECT_TRUE(OrbColor(255, 255, 255).IsNone()) << "opaque by default";
}

} // namespace Orbane
