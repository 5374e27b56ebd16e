#include "Counted.h"
#include "TestClasses.h"

#include "orbane/Registry.h"
#include "orbane/RegistryList.h"
#include "orbane/ScriptInfo.h"
#include "orbane/ScriptVal.h"

#include <gtest/gtest.h>

#include <memory>
#include <typeinfo>

namespace Orbane {

using TestKit::GadgetClassID;
using TestKit::TestGadget;
using TestKit::TestWidget;
using TestKit::WidgetClassID;
using TestKit::WidgetIDClassID;

namespace {

// Releases the creator's reference at the end of a test.
struct Release
{
    void operator()(ScriptObject *obj) const { obj->DecRef(); }
};
using ObjectPtr = std::unique_ptr<ScriptObject, Release>;

ObjectPtr Create(const OrbID &classID, const TagList &tags = {})
{
    return ObjectPtr(ClassRegistry.New(classID, ScriptVal::NewTable(), tags));
}

// Hooks that count their calls, for registrations made inside one test.
int gInits = 0;
int gCleanups = 0;
bool CountInit(Registry *)
{
    ++gInits;
    return true;
}
bool CountCleanup(Registry *)
{
    ++gCleanups;
    return true;
}
bool NoMapping(OrbID, int32, ScriptVal &, TagList &)
{
    return true;
}
ScriptObject *MakeCounted(const Registry *, const ScriptVal &, const TagList &)
{
    static int deaths = 0;
    return new TestKit::Counted(&deaths);
}

} // namespace

TEST(ClassRegistry, FindsClassesByClassID)
{
    const Registry *reg = ClassRegistry.Find(WidgetClassID);
    ASSERT_NE(reg, nullptr);
    EXPECT_EQ(reg->ClassID(), OrbID("WidgetControl"));
    EXPECT_STREQ(reg->Name(), "TestWidget");
    EXPECT_EQ(reg->Kind(), REGKIND_InputControl);
    EXPECT_EQ(reg->BaseClassID(), OrbID("TestRoot"));
    ASSERT_NE(reg->GetScriptInfo(), nullptr);
    EXPECT_EQ(reg->GetScriptInfo()->NativeType(), typeid(TestWidget));
    EXPECT_STREQ(reg->GetScriptInfo()->ClassID(), "WidgetControl");
    EXPECT_NE(reg->Factory(), nullptr);
    EXPECT_NE(reg->MapHook(), nullptr);
    EXPECT_EQ(reg->Tags().GetInt(REG_FormatLevel), 7) << "the registration tags stay readable";
    EXPECT_EQ(ClassRegistry.Find(OrbID("NoSuchControl")), nullptr);
    EXPECT_EQ(ClassRegistry.Find(OrbID()), nullptr);
}

TEST(ClassRegistry, FindsByScriptNameButNotByNativeName)
{
    const Registry *widget = ClassRegistry.Find(WidgetClassID);
    EXPECT_EQ(ClassRegistry.FindScriptName("WidgetControl"), widget) << "a class ID is a script name";
    EXPECT_EQ(ClassRegistry.FindScriptName("ScriptWidget"), widget) << "the bound script type";
    EXPECT_EQ(ClassRegistry.FindScriptName("WidgetIDControl"), ClassRegistry.Find(WidgetIDClassID));
    EXPECT_EQ(ClassRegistry.FindScriptName("TestWidget"), nullptr) << "the native name is neither";
    EXPECT_EQ(ClassRegistry.FindScriptName(""), nullptr);
    EXPECT_EQ(ClassRegistry.FindScriptName(nullptr), nullptr);
    EXPECT_EQ(ClassRegistry.FindNativeName("TestWidget"), widget) << "the registration with the hook wins";
}

TEST(ClassRegistry, KeepsRegistrationOrder)
{
    const auto &all = ClassRegistry.All();
    const auto at = [&](const OrbID &id) { return std::find(all.begin(), all.end(), ClassRegistry.Find(id)); };
    EXPECT_LT(at(WidgetClassID), at(WidgetIDClassID));
    EXPECT_LT(at(WidgetIDClassID), at(GadgetClassID));
}

TEST(ClassRegistry, CreatesThroughTheFactory)
{
    const int alive = TestWidget::sAlive;
    {
        ObjectPtr obj = Create(WidgetClassID, {{TestKit::WGT_Count, 3}});
        ASSERT_NE(obj, nullptr);
        auto *widget = dynamic_cast<TestWidget *>(obj.get());
        ASSERT_NE(widget, nullptr);
        EXPECT_EQ(widget->Count(), 3);
        EXPECT_EQ(obj->GetRegistry(), ClassRegistry.Find(WidgetClassID));
        EXPECT_EQ(TestWidget::sAlive, alive + 1);
    }
    EXPECT_EQ(TestWidget::sAlive, alive);
    EXPECT_EQ(ClassRegistry.New(OrbID("NoSuchControl"), ScriptVal(), TagList()), nullptr);
}

// The variant shares the primary's factory: the object is of the primary
// class, and it keeps the variant's registry, which tells the two apart.
TEST(ClassRegistry, AnIDVariantCreatesItsPrimaryClass)
{
    const Registry *variant = ClassRegistry.Find(WidgetIDClassID);
    ASSERT_NE(variant, nullptr);
    EXPECT_EQ(variant->Base(), ClassRegistry.Find(WidgetClassID));
    EXPECT_EQ(variant->MapHook(), nullptr);
    ObjectPtr obj = Create(WidgetIDClassID);
    ASSERT_NE(obj, nullptr);
    EXPECT_EQ(typeid(*obj), typeid(TestWidget));
    EXPECT_EQ(obj->GetRegistry(), variant);
}

TEST(ClassRegistry, MapHooksAreInheritedAlongTheBaseChain)
{
    const Registry *widget = ClassRegistry.Find(WidgetClassID);
    const Registry *variant = ClassRegistry.Find(WidgetIDClassID);
    const Registry *gadget = ClassRegistry.Find(GadgetClassID);
    EXPECT_EQ(variant->FindMapHook(), widget->MapHook());
    EXPECT_EQ(gadget->FindMapHook(), widget->MapHook());
    EXPECT_TRUE(gadget->IsA(WidgetClassID));
    EXPECT_TRUE(gadget->IsA(OrbID("TestRoot")));
    EXPECT_FALSE(widget->IsA(GadgetClassID));
    ObjectPtr obj = Create(GadgetClassID);
    EXPECT_NE(dynamic_cast<TestGadget *>(obj.get()), nullptr);
}

TEST(Registry, InitEntersTheListAndTheDestructorLeavesIt)
{
    RegistryList list;
    gInits = gCleanups = 0;
    {
        Registry reg;
        EXPECT_TRUE(
            reg._Init(list, OrbID("Local"),
                      {{REG_ClassInit, &CountInit}, {REG_ClassCleanup, &CountCleanup}, {REG_Factory, &MakeCounted}}));
        EXPECT_EQ(gInits, 1);
        EXPECT_EQ(list.Find(OrbID("Local")), &reg);
        EXPECT_STREQ(reg.Name(), "Local") << "without a registry name the class ID stands in";
        ObjectPtr obj(list.New(OrbID("Local"), ScriptVal(), TagList()));
        EXPECT_STREQ(obj->ScriptTypeName(), "Counted");
        EXPECT_EQ(gCleanups, 0);
    }
    EXPECT_EQ(gCleanups, 1);
    EXPECT_TRUE(list.All().empty());
}

// The base is given as the address of a static ID that another source file
// may construct later; it is read when asked for, not copied at _Init.
TEST(Registry, BaseClassIDIsReadThroughItsAddress)
{
    RegistryList list;
    OrbID late;
    Registry base, derived;
    base._Init(list, OrbID("Base"), {{REG_TagMapHook, &NoMapping}});
    derived._Init(list, OrbID("Derived"), {{REG_BaseClassID, static_cast<const void *>(&late)}});
    EXPECT_EQ(derived.Base(), nullptr);
    late = OrbID("Base");
    EXPECT_EQ(derived.BaseClassID(), OrbID("Base"));
    EXPECT_EQ(derived.Base(), &base);
    EXPECT_EQ(derived.FindMapHook(), &NoMapping);
}

TEST(Registry, BaseClassIDMayBeAnIdentifierValue)
{
    RegistryList list;
    Registry base, derived;
    base._Init(list, OrbID("Base"), {{REG_Factory, &MakeCounted}});
    derived._Init(list, OrbID("Derived"), {{REG_BaseClassID, OrbID("Base")}});
    EXPECT_EQ(derived.Base(), &base);
    ObjectPtr obj(derived.New(ScriptVal(), TagList()));
    EXPECT_NE(obj, nullptr) << "a variant without a factory borrows its base's";
}

TEST(Registry, BaseLoopsEndWithoutAHook)
{
    RegistryList list;
    const OrbID a("LoopA"), b("LoopB");
    Registry ra, rb;
    ra._Init(list, a, {{REG_BaseClassID, static_cast<const void *>(&b)}});
    rb._Init(list, b, {{REG_BaseClassID, static_cast<const void *>(&a)}});
    EXPECT_EQ(ra.FindMapHook(), nullptr);
    EXPECT_EQ(ra.New(ScriptVal(), TagList()), nullptr);
    EXPECT_FALSE(ra.IsA(OrbID("Elsewhere")));
}

TEST(Registry, ReinitMovesToTheNewList)
{
    RegistryList first, second;
    Registry reg;
    reg._Init(first, OrbID("Moving"), {});
    reg._Init(second, OrbID("Moving"), {});
    EXPECT_TRUE(first.All().empty());
    EXPECT_EQ(second.All().size(), 1u);
}

} // namespace Orbane
