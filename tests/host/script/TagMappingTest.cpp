#include "Counted.h"
#include "TestClasses.h"
#include "TestShow.h"

#include "orbane/ScriptError.h"
#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"
#include "orbane/TagMapping.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace Orbane {

using namespace Orbane::TestKit;

namespace {

ScriptVal Table(std::initializer_list<ScriptVal::Entry> entries)
{
    ScriptVal t = ScriptVal::NewTable();
    for (const auto &[key, value] : entries)
        t.SetKey(key, value);
    return t;
}

ScriptVal Array(std::initializer_list<ScriptVal> values)
{
    ScriptVal t = ScriptVal::NewTable();
    for (const ScriptVal &v : values)
        t.Append(v);
    return t;
}

bool IntoTags(ScriptVal args, TagList &tags)
{
    return scriptval_maptags(WidgetTags, MAP_ToTags, args, tags);
}

struct IntoCase
{
    const char *name;
    ScriptVal args;
    std::string tags;
};

std::vector<IntoCase> IntoCases()
{
    return {
        {"PlainText", Table({{"WGT_Title", "Hello"}}), "30050000=Hello"},
        {"PlainInteger", Table({{"WGT_Count", 3}}), "10050001=3"},
        {"PlainDouble", Table({{"WGT_Scale", 0.5}}), "20050002=0.5"},
        {"PlainIdentifier", Table({{"WGT_Mode", "Fast"}}), "80050003=#Fast"},
        {"BooleanTrue", Table({{"WGT_TriState", true}}), "10050004=1"},
        {"BooleanFromZero", Table({{"WGT_TriState", 0}}), "10050004=0"},
        {"EnumerationByName", Table({{"WGT_Align", "CenteredRight"}}), "10050005=3"},
        {"EnumerationByNumber", Table({{"WGT_Align", 4}}), "10050005=4"},
        {"ColourPacked", Table({{"WGT_Color", 2164195328.0}}), "10050007=2164195328"},
        {"ColourNamedTable", Table({{"WGT_Color", Table({{"R", 1}, {"G", 0.5}, {"B", 0}})}}), "10050007=4278223103"},
        {"ColourClamped", Table({{"WGT_Color", Table({{"R", 2}, {"G", -1}, {"B", 0}, {"A", 1}})}}),
         "10050007=4278190335"},
        {"RepeatableArray", Table({{"WGT_AddItem", Array({"a", "b", "c"})}}), "38050008=a 38050008=b 38050008=c"},
        {"InsertionOrder", Table({{"WGT_Scale", 1}, {"WGT_Title", "T"}, {"WGT_Count", 2}}),
         "20050002=1 30050000=T 10050001=2"},
        {"NoTable", ScriptVal(), ""},
    };
}

using IntoTagsTest = testing::TestWithParam<IntoCase>;

struct ErrorCase
{
    const char *name;
    ScriptVal args;
    const char *message;
};

std::vector<ErrorCase> ErrorCases()
{
    return {
        {"UnknownTag", Table({{"Foo", 1}}), "unknown tag \"Foo\" for ScriptWidget"},
        {"BooleanGivenString", Table({{"WGT_TriState", "yes"}}), "WGT_TriState: expected a boolean, got string"},
        {"UnknownEnumerationName", Table({{"WGT_Align", "Middle"}}),
         "WGT_Align: unknown value \"Middle\"; expected one of Left, CenteredLeft, Center, CenteredRight, Right"},
        {"EnumerationGivenBoolean", Table({{"WGT_Align", true}}),
         "WGT_Align: expected a name of Align or a number, got boolean"},
        {"IntegerGivenFraction", Table({{"WGT_Count", 1.5}}), "WGT_Count: expected an integer, got 1.5"},
        {"RepeatableItemOfWrongType", Table({{"WGT_AddItem", Array({"a", 2})}}),
         "WGT_AddItem: item 2: expected a string, got 2"},
        {"PositionalValue", Array({"x"}), "tag names must be strings, got 1"},
        {"NotATable", ScriptVal("text"), "tags must be given as a table, got string"},
        {"FailureAfterGoodValues", Table({{"WGT_Title", "ok"}, {"WGT_TriState", "bad"}}),
         "WGT_TriState: expected a boolean, got string"},
    };
}

using MapErrorTest = testing::TestWithParam<ErrorCase>;

struct FromCase
{
    const char *name;
    TagList tags;
    std::string attrs;
};

std::vector<FromCase> FromCases()
{
    return {
        {"EveryKind",
         {{WGT_Title, "Hello"}, {WGT_Count, 3}, {WGT_Scale, 0.5}, {WGT_Mode, OrbID("Fast")}, {WGT_TriState, 1}, {WGT_Align, 2}},
         "WGT_Title=Hello; WGT_Count=3; WGT_Scale=0.5; WGT_Mode=Fast; WGT_TriState=true; WGT_Align=Center"},
        {"Colour", {{WGT_Color, 0xFF0000FFu}}, "WGT_Color={R=1, G=0, B=0, A=1}"},
        {"RepeatableInRowOrder",
         {{WGT_AddItem, "a"}, {WGT_Title, "T"}, {WGT_AddItem, "b"}},
         "WGT_Title=T; WGT_AddItem={a, b}"},
        {"WrongKindsAndUnknownTagsAreSkipped", {{WGT_Title, 5}, {WGT_TriState, "yes"}, {0x10059999, 1}}, ""},
    };
}

using FromTagsTest = testing::TestWithParam<FromCase>;

const auto kName = [](const auto &info) { return std::string(info.param.name); };

} // namespace

TEST_P(IntoTagsTest, MapsNamedValuesToTags)
{
    TagList tags;
    ASSERT_TRUE(IntoTags(GetParam().args, tags)) << TakeScriptError();
    EXPECT_EQ(Show(tags), GetParam().tags);
}

INSTANTIATE_TEST_SUITE_P(TagMapping, IntoTagsTest, testing::ValuesIn(IntoCases()), kName);

TEST_P(MapErrorTest, FailsWithAMessageAndLeavesTheListAlone)
{
    TagList tags{{WGT_Title, "before"}};
    TakeScriptError();
    EXPECT_FALSE(IntoTags(GetParam().args, tags));
    const std::string message = TakeScriptError();
    EXPECT_EQ(message, GetParam().message);
    EXPECT_EQ(Show(tags), "30050000=before");
}

INSTANTIATE_TEST_SUITE_P(TagMapping, MapErrorTest, testing::ValuesIn(ErrorCases()), kName);

TEST_P(FromTagsTest, MapsTagsToNamedValues)
{
    ScriptVal attrs;
    TagList tags = GetParam().tags;
    ASSERT_TRUE(scriptval_maptags(WidgetTags, MAP_FromTags, attrs, tags));
    EXPECT_EQ(Show(attrs), GetParam().attrs);
}

INSTANTIATE_TEST_SUITE_P(TagMapping, FromTagsTest, testing::ValuesIn(FromCases()), kName);

// An object row checks the script type (or its script base); on a pointer tag
// the object travels as its address, the way overlays take their linked Inputs.
TEST(TagMapping, ObjectsMustBeOfTheRowsTypeOrDeriveFromIt)
{
    int deaths = 0;
    auto *widget = new Counted(&deaths, "ScriptWidget");
    auto *gadget = new Counted(&deaths, "GadgetControl"); // its script base is ScriptWidget
    auto *stranger = new Counted(&deaths, "Image");
    TagList tags;
    EXPECT_TRUE(IntoTags(Table({{"WGT_Partner", widget}}), tags));
    EXPECT_TRUE(IntoTags(Table({{"WGT_Partner", gadget}, {"WGT_Link", gadget}}), tags));
    EXPECT_EQ(Show(tags), "40050006=ScriptWidget 40050006=GadgetControl 60050009=pointer");
    EXPECT_EQ(tags.GetPtr(WGT_Link), static_cast<void *>(gadget));
    EXPECT_EQ(widget->RefCount(), 2) << "the list holds a reference";
    EXPECT_EQ(gadget->RefCount(), 2) << "a pointer holds none";
    EXPECT_FALSE(IntoTags(Table({{"WGT_Partner", stranger}}), tags));
    EXPECT_EQ(TakeScriptError(), "WGT_Partner: expected an object of type ScriptWidget, got Image");

    ScriptVal attrs;
    ASSERT_TRUE(scriptval_maptags(WidgetTags, MAP_FromTags, attrs, tags));
    EXPECT_EQ(attrs.FindKeyConst("WGT_Partner")->GetObject(), widget) << "not repeatable: the first occurrence";
    EXPECT_EQ(attrs.FindKeyConst("WGT_Link")->GetObject(), gadget);
    for (auto *obj : {widget, gadget, stranger})
        obj->DecRef();
    tags.Clear();
    attrs = ScriptVal();
    EXPECT_EQ(deaths, 3);
}

} // namespace Orbane
