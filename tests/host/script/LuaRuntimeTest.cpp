#include "Counted.h"
#include "TestClasses.h"
#include "TestShow.h"

#include "orbane/FFIFunc.h"
#include "orbane/FFIType.h"
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

// Every test starts from a fresh state with the test classes declared.
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
        return error.empty() ? Show(Global("result")) : "error: " + error;
    }

    static ScriptVal Global(const char *name)
    {
        lua_State *L = Lua().State();
        lua_getglobal(L, name);
        ScriptVal v = LuaRuntime::ToScriptVal(L, -1);
        lua_pop(L, 1);
        return v;
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

struct ErrorCase
{
    const char *name;
    const char *code;
    const char *error;
};

class LuaErrors : public LuaTest, public testing::WithParamInterface<ErrorCase>
{
};

// A failing call reports where the script made it, and creates nothing.
TEST_P(LuaErrors, FailWithFileLineAndMessage)
{
    EXPECT_EQ(Run(GetParam().code), GetParam().error);
    EXPECT_EQ(TestWidget::sAlive, mAlive);
}

INSTANTIATE_TEST_SUITE_P(
    Lua, LuaErrors,
    testing::Values(ErrorCase{"UnknownClass", "local x = 1\norbane.Create(\"TestWidget\")",
                              "test.lua:2: unknown class \"TestWidget\""},
                    ErrorCase{"NoClassName", "orbane.Create()", "test.lua:1: expected a class name, got no value"},
                    ErrorCase{"TagsNotATable", "orbane.Create('WidgetControl', 5)",
                              "test.lua:1: expected a table of tags, got number"},
                    ErrorCase{"WrongTagType", "orbane.Create('WidgetControl', { WGT_TriState = 'yes' })",
                              "test.lua:1: WGT_TriState: expected a boolean, got string"},
                    ErrorCase{"UnknownTag", "orbane.Create('ScriptWidget', { Foo = 1 })",
                              "test.lua:1: unknown tag \"Foo\" for ScriptWidget"},
                    ErrorCase{"MapTagsOfUnknownClass", "orbane.MapTags('CheckBoxLike', {})",
                              "test.lua:1: unknown class \"CheckBoxLike\""},
                    ErrorCase{"Nested", "local function f()\n  error('deep')\nend\nf()", "test.lua:2: deep"},
                    ErrorCase{"NotAString", "error({})", "(error object is a table value)"}),
    [](const auto &info) { return std::string(info.param.name); });

TEST_F(LuaTest, ErrorsCarryTheFileTheyCameFrom)
{
    EXPECT_EQ(Run("x = = 1", "syntax.lua").rfind("syntax.lua:1:", 0), 0u);
    const std::string path = testing::TempDir() + "orbane_error_test.lua";
    std::ofstream(path) << "-- a file\n\nerror('boom')\n";
    std::string error;
    EXPECT_FALSE(Lua().RunFile(path, &error));
    EXPECT_EQ(error, path + ":3: boom");
    EXPECT_FALSE(Lua().RunFile(path + ".missing", &error));
    EXPECT_NE(error.find("orbane_error_test.lua.missing"), std::string::npos) << error;
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

TEST_F(LuaTest, ResultsStayOnTheStackOnlyWhenAskedFor)
{
    lua_State *L = Lua().State();
    const int top = lua_gettop(L);
    EXPECT_TRUE(Lua().RunString("return 1, 2", "r.lua"));
    ASSERT_TRUE(Lua().RunString("return 7, 'x'", "r.lua", nullptr, 2));
    ASSERT_EQ(lua_gettop(L), top + 2);
    EXPECT_EQ(lua_tointeger(L, top + 1), 7) << "only the asked-for results stay";
    lua_settop(L, top);
    EXPECT_FALSE(Lua().RunString("error('no')", "r.lua", nullptr, 1));
    EXPECT_EQ(lua_gettop(L), top) << "a failure leaves nothing";
}

// The same class or a derived one gives the object, nil gives nil (and
// another class nil: ScriptValuesPushWithTheirObjects).
TEST_F(LuaTest, CastFunctionsSeeTheRealObject)
{
    EXPECT_EQ(Eval(R"(
        local ffi = require("ffi")
        local w, g = orbane.Create("WidgetControl"), orbane.Create("GadgetControl")
        local wc = ffi.C.ffi_TestWidget_cast(w)
        result = { ffi.C.ffi_TestWidget_uncast(wc) == w, ffi.C.ffi_TestWidget_uncast(ffi.C.ffi_TestWidget_cast(g)) == g,
                   ffi.C.ffi_TestWidget_cast(nil) == nil, tostring(ffi.typeof(wc)) })"),
              "true; true; true; ctype<struct TestWidget *>");
}

TEST_F(LuaTest, DeclaresEachDeclarationOnceAndReportsABadOneByName)
{
    std::string error;
    EXPECT_TRUE(Lua().DeclareFFI(&error)) << error;
    EXPECT_EQ(Eval("result = tostring(require('ffi').typeof('WidgetIDControl *'))"), "ctype<struct WidgetIDControl *>")
        << "ID variants' native names are declared too";
    FFITypeT<Counted> type("BrokenScript", "Broken", "", -1, 0, nullptr);
    FFIFunc func(type, "f", "f", "broken_f", "Broken * broken_f(int", "", nullptr, "Broken *", 0);
    EXPECT_FALSE(Lua().DeclareFFI(&error));
    EXPECT_EQ(error.rfind("Broken * broken_f(int;: ", 0), 0u) << error;
    EXPECT_EQ(Eval("result = tostring(require('ffi').typeof('Broken *'))"), "ctype<struct Broken *>")
        << "the good declarations went through";
}

TEST_F(LuaTest, LoadingAMissingLibraryFails)
{
    std::string error;
    EXPECT_FALSE(Lua().LoadLibrary("/nonexistent/liborbane_nothing.so", &error));
    EXPECT_NE(error.find("liborbane_nothing.so"), std::string::npos) << error;
    const std::string message = Run("orbane.LoadControls('/nonexistent/liborbane_nothing.so')");
    EXPECT_EQ(message.rfind("test.lua:1: /nonexistent/liborbane_nothing.so", 0), 0u) << message;
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
        result = {
            w.Name, w.ScriptType, w.BaseClassID, w.Tags,
            v.Name, v.ScriptType, v.BaseClassID, v.Tags,
            g.Name, g.ScriptType, g.BaseClassID, g.Tags,
            w.index < v.index and v.index < g.index,
        })"),
              "TestWidget; ScriptWidget; TestRoot; 10; TestWidget; WidgetIDControl; WidgetControl; 10; "
              "TestGadget; GadgetControl; WidgetControl; 0; true");
    EXPECT_EQ(Eval("result = #orbane.Classes()"), std::to_string(ClassRegistry.All().size()));
}

TEST_F(LuaTest, MapTagsShowsTheTagListATableBecomes)
{
    // Formatted in Lua: the order of a Lua table's named keys is Lua's own.
    EXPECT_EQ(Eval(R"(
        local out = {}
        for _, item in ipairs(orbane.MapTags('ScriptWidget', { WGT_AddItem = { 'a', 'b' } })) do
            out[#out + 1] = string.format("%08X=%s", item.tag, tostring(item.value))
        end
        result = { table.concat(out, " "), orbane.MapTags('WidgetControl', { WGT_Align = 'Center' })[1].value,
                   #orbane.MapTags('WidgetControl') })"),
              "38050008=a 38050008=b; 2; 0");
}

int Twice(lua_State *L)
{
    lua_pushnumber(L, 2 * lua_tonumber(L, 1));
    return 1;
}

TEST_F(LuaTest, ModuleFunctionsAddedLaterSurviveAReset)
{
    Lua().AddModuleFunction("Twice", Twice);
    Lua().Reset();
    EXPECT_EQ(Eval("result = { require('orbane').Twice(2), require('orbane') == orbane }"), "4; true");
}

TEST_F(LuaTest, LuaValuesConvertByKindWithTheArrayPartFirst)
{
    EXPECT_EQ(Eval(R"(result = { name = "x", 10, require("ffi").new("int64_t", 5), "a", { true } })"),
              "10; 5; a; {true}; name=x");
    ASSERT_EQ(Run(R"(raw = require("ffi").cast("void *", 16); fn = print; text = "a\0b")"), "");
    EXPECT_EQ(Global("raw").GetPointer(), reinterpret_cast<void *>(16));
    EXPECT_TRUE(Global("fn").IsNil()) << "functions have no script value";
    EXPECT_EQ(std::string(Global("text").GetString(), 3), std::string("a\0b", 3));
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
    lua_getglobal(L, "pushed");
    lua_getfield(L, -1, "obj");
    EXPECT_EQ(LuaRuntime::ToObject(L, -1), obj);
    EXPECT_EQ(LuaRuntime::ToObject(L, -2), nullptr) << "a table is no object";
    lua_pop(L, 2);
    obj->DecRef();
    Lua().Reset();
    EXPECT_EQ(deaths, 1);
}

} // namespace Orbane
