// The cast declarations as the script layer's foreign-function interface
// really parses and binds them: LuaJIT's ffi calls the exported symbols.

#include "ExpectedClasses.h"

#include "orbane/LuaRuntime.h"
#include "orbane/RegistryList.h"
#include "orbane/ScriptObject.h"
#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

#include <gtest/gtest.h>

#include <string>

namespace Orbane {
namespace Test {
namespace {

class LuaCasts : public testing::Test
{
protected:
    void SetUp() override
    {
        std::string error;
        ASSERT_TRUE(LuaRuntime::Instance().DeclareFFI(&error)) << error;
    }

    static void Run(const std::string &code)
    {
        std::string error;
        EXPECT_TRUE(LuaRuntime::Instance().RunString(code, "LuaCastTest", &error)) << error;
    }

    // Gives a script the object as the global `obj`.
    static void Give(ScriptObject *obj)
    {
        lua_State *L = LuaRuntime::Instance().State();
        LuaRuntime::PushObject(L, obj);
        lua_setglobal(L, "obj");
    }

    // Drops the script's reference, so the object can go.
    static void Forget() { Run("obj = nil; collectgarbage(); collectgarbage()"); }
};

TEST_F(LuaCasts, EveryExportedPairIsCallableThroughFfi)
{
    for (const ExpectedClass &row : ExpectedClasses()) {
        if (!row.HasCasts())
            continue;
        SCOPED_TRACE(row.name);
        const std::string name = row.name;
        Run("local ffi = require('ffi')\n"
            "assert(ffi.C.ffi_" + name + "_cast(nil) == nil)\n"
            "assert(ffi.C.ffi_" + name + "_uncast(nil) == nil)");
    }
}

TEST_F(LuaCasts, ScriptCastsACheckBoxAndNotAButton)
{
    ScriptObject *box = ClassRegistry.New(OrbID("CheckboxControl"), ScriptVal(), TagList());
    ASSERT_NE(box, nullptr);
    Give(box);
    Run("local ffi = require('ffi')\n"
        "local typed = ffi.C.ffi_CheckBoxControl_cast(obj)\n"
        "assert(typed ~= nil, 'a check box casts to itself')\n"
        "assert(ffi.C.ffi_ButtonControl_cast(obj) == nil, 'a check box is no button')\n"
        "assert(ffi.C.ffi_CheckBoxControl_uncast(typed) == obj, 'uncast gives the object back')");
    Forget();
    box->DecRef();
}

} // namespace
} // namespace Test
} // namespace Orbane
