// The exported cast pairs, called through dlsym as the script layer's
// foreign-function interface calls them.

#include "ControlModule.h"
#include "ExpectedClasses.h"

#include "orbane/RegistryList.h"
#include "orbane/ScriptObject.h"
#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

#include <gtest/gtest.h>

#include <string>

namespace Orbane {
namespace Test {
namespace {

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

ScriptObject *Create(const char *classID)
{
    return ClassRegistry.New(OrbID(classID), ScriptVal(), TagList());
}

struct CastCase
{
    const char *castTo;   // native name of the cast
    const char *objectID; // class ID of the object cast
    bool sameObject;      // the cast yields the object; otherwise null
};

class CastCases : public testing::TestWithParam<CastCase>
{
};

TEST_P(CastCases, CastYieldsTheObjectOnlyWhereItIsOfTheClass)
{
    const CastCase &c = GetParam();
    const CastFn cast = Cast(c.castTo);
    ASSERT_NE(cast, nullptr);
    ScriptObject *obj = Create(c.objectID);
    ASSERT_NE(obj, nullptr);
    EXPECT_EQ(cast(obj), c.sameObject ? static_cast<void *>(obj) : nullptr);
    obj->DecRef();
}

INSTANTIATE_TEST_SUITE_P(Library, CastCases,
                         testing::Values(CastCase{"CheckBoxControl", "CheckboxControl", true},
                                         CastCase{"CheckBoxControl", "ButtonControl", false},
                                         CastCase{"ButtonControl", "CheckboxControl", false},
                                         CastCase{"ComboControl", "ComboIDControl", true},
                                         CastCase{"ListControl", "ComboIDControl", false},
                                         CastCase{"LabelControl", "SpacerControl", true},
                                         CastCase{"PointControl", "CrosshairControl", false},
                                         CastCase{"PolyLineControl", "PolylineControl", true},
                                         CastCase{"TransformControl", "CameraControl", true},
                                         CastCase{"CameraControl", "TransformControl", false},
                                         CastCase{"CameraControl", "LightControl", false},
                                         CastCase{"SliderControl", "SliderOverlay", false},
                                         CastCase{"PointControl", "CropControl", false}));

TEST(Casts, EveryCastOfNullIsNullAndEveryUncastKeepsTheAddress)
{
    for (const ExpectedClass &row : ExpectedClasses()) {
        if (!row.HasCasts())
            continue;
        SCOPED_TRACE(row.name);
        const CastFn cast = Cast(row.name);
        const UncastFn uncast = Uncast(row.name);
        ASSERT_NE(cast, nullptr);
        ASSERT_NE(uncast, nullptr);
        EXPECT_EQ(cast(nullptr), nullptr);
        ScriptObject *obj = Create(row.classID);
        ASSERT_NE(obj, nullptr);
        void *typed = cast(obj);
        EXPECT_EQ(typed, static_cast<void *>(obj));
        EXPECT_EQ(uncast(typed), obj);
        obj->DecRef();
    }
}

} // namespace
} // namespace Test
} // namespace Orbane
