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

} // namespace

// One row per kind of map row and per way of giving its value that the
// library's published rows do not reach (TagMapHookTest maps those both
// ways); the text is the tag list the table becomes.
TEST(TagMapping, MapsNamedValuesToTags)
{
    const struct
    {
        const char *name;
        ScriptVal args;
        std::string tags;
    } cases[] = {
        {"PlainDouble", Table({{"WGT_Scale", 0.5}}), "20050002=0.5"},
        {"PlainIdentifier", Table({{"WGT_Mode", "Fast"}}), "80050003=#Fast"},
        {"BooleanFromZero", Table({{"WGT_TriState", 0}}), "10050004=0"},
        {"EnumerationByNumber", Table({{"WGT_Align", 4}}), "10050005=4"},
        {"ColourPacked", Table({{"WGT_Color", 2164195328.0}}), "10050007=2164195328"},
        {"ColourNamedTable", Table({{"WGT_Color", Table({{"R", 1}, {"G", 0.5}, {"B", 0}})}}), "10050007=4278223103"},
        {"ColourClamped", Table({{"WGT_Color", Table({{"R", 2}, {"G", -1}, {"B", 0}, {"A", 1}})}}),
         "10050007=4278190335"},
        {"InsertionOrder", Table({{"WGT_Scale", 1}, {"WGT_Title", "T"}, {"WGT_Count", 2}}),
         "20050002=1 30050000=T 10050001=2"},
        {"NoTable", ScriptVal(), ""},
    };
    for (const auto &c : cases) {
        TagList tags;
        ASSERT_TRUE(IntoTags(c.args, tags)) << c.name << ": " << TakeScriptError();
        EXPECT_EQ(Show(tags), c.tags) << c.name;
    }
}

// A failure leaves the list as it was, even after good values.
TEST(TagMapping, FailsWithAMessageAndLeavesTheListAlone)
{
    const std::pair<ScriptVal, const char *> cases[] = {
        {Table({{"Foo", 1}}), "unknown tag \"Foo\" for ScriptWidget"},
        {Table({{"WGT_TriState", "yes"}}), "WGT_TriState: expected a boolean, got string"},
        {Table({{"WGT_Align", "Middle"}}),
         "WGT_Align: unknown value \"Middle\"; expected one of Left, CenteredLeft, Center, CenteredRight, Right"},
        {Table({{"WGT_Align", true}}), "WGT_Align: expected a name of Align or a number, got boolean"},
        {Table({{"WGT_Count", 1.5}}), "WGT_Count: expected an integer, got 1.5"},
        {Table({{"WGT_AddItem", Array({"a", 2})}}), "WGT_AddItem: item 2: expected a string, got 2"},
        {Array({"x"}), "tag names must be strings, got 1"},
        {ScriptVal("text"), "tags must be given as a table, got string"},
        {Table({{"WGT_Title", "ok"}, {"WGT_TriState", "bad"}}), "WGT_TriState: expected a boolean, got string"},
    };
    for (const auto &[args, message] : cases) {
        TagList tags{{WGT_Title, "before"}};
        EXPECT_FALSE(IntoTags(args, tags));
        EXPECT_EQ(TakeScriptError(), message);
        EXPECT_EQ(Show(tags), "30050000=before") << message;
    }
}

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
