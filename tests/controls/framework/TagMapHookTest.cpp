// The tag-mapping hooks: which script methods they translate, and that each
// class translates by its own tag table.

#include "orbane/Registry.h"
#include "orbane/RegistryList.h"
#include "orbane/ScriptError.h"
#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"
#include "orbane/TagMapping.h"

#include <gtest/gtest.h>

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

struct MethodCase
{
    const char *method;
    bool translated;
};

class HookMethods : public testing::TestWithParam<MethodCase>
{
};

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

struct MappingCase
{
    const char *classID;
    const char *name;
    ScriptVal value;
    Tag tag;
    int64 expected;
};

class HookMappings : public testing::TestWithParam<MappingCase>
{
};

TEST_P(HookMappings, MapsByTheClasssOwnTable)
{
    const MappingCase &c = GetParam();
    const TagMapHook hook = HookOf(c.classID);
    ASSERT_NE(hook, nullptr);
    ScriptVal args = Table(c.name, c.value);
    TagList tags;
    ASSERT_TRUE(hook(OrbID("Create"), MAP_ToTags, args, tags)) << TakeScriptError();
    EXPECT_EQ(tags.GetLong(c.tag, -1), c.expected);
}

INSTANTIATE_TEST_SUITE_P(Library, HookMappings,
                         testing::Values(MappingCase{"ButtonControl", "BTNC_Align", "CenteredRight", 0x10050000, 3},
                                         MappingCase{"ComboControl", "CC_LabelPosition", "Vertical", 0x10050000, 1},
                                         // The ID variant maps through its primary's hook.
                                         MappingCase{"ComboIDControl", "CC_AlphaSort", true, 0x10050001, 1},
                                         MappingCase{"ListIDControl", "LC_Rows", 9, 0x10050000, 9},
                                         MappingCase{"ScriptValListControl", "LC_Rows", 12, 0x10050000, 12},
                                         MappingCase{"SliderControl", "IC_TickFreq", 5, 0x10050000, 5},
                                         MappingCase{"CrosshairControl", "CHC_Style", 3, 0x10058000, 3},
                                         MappingCase{"RectangleControl", "RC_DoLockAspect", false, 0x10058001, 0},
                                         MappingCase{"PolylineControl", "PLC_DrawStyle", 5, 0x10058010, 5}));

TEST(Hooks, ClassRejectsAnotherClasssTag)
{
    const TagMapHook hook = HookOf("CheckboxControl");
    ASSERT_NE(hook, nullptr);
    ScriptVal args = Table("BTNC_Align", "Center");
    TagList tags;
    EXPECT_FALSE(hook(OrbID("Create"), MAP_ToTags, args, tags));
    EXPECT_TRUE(tags.IsEmpty());
    EXPECT_NE(TakeScriptError().find("BTNC_Align"), std::string::npos);
}

TEST(Hooks, ClassWithoutPublishedNamesMapsByAnEmptyTable)
{
    const TagMapHook hook = HookOf("CameraControl");
    ASSERT_NE(hook, nullptr);
    ScriptVal none = ScriptVal::NewTable();
    TagList tags;
    EXPECT_TRUE(hook(OrbID("Create"), MAP_ToTags, none, tags));
    EXPECT_TRUE(tags.IsEmpty());
    ScriptVal some = Table("CC_AlphaSort", true);
    EXPECT_FALSE(hook(OrbID("Create"), MAP_ToTags, some, tags));
    EXPECT_TRUE(tags.IsEmpty());
    TakeScriptError();
}

TEST(Hooks, GetAttrsTurnsTagsBackIntoNames)
{
    const TagMapHook hook = HookOf("ButtonControl");
    ASSERT_NE(hook, nullptr);
    ScriptVal args;
    TagList tags{{0x10050000, 4}, {0x30050000, "print(1)"}};
    ASSERT_TRUE(hook(OrbID("GetAttrs"), MAP_FromTags, args, tags));
    ASSERT_TRUE(args.IsTable());
    const ScriptVal *align = args.FindKeyConst("BTNC_Align");
    const ScriptVal *execute = args.FindKeyConst("BTNCS_Execute");
    ASSERT_NE(align, nullptr);
    ASSERT_NE(execute, nullptr);
    EXPECT_STREQ(align->GetString(), "Right");
    EXPECT_STREQ(execute->GetString(), "print(1)");
}

} // namespace
} // namespace Test
} // namespace Orbane
