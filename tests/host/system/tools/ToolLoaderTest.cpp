#include "orbane/ToolLoader.h"
#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/LuaRuntime.h"
#include "orbane/LuaSandbox.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/Prefs.h"

#include <QDir>
#include <QFile>
#include <QTemporaryDir>

#include <gtest/gtest.h>

#include <string>

namespace Orbane {
namespace {

const char kTool[] = R"(return { inputs = { { id = "Size", type = "Number", default = 1 } } })";

struct CompCase
{
    const char *name;
    const char *comp;  // the text of comp.lua
    const char *other; // the text of other.lua, a tool file it may name
    const char *error; // a part of the message
};

// What a user sees of a document: the tools, the time, the preferences the
// comp sets, and the history.
std::string Shown(const OrbaneDoc &doc)
{
    std::string shown;
    for (const Operator *tool : doc.Tools())
        shown += std::string(tool->GetName()) + ",";
    shown += " t=" + std::to_string(doc.GetCurrentTime());
    shown += " aspect=" + std::to_string(doc.GetPrefs().GetDouble(PREF_ViewerPixelAspect, -1));
    shown += " image=" + std::string(doc.GetPrefs().GetString(PREF_ViewerImage, ""));
    shown += " undo=" + std::to_string(doc.UndoNames().size());
    return shown;
}

// A comp that fails in any way leaves the document exactly as it was, and
// says why, naming the file.
class BadComp : public testing::TestWithParam<CompCase>
{
protected:
    void SetUp() override
    {
        LuaRuntime::Instance().Reset();
        LuaSandbox::SetLimits({1'000'000, std::size_t(32) << 20});
    }
    void TearDown() override { LuaSandbox::SetLimits(LuaSandbox::kDefaultLimits); }

    static void Write(const QString &path, const char *text)
    {
        QFile file(path);
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
        file.write(text);
    }
};

TEST_P(BadComp, LeavesTheDocumentAsItWas)
{
    QTemporaryDir dir;
    Write(dir.filePath("comp.lua"), GetParam().comp);
    Write(dir.filePath("tool.lua"), kTool);
    Write(dir.filePath("other.lua"), GetParam().other);
    OrbaneDoc doc;
    AutoRef<Operator> keep(new Operator("Keep1", "Keep"));
    Input *in = keep->AddInput("Size", "Size", CLSID_DataType_Number, {}, AutoNumber(1.0));
    doc.AddTool(keep);
    doc.SetCurrentTime(5);
    ASSERT_TRUE(in->SetValue(AutoNumber(2.0), 5));
    const std::string before = Shown(doc);
    std::string error;
    EXPECT_FALSE(ToolLoader::LoadComp(doc, dir.filePath("comp.lua").toStdString(), &error));
    EXPECT_NE(error.find(GetParam().error), std::string::npos) << "got: " << error;
    EXPECT_NE(error.find(".lua"), std::string::npos) << "the message names the file: " << error;
    EXPECT_EQ(Shown(doc), before);
}

const CompCase kBadComps[] = {
    {"syntax", "return {", "", "near '<eof>'"},
    {"not_a_table", "return 42", "", "the file must return a table"},
    {"runtime_error", "error('broken comp')", "", "broken comp"},
    {"os_execute", "os.execute('touch /tmp/orbane-pwned') return {}", "", "field 'execute'"},
    {"io", "io.open('/etc/passwd') return {}", "", "global 'io'"},
    {"endless_loop", "while true do end", "", "instructions"},
    {"endless_growth", "local t = {} while true do t[#t + 1] = ('x'):rep(999) .. #t end", "", "MB of memory"},
    {"contains_itself", "local c = { tools = {} } c.tools.back = c return c", "", "a table contains itself"},
    {"tools_not_a_list", "return { tools = 5 }", "", "tools must be a list"},
    {"tool_without_file", "return { tools = { { name = 'A1' } } }", "", "names no file"},
    {"tool_file_missing", "return { tools = { { file = 'none.lua', name = 'A1' } } }", "", "none.lua"},
    {"second_tool_fails",
     "return { tools = { { file = 'tool.lua', name = 'A1' }, { file = 'other.lua', name = 'B1' } } }",
     "while true do end", "other.lua: stopped"},
    {"tool_with_bad_input",
     "return { tools = { { file = 'tool.lua', name = 'A1' }, { file = 'other.lua', name = 'B1' } } }",
     "return { inputs = { { type = 'Number' } } }", "an Input needs an id"},
    {"name_in_document", "return { tools = { { file = 'tool.lua', name = 'Keep1' } } }", "", "name taken"},
    {"name_twice", "return { tools = { { file = 'tool.lua', name = 'A1' }, { file = 'tool.lua', name = 'A1' } } }", "",
     "name taken"},
    {"time_nan", "return { tools = { { file = 'tool.lua', name = 'A1' } }, time = 0/0 }", "",
     "time must be a finite number"},
    {"time_infinite", "return { time = math.huge }", "", "time must be a finite number"},
    {"time_text", "return { time = 'noon' }", "", "time must be a finite number"},
    {"aspect_negative", "return { pixelAspect = -1 }", "", "pixelAspect must be"},
    {"image_not_a_name", "return { tools = { { file = 'tool.lua', name = 'A1' } }, image = {} }", "",
     "image must be a file name"},
    {"too_many_tools",
     "local t = {} for i = 1, 5000 do t[i] = { file = 'tool.lua', name = 'T' .. i } end "
     "return { tools = t }",
     "", "more than 4096 tools"},
    // saved work
    {"newer_version", "return { version = 99, tools = {} }", "", "written by a newer Orbane (comp version 99;"},
    {"version_text", "return { version = 'two' }", "", "version must be a whole number"},
    {"truncated", "return { version = 2, tools = { { file = 'tool.lua', name = 'A1', inputs = { Size = { value = 1", "",
     "near '<eof>'"},
    {"key_at_nan",
     "return { tools = { { file = 'tool.lua', name = 'A1', inputs = { Size = { keys = { { 0/0, 1 } } } } } } }", "",
     "Input \"Size\": key 1 is not at a finite time"},
    {"key_value_infinite",
     "return { tools = { { file = 'tool.lua', name = 'A1', inputs = { Size = { keys = { { 0, 1 }, { 2, 1/0 } } } } } } "
     "}",
     "", "Input \"Size\": key 2 holds a number that is not finite"},
    {"missing_input",
     "return { tools = { { file = 'tool.lua', name = 'A1' }, "
     "{ file = 'tool.lua', name = 'B1', inputs = { Width = { value = 1 } } } } }",
     "", "Input \"Width\": tool \"B1\" has no such Input"},
    {"value_of_another_type",
     "return { tools = { { file = 'tool.lua', name = 'A1', inputs = { Size = { value = 'big' } } } } }", "",
     "Input \"Size\": value: expected a value of type Number, got string"},
    {"unknown_interpolation",
     "return { tools = { { file = 'tool.lua', name = 'A1', inputs = { Size = { keys = {}, interpolation = 'cubic' } } "
     "} } }",
     "", "interpolation is \"linear\" or \"smooth\""},
    // Given back once the tools are in the document, and taken out with them.
    {"expression_refused",
     "return { tools = { { file = 'tool.lua', name = 'A1', inputs = { Size = { value = 1, expression = 'Nope * 2' } } "
     "} } }",
     "", "Input \"Size\""},
};

INSTANTIATE_TEST_SUITE_P(Comps, BadComp, testing::ValuesIn(kBadComps),
                         [](const auto &info) { return std::string(info.param.name); });

TEST_F(BadComp, AGoodCompAddsEverything)
{
    QTemporaryDir dir;
    Write(dir.filePath("comp.lua"),
          "return { tools = { { file = 'tool.lua', name = 'A1' }, { file = 'tool.lua', name = 'B1' } }, "
          "time = 3, pixelAspect = 2, image = 'x.png' }");
    Write(dir.filePath("tool.lua"), kTool);
    OrbaneDoc doc;
    std::string error;
    ASSERT_TRUE(ToolLoader::LoadComp(doc, dir.filePath("comp.lua").toStdString(), &error)) << error;
    EXPECT_EQ(Shown(doc), "A1,B1, t=3.000000 aspect=2.000000 image=" + dir.filePath("x.png").toStdString() + " undo=0");
}

} // namespace
} // namespace Orbane
