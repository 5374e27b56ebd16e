// The class registry side of the library's registrations, row by row against
// the published class table.

#include "ControlModule.h"
#include "ExpectedClasses.h"

#include "orbane/ClassIDs.h"
#include "orbane/Object.h"
#include "orbane/PreviewControl.h"
#include "orbane/Registry.h"
#include "orbane/RegistryList.h"
#include "orbane/ScriptInfo.h"

#include <gtest/gtest.h>

#include <regex>
#include <set>
#include <string>

namespace Orbane {
namespace Test {
namespace {

const std::set<std::string> kOwnCleanup = {"AngleControl", "EllipseControl", "FontfileControl", "SplineControl"};

std::vector<Tag> TagIds(const TagList &tags)
{
    std::vector<Tag> ids;
    for (const TagItem &item : tags.Items())
        ids.push_back(item.tag);
    return ids;
}

class RegistrationTable : public testing::TestWithParam<ExpectedClass>
{
protected:
    const Registry *Reg() const { return ClassRegistry.Find(OrbID(GetParam().classID)); }
};

TEST_P(RegistrationTable, IsRegisteredUnderItsClassIDWithItsNameBaseAndKind)
{
    const ExpectedClass &row = GetParam();
    const Registry *reg = Reg();
    ASSERT_NE(reg, nullptr);
    EXPECT_STREQ(reg->Name(), row.name);
    EXPECT_STREQ(reg->BaseClassID().c_str(), row.baseID);
    EXPECT_EQ(reg->Kind(), row.family == Family::Input ? REGKIND_InputControl : REGKIND_PreviewControl);
}

TEST_P(RegistrationTable, GivesItsRegistrationTagsInTheHostOrder)
{
    const ExpectedClass &row = GetParam();
    std::vector<Tag> expected = {REG_ClassInit,   REG_ClassCleanup, REG_Kind, REG_FormatLevel, REG_BuildStamp,
                                 REG_BaseClassID, REG_ScriptInfo,   REG_Name, REG_Factory};
    expected.insert(expected.end(), row.extras.begin(), row.extras.end());
    if (row.hook)
        expected.push_back(REG_TagMapHook);
    ASSERT_NE(Reg(), nullptr);
    EXPECT_EQ(TagIds(Reg()->Tags()), expected);
    EXPECT_EQ(Reg()->MapHook() != nullptr, row.hook);
}

TEST_P(RegistrationTable, CarriesFormatLevelInitHookAndBaseByAddress)
{
    const Registry *reg = Reg();
    ASSERT_NE(reg, nullptr);
    EXPECT_EQ(reg->Tags().GetInt(REG_FormatLevel), 7);
    EXPECT_EQ(reg->Tags().GetPtr(REG_ClassInit), reinterpret_cast<void *>(&Object::RegInit));
    const auto *base = static_cast<const OrbID *>(reg->Tags().GetPtr(REG_BaseClassID));
    ASSERT_NE(base, nullptr);
    EXPECT_STREQ(base->c_str(), GetParam().baseID);
    ASSERT_NE(reg->Factory(), nullptr);
}

TEST_P(RegistrationTable, HasScriptInfoOfVersionOneNamingItsClassID)
{
    const Registry *reg = Reg();
    ASSERT_NE(reg, nullptr);
    const ScriptInfo *info = reg->GetScriptInfo();
    ASSERT_NE(info, nullptr);
    EXPECT_EQ(info->Version(), 1);
    EXPECT_STREQ(info->ClassID(), GetParam().classID);
}

TEST_P(RegistrationTable, ExtraTagsHoldTheirValues)
{
    const Registry *reg = Reg();
    ASSERT_NE(reg, nullptr);
    for (Tag tag : GetParam().extras) {
        SCOPED_TRACE(tag);
        if (tag == REG_ClassFamily)
            EXPECT_STREQ(static_cast<const char *>(reg->Tags().GetPtr(tag)), "OverlayControl");
        else if (tag == REG_DisplayName)
            EXPECT_STREQ(reg->Tags().GetString(tag), "Spline Control");
        else if (tag == REG_MenuPath)
            EXPECT_STREQ(reg->Tags().GetString(tag), "Controls\\Spline");
        else
            EXPECT_EQ(reg->Tags().GetLong(tag), 1);
    }
}

TEST_P(RegistrationTable, CleansUpThroughItsFamilyOrItsOwnHook)
{
    const ExpectedClass &row = GetParam();
    ASSERT_NE(Reg(), nullptr);
    const ClassHook cleanup = reinterpret_cast<ClassHook>(Reg()->Tags().GetPtr(REG_ClassCleanup));
    ASSERT_NE(cleanup, nullptr);
    const ClassHook family = row.family == Family::Input ? &Object::RegCleanup : &PreviewControl::RegCleanup;
    if (kOwnCleanup.count(row.name))
        EXPECT_NE(cleanup, family);
    else
        EXPECT_EQ(cleanup, family);
}

std::string RowName(const testing::TestParamInfo<ExpectedClass> &info)
{
    return info.param.classID;
}

INSTANTIATE_TEST_SUITE_P(Library, RegistrationTable, testing::ValuesIn(ExpectedClasses()), RowName);

TEST(Registration, LibraryAddsOneRegistrationPerTableRow)
{
    EXPECT_EQ(ExpectedClasses().size(), 53u);
    EXPECT_EQ(ControlModule::AddedRegistrations(), ExpectedClasses().size());
    std::set<std::string> ids;
    for (const ExpectedClass &row : ExpectedClasses())
        ids.insert(row.classID);
    EXPECT_EQ(ids.size(), ExpectedClasses().size());
}

TEST(Registration, BuildStampNamesTheBuildDateAlike)
{
    const std::regex stamp(R"(Built: (Jan|Feb|Mar|Apr|May|Jun|Jul|Aug|Sep|Oct|Nov|Dec) [ 123]\d \d{4})");
    std::set<std::string> stamps;
    for (const ExpectedClass &row : ExpectedClasses()) {
        const Registry *reg = ClassRegistry.Find(OrbID(row.classID));
        ASSERT_NE(reg, nullptr) << row.classID;
        const char *text = reg->Tags().GetString(REG_BuildStamp, "");
        EXPECT_TRUE(std::regex_match(text, stamp)) << text;
        stamps.insert(text);
    }
    EXPECT_EQ(stamps.size(), 1u);
}

struct HostConstant
{
    const OrbID &id;
    const char *name;
};

TEST(Registration, HostClassIDConstantsLeadToTheirClasses)
{
    const HostConstant constants[] = {
        {CLSID_InputControl_Checkbox, "CheckBoxControl"},
        {CLSID_InputControl_Combo, "ComboControl"},
        {CLSID_InputControl_ComboID, "ComboControl"},
        {CLSID_InputControl_Label, "LabelControl"},
        {CLSID_InputControl_Nest, "LabelControl"},
        {CLSID_InputControl_Separator, "LabelControl"},
        {CLSID_InputControl_Spacer, "LabelControl"},
        {CLSID_InputControl_List, "ListControl"},
        {CLSID_InputControl_ListID, "ListControl"},
        {CLSID_InputControl_MultiButton, "MultiButtonControl"},
        {CLSID_InputControl_MultiButtonID, "MultiButtonControl"},
        {CLSID_InputControl_Slider, "SliderControl"},
        {CLSID_PreviewControl_Crop, "CropControl"},
    };
    for (const HostConstant &c : constants) {
        const Registry *reg = ClassRegistry.Find(c.id);
        ASSERT_NE(reg, nullptr) << c.id.c_str();
        EXPECT_STREQ(reg->Name(), c.name) << c.id.c_str();
    }
}

TEST(Registration, CheckboxScriptNameLeadsToTheCheckBoxButItsNativeNameDoesNot)
{
    const Registry *byScript = ClassRegistry.FindScriptName("CheckboxControl");
    ASSERT_NE(byScript, nullptr);
    EXPECT_EQ(byScript, ClassRegistry.Find(CLSID_InputControl_Checkbox));
    EXPECT_EQ(ClassRegistry.Find(OrbID("CheckBoxControl")), nullptr);
    EXPECT_EQ(ClassRegistry.FindScriptName("CheckBoxControl"), nullptr);
}

TEST(Registration, VariantsFindTheirPrimarysHook)
{
    for (const ExpectedClass &row : ExpectedClasses()) {
        if (!row.IsVariant())
            continue;
        const Registry *variant = ClassRegistry.Find(OrbID(row.classID));
        const Registry *primary = ClassRegistry.Find(OrbID(row.baseID));
        ASSERT_NE(variant, nullptr) << row.classID;
        ASSERT_NE(primary, nullptr) << row.baseID;
        EXPECT_EQ(variant->Base(), primary) << row.classID;
        EXPECT_EQ(variant->FindMapHook(), primary->MapHook()) << row.classID;
        EXPECT_EQ(variant->Factory(), primary->Factory()) << row.classID;
    }
}

} // namespace
} // namespace Test
} // namespace Orbane
