// The hooks that map by the published "Create" tag tables.

#include "orbane/FFITagMap.h"
#include "orbane/FFIType.h"
#include "orbane/Registry.h"
#include "orbane/RegistryList.h"
#include "orbane/ScriptError.h"
#include "orbane/ScriptVal.h"
#include "orbane/TagMapEntry.h"
#include "orbane/TagMapping.h"

#include <gtest/gtest.h>

#include <string>

namespace Orbane {
namespace Test {
namespace {

TagMapHook HookOf(const char *classID)
{
    const Registry *reg = ClassRegistry.Find(OrbID(classID));
    return reg ? reg->FindMapHook() : nullptr;
}

ScriptVal Table(const char *key, const ScriptVal &value)
{
    ScriptVal table = ScriptVal::NewTable();
    table.SetKey(key, value);
    return table;
}

const TagMapEntry *TableOf(const char *scriptType)
{
    const FFITagMap *map = FFITagMap::ForType(FFIType::FindScriptName(scriptType));
    return map ? map->Table() : nullptr;
}

struct MethodCase
{
    const char *method;
    bool translated;
};

using HookMethods = testing::TestWithParam<MethodCase>;

TEST_P(HookMethods, TranslatesOnlyTheTagMethods)
{
    const TagMapHook hook = HookOf("CheckboxControl");
    ASSERT_NE(hook, nullptr);
    ScriptVal args = Table("CBC_TriState", true);
    TagList tags;
    EXPECT_EQ(hook(OrbID(GetParam().method), MAP_ToTags, args, tags), GetParam().translated);
    EXPECT_EQ(tags.GetLong(0x10050000, -1), GetParam().translated ? 1 : -1);
}

INSTANTIATE_TEST_SUITE_P(Library, HookMethods,
                         testing::Values(MethodCase{"Create", true}, MethodCase{"GetAttrs", true},
                                         MethodCase{"SetAttrs", true}, MethodCase{"UserControl", true},
                                         MethodCase{"create", false}, MethodCase{"Destroy", false},
                                         MethodCase{"", false}));

struct RowCase
{
    const char *classID;
    const char *name;
    ScriptVal value;
    Tag tag;
};

using PublishedRows = testing::TestWithParam<RowCase>;

// A published name maps to its tag and, read back, gives the value again.
TEST_P(PublishedRows, MapToTheirTagAndBack)
{
    const RowCase &c = GetParam();
    const TagMapHook hook = HookOf(c.classID);
    ASSERT_NE(hook, nullptr);
    ScriptVal args = Table(c.name, c.value);
    TagList tags;
    ASSERT_TRUE(hook(OrbID("Create"), MAP_ToTags, args, tags)) << TakeScriptError();
    ASSERT_EQ(tags.Count(), 1);
    EXPECT_EQ(tags.First()->tag, c.tag);
    ScriptVal attrs;
    ASSERT_TRUE(hook(OrbID("GetAttrs"), MAP_FromTags, attrs, tags));
    ASSERT_NE(attrs.FindKeyConst(c.name), nullptr);
    const ScriptVal &back = *attrs.FindKeyConst(c.name);
    EXPECT_EQ(TagIsRepeatable(c.tag) ? *back.FindKeyConst(1) : back, c.value);
}

// ID variants map through their primary's hook.
INSTANTIATE_TEST_SUITE_P(Library, PublishedRows,
                         testing::Values(RowCase{"ButtonControl", "BTNC_Align", "CenteredRight", 0x10050000},
                                         RowCase{"ComboControl", "CCS_AddString", "One", 0x38040000},
                                         RowCase{"ComboIDControl", "CC_AlphaSort", true, 0x10050001},
                                         RowCase{"ComboIDControl", "CCID_AddID", "One", 0x88030000},
                                         RowCase{"PointControl", "PCD_SetPrevPointY", 0.25, 0x20058001},
                                         RowCase{"RectangleControl", "RCID_AxisY", "Y", 0x8005800a},
                                         RowCase{"AngleControl", "ACD_CurrentAngle", 45.5, 0x20058005},
                                         RowCase{"PolylineControl", "PLC_DrawStyle", 5, 0x10058010}),
                         [](const auto &info) { return std::string(info.param.name); });

TEST(Hooks, AClassRejectsNamesNotInItsTable)
{
    ASSERT_NE(HookOf("CheckboxControl"), nullptr);
    ScriptVal other = Table("BTNC_Align", "Center");
    TagList tags;
    EXPECT_FALSE(HookOf("CheckboxControl")(OrbID("Create"), MAP_ToTags, other, tags));
    EXPECT_NE(TakeScriptError().find("BTNC_Align"), std::string::npos);
    EXPECT_TRUE(tags.IsEmpty());
}

TEST(TagTables, VariantsShareTheirPrimarysTable)
{
    EXPECT_EQ(TableOf("ComboIDControl"), TableOf("ComboControl"));
    EXPECT_EQ(TableOf("ListIDControl"), TableOf("ListControl"));
    EXPECT_EQ(TableOf("ScriptValListControl"), TableOf("ListControl"));
}

} // namespace
} // namespace Test
} // namespace Orbane
