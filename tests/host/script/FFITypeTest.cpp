#include "TestClasses.h"

#include "orbane/FFIFunc.h"
#include "orbane/FFITagMap.h"
#include "orbane/FFIType.h"
#include "orbane/ScriptInfo.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>

namespace Orbane {

using TestKit::TestGadget;
using TestKit::TestWidget;

namespace {

// Classes known only to these tests.
struct Root
{
    virtual ~Root() = default;
};
struct Middle : Root
{
};
struct Leaf : Middle
{
};
struct Stranger
{
};

} // namespace

TEST(FFIType, ObjectsListThemselvesWhileTheyLive)
{
    const std::size_t before = FFIType::All().size();
    {
        FFITypeT<Stranger> type("StrangerScript", "Stranger", "", -1, 0, nullptr);
        EXPECT_EQ(FFIType::All().size(), before + 1);
        EXPECT_EQ(FFIType::FindScriptName("StrangerScript"), &type);
        EXPECT_STREQ(type.NativeName(), "Stranger");
        EXPECT_EQ(type.NativeType(), typeid(Stranger));
    }
    EXPECT_EQ(FFIType::All().size(), before);
    EXPECT_EQ(FFIType::FindScriptName("StrangerScript"), nullptr);
    EXPECT_EQ(FFIType::FindScriptName(nullptr), nullptr);
}

TEST(FFIType, GetFFITypeFallsBackAlongTypeInfoBases)
{
    FFITypeT<Root> rootType("RootScript", "Root", "", -1, 0, nullptr);
    SetTypeInfo(typeid(Middle), typeid(Root));
    SetTypeInfo(typeid(Leaf), typeid(Middle));
    EXPECT_EQ(GetFFIType(typeid(Leaf)), nullptr) << "nothing bound yet";
    SetFFIType(typeid(Root), &rootType);
    EXPECT_EQ(GetBaseTypeInfo(typeid(Leaf)), &typeid(Middle));
    EXPECT_EQ(GetBaseTypeInfo(typeid(Root)), nullptr);
    EXPECT_EQ(GetFFIType(typeid(Leaf)), &rootType);
    {
        FFITypeT<Middle> middleType("MiddleScript", "Middle", "RootScript", -1, 0, nullptr);
        SetFFIType(typeid(Middle), &middleType);
        EXPECT_EQ(GetFFIType(typeid(Leaf)), &middleType) << "the nearest base wins";
    }
    EXPECT_EQ(GetFFIType(typeid(Leaf)), &rootType) << "a destroyed type is unbound";
}

TEST(FFIType, TheFirstBindingOfAClassWins)
{
    // The widget's ID variant binds its script type to the same class later.
    const FFIType *bound = GetFFIType(typeid(TestWidget));
    ASSERT_NE(bound, nullptr);
    EXPECT_STREQ(bound->ScriptName(), "ScriptWidget");
    ASSERT_NE(FFIType::FindScriptName("WidgetIDControl"), nullptr);
    EXPECT_EQ(FFIType::FindScriptName("WidgetIDControl")->NativeType(), typeid(TestWidget));
    EXPECT_STREQ(GetFFIType(typeid(TestGadget))->ScriptName(), "GadgetControl");
}

TEST(FFITagMap, MapsBelongToTheirTypeAndCountTheirRows)
{
    const FFIType *widget = FFIType::FindScriptName("ScriptWidget");
    const FFITagMap *map = FFITagMap::ForType(widget);
    ASSERT_NE(map, nullptr);
    EXPECT_EQ(map->Count(), TestKit::kWidgetTagCount);
    EXPECT_STREQ(map->Method(), "Create");
    EXPECT_STREQ(map->MapName(), "InputControl.Create");
    EXPECT_EQ(map->Table(), TestKit::WidgetTags);
    EXPECT_EQ(FFITagMap::ForType(FFIType::FindScriptName("WidgetIDControl"))->Table(), TestKit::WidgetTags);
    EXPECT_EQ(FFITagMap::ForType(FFIType::FindScriptName("GadgetControl")), nullptr);
}

TEST(FFIFunc, FunctionsKeepTheirTypeAndDeclaration)
{
    const auto &all = FFIFunc::All();
    const auto cast = std::find_if(
        all.begin(), all.end(), [](const FFIFunc *f) { return std::strcmp(f->Symbol(), "ffi_TestWidget_cast") == 0; });
    ASSERT_NE(cast, all.end());
    EXPECT_EQ(&(*cast)->Type(), FFIType::FindScriptName("ScriptWidget"));
    EXPECT_STREQ((*cast)->Declaration(), "TestWidget * ffi_TestWidget_cast(void * obj)");
    EXPECT_STREQ((*cast)->ResultType(), "TestWidget *");
    EXPECT_STREQ((*cast)->ArgNames(), "obj");
    EXPECT_STREQ((*cast)->Name(), "_cast");
}

} // namespace Orbane
