// The library's registrations row by row against the published class table:
// what the class registry holds, and what each factory makes.

#include "ControlModule.h"
#include "ExpectedClasses.h"

#include "orbane/ClassIDs.h"
#include "orbane/InputControl.h"
#include "orbane/Object.h"
#include "orbane/PreviewControl.h"
#include "orbane/Registry.h"
#include "orbane/RegistryList.h"
#include "orbane/Reuser.h"
#include "orbane/ScriptInfo.h"
#include "orbane/ScriptVal.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <memory>
#include <regex>
#include <set>
#include <string>
#include <typeindex>

namespace Orbane {
namespace Test {
namespace {

const std::set<std::string> kOwnCleanup = {"AngleControl", "EllipseControl", "FontfileControl", "SplineControl"};

struct Release
{
    void operator()(ScriptObject *obj) const { obj->DecRef(); }
};
using Held = std::unique_ptr<ScriptObject, Release>;

Held Create(const char *classID)
{
    return Held(ClassRegistry.New(OrbID(classID), ScriptVal(), TagList()));
}

// The tags every registration gives, in the host's order, then the row's
// extras and the hook.
std::vector<Tag> ExpectedTagIds(const ExpectedClass &row)
{
    std::vector<Tag> ids = {REG_ClassInit,   REG_ClassCleanup, REG_Kind, REG_FormatLevel, REG_BuildStamp,
                            REG_BaseClassID, REG_ScriptInfo,   REG_Name, REG_Factory};
    ids.insert(ids.end(), row.extras.begin(), row.extras.end());
    if (row.hook)
        ids.push_back(REG_TagMapHook);
    return ids;
}

std::vector<Tag> TagIds(const TagList &tags)
{
    std::vector<Tag> ids;
    for (const TagItem &item : tags.Items())
        ids.push_back(item.tag);
    return ids;
}

void ExpectExtraValues(const ExpectedClass &row, const TagList &tags)
{
    for (Tag tag : row.extras) {
        SCOPED_TRACE(tag);
        if (tag == REG_ClassFamily)
            EXPECT_STREQ(static_cast<const char *>(tags.GetPtr(tag)), "OverlayControl");
        else if (tag == REG_DisplayName)
            EXPECT_STREQ(tags.GetString(tag), "Spline Control");
        else if (tag == REG_MenuPath)
            EXPECT_STREQ(tags.GetString(tag), "Controls\\Spline");
        else
            EXPECT_EQ(tags.GetLong(tag), 1);
    }
}

class ClassTable : public testing::TestWithParam<ExpectedClass>
{
};

TEST_P(ClassTable, RegistrationHoldsTheRowsColumns)
{
    const ExpectedClass &row = GetParam();
    const Registry *reg = ClassRegistry.Find(OrbID(row.classID));
    ASSERT_NE(reg, nullptr);
    const TagList &tags = reg->Tags();
    EXPECT_STREQ(reg->Name(), row.name);
    EXPECT_EQ(reg->Kind(), row.family == Family::Input ? REGKIND_InputControl : REGKIND_PreviewControl);
    EXPECT_EQ(TagIds(tags), ExpectedTagIds(row));
    EXPECT_EQ(reg->MapHook() != nullptr, row.hook);
    EXPECT_EQ(tags.GetInt(REG_FormatLevel), 7);
    EXPECT_EQ(tags.GetPtr(REG_ClassInit), reinterpret_cast<void *>(&Object::RegInit));
    const auto *base = static_cast<const OrbID *>(tags.GetPtr(REG_BaseClassID));
    ASSERT_NE(base, nullptr) << "the base is given by address";
    EXPECT_STREQ(base->c_str(), row.baseID);
    ASSERT_NE(reg->GetScriptInfo(), nullptr);
    EXPECT_EQ(reg->GetScriptInfo()->Version(), 1);
    EXPECT_STREQ(reg->GetScriptInfo()->ClassID(), row.classID);
    ExpectExtraValues(row, tags);

    const void *cleanup = tags.GetPtr(REG_ClassCleanup);
    const ClassHook family = row.family == Family::Input ? &Object::RegCleanup : &PreviewControl::RegCleanup;
    ASSERT_NE(cleanup, nullptr);
    EXPECT_EQ(cleanup == reinterpret_cast<void *>(family), kOwnCleanup.count(row.name) == 0);

    const std::regex date(R"(Built: (Jan|Feb|Mar|Apr|May|Jun|Jul|Aug|Sep|Oct|Nov|Dec) [ 123]\d \d{4})");
    const char *stamp = tags.GetString(REG_BuildStamp, "");
    EXPECT_TRUE(std::regex_match(stamp, date)) << stamp;
    EXPECT_STREQ(stamp, ClassRegistry.Find(OrbID("AngleControl"))->Tags().GetString(REG_BuildStamp)) << "one build";

    if (row.IsVariant()) {
        const Registry *primary = ClassRegistry.Find(OrbID(row.baseID));
        ASSERT_NE(primary, nullptr);
        EXPECT_EQ(reg->Base(), primary);
        EXPECT_EQ(reg->FindMapHook(), primary->MapHook());
        EXPECT_EQ(reg->Factory(), primary->Factory());
    }
}

TEST_P(ClassTable, FactoryMakesAPooledObjectOfItsFamilyAndBase)
{
    const ExpectedClass &row = GetParam();
    Held obj = Create(row.classID);
    ASSERT_NE(obj, nullptr);
    EXPECT_EQ(obj->GetRegistry(), ClassRegistry.Find(OrbID(row.classID)));
    if (row.family == Family::Input)
        EXPECT_NE(dynamic_cast<InputControl *>(obj.get()), nullptr);
    else
        EXPECT_NE(dynamic_cast<PreviewControl *>(obj.get()), nullptr);

    const std::type_info *base = GetBaseTypeInfo(typeid(*obj));
    ASSERT_NE(base, nullptr);
    Held parent = Create(row.baseID); // none where the base is a family
    if (row.IsVariant()) {
        ASSERT_NE(parent, nullptr);
        EXPECT_EQ(typeid(*obj), typeid(*parent)) << "a variant makes its primary's class";
    } else if (parent) {
        EXPECT_EQ(*base, typeid(*parent));
    }

    const std::size_t size = dynamic_cast<Object &>(*obj).SizeOf();
    EXPECT_GE(size, row.family == Family::Input ? sizeof(InputControl) : sizeof(PreviewControl));
    ASSERT_NE(Reuser::ClassSize(size), 0u) << "small enough to be pooled";
    void *address = obj.get();
    const std::size_t waiting = Reuser::FreeBlocks(size);
    obj.reset();
    EXPECT_EQ(Reuser::FreeBlocks(size), waiting + 1);
    EXPECT_EQ(static_cast<void *>(Create(row.classID).get()), address) << "served from the freed block";
}

INSTANTIATE_TEST_SUITE_P(Library, ClassTable, testing::ValuesIn(ExpectedClasses()),
                         [](const auto &info) { return std::string(info.param.classID); });

// The exported casts tell classes apart by their run-time types.
TEST(Registration, LibraryAddsOneRegistrationPerRowOneTypePerClassAndFortyFiveCastPairs)
{
    EXPECT_EQ(ExpectedClasses().size(), 53u);
    EXPECT_EQ(ControlModule::AddedRegistrations(), ExpectedClasses().size());
    std::set<std::string> ids;
    std::set<std::type_index> types;
    std::size_t classes = 0;
    int exported = 0;
    for (const ExpectedClass &row : ExpectedClasses()) {
        ids.insert(row.classID);
        if (row.IsVariant())
            continue;
        ++classes;
        Held obj = Create(row.classID);
        ASSERT_NE(obj, nullptr) << row.classID;
        types.insert(std::type_index(typeid(*obj)));
        const std::string name = row.name;
        exported += ControlModule::Symbol("ffi_" + name + "_cast") && ControlModule::Symbol("ffi_" + name + "_uncast");
    }
    EXPECT_EQ(ids.size(), ExpectedClasses().size());
    EXPECT_EQ(classes, 47u);
    EXPECT_EQ(types.size(), classes);
    EXPECT_EQ(exported, 45);
}

// Each constant names a row of the table, whose class it finds.
TEST(Registration, HostClassIDConstantsAndScriptNamesLeadToTheirClasses)
{
    for (const OrbID &id :
         {CLSID_InputControl_Checkbox, CLSID_InputControl_Combo, CLSID_InputControl_ComboID, CLSID_InputControl_Label,
          CLSID_InputControl_Nest, CLSID_InputControl_Separator, CLSID_InputControl_Spacer, CLSID_InputControl_List,
          CLSID_InputControl_ListID, CLSID_InputControl_MultiButton, CLSID_InputControl_MultiButtonID,
          CLSID_InputControl_Slider, CLSID_PreviewControl_Crop}) {
        const auto &rows = ExpectedClasses();
        const auto row = std::find_if(rows.begin(), rows.end(), [&](const auto &r) { return id == r.classID; });
        ASSERT_NE(row, rows.end()) << id.c_str();
        ASSERT_NE(ClassRegistry.Find(id), nullptr) << id.c_str();
        EXPECT_STREQ(ClassRegistry.Find(id)->Name(), row->name);
    }
    // The check box's script name differs from its native name in case.
    EXPECT_EQ(ClassRegistry.FindScriptName("CheckboxControl"), ClassRegistry.Find(CLSID_InputControl_Checkbox));
    EXPECT_EQ(ClassRegistry.Find(OrbID("CheckBoxControl")), nullptr);
    EXPECT_EQ(ClassRegistry.FindScriptName("CheckBoxControl"), nullptr);
}

} // namespace
} // namespace Test
} // namespace Orbane
