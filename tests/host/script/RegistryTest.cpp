#include "Counted.h"
#include "TestClasses.h"

#include "orbane/Registry.h"
#include "orbane/RegistryList.h"
#include "orbane/ScriptVal.h"

#include <gtest/gtest.h>

#include <memory>

namespace Orbane {

using namespace Orbane::TestKit;

namespace {

struct Release
{
    void operator()(ScriptObject *obj) const { obj->DecRef(); }
};
using ObjectPtr = std::unique_ptr<ScriptObject, Release>;

int gInits = 0;
int gCleanups = 0;
const ClassHook kCountInit = [](Registry *) { return ++gInits > 0; };
const ClassHook kCountCleanup = [](Registry *) { return ++gCleanups > 0; };
const TagMapHook kNoMapping = [](OrbID, int32, ScriptVal &, TagList &) { return true; };
const FactoryFunc kMakeCounted = [](const Registry *, const ScriptVal &, const TagList &) -> ScriptObject * {
    static int deaths = 0;
    return new Counted(&deaths);
};

} // namespace

TEST(Registry, InitEntersTheListAndTheDestructorLeavesIt)
{
    RegistryList list;
    gInits = gCleanups = 0;
    {
        Registry reg;
        EXPECT_TRUE(
            reg._Init(list, OrbID("Local"),
                      {{REG_ClassInit, kCountInit}, {REG_ClassCleanup, kCountCleanup}, {REG_Factory, kMakeCounted}}));
        EXPECT_EQ(gInits, 1);
        EXPECT_EQ(list.Find(OrbID("Local")), &reg);
        EXPECT_STREQ(reg.Name(), "Local") << "without a registry name the class ID stands in";
        EXPECT_STREQ(ObjectPtr(list.New(OrbID("Local"), ScriptVal(), TagList()))->ScriptTypeName(), "Counted");
        EXPECT_EQ(gCleanups, 0);
    }
    EXPECT_EQ(gCleanups, 1);
    EXPECT_TRUE(list.All().empty());
}

// The base is given as the address of a static ID that another source file
// may construct later; it is read when asked for, not copied at _Init.
TEST(Registry, BaseIsReadThroughItsAddressOrGivenAsAValueAndLoopsEnd)
{
    RegistryList list;
    OrbID late;
    Registry base, derived, variant;
    base._Init(list, OrbID("Base"), {{REG_TagMapHook, kNoMapping}, {REG_Factory, kMakeCounted}});
    derived._Init(list, OrbID("Derived"), {{REG_BaseClassID, static_cast<const void *>(&late)}});
    EXPECT_EQ(derived.Base(), nullptr);
    late = OrbID("Base");
    EXPECT_EQ(derived.Base(), &base);
    EXPECT_EQ(derived.FindMapHook(), kNoMapping);
    EXPECT_TRUE(derived.IsA(OrbID("Base")));
    variant._Init(list, OrbID("Variant"), {{REG_BaseClassID, OrbID("Base")}});
    EXPECT_EQ(variant.Base(), &base);
    EXPECT_NE(ObjectPtr(variant.New(ScriptVal(), TagList())), nullptr) << "a variant borrows its base's factory";

    const OrbID a("LoopA"), b("LoopB");
    Registry ra, rb;
    ra._Init(list, a, {{REG_BaseClassID, static_cast<const void *>(&b)}});
    rb._Init(list, b, {{REG_BaseClassID, static_cast<const void *>(&a)}});
    EXPECT_EQ(ra.FindMapHook(), nullptr) << "base loops end";
    EXPECT_EQ(ra.New(ScriptVal(), TagList()), nullptr);
    EXPECT_FALSE(ra.IsA(OrbID("Elsewhere")));
}

} // namespace Orbane
