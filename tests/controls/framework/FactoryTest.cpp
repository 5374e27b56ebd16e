// Instances made through each registration's factory: their class, their
// size and the pooled memory they come from and go back to.

#include "ExpectedClasses.h"

#include "orbane/InputControl.h"
#include "orbane/OverlayControl.h"
#include "orbane/PreviewControl.h"
#include "orbane/Registry.h"
#include "orbane/RegistryList.h"
#include "orbane/Reuser.h"
#include "orbane/ScriptInfo.h"
#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"


#include <gtest/gtest.h>

#include <cstring>
#include <memory>
#include <set>
#include <typeindex>
#include <typeinfo>

namespace Orbane {
namespace Test {
namespace {

// Releases the creator's reference, which deletes the object.
struct Release
{
    void operator()(ScriptObject *obj) const { obj->DecRef(); }
};
using Held = std::unique_ptr<ScriptObject, Release>;

Held Create(const char *classID)
{
    return Held(ClassRegistry.New(OrbID(classID), ScriptVal(), TagList()));
}

class FactoryTable : public testing::TestWithParam<ExpectedClass>
{
};

TEST_P(FactoryTable, MakesAnObjectThatKnowsItsRegistration)
{
    const ExpectedClass &row = GetParam();
    Held obj = Create(row.classID);
    ASSERT_NE(obj, nullptr);
    EXPECT_EQ(obj->GetRegistry(), ClassRegistry.Find(OrbID(row.classID)));
    if (row.family == Family::Input)
        EXPECT_NE(dynamic_cast<InputControl *>(obj.get()), nullptr);
    else
        EXPECT_NE(dynamic_cast<PreviewControl *>(obj.get()), nullptr);
}

TEST_P(FactoryTable, SizeOfIsThePoolBlockThatComesBackOnDelete)
{
    Held obj = Create(GetParam().classID);
    ASSERT_NE(obj, nullptr);
    const std::size_t size = dynamic_cast<Object &>(*obj).SizeOf();
    const std::size_t familySize = GetParam().family == Family::Input ? sizeof(InputControl) : sizeof(PreviewControl);
    EXPECT_GE(size, familySize);
    ASSERT_NE(Reuser::ClassSize(size), 0u) << "small enough to be pooled";

    void *address = obj.get();
    const std::size_t waiting = Reuser::FreeBlocks(size);
    obj.reset();
    EXPECT_EQ(Reuser::FreeBlocks(size), waiting + 1);
    // The next object of the class is served from that very block.
    Held again = Create(GetParam().classID);
    EXPECT_EQ(static_cast<void *>(again.get()), address);
    EXPECT_EQ(Reuser::FreeBlocks(size), waiting);
}

TEST_P(FactoryTable, TellsTheScriptLayerItsBaseClass)
{
    const ExpectedClass &row = GetParam();
    Held obj = Create(row.classID);
    ASSERT_NE(obj, nullptr);
    const std::type_info *base = GetBaseTypeInfo(typeid(*obj));
    ASSERT_NE(base, nullptr);
    if (row.IsVariant()) {
        // A variant makes its primary's class, whose base is the family's.
        Held primary = Create(row.baseID);
        ASSERT_NE(primary, nullptr);
        EXPECT_EQ(typeid(*obj), typeid(*primary));
        EXPECT_EQ(*base, typeid(InputControl));
    } else if (std::strcmp(row.baseID, "InputControl") == 0) {
        EXPECT_EQ(*base, typeid(InputControl));
    } else if (std::strcmp(row.baseID, "PreviewControl") == 0) {
        EXPECT_EQ(*base, typeid(PreviewControl));
    } else if (std::strcmp(row.baseID, "OverlayControl") == 0) {
        EXPECT_EQ(*base, typeid(OverlayControl));
        EXPECT_NE(dynamic_cast<OverlayControl *>(obj.get()), nullptr);
    } else {
        Held parent = Create(row.baseID);
        ASSERT_NE(parent, nullptr);
        EXPECT_EQ(*base, typeid(*parent));
    }
}

std::string RowName(const testing::TestParamInfo<ExpectedClass> &info)
{
    return info.param.classID;
}

INSTANTIATE_TEST_SUITE_P(Library, FactoryTable, testing::ValuesIn(ExpectedClasses()), RowName);

TEST(Factory, EveryClassHasATypeOfItsOwn)
{
    // The exported casts tell classes apart by their run-time types.
    std::set<std::type_index> types;
    std::size_t classes = 0;
    for (const ExpectedClass &row : ExpectedClasses()) {
        if (row.IsVariant())
            continue;
        ++classes;
        Held obj = Create(row.classID);
        ASSERT_NE(obj, nullptr) << row.classID;
        types.insert(std::type_index(typeid(*obj)));
    }
    EXPECT_EQ(classes, 47u);
    EXPECT_EQ(types.size(), classes);
}

} // namespace
} // namespace Test
} // namespace Orbane
