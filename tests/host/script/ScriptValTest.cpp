#include "Counted.h"

#include "orbane/ScriptVal.h"

#include <gtest/gtest.h>

#include <iterator>
#include <string>
#include <vector>

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

namespace {

// "k=v," for each entry in order, numbers as integers.
std::string Shown(const ScriptVal &t)
{
    std::string shown;
    for (const auto &[k, v] : t.GetEntries())
        shown += (k.IsString() ? k.GetString() : std::to_string(int(k.GetNumber()))) + "=" +
                 std::to_string(int(v.GetNumber())) + ",";
    return shown;
}

} // namespace

// Every key is found after any mix of sets and removals, the order stays
// that of insertion, and the array part ends at the first missing index.
TEST(ScriptVal, TablesFindEveryKeyAfterChanges)
{
    struct Case
    {
        const char *name;
        std::vector<std::pair<ScriptVal, ScriptVal>> sets; // nil removes
        const char *shown;
        int32 length;
    };
    const Case cases[] = {
        {"append", {{1, 10}, {2, 20}, {3, 30}}, "1=10,2=20,3=30,", 3},
        {"remove within the array", {{1, 10}, {2, 20}, {3, 30}, {4, 40}, {2, ScriptVal()}}, "1=10,3=30,4=40,", 1},
        {"refill the gap", {{1, 10}, {2, 20}, {3, 30}, {2, ScriptVal()}, {2, 21}}, "1=10,3=30,2=21,", 3},
        {"overwrite keeps the place", {{"a", 1}, {"b", 2}, {"a", 3}}, "a=3,b=2,", 0},
        {"zero and minus zero are one key", {{0.0, 1}, {-0.0, 2}}, "0=2,", 0},
        {"integral double is the integer", {{1, 1}, {1.0, 2}, {2.5, 3}}, "1=2,2=3,", 1},
        {"remove first then find the rest",
         {{"a", 1}, {"b", 2}, {"c", 3}, {"a", ScriptVal()}, {"d", 4}},
         "b=2,c=3,d=4,",
         0},
    };
    for (const Case &c : cases) {
        SCOPED_TRACE(c.name);
        ScriptVal t = ScriptVal::NewTable();
        for (const auto &[k, v] : c.sets)
            t.SetKey(k, v);
        EXPECT_EQ(Shown(t), c.shown);
        EXPECT_EQ(t.Length(), c.length);
        for (const auto &[k, v] : t.GetEntries())
            EXPECT_EQ(t.FindKeyConst(k), &v) << "every key leads to its own entry";
    }
}

// Keys of every kind find their entry; a table key by identity.
TEST(ScriptVal, KeysOfEveryKind)
{
    int deaths = 0;
    auto *obj = new TestKit::Counted(&deaths);
    const ScriptVal inner = ScriptVal::NewTable(), other = ScriptVal::NewTable();
    int here = 0;
    const ScriptVal keys[] = {ScriptVal(true),
                              ScriptVal(false),
                              ScriptVal("1"),
                              ScriptVal(1),
                              ScriptVal(obj),
                              inner,
                              ScriptVal::FromPointer(&here)};
    ScriptVal t = ScriptVal::NewTable();
    for (int i = 0; i < int(std::size(keys)); ++i)
        t.SetKey(keys[i], i + 100);
    for (int i = 0; i < int(std::size(keys)); ++i) {
        const ScriptVal *found = t.FindKeyConst(keys[i]);
        ASSERT_TRUE(found) << keys[i].TypeName();
        EXPECT_EQ(found->GetNumber(), i + 100);
    }
    EXPECT_EQ(t.FindKeyConst(other), nullptr);
    obj->DecRef();
}

TEST(ScriptVal, FiftyThousandEntries)
{
    ScriptVal t = ScriptVal::NewTable();
    for (int i = 1; i <= 50000; ++i) {
        t.Append(ScriptVal(i * 2));
        t.SetKey(ScriptVal("k" + std::to_string(i)), ScriptVal(i));
    }
    EXPECT_EQ(t.Length(), 50000);
    for (int i = 1; i <= 50000; ++i) {
        ASSERT_EQ(t.FindKeyConst(ScriptVal(i))->GetNumber(), i * 2);
        ASSERT_EQ(t.FindKeyConst(ScriptVal("k" + std::to_string(i)))->GetNumber(), i);
    }
}

} // namespace Orbane
