// Script types, tag maps and the exported cast pairs of the registrations.

#include "ControlModule.h"
#include "ExpectedClasses.h"

#include "orbane/FFIFunc.h"
#include "orbane/FFITagMap.h"
#include "orbane/FFIType.h"
#include "orbane/LuaRuntime.h"
#include "orbane/RegistryList.h"
#include "orbane/ScriptObject.h"
#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"
#include "orbane/TagMapEntry.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <set>
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

const FFIFunc *FindFunc(const std::string &symbol)
{
    for (const FFIFunc *func : FFIFunc::All())
        if (symbol == func->Symbol())
            return func;
    return nullptr;
}

// Each row's kind agrees with its tag's type bits and carries the extra it needs.
void ExpectRowsWellFormed(const TagMapEntry *table)
{
    std::set<std::string> names;
    for (const TagMapEntry *row = table; row->name; ++row) {
        SCOPED_TRACE(row->name);
        EXPECT_TRUE(names.insert(row->name).second) << "named twice";
        const uint32 type = TagTypeOf(Tag(row->tag));
        switch (row->kind) {
        case TMK_Boolean:
        case TMK_Color:
        case TMK_Enumeration:
            EXPECT_EQ(type, TAGTYPE_Long);
            EXPECT_EQ(row->extra != nullptr, row->kind == TMK_Enumeration);
            break;
        case TMK_Object:
            EXPECT_TRUE(type == TAGTYPE_Object || type == TAGTYPE_Ptr);
            EXPECT_STREQ(static_cast<const char *>(row->extra), "Input");
            break;
        default:
            EXPECT_EQ(row->kind, TMK_Plain);
            EXPECT_EQ(row->extra, nullptr);
        }
    }
}

void ExpectScriptTypeAndTagMap(const ExpectedClass &row)
{
    if (!row.script) {
        if (!row.IsVariant()) { // the label's variants share its type
            EXPECT_EQ(FFIType::FindScriptName(row.name), nullptr);
        }
        EXPECT_EQ(FFIType::FindScriptName(row.classID), nullptr);
        return;
    }
    const FFIType *type = FFIType::FindScriptName(row.script);
    ASSERT_NE(type, nullptr);
    // An ID variant's type names itself as its native type.
    EXPECT_STREQ(type->NativeName(), row.IsVariant() ? row.script : row.name);
    EXPECT_STREQ(type->BaseName(), row.scriptBase);
    const FFITagMap *map = FFITagMap::ForType(type);
    if (!row.tagNamesKnown || row.tags == 0) {
        EXPECT_EQ(map, nullptr);
        return;
    }
    ASSERT_NE(map, nullptr);
    EXPECT_EQ(map->Count(), row.tags);
    EXPECT_STREQ(map->Method(), "Create");
    EXPECT_STREQ(map->MapName(), row.MapName());
    ExpectRowsWellFormed(map->Table());
}

void ExpectCastPair(const ExpectedClass &row)
{
    const std::string name = row.name;
    const FFIFunc *cast = FindFunc("ffi_" + name + "_cast");
    const FFIFunc *uncast = FindFunc("ffi_" + name + "_uncast");
    ASSERT_EQ(cast && uncast, row.HasCasts());
    ASSERT_EQ(Cast(name) && Uncast(name), row.HasCasts()) << "exported where declared";
    if (!row.HasCasts())
        return;
    EXPECT_STREQ(cast->Declaration(), (name + " * ffi_" + name + "_cast(void * obj)").c_str());
    EXPECT_STREQ(uncast->Declaration(), ("ScriptObject * ffi_" + name + "_uncast(" + name + " * self)").c_str());
    EXPECT_STREQ(cast->Type().ScriptName(), row.script);
    EXPECT_EQ(&uncast->Type(), &cast->Type());

    EXPECT_EQ(Cast(name)(nullptr), nullptr);
    ScriptObject *obj = ClassRegistry.New(OrbID(row.classID), ScriptVal(), TagList());
    ASSERT_NE(obj, nullptr);
    void *typed = Cast(name)(obj);
    EXPECT_EQ(typed, static_cast<void *>(obj));
    EXPECT_EQ(Uncast(name)(typed), obj);
    obj->DecRef();
}

class ScriptTable : public testing::TestWithParam<ExpectedClass>
{
};

TEST_P(ScriptTable, ScriptTypeTagMapAndCastPairMatchTheRow)
{
    const ExpectedClass &row = GetParam();
    ExpectScriptTypeAndTagMap(row);
    if (row.IsVariant()) {
        // The variant's class is the primary's, whose pair it does not repeat.
        EXPECT_EQ(FindFunc(std::string("ffi_") + row.classID + "_cast"), nullptr);
        EXPECT_EQ(Cast(row.classID), nullptr);
        return;
    }
    ExpectCastPair(row);
}

INSTANTIATE_TEST_SUITE_P(Library, ScriptTable, testing::ValuesIn(ExpectedClasses()),
                         [](const auto &info) { return std::string(info.param.classID); });

struct CastCase
{
    const char *castTo;   // native name of the cast
    const char *objectID; // class ID of the object cast
    bool sameObject;      // the cast yields the object; otherwise nil
};

using LuaCasts = testing::TestWithParam<CastCase>;

// As scripts call them, through LuaJIT's ffi: nil casts to nil, and an object
// casts (and uncasts back) only where it is of the class.
TEST_P(LuaCasts, CastYieldsTheObjectOnlyWhereItIsOfTheClass)
{
    std::string error;
    ASSERT_TRUE(LuaRuntime::Instance().DeclareFFI(&error)) << error;
    const CastCase &c = GetParam();
    char code[512];
    std::snprintf(code, sizeof code, R"(
        local ffi = require('ffi')
        local obj = orbane.Create('%s')
        local typed = ffi.C.ffi_%s_cast(obj)
        assert(ffi.C.ffi_%s_cast(nil) == nil, 'nil casts to nil')
        assert((typed ~= nil) == %s, 'cast')
        assert(typed == nil or ffi.C.ffi_%s_uncast(typed) == obj, 'uncast gives the object back'))",
                  c.objectID, c.castTo, c.castTo, c.sameObject ? "true" : "false", c.castTo);
    EXPECT_TRUE(LuaRuntime::Instance().RunString(code, "LuaCast", &error)) << error;
    LuaRuntime::Instance().RunString("collectgarbage(); collectgarbage()", "LuaCast");
}

// clang-format off
INSTANTIATE_TEST_SUITE_P(Library, LuaCasts,
                         testing::Values(CastCase{"CheckBoxControl", "CheckboxControl", true},
                                         CastCase{"CheckBoxControl", "ButtonControl", false},
                                         CastCase{"ComboControl", "ComboIDControl", true},
                                         CastCase{"TransformControl", "CameraControl", true},
                                         CastCase{"PointControl", "CropControl", false}),
                         [](const auto &info) { return std::string(info.param.castTo) + "_" + info.param.objectID; });
// clang-format on

} // namespace
} // namespace Test
} // namespace Orbane
