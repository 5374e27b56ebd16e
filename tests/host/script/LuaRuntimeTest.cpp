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
        if (!error.empty())
            return "error: " + error;
        return Show(Global("result"));
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

// ---- creating objects

TEST_F(LuaTest, CreatesByClassIDAndByScriptTypeName)
{
    EXPECT_EQ(Eval(R"(
        local a = orbane.Create("WidgetControl", { WGT_Title = "A" })
        local b = require("orbane").Create("ScriptWidget")
        local c = orbane.Create("WidgetIDControl")
        result = { a:ClassID(), a:TypeName(), b:ClassID(), c:ClassID(), c:TypeName() })"),
              "WidgetControl; ScriptWidget; WidgetControl; WidgetIDControl; ScriptWidget");
    EXPECT_EQ(TestWidget::sAlive, mAlive + 3) << "the state still holds them";
}

TEST_F(LuaTest, UnknownClassesAreErrorsWithFileAndLine)
{
    EXPECT_EQ(Run("local x = 1\norbane.Create(\"TestWidget\")", "create.lua"),
              "create.lua:2: unknown class \"TestWidget\"");
    EXPECT_EQ(Run("orbane.Create()"), "test.lua:1: expected a class name, got no value");
    EXPECT_EQ(Run("orbane.Create('WidgetControl', 5)"), "test.lua:1: expected a table of tags, got number");
}

TEST_F(LuaTest, MappingErrorsCreateNothing)
{
    EXPECT_EQ(Run("orbane.Create('WidgetControl', { WGT_TriState = 'yes' })"),
              "test.lua:1: WGT_TriState: expected a boolean, got string");
    EXPECT_EQ(Run("orbane.Create('ScriptWidget', { Foo = 1 })"), "test.lua:1: unknown tag \"Foo\" for ScriptWidget");
    EXPECT_EQ(TestWidget::sAlive, mAlive);
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

TEST_F(LuaTest, ObjectsPrintTheirTypeName)
{
    EXPECT_EQ(Eval("result = tostring(orbane.Create('GadgetControl')):match('^[%w]+: ') ~= nil"), "true");
    EXPECT_EQ(Eval("result = tostring(orbane.Create('GadgetControl')):match('^%w+')"), "GadgetControl");
}

// ---- script errors

TEST_F(LuaTest, ErrorsCarryFileAndLine)
{
    EXPECT_EQ(Run("x = = 1", "syntax.lua").rfind("syntax.lua:1:", 0), 0u);
    EXPECT_EQ(Run("local function f()\n  error('deep')\nend\nf()", "nested.lua"), "nested.lua:2: deep");
    EXPECT_EQ(Run("error({})"), "(error object is a table value)");

    const std::string path = testing::TempDir() + "orbane_error_test.lua";
    std::ofstream(path) << "-- a file\n\nerror('boom')\n";
    std::string error;
    EXPECT_FALSE(Lua().RunFile(path, &error));
    EXPECT_EQ(error, path + ":3: boom");
    EXPECT_FALSE(Lua().RunFile(path + ".missing", &error));
    EXPECT_NE(error.find("orbane_error_test.lua.missing"), std::string::npos) << error;
    std::remove(path.c_str());
}

TEST_F(LuaTest, ResultsStayOnTheStackOnlyWhenAskedFor)
{
    lua_State *L = Lua().State();
    const int top = lua_gettop(L);
    EXPECT_TRUE(Lua().RunString("return 1, 2", "r.lua"));
    EXPECT_EQ(lua_gettop(L), top);
    ASSERT_TRUE(Lua().RunString("return 7, 'x'", "r.lua", nullptr, 2));
    ASSERT_EQ(lua_gettop(L), top + 2);
    EXPECT_EQ(lua_tointeger(L, -2), 7);
    EXPECT_STREQ(lua_tostring(L, -1), "x");
    lua_settop(L, top);
    EXPECT_FALSE(Lua().RunString("error('no')", "r.lua", nullptr, 1));
    EXPECT_EQ(lua_gettop(L), top) << "a failure leaves nothing";
}

// ---- the foreign-function interface

TEST_F(LuaTest, CastFunctionsSeeTheRealObject)
{
    EXPECT_EQ(Eval(R"(
        local ffi = require("ffi")
        local w = orbane.Create("WidgetControl", { WGT_Count = 7 })
        local g = orbane.Create("GadgetControl", { WGT_Count = 9 })
        local wc = ffi.C.ffi_TestWidget_cast(w)
        result = {
            ffi.C.test_TestWidget_count(wc),
            ffi.C.test_TestWidget_count(ffi.C.ffi_TestWidget_cast(g)),
            ffi.C.ffi_TestGadget_cast(w) == nil,
            ffi.C.ffi_TestWidget_cast(nil) == nil,
            ffi.C.ffi_TestWidget_uncast(wc) == w,
            tostring(ffi.typeof(wc)),
        })"),
              "7; 9; true; true; true; ctype<struct TestWidget *>");
}

TEST_F(LuaTest, DeclaresEachDeclarationOnce)
{
    std::string error;
    EXPECT_TRUE(Lua().DeclareFFI(&error)) << error;
    EXPECT_TRUE(Lua().DeclareFFI(&error)) << error;
    EXPECT_EQ(error, "");
    EXPECT_EQ(Eval("result = tostring(require('ffi').typeof('WidgetIDControl *'))"), "ctype<struct WidgetIDControl *>")
        << "ID variants' native names are declared too";
}

TEST_F(LuaTest, ABadDeclarationIsReportedByName)
{
    FFITypeT<Counted> type("BrokenScript", "Broken", "", -1, 0, nullptr);
    FFIFunc func(type, "f", "f", "broken_f", "Broken * broken_f(int", "", nullptr, "Broken *", 0);
    std::string error;
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

// ---- attributes

TEST_F(LuaTest, GetAndSetAttributesByName)
{
    EXPECT_EQ(Eval(R"(
        local w = orbane.Create("WidgetControl", { WGT_Title = "T", WGT_TriState = true,
                                                   WGT_Color = { R = 1, G = 0, B = 0 } })
        local before = w:GetAttrs()
        local ok = w:SetAttrs({ WGT_Title = "U", WGT_Align = "Right" })
        local after = w:GetAttrs()
        local c = before.WGT_Color
        result = { before.WGT_Title, before.WGT_TriState, string.format("%g %g %g %g", c.R, c.G, c.B, c.A),
                   ok, after.WGT_Title, after.WGT_Align })"),
              "T; true; 1 0 0 1; true; U; Right");
    EXPECT_EQ(Run("orbane.Create('WidgetControl'):SetAttrs({ Bogus = 1 })"),
              "test.lua:1: unknown tag \"Bogus\" for ScriptWidget");
}

TEST_F(LuaTest, VariantsAndDerivedClassesUseTheInheritedTagMap)
{
    EXPECT_EQ(Eval(R"(
        local v = orbane.Create("WidgetIDControl", { WGT_Title = "V", WGT_AddItem = { "a", "b" } })
        local g = orbane.Create("GadgetControl", { WGT_Align = 1 })
        result = { v:GetAttrs().WGT_Title, v:GetAttrs().WGT_AddItem, g:GetAttrs().WGT_Align })"),
              "V; {a, b}; CenteredLeft");
}

TEST_F(LuaTest, ObjectTagsTakeObjectsOfTheirType)
{
    EXPECT_EQ(Eval(R"(
        local partner = orbane.Create("GadgetControl")
        local w = orbane.Create("WidgetControl", { WGT_Partner = partner })
        result = { w:GetAttrs().WGT_Partner == partner, w:GetAttrs().WGT_Partner:TypeName() })"),
              "true; GadgetControl");
    EXPECT_EQ(Run("orbane.Create('WidgetControl', { WGT_Partner = 'name' })"),
              "test.lua:1: WGT_Partner: expected an object of type ScriptWidget, got string");
}

// ---- module functions

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
    const std::string format = R"(
        local function format(items)
            local out = {}
            for _, item in ipairs(items) do out[#out + 1] = string.format("%08X=%s", item.tag, tostring(item.value)) end
            return table.concat(out, " ")
        end
    )";
    EXPECT_EQ(Eval(format + "result = format(orbane.MapTags('ScriptWidget', { WGT_AddItem = { 'a', 'b' } }))"),
              "38050008=a 38050008=b");
    EXPECT_EQ(Eval(format + "result = format(orbane.MapTags('WidgetControl', { WGT_Align = 'Center' }))"),
              "10050005=2");
    EXPECT_EQ(Eval("result = #orbane.MapTags('WidgetControl')"), "0");
    EXPECT_EQ(Run("orbane.MapTags('WidgetControl', { WGT_Align = 'Middle' })")
                  .rfind("test.lua:1: WGT_Align: unknown value \"Middle\"", 0),
              0u);
    EXPECT_EQ(Run("orbane.MapTags('CheckBoxLike', {})"), "test.lua:1: unknown class \"CheckBoxLike\"");
}

int Twice(lua_State *L)
{
    lua_pushnumber(L, 2 * lua_tonumber(L, 1));
    return 1;
}

TEST_F(LuaTest, ModuleFunctionsAddedLaterSurviveAReset)
{
    Lua().AddModuleFunction("Twice", Twice);
    EXPECT_EQ(Eval("result = orbane.Twice(21)"), "42");
    Lua().Reset();
    EXPECT_EQ(Eval("result = { require('orbane').Twice(2), require('orbane') == orbane }"), "4; true");
}

// ---- conversions

TEST_F(LuaTest, LuaTablesConvertWithTheArrayPartFirst)
{
    ASSERT_EQ(Run("result = { 10, 20, 30, name = 'x', nested = { true } }"), "");
    const ScriptVal v = Global("result");
    ASSERT_TRUE(v.IsTable());
    ASSERT_EQ(v.GetEntries().size(), 5u);
    EXPECT_EQ(v.Length(), 3);
    for (int i = 0; i < 3; ++i)
        EXPECT_EQ(v.GetEntries()[std::size_t(i)].first, ScriptVal(i + 1));
    EXPECT_STREQ(v.FindKeyConst("name")->GetString(), "x");
    EXPECT_TRUE(v.FindKeyConst("nested")->FindKeyConst(1)->GetBool());
}

TEST_F(LuaTest, OtherValuesConvertByKind)
{
    ASSERT_EQ(Run(R"(
        local ffi = require("ffi")
        big = ffi.new("int64_t", 5)
        raw = ffi.cast("void *", 16)
        fn = print
        text = "a\0b")"),
              "");
    EXPECT_EQ(Global("big"), ScriptVal(5));
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
    t.SetKey("flag", true);
    t.SetKey("obj", obj);
    t.SetKey("inner", ScriptVal::NewTable());
    t.FindKey("inner")->Append(2.5);
    lua_State *L = Lua().State();
    LuaRuntime::Push(L, t);
    lua_setglobal(L, "pushed");
    t = ScriptVal();
    EXPECT_EQ(obj->RefCount(), 2) << "the script holds its own reference";
    EXPECT_EQ(Eval("result = { pushed[1], pushed.flag, pushed.inner[1], pushed.obj:TypeName() }"),
              "first; true; 2.5; Counted");

    lua_getglobal(L, "pushed");
    lua_getfield(L, -1, "obj");
    EXPECT_EQ(LuaRuntime::ToObject(L, -1), obj);
    EXPECT_EQ(LuaRuntime::ToObject(L, -2), nullptr) << "a table is no object";
    lua_pop(L, 2);
    obj->DecRef();
    EXPECT_EQ(deaths, 0);
    Lua().Reset();
    EXPECT_EQ(deaths, 1);
}

} // namespace Orbane
