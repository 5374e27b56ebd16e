#include "Counted.h"
#include "TestClasses.h"
#include "TestShow.h"

#include "orbane/LuaRuntime.h"
#include "orbane/RegistryList.h"
#include "orbane/Reuser.h"
#include "orbane/ScriptVal.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <fstream>
#include <string>

namespace Orbane {

using namespace Orbane::TestKit;

class LuaTest : public testing::Test
{
protected:
    void SetUp() override
    {
        Lua().Reset();
        mAlive = TestWidget::sAlive;
    }
    void TearDown() override
    {
        Lua().Reset();
        EXPECT_EQ(TestWidget::sAlive, mAlive) << "closing the state released every object";
    }

    static LuaRuntime &Lua() { return LuaRuntime::Instance(); }

    // Runs a chunk; returns its error, empty on success.
    static std::string Run(const std::string &code, const std::string &chunk = "test.lua")
    {
        std::string error;
        Lua().RunString(code, chunk, &error);
        return error;
    }

    // The global `result` after running the code, shown as text.
    static std::string Eval(const std::string &code)
    {
        const std::string error = Run(code);
        if (!error.empty())
            return "error: " + error;
        lua_getglobal(Lua().State(), "result");
        const ScriptVal result = LuaRuntime::ToScriptVal(Lua().State(), -1);
        lua_pop(Lua().State(), 1);
        return Show(result);
    }

    int mAlive = 0;
};

TEST_F(LuaTest, CreatesByClassIDAndByScriptTypeName)
{
    EXPECT_EQ(Eval(R"(
        local a = orbane.Create("WidgetControl", { WGT_Title = "A" })
        local b = require("orbane").Create("ScriptWidget")
        local c = orbane.Create("WidgetIDControl")
        result = { a:ClassID(), a:TypeName(), b:ClassID(), c:ClassID(), c:TypeName(),
                   tostring(orbane.Create("GadgetControl")):match("^(%w+): ") })"),
              "WidgetControl; ScriptWidget; WidgetControl; WidgetIDControl; ScriptWidget; GadgetControl");
    EXPECT_EQ(TestWidget::sAlive, mAlive + 4) << "the state still holds them";
}

// Errors name the chunk and the line they were raised on, and leak nothing.
TEST_F(LuaTest, ErrorsCarryFileLineAndMessage)
{
    const std::pair<const char *, const char *> cases[] = {
        {"local x = 1\norbane.Create(\"TestWidget\")", "test.lua:2: unknown class \"TestWidget\""},
        {"orbane.Create('ScriptWidget', { Foo = 1 })", "test.lua:1: unknown tag \"Foo\" for ScriptWidget"},
        {"local function f()\n  error('deep')\nend\nf()", "test.lua:2: deep"},
    };
    for (const auto &[code, error] : cases)
        EXPECT_EQ(Run(code), error);
    EXPECT_EQ(TestWidget::sAlive, mAlive);
    EXPECT_EQ(Run("x = = 1", "syntax.lua").rfind("syntax.lua:1:", 0), 0u);
    const std::string path = testing::TempDir() + "orbane_error_test.lua";
    std::ofstream(path) << "-- a file\n\nerror('boom')\n";
    std::string error;
    EXPECT_FALSE(Lua().RunFile(path, &error));
    EXPECT_EQ(error, path + ":3: boom");
    std::remove(path.c_str());
}

TEST_F(LuaTest, AThrowingConstructorBecomesAnErrorAndGivesItsMemoryBack)
{
    Reuser::Trim();
    EXPECT_EQ(Run("orbane.Create('WidgetControl', { WGT_Count = -1 })"),
              "test.lua:1: creating ScriptWidget failed: negative count");
    EXPECT_EQ(Reuser::FreeBlocks(sizeof(TestWidget)), 1u);
    EXPECT_EQ(TestWidget::sAlive, mAlive);
}

TEST_F(LuaTest, ObjectsAreReleasedWhenCollected)
{
    ASSERT_EQ(Run("kept = orbane.Create('WidgetControl'); local dropped = orbane.Create('WidgetControl')"), "");
    EXPECT_EQ(Run("collectgarbage(); collectgarbage()"), "");
    EXPECT_EQ(TestWidget::sAlive, mAlive + 1);
    EXPECT_EQ(Run("kept = nil; collectgarbage(); collectgarbage()"), "");
    EXPECT_EQ(TestWidget::sAlive, mAlive);
}

TEST_F(LuaTest, AttributesGoByNameThroughTheInheritedTagMap)
{
    EXPECT_EQ(Eval(R"(
        local w = orbane.Create("WidgetControl", { WGT_Title = "T", WGT_Color = { R = 1, G = 0, B = 0 } })
        local before = w:GetAttrs()
        local ok = w:SetAttrs({ WGT_Title = "U", WGT_Align = "Right" })
        local c = before.WGT_Color
        local v = orbane.Create("WidgetIDControl", { WGT_AddItem = { "a", "b" } })
        local g = orbane.Create("GadgetControl", { WGT_Align = 1, WGT_Partner = w })
        result = { before.WGT_Title, string.format("%g %g %g %g", c.R, c.G, c.B, c.A), ok, w:GetAttrs().WGT_Title,
                   w:GetAttrs().WGT_Align, v:GetAttrs().WGT_AddItem, g:GetAttrs().WGT_Align, g:GetAttrs().WGT_Partner == w })"),
              "T; 1 0 0 1; true; U; Right; {a, b}; CenteredLeft; true");
    EXPECT_EQ(Run("orbane.Create('WidgetControl'):SetAttrs({ Bogus = 1 })"),
              "test.lua:1: unknown tag \"Bogus\" for ScriptWidget");
}

TEST_F(LuaTest, ClassesListsEveryRegistrationInOrder)
{
    EXPECT_EQ(Eval(R"(
        local found = {}
        for i, c in ipairs(orbane.Classes()) do found[c.ClassID] = c; c.index = i end
        local w, v, g = found.WidgetControl, found.WidgetIDControl, found.GadgetControl
        result = { w.Name, w.ScriptType, w.BaseClassID, w.Tags, v.Name, v.ScriptType, v.BaseClassID, g.Tags,
                   w.index < v.index and v.index < g.index })"),
              "TestWidget; ScriptWidget; TestRoot; 10; TestWidget; WidgetIDControl; WidgetControl; 0; true");
    EXPECT_EQ(Eval("result = #orbane.Classes()"), std::to_string(ClassRegistry.All().size()));
}

TEST_F(LuaTest, ScriptValuesPushWithTheirObjects)
{
    int deaths = 0;
    auto *obj = new Counted(&deaths);
    ScriptVal t = ScriptVal::NewTable();
    t.Append("first");
    t.SetKey("obj", obj);
    lua_State *L = Lua().State();
    LuaRuntime::Push(L, t);
    lua_setglobal(L, "pushed");
    t = ScriptVal();
    EXPECT_EQ(obj->RefCount(), 2) << "the script holds its own reference";
    EXPECT_EQ(
        Eval("result = { pushed[1], pushed.obj:TypeName(), require('ffi').C.ffi_TestWidget_cast(pushed.obj) == nil }"),
        "first; Counted; true");
    obj->DecRef();
    Lua().Reset();
    EXPECT_EQ(deaths, 1);
}

} // namespace Orbane
