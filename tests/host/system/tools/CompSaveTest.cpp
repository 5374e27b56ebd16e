#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/LuaRuntime.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ParameterScript.h"
#include "orbane/Prefs.h"
#include "orbane/ScriptValParam.h"
#include "orbane/ToolLoader.h"

#include <QDir>
#include <QFile>
#include <QTemporaryDir>
#include <QUndoStack>

#include <gtest/gtest.h>

#include <csignal>
#include <sys/resource.h>

namespace Orbane {
namespace {

const char kTool[] = R"(return { inputs = {
    { id = "Size", type = "Number", default = 1 },
    { id = "Center", type = "Point", default = { 0.5, 0.5 } },
    { id = "Label", type = "Text", default = "x" },
    { id = "Mode", type = "ID", default = "good" },
    { id = "Table", type = "ScriptVal" },
    { id = "Shape", type = "PolyLine" },
    { id = "Spline", type = "BSplinePolyLine" },
    { id = "Plate", type = "Image" },
} })";

std::string ReadAll(const QString &path)
{
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readAll().toStdString() : std::string("<unreadable>");
}

void WriteAll(const QString &path, const char *text)
{
    QFile file(path);
    ASSERT_TRUE(file.open(QIODevice::WriteOnly));
    file.write(text);
}

// The script value a Lua expression gives.
ScriptVal Eval(const std::string &expr)
{
    lua_State *L = LuaRuntime::Instance().State();
    std::string error;
    if (!LuaRuntime::Instance().RunString("return " + expr, "case", &error, 1)) {
        ADD_FAILURE() << error;
        return ScriptVal();
    }
    ScriptVal v = LuaRuntime::ToScriptVal(L, -1);
    lua_pop(L, 1);
    return v;
}

class CompFiles : public testing::Test
{
protected:
    void SetUp() override { WriteAll(dir.filePath("tool.lua"), kTool); }

    // A document with the tool Demo1 at time 7 over an image sequence.
    Operator *Fill(OrbaneDoc &doc)
    {
        std::string error;
        AutoRef<Operator> tool(ToolLoader::LoadTool(dir.filePath("tool.lua").toStdString(), "Demo1", &error));
        EXPECT_TRUE(tool) << error;
        doc.AddTool(tool.get());
        doc.SetCurrentTime(7);
        doc.SetPref(PREF_ViewerImage, dir.filePath("plates/shot.####.exr").toStdString());
        return tool.get();
    }
    std::string Path(const char *name) const { return dir.filePath(name).toStdString(); }

    QTemporaryDir dir;
};

struct RoundTrip
{
    const char *name;
    const char *input;
    const char *value; // Lua: the plain value, or null
    const char *keys;  // Lua: { { time, value }, ... } of an animated Input, or null
    Interpolation mode;
    const char *expression = nullptr; // a live expression kept on the Input
};

// Every kind of value, plain and animated, with numbers and texts that a
// careless writer would round or mangle. "%DIR%" is the comp's folder.
const RoundTrip kTrips[] = {
    {"number_thirds", "Size", "1/3", nullptr, Interpolation::Linear},
    {"number_extremes", "Size", nullptr, "{ { -4, 1e-300 }, { 0.1, -0.1 }, { 2.5, 123456789.123456789 } }",
     Interpolation::Smooth},
    {"point", "Center", "{ 1/3, 2/7, -1e-9 }", nullptr, Interpolation::Linear},
    {"point_keys", "Center", nullptr, "{ { 0, { 0.1, 0.2 } }, { 10, { 0.9, 0.8, 3 } } }", Interpolation::Smooth},
    {"text_escapes", "Label", "'q\"uote back\\\\ nl\\n cr\\r tab\\t bell\\7 1\\0012 \\195\\188 end'", nullptr,
     Interpolation::Linear},
    {"text_keys", "Label", nullptr, "{ { 1, 'one' }, { 2, '' } }", Interpolation::Linear},
    {"identifier", "Mode", "'green'", nullptr, Interpolation::Linear},
    {"script_table", "Table",
     "{ 1, 2, name = 'x', ['end'] = false, nested = { a = true, [10] = 'ten', ['with space'] = 1.5, [2.5] = {} } }",
     nullptr, Interpolation::Linear},
    {"script_table_keys", "Table", nullptr, "{ { 0, { 'a' } }, { 5, { b = { c = 1 } } } }", Interpolation::Linear},
    {"polyline", "Shape",
     "{ kind = 'bezier', closed = true, points = { { x = 0.1, y = 0.2, inX = 0.05, inY = 0.2, outX = 0.15, outY = "
     "0.25, weight = 2, id = 7 }, { x = 0.9, y = 0.8, linear = true } } }",
     nullptr, Interpolation::Linear},
    {"polyline_keys", "Shape", nullptr,
     "{ { 0, { points = { { x = 0, y = 0 }, { x = 1, y = 1 } } } }, { 12, { points = { { x = 0.5, y = 0 }, { x = 1, "
     "y = 0.25 } } } } }",
     Interpolation::Smooth},
    {"bspline", "Spline",
     "{ kind = 'bspline', points = { { x = 0.1, y = 0.1 }, { x = 0.5, y = 0.9, weight = 3 }, { x = 0.9, y = 0.1 } } }",
     nullptr, Interpolation::Linear},
    {"image", "Plate", "'%DIR%/plates/grade.png'", nullptr, Interpolation::Linear},
    {"expression", "Size", "1", nullptr, Interpolation::Linear, "time / 2 + 1"},
};

class CompRoundTrip : public CompFiles, public testing::WithParamInterface<RoundTrip>
{
protected:
    ScriptVal Value(const char *lua)
    {
        std::string text = lua;
        if (const auto at = text.find("%DIR%"); at != std::string::npos)
            text.replace(at, 5, dir.path().toStdString());
        return Eval(text);
    }
    void Give(Input &in)
    {
        const RoundTrip &c = GetParam();
        std::string why;
        if (c.value) {
            AutoParameter v(ParameterScript::FromScript(in.GetDataType(), Value(c.value), &why));
            ASSERT_TRUE(v) << why;
            ASSERT_TRUE(in.SetValue(v.get(), 0.0));
        }
        if (c.expression) {
            ASSERT_TRUE(in.SetExpression(c.expression, 0, &why)) << why;
        }
        if (!c.keys)
            return;
        in.SetAnimated(true);
        const ScriptVal keys = Value(c.keys);
        for (int32 i = 1; i <= keys.Length(); ++i) {
            const ScriptVal &key = *keys.FindKeyConst(ScriptVal(i));
            AutoParameter v(ParameterScript::FromScript(in.GetDataType(), *key.FindKeyConst(ScriptVal(2)), &why));
            ASSERT_TRUE(v) << why;
            ASSERT_TRUE(in.SetValue(v.get(), key.FindKeyConst(ScriptVal(1))->GetNumber()));
        }
        in.RemoveKey(7.0); // the key that animating made at the current time
        in.SetInterpolation(c.mode);
    }
};

void ExpectSame(const Input &a, const Input &b)
{
    ASSERT_EQ(a.IsAnimated(), b.IsAnimated()) << a.GetID().c_str();
    EXPECT_EQ(a.GetInterpolation(), b.GetInterpolation()) << a.GetID().c_str();
    EXPECT_STREQ(a.GetExpression(), b.GetExpression()) << a.GetID().c_str();
    ASSERT_EQ(a.KeyTimes(), b.KeyTimes()) << a.GetID().c_str();
    for (const float64 time : a.KeyTimes()) {
        EXPECT_TRUE(AutoParameter(a.GetKey(time))->Equals(*AutoParameter(b.GetKey(time))))
            << a.GetID().c_str() << " key at " << time;
    }
    const AutoParameter va(a.GetValue(3.0)), vb(b.GetValue(3.0));
    ASSERT_EQ(bool(va), bool(vb)) << a.GetID().c_str();
    if (va) {
        EXPECT_TRUE(va->Equals(*vb)) << a.GetID().c_str();
    }
}

TEST_P(CompRoundTrip, OpeningTheSavedCompRestoresItExactly)
{
    OrbaneDoc saved;
    Operator *tool = Fill(saved);
    tool->SetLocked(true);
    Give(*tool->FindInput(OrbID(GetParam().input)));
    std::string error;
    ASSERT_TRUE(ToolLoader::SaveComp(saved, Path("work.lua"), &error)) << error;

    OrbaneDoc opened;
    ASSERT_TRUE(ToolLoader::OpenComp(opened, Path("work.lua"), &error)) << error;
    ASSERT_EQ(opened.Tools().size(), 1u);
    const Operator *back = opened.Tools()[0];
    EXPECT_STREQ(back->GetName(), "Demo1");
    EXPECT_TRUE(back->IsLocked());
    EXPECT_EQ(opened.GetCurrentTime(), 7.0);
    EXPECT_STREQ(opened.GetPrefs().GetString(PREF_ViewerImage, ""), Path("plates/shot.####.exr").c_str());
    for (std::size_t i = 0; i < tool->Inputs().size(); ++i)
        ExpectSame(*tool->Inputs()[i], *back->Inputs()[i]);
    // Saved again, the opened document writes the same text.
    ASSERT_TRUE(ToolLoader::WriteComp(opened, Path("again.lua"), &error)) << error;
    EXPECT_EQ(ReadAll(dir.filePath("again.lua")), ReadAll(dir.filePath("work.lua")));
}

INSTANTIATE_TEST_SUITE_P(Values, CompRoundTrip, testing::ValuesIn(kTrips),
                         [](const auto &info) { return std::string(info.param.name); });

// A save that fails for any reason leaves the file that was there as it was,
// and no temporary file beside it.
TEST_F(CompFiles, AFailedSaveLeavesTheOldFile)
{
    OrbaneDoc doc;
    Operator *tool = Fill(doc);
    std::string error;
    ASSERT_TRUE(ToolLoader::SaveComp(doc, Path("work.lua"), &error)) << error;
    const std::string before = ReadAll(dir.filePath("work.lua"));
    const QStringList files = QDir(dir.path()).entryList(QDir::Files);

    // The disk refuses: writes past a few bytes fail, as on a full disk.
    tool->FindInput(OrbID("Size"))->SetValue(AutoNumber(2.0), 0.0);
    std::signal(SIGXFSZ, SIG_IGN);
    rlimit was{};
    getrlimit(RLIMIT_FSIZE, &was);
    rlimit small = was;
    small.rlim_cur = 64;
    setrlimit(RLIMIT_FSIZE, &small);
    const bool full = ToolLoader::SaveComp(doc, Path("work.lua"), &error);
    setrlimit(RLIMIT_FSIZE, &was);
    EXPECT_FALSE(full);
    EXPECT_NE(error.find("cannot write"), std::string::npos) << error;
    EXPECT_TRUE(doc.IsModified());

    // The document holds what a comp cannot: an object in a script table.
    ScriptVal holder = ScriptVal::NewTable();
    holder.SetKey("tool", ScriptVal(static_cast<ScriptObject *>(tool)));
    tool->FindInput(OrbID("Table"))->SetValue(AutoScriptValParam(holder), 0.0);
    EXPECT_FALSE(ToolLoader::SaveComp(doc, Path("work.lua"), &error));
    EXPECT_NE(error.find("cannot be written"), std::string::npos) << error;
    tool->FindInput(OrbID("Table"))->SetValue(AutoScriptValParam(ScriptVal::NewTable()), 0.0);

    // A tool made from no file cannot be named.
    AutoRef<Operator> loose(new Operator("Loose1", "Loose"));
    doc.AddTool(loose.get());
    EXPECT_FALSE(ToolLoader::SaveComp(doc, Path("work.lua"), &error));
    EXPECT_NE(error.find("tool \"Loose1\" was made from no tool file"), std::string::npos) << error;

    EXPECT_EQ(ReadAll(dir.filePath("work.lua")), before);
    EXPECT_EQ(QDir(dir.path()).entryList(QDir::Files), files);
}

// The window's title and prompts read these: the comp the work is, and
// whether it changed since it was saved.
TEST_F(CompFiles, TheDocumentKnowsItsCompAndWhetherItChanged)
{
    OrbaneDoc doc;
    std::vector<bool> told;
    QObject::connect(&doc, &OrbaneDoc::modifiedChanged, [&told](bool m) { told.push_back(m); });
    Input *size = Fill(doc)->FindInput(OrbID("Size"));
    std::string error;
    ASSERT_TRUE(ToolLoader::SaveComp(doc, Path("work.lua"), &error)) << error;
    EXPECT_EQ(doc.CompPath(), Path("work.lua"));
    EXPECT_FALSE(doc.IsModified());

    size->SetValue(AutoNumber(4.0), 0.0);
    EXPECT_TRUE(doc.IsModified());
    doc.Undo();
    EXPECT_FALSE(doc.IsModified()) << "undone back to the saved state";
    size->SetInterpolation(Interpolation::Smooth);
    EXPECT_TRUE(doc.IsModified()) << "a change outside undo counts";
    EXPECT_EQ(told, (std::vector<bool>{true, false, true, false, true}));

    // Opened into empty work the comp is the document; into work with tools
    // it adds to that work.
    OrbaneDoc other;
    ASSERT_TRUE(ToolLoader::LoadComp(other, Path("work.lua"), &error)) << error;
    EXPECT_EQ(other.CompPath(), Path("work.lua"));
    EXPECT_FALSE(other.IsModified());
    WriteAll(dir.filePath("more.lua"), "return { tools = { { file = 'tool.lua', name = 'More1' } } }");
    ASSERT_TRUE(ToolLoader::LoadComp(other, Path("more.lua"), &error)) << error;
    EXPECT_EQ(other.Tools().size(), 2u);
    EXPECT_EQ(other.CompPath(), Path("work.lua"));
    EXPECT_TRUE(other.IsModified());

    other.Clear();
    EXPECT_TRUE(other.Tools().empty());
    EXPECT_EQ(other.CompPath(), "");
    EXPECT_FALSE(other.IsModified());
    EXPECT_EQ(other.UndoStack()->count(), 0);
}

} // namespace
} // namespace Orbane
