// The script side of the registrations: script types, tag maps and the
// declarations of the exported cast pairs, row by row.

#include "ControlModule.h"
#include "ExpectedClasses.h"

#include "orbane/FFIFunc.h"
#include "orbane/FFITagMap.h"
#include "orbane/FFIType.h"

#include <gtest/gtest.h>

#include <string>

namespace Orbane {
namespace Test {
namespace {

const FFIFunc *FindFunc(const std::string &symbol)
{
    for (const FFIFunc *func : FFIFunc::All())
        if (symbol == func->Symbol())
            return func;
    return nullptr;
}

class ScriptBindingTable : public testing::TestWithParam<ExpectedClass>
{
};

TEST_P(ScriptBindingTable, ScriptTypeNamesItsNativeTypeAndBase)
{
    const ExpectedClass &row = GetParam();
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
}

TEST_P(ScriptBindingTable, HasTheCreateTagMapWhereItsNamesArePublished)
{
    const ExpectedClass &row = GetParam();
    if (!row.script)
        return;
    const FFITagMap *map = FFITagMap::ForType(FFIType::FindScriptName(row.script));
    if (!row.tagNamesKnown || row.tags == 0) {
        EXPECT_EQ(map, nullptr);
        return;
    }
    ASSERT_NE(map, nullptr);
    EXPECT_EQ(map->Count(), row.tags);
    EXPECT_STREQ(map->Method(), "Create");
    EXPECT_STREQ(map->MapName(), row.MapName());
}

TEST_P(ScriptBindingTable, DeclaresItsCastPairForTheScriptLayer)
{
    const ExpectedClass &row = GetParam();
    const std::string name = row.name;
    const FFIFunc *cast = FindFunc("ffi_" + name + "_cast");
    const FFIFunc *uncast = FindFunc("ffi_" + name + "_uncast");
    if (row.IsVariant()) {
        // The variant's class is the primary's, whose pair it does not repeat.
        EXPECT_EQ(FindFunc(std::string("ffi_") + row.classID + "_cast"), nullptr);
        return;
    }
    if (!row.HasCasts()) {
        EXPECT_EQ(cast, nullptr);
        EXPECT_EQ(uncast, nullptr);
        return;
    }
    ASSERT_NE(cast, nullptr);
    ASSERT_NE(uncast, nullptr);
    EXPECT_STREQ(cast->Name(), "_cast");
    EXPECT_STREQ(cast->Declaration(), (name + " * ffi_" + name + "_cast(void * obj)").c_str());
    EXPECT_STREQ(cast->ArgNames(), "obj");
    EXPECT_STREQ(cast->ResultType(), (name + " *").c_str());
    EXPECT_STREQ(uncast->Name(), "_uncast");
    EXPECT_STREQ(uncast->Declaration(), ("ScriptObject * ffi_" + name + "_uncast(" + name + " * self)").c_str());
    EXPECT_STREQ(uncast->ArgNames(), "self");
    EXPECT_STREQ(uncast->ResultType(), "ScriptObject *");
    EXPECT_STREQ(cast->Type().ScriptName(), row.script);
    EXPECT_EQ(&uncast->Type(), &cast->Type());
}

TEST_P(ScriptBindingTable, ExportsItsCastPairExactlyWhereScriptable)
{
    const ExpectedClass &row = GetParam();
    if (row.IsVariant()) {
        EXPECT_EQ(ControlModule::Symbol(std::string("ffi_") + row.classID + "_cast"), nullptr);
        return;
    }
    const std::string name = row.name;
    EXPECT_EQ(ControlModule::Symbol("ffi_" + name + "_cast") != nullptr, row.HasCasts());
    EXPECT_EQ(ControlModule::Symbol("ffi_" + name + "_uncast") != nullptr, row.HasCasts());
}

std::string RowName(const testing::TestParamInfo<ExpectedClass> &info)
{
    return info.param.classID;
}

INSTANTIATE_TEST_SUITE_P(Library, ScriptBindingTable, testing::ValuesIn(ExpectedClasses()), RowName);

TEST(ScriptBinding, FortyFiveClassesExportACastPair)
{
    int exported = 0;
    for (const ExpectedClass &row : ExpectedClasses()) {
        const std::string name = row.name;
        if (!row.IsVariant() && ControlModule::Symbol("ffi_" + name + "_cast") &&
            ControlModule::Symbol("ffi_" + name + "_uncast"))
            ++exported;
    }
    EXPECT_EQ(exported, 45);
}

} // namespace
} // namespace Test
} // namespace Orbane
