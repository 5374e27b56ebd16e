#include "orbane/LuaSandbox.h"
#include "orbane/LuaRuntime.h"
#include "orbane/ScriptObject.h"
#include "orbane/ScriptVal.h"

#include <gtest/gtest.h>

#include <string>

namespace Orbane {

namespace {

lua_State *State()
{
    return LuaRuntime::Instance().State();
}

// Runs code as content named "comp.lua"; its error, empty on success.
std::string Content(const std::string &code)
{
    std::string error;
    if (LuaSandbox::LoadString(State(), code, "comp.lua", &error))
        LuaSandbox::Call(State(), 0, 0, "comp.lua", &error);
    return error;
}

// Runs code with full power and gives its one result as a string.
std::string FullPower(const std::string &code)
{
    std::string error;
    if (!LuaRuntime::Instance().RunString("return tostring(" + code + ")", "script.lua", &error, 1))
        return "error: " + error;
    const std::string result = lua_tostring(State(), -1);
    lua_pop(State(), 1);
    return result;
}

// Content that runs content: the module call runs its own text again.
int RunItself(lua_State *L)
{
    std::string error;
    if (LuaSandbox::LoadString(L, "orbane.RunItself()", "self.lua", &error) &&
        LuaSandbox::Call(L, 0, 0, "self.lua", &error))
        return 0;
    lua_pushstring(L, error.c_str());
    return lua_error(L);
}

// A host object much larger than the Lua value that holds it, as a control is.
class Bulky : public RefObject
{
public:
    std::size_t SizeOf() const override { return sizeof(Bulky); }

private:
    char mPayload[4000] = {};
};

int MakeBulky(lua_State *L)
{
    auto *bulky = new Bulky;
    LuaRuntime::PushObject(L, bulky);
    bulky->DecRef();
    return 1;
}

struct Case
{
    const char *name;
    const char *code;
    const char *error; // a part of the message
};

class LuaSandboxTest : public testing::TestWithParam<Case>
{
protected:
    void SetUp() override
    {
        LuaRuntime::Instance().Reset();
        LuaRuntime::Instance().AddModuleFunction("MakeBulky", MakeBulky);
        LuaSandbox::AllowCall("MakeBulky");
        // Low limits keep the runs short under the sanitizers.
        LuaSandbox::SetLimits({1'000'000, std::size_t(32) << 20});
    }
    void TearDown() override
    {
        LuaSandbox::SetLimits(LuaSandbox::kDefaultLimits);
        LuaRuntime::Instance().Reset();
    }
};

// Each way out of the sandbox, tried alone: every one must end in an error.
class SandboxEscape : public LuaSandboxTest
{
};

TEST_P(SandboxEscape, Fails)
{
    const std::string error = Content(GetParam().code);
    EXPECT_NE(error.find(GetParam().error), std::string::npos) << "got: " << error;
    EXPECT_EQ(FullPower("escaped"), "nil") << "the run left no mark on the real globals";
}

const Case kEscapes[] = {
    {"io", "io.open('/etc/passwd')", "global 'io'"},
    {"os_execute", "os.execute('true')", "field 'execute'"},
    {"os_remove", "os.remove('/tmp/x')", "field 'remove'"},
    {"require_ffi", "require('ffi')", "global 'require'"},
    {"package_loadlib", "package.loadlib('libc.so.6', 'system')", "global 'package'"},
    {"debug", "debug.getregistry()", "global 'debug'"},
    {"jit", "jit.off()", "global 'jit'"},
    {"dofile", "dofile('/etc/passwd')", "global 'dofile'"},
    {"loadfile", "loadfile('/etc/passwd')", "global 'loadfile'"},
    {"getfenv", "escaped = getfenv(0).io", "global 'getfenv'"},
    {"setfenv", "setfenv(1, {})", "global 'setfenv'"},
    {"collectgarbage", "collectgarbage('stop')", "global 'collectgarbage'"},
    {"string_dump", "load(string.dump(function() end))", "field 'dump'"},
    {"string_method_dump", "local s = ''\ns.dump(print)", "field 'dump'"},
    {"string_metatable", "getmetatable('').__index.dump(print)", "index a nil value"},
    {"load_reader", "assert(load(function() return nil end))", "load takes the text of a chunk"},
    {"load_bytecode", "assert(load('\\27LJ\\2\\0'))", "wrong mode"},
    {"loaded_chunk_env", "assert(load('return io')(), 'no io in a loaded chunk')", "no io in a loaded chunk"},
    {"global_table", "assert(rawget(_G, 'os').exit, 'no exit')", "no exit"},
    {"coroutine_env", "assert(coroutine.wrap(function() return io end)(), 'no io')", "no io"},
    {"load_libraries", "orbane.LoadControls('/tmp/lib.so')", "field 'LoadControls'"},
    {"globals_written", "escaped = true\nerror('written only here')", "written only here"},
};

INSTANTIATE_TEST_SUITE_P(Escapes, SandboxEscape, testing::ValuesIn(kEscapes),
                         [](const auto &info) { return std::string(info.param.name); });

// Endless loops and growth stop with a message that names the file, however
// the script tries to carry on; the state works normally afterwards.
class SandboxLimit : public LuaSandboxTest
{
};

TEST_P(SandboxLimit, StopsTheRun)
{
    const std::string error = Content(GetParam().code);
    EXPECT_EQ(error.rfind("comp.lua: stopped", 0), 0u) << "got: " << error;
    EXPECT_NE(error.find(GetParam().error), std::string::npos) << "got: " << error;
    EXPECT_EQ(FullPower("(function() local n = 0 for i = 1, 1e7 do n = n + 1 end return n end)()"), "10000000")
        << "full-power scripts have no budget";
    EXPECT_EQ(FullPower("#string.rep('x', 64 * 1024 * 1024)"), "67108864") << "nor a memory cap";
    EXPECT_EQ(FullPower("jit.status()"), "true") << "the JIT is back on";
}

const Case kLimits[] = {
    {"endless_loop", "while true do end", "instructions"},
    {"endless_numeric_loop", "local x = 0 for i = 1, math.huge do x = x + i end", "instructions"},
    {"loop_in_coroutine", "coroutine.wrap(function() while true do end end)()", "instructions"},
    {"pcall_swallows_budget", "while true do pcall(function() while true do end end) end", "instructions"},
    {"tail_calls", "local function f() return f() end\nf()", "instructions"},
    {"growing_table", "local t = {}\nwhile true do t[#t + 1] = ('x'):rep(1000) .. #t end", "MB of memory"},
    {"doubling_string", "local s = 'x'\nwhile true do s = s .. s end", "MB of memory"},
    {"huge_rep", "local s = string.rep('x', 2 ^ 30)", "MB of memory"},
    {"pcall_swallows_memory", "local t = {}\nwhile true do pcall(function() t[#t + 1] = ('y'):rep(1e5) .. #t end) end",
     "MB of memory"},
    {"host_objects_held", "local t = {}\nwhile true do t[#t + 1] = orbane.MakeBulky() end", "MB of memory"},
};

INSTANTIATE_TEST_SUITE_P(Limits, SandboxLimit, testing::ValuesIn(kLimits),
                         [](const auto &info) { return std::string(info.param.name); });

TEST_F(LuaSandboxTest, ContentStillComputes)
{
    EXPECT_EQ(Content(R"(
        local t = { 3, 1, 2 }
        table.sort(t)
        assert(table.concat(t, ",") == "1,2,3")
        assert(string.format("%.1f", math.sqrt(2)) == "1.4")
        assert(("abc"):upper() == "ABC")
        x = 41
        assert(load("return x + 1")() == 42, "a loaded chunk shares the environment")
        assert(type(os.clock()) == "number" and type(os.date("%Y")) == "string")
        assert(_G.x == 41)
        local c = orbane.Classes()
        assert(type(c) == "table")
    )"),
              "");
}

// Objects let go of are paid back: many times the cap made and dropped is fine.
TEST_F(LuaSandboxTest, HostObjectsLetGoAreNotCounted)
{
    EXPECT_EQ(Content("for i = 1, 30000 do local o = orbane.MakeBulky() end"), "");
    EXPECT_EQ(Content("local t = {}\nfor i = 1, 6000 do t[i] = orbane.MakeBulky() end"), "") << "24 MB held fits in 32";
}

TEST_F(LuaSandboxTest, EveryRunStartsFresh)
{
    ASSERT_EQ(Content("left = 1\nstring.upper = nil"), "");
    EXPECT_EQ(Content("assert(left == nil, 'a global of the last run')\nassert(string.upper('a') == 'A')"), "");
    EXPECT_EQ(FullPower("left"), "nil");
    EXPECT_EQ(FullPower("string.upper('a')"), "A");
}

TEST_F(LuaSandboxTest, ContentThatRunsItselfStopsAtTheDepthLimit)
{
    LuaRuntime::Instance().AddModuleFunction("RunItself", RunItself);
    LuaSandbox::AllowCall("RunItself");
    const std::string error = Content("orbane.RunItself()");
    EXPECT_NE(error.find("nested deeper than 8 levels"), std::string::npos) << error;
}

// Tables that contain themselves, nest without end or stand for more entries
// than memory holds are refused with a reason, not walked or cut silently.
TEST_F(LuaSandboxTest, TablesThatCannotBeValuesAreRefused)
{
    const Case cases[] = {
        {"self", "local t = {}\nt.me = t\nreturn t", "a table contains itself"},
        {"cycle", "local a, b = {}, {}\na.b = b\nb.a = a\nreturn { a }", "a table contains itself"},
        {"deep", "local t = {}\nfor i = 1, 500 do t = { t } end\nreturn t", "tables are nested too deeply"},
        {"shared", "local t = {}\nfor i = 1, 24 do t = { t, t } end\nreturn t", "tables hold too many entries"},
    };
    for (const Case &c : cases) {
        SCOPED_TRACE(c.name);
        ASSERT_TRUE(LuaRuntime::Instance().RunString(c.code, "t.lua", nullptr, 1));
        ScriptVal out;
        std::string error;
        EXPECT_FALSE(LuaRuntime::ToScriptVal(State(), -1, out, error));
        EXPECT_EQ(error, c.error);
        lua_pop(State(), 1);
        if (c.name == std::string("shared"))
            continue; // one walk of a million entries is enough
        std::string raised;
        LuaRuntime::Instance().RunString(
            std::string("orbane.MapTags('ScriptWidget', (function() ") + c.code + " end)())", "t.lua", &raised);
        EXPECT_NE(raised.find(c.error), std::string::npos) << raised;
    }
}

} // namespace

} // namespace Orbane
