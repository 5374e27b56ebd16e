// The library's registrations as the host reads them: the tags every one must
// give, what each factory makes, the script types, tag maps and their hooks,
// and the exported cast pairs. The rules are checked on every registration; only the counts and the
// rows that differ from the rule are spelt out.

#include "ControlModule.h"

#include "orbane/ClassIDs.h"
#include "orbane/FFIFunc.h"
#include "orbane/FFITagMap.h"
#include "orbane/FFIType.h"
#include "orbane/InputControl.h"
#include "orbane/Object.h"
#include "orbane/PreviewControl.h"
#include "orbane/Registry.h"
#include "orbane/RegistryList.h"
#include "orbane/Reuser.h"
#include "orbane/ScriptError.h"
#include "orbane/ScriptInfo.h"
#include "orbane/ScriptVal.h"
#include "orbane/TagMapEntry.h"
#include "orbane/TagMapping.h"

#include <gtest/gtest.h>

#include <map>
#include <memory>
#include <regex>
#include <set>
#include <string>
#include <typeindex>
#include <vector>

namespace Orbane {
namespace Test {
namespace {

const std::set<std::string> kOwnCleanup = {"AngleControl", "EllipseControl", "FontfileControl", "SplineControl"};

struct Release
{
    void operator()(ScriptObject *obj) const { obj->DecRef(); }
};
using Held = std::unique_ptr<ScriptObject, Release>;

Held Create(const OrbID &classID)
{
    return Held(ClassRegistry.New(classID, ScriptVal(), TagList()));
}

// The library's registrations: the ones added while it loaded.
std::vector<const Registry *> Library()
{
    const auto &all = ClassRegistry.All();
    return std::vector<const Registry *>(all.end() - ControlModule::AddedRegistrations(), all.end());
}

// A second class ID for a class of the library: its base is a registration
// of the same native name.
bool IsVariant(const Registry *reg)
{
    return reg->Base() && std::string(reg->Base()->Name()) == reg->Name();
}

using CastFn = void *(*)(void *);
using UncastFn = ScriptObject *(*)(void *);

CastFn Cast(const std::string &name)
{
    return reinterpret_cast<CastFn>(ControlModule::Symbol("ffi_" + name + "_cast"));
}

UncastFn Uncast(const std::string &name)
{
    return reinterpret_cast<UncastFn>(ControlModule::Symbol("ffi_" + name + "_uncast"));
}

const FFIFunc *FindFunc(const std::string &symbol)
{
    for (const FFIFunc *func : FFIFunc::All())
        if (symbol == func->Symbol())
            return func;
    return nullptr;
}

std::vector<Tag> TagIds(const TagList &tags)
{
    std::vector<Tag> ids;
    for (const TagItem &item : tags.Items())
        ids.push_back(item.tag);
    return ids;
}

void ExpectStandardTags(const Registry *reg)
{
    const TagList &tags = reg->Tags();
    const std::vector<Tag> standard = {REG_ClassInit,   REG_ClassCleanup, REG_Kind, REG_FormatLevel, REG_BuildStamp,
                                       REG_BaseClassID, REG_ScriptInfo,   REG_Name, REG_Factory};
    const std::vector<Tag> ids = TagIds(tags);
    ASSERT_GE(ids.size(), standard.size());
    EXPECT_EQ(std::vector<Tag>(ids.begin(), ids.begin() + standard.size()), standard) << "the host's order";
    EXPECT_EQ(ids.back() == REG_TagMapHook, reg->MapHook() != nullptr) << "the hook comes last";
    EXPECT_EQ(tags.GetInt(REG_FormatLevel), 7);
    EXPECT_EQ(tags.GetPtr(REG_ClassInit), reinterpret_cast<void *>(&Object::RegInit));
    EXPECT_NE(tags.GetPtr(REG_BaseClassID), nullptr) << "the base is given by address";
    ASSERT_NE(reg->GetScriptInfo(), nullptr);
    EXPECT_EQ(reg->GetScriptInfo()->Version(), 1);
    EXPECT_EQ(reg->ClassID(), OrbID(reg->GetScriptInfo()->ClassID()));
    const ClassHook family = reg->Kind() == REGKIND_InputControl ? &Object::RegCleanup : &PreviewControl::RegCleanup;
    EXPECT_EQ(tags.GetPtr(REG_ClassCleanup) == reinterpret_cast<void *>(family), kOwnCleanup.count(reg->Name()) == 0);
    const std::regex date(R"(Built: (Jan|Feb|Mar|Apr|May|Jun|Jul|Aug|Sep|Oct|Nov|Dec) [ 123]\d \d{4})");
    const char *stamp = tags.GetString(REG_BuildStamp, "");
    EXPECT_TRUE(std::regex_match(stamp, date)) << stamp;
    EXPECT_STREQ(stamp, Library().front()->Tags().GetString(REG_BuildStamp)) << "one build";
}

// The factory makes an object of the registration's family and base class,
// served from the host's pool.
void ExpectPooledObjectOfItsKind(const Registry *reg)
{
    Held obj = Create(reg->ClassID());
    ASSERT_NE(obj, nullptr);
    EXPECT_EQ(obj->GetRegistry(), reg);
    const bool input = reg->Kind() == REGKIND_InputControl;
    EXPECT_TRUE(input ? dynamic_cast<InputControl *>(obj.get()) != nullptr
                      : reg->Kind() == REGKIND_PreviewControl && dynamic_cast<PreviewControl *>(obj.get()));
    const std::type_info *base = GetBaseTypeInfo(typeid(*obj));
    ASSERT_NE(base, nullptr);
    if (Held parent = Create(reg->BaseClassID())) { // none where the base is a family
        EXPECT_EQ(IsVariant(reg) ? typeid(*obj) : *base, typeid(*parent));
    }
    const std::size_t size = dynamic_cast<Object &>(*obj).SizeOf();
    EXPECT_GE(size, input ? sizeof(InputControl) : sizeof(PreviewControl));
    ASSERT_NE(Reuser::ClassSize(size), 0u) << size << " bytes: small enough to be pooled";
    void *address = obj.get();
    const std::size_t waiting = Reuser::FreeBlocks(size);
    obj.reset();
    EXPECT_EQ(Reuser::FreeBlocks(size), waiting + 1);
    EXPECT_EQ(static_cast<void *>(Create(reg->ClassID()).get()), address) << "served from the freed block";
}

// A primary with a hook of its own exports a cast pair, declared for scripts,
// that casts its objects to themselves and back; a variant repeats neither.
void ExpectCastPair(const Registry *reg)
{
    if (IsVariant(reg)) {
        EXPECT_EQ(reg->MapHook(), nullptr);
        EXPECT_EQ(reg->FindMapHook(), reg->Base()->MapHook());
        EXPECT_EQ(reg->Factory(), reg->Base()->Factory());
        EXPECT_EQ(Cast(reg->ClassID().c_str()), nullptr);
        return;
    }
    const std::string name = reg->Name();
    const FFIFunc *cast = FindFunc("ffi_" + name + "_cast"), *uncast = FindFunc("ffi_" + name + "_uncast");
    const bool hasCasts = reg->MapHook() != nullptr;
    ASSERT_EQ(cast && uncast, hasCasts);
    ASSERT_EQ(Cast(name) && Uncast(name), hasCasts) << "exported where declared";
    if (!hasCasts)
        return;
    EXPECT_STREQ(cast->Declaration(), (name + " * ffi_" + name + "_cast(void * obj)").c_str());
    EXPECT_STREQ(uncast->Declaration(), ("ScriptObject * ffi_" + name + "_uncast(" + name + " * self)").c_str());
    EXPECT_EQ(&uncast->Type(), &cast->Type());
    EXPECT_EQ(ClassRegistry.FindScriptName(cast->Type().ScriptName()), reg);
    EXPECT_EQ(Cast(name)(nullptr), nullptr);
    Held obj = Create(reg->ClassID());
    void *typed = Cast(name)(obj.get());
    EXPECT_EQ(typed, static_cast<void *>(obj.get()));
    EXPECT_EQ(Uncast(name)(typed), obj.get());
}

TEST(Registration, EveryRegistrationFollowsTheHostsRules)
{
    for (const Registry *reg : Library()) {
        SCOPED_TRACE(reg->ClassID().c_str());
        ExpectStandardTags(reg);
        ExpectPooledObjectOfItsKind(reg);
        ExpectCastPair(reg);
    }
}

// 53 class IDs for 47 classes of distinct types, 45 of them with casts.
TEST(Registration, Counts)
{
    std::set<std::string> ids;
    std::set<std::type_index> types;
    int classes = 0, casts = 0;
    for (const Registry *reg : Library()) {
        ids.insert(reg->ClassID().c_str());
        if (IsVariant(reg))
            continue;
        ++classes;
        types.insert(std::type_index(typeid(*Create(reg->ClassID()))));
        casts += Cast(reg->Name()) != nullptr;
    }
    EXPECT_EQ(ControlModule::AddedRegistrations(), 53u);
    EXPECT_EQ(ids.size(), 53u);
    EXPECT_EQ(classes, 47);
    EXPECT_EQ(types.size(), 47u);
    EXPECT_EQ(casts, 45);
}

// The rows that differ from the rule: extra tags, and names that are not the
// class ID.
TEST(Registration, ExtraTagsAndNames)
{
    const TagList &spline = ClassRegistry.Find(OrbID("SplineControl"))->Tags();
    EXPECT_EQ(spline.GetLong(REG_SplineFlag), 1);
    EXPECT_STREQ(spline.GetString(REG_DisplayName), "Spline Control");
    EXPECT_STREQ(spline.GetString(REG_MenuPath), "Controls\\Spline");
    const TagList &overlay = ClassRegistry.Find(OrbID("SliderOverlay"))->Tags();
    EXPECT_EQ(overlay.GetLong(REG_PreviewFlag64), 1);
    EXPECT_STREQ(static_cast<const char *>(overlay.GetPtr(REG_ClassFamily)), "OverlayControl");
    const TagList &camera = ClassRegistry.Find(OrbID("CameraControl"))->Tags();
    EXPECT_EQ(camera.GetLong(REG_PreviewFlag64) + camera.GetLong(REG_PreviewFlag65), 2);
    EXPECT_STREQ(ClassRegistry.Find(OrbID("CubeControl"))->Name(), "ObloidControl");
    EXPECT_STREQ(ClassRegistry.Find(OrbID("SpacerControl"))->Name(), "LabelControl");
    EXPECT_EQ(ClassRegistry.FindScriptName("ImageOverlayControl"), ClassRegistry.Find(OrbID("ImgOverlayControl")));
    // The check box's script name differs from its native name in case.
    EXPECT_EQ(ClassRegistry.FindScriptName("CheckboxControl"), ClassRegistry.Find(CLSID_InputControl_Checkbox));
    EXPECT_EQ(ClassRegistry.FindScriptName("CheckBoxControl"), nullptr);
    for (const OrbID &id :
         {CLSID_InputControl_Checkbox, CLSID_InputControl_Combo, CLSID_InputControl_ComboID, CLSID_InputControl_Label,
          CLSID_InputControl_Nest, CLSID_InputControl_Separator, CLSID_InputControl_Spacer, CLSID_InputControl_List,
          CLSID_InputControl_ListID, CLSID_InputControl_MultiButton, CLSID_InputControl_MultiButtonID,
          CLSID_InputControl_Slider, CLSID_PreviewControl_Crop})
        EXPECT_NE(ClassRegistry.Find(id), nullptr) << id.c_str();
}

// Each row's kind agrees with its tag's type bits and carries the extra it needs.
void ExpectRowsWellFormed(const TagMapEntry *table)
{
    std::set<std::string> names;
    for (const TagMapEntry *row = table; row->name; ++row) {
        SCOPED_TRACE(row->name);
        EXPECT_TRUE(names.insert(row->name).second) << "named twice";
        const uint32 type = TagTypeOf(Tag(row->tag));
        if (row->kind == TMK_Boolean || row->kind == TMK_Color || row->kind == TMK_Enumeration) {
            EXPECT_EQ(type, TAGTYPE_Long);
            EXPECT_EQ(row->extra != nullptr, row->kind == TMK_Enumeration);
        } else if (row->kind == TMK_Object) {
            EXPECT_TRUE(type == TAGTYPE_Object || type == TAGTYPE_Ptr);
            EXPECT_STREQ(static_cast<const char *>(row->extra), "Input");
        } else {
            EXPECT_EQ(row->kind, TMK_Plain);
            EXPECT_EQ(row->extra, nullptr);
        }
    }
}

// Only the classes whose tag names are published have maps, each named for
// its family's "Create".
TEST(TagMaps, PublishedMapsAreWellFormed)
{
    std::map<std::string, int> counts;
    for (const FFITagMap *map : FFITagMap::All()) {
        const Registry *reg = ClassRegistry.FindScriptName(map->Type().ScriptName());
        if (!reg)
            continue;
        SCOPED_TRACE(map->Type().ScriptName());
        counts[map->Type().ScriptName()] = map->Count();
        EXPECT_STREQ(map->Method(), "Create");
        // The tracker is an overlay whose map carries the inspector's name.
        const bool inputName = reg->Kind() == REGKIND_InputControl || std::string(reg->Name()) == "TrackerControl";
        EXPECT_STREQ(map->MapName(), inputName ? "InputControl.Create" : "PreviewControl.Create");
        ExpectRowsWellFormed(map->Table());
    }
    std::map<std::string, int> published = {
        {"AngleControl", 16},         {"ButtonControl", 2}, {"CheckboxControl", 1},   {"CheckListControl", 7},
        {"ClipControl", 3},           {"ComboControl", 5},  {"ComboIDControl", 5},    {"CrosshairControl", 7},
        {"EllipseControl", 53},       {"FileControl", 4},   {"FontFileControl", 3},   {"ImageOverlayControl", 32},
        {"LabelControl", 10},         {"ListControl", 4},   {"ListIDControl", 4},     {"MultiButtonControl", 33},
        {"MultiButtonIDControl", 33}, {"OffsetControl", 2}, {"PointControl", 4},      {"PolylineControl", 56},
        {"PositionerControl", 16},    {"RangeControl", 14}, {"RectangleControl", 35}, {"ScriptValListControl", 4},
        {"ScrewControl", 1},          {"SliderControl", 4}, {"TransformControl", 10}, {"XYOffsetControl", 1}};
    // The colour and tone controls.
    published.insert({{"ColorControl", 6}, {"ColorWheelControl", 3}, {"GradientControl", 2}});
    published.insert({{"ColorSuppressionControl", 7}, {"ColorRangesControl", 4}, {"LevelsControl", 3}});
    published.insert({{"LevelsOutputControl", 3}, {"SplineControl", 21}});
    published.insert({"PatternControl", 2});
    // The 3D overlays.
    published.insert({{"CameraControl", 26}, {"LightControl", 1}, {"ObloidControl", 46}});
    published.insert({{"MeshControl", 43}, {"TrackerControl", 9}});
    EXPECT_EQ(counts, published);
    const auto table = [](const char *type) { return FFITagMap::ForType(FFIType::FindScriptName(type))->Table(); };
    EXPECT_EQ(table("ComboIDControl"), table("ComboControl")) << "variants share their primary's table";
    EXPECT_EQ(table("ListIDControl"), table("ListControl"));
    EXPECT_EQ(table("MultiButtonIDControl"), table("MultiButtonControl"));
    EXPECT_EQ(table("ScriptValListControl"), table("ListControl"));
}

// The hooks map by the published "Create" tables.
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

} // namespace
} // namespace Test
} // namespace Orbane
