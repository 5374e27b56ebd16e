#include "orbane/ShapeFile.h"

#include "orbane/ClassIDs.h"
#include "orbane/PolyLine.h"
#include "orbane/PolyLineScript.h"
#include "orbane/ScriptVal.h"
#include "orbane/SvgPath.h"

#include <cctype>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <sstream>
#include <vector>

namespace Orbane {

namespace {

constexpr const char *kMagic = "orbane-shape 1";

bool IsSvg(const std::string &file)
{
    const std::size_t dot = file.rfind('.');
    std::string ext = dot == std::string::npos ? "" : file.substr(dot);
    for (char &c : ext)
        c = char(std::tolower(static_cast<unsigned char>(c)));
    return ext == ".svg";
}

class LineReader
{
public:
    LineReader(const std::string &file, ScriptVal &table) : mFile(file), mTable(table) {}

    bool Feed(const std::string &raw, int line, std::string *error)
    {
        mLine = line;
        const std::string text = raw.substr(0, raw.find('#'));
        std::istringstream in(text);
        std::string word;
        if (!(in >> word))
            return true;
        if (!mSawMagic)
            return Magic(text, error);
        if (word == "kind" || word == "closed")
            return Setting(word, in, error);
        if (word == "point")
            return Point(text, in, error);
        return Fail(error, 1, "unknown statement \"" + word + "\"");
    }
    bool Finish(std::string *error)
    {
        return mSawMagic ||
               Fail(error, 1, "the file is empty; a shape file starts with \"" + std::string(kMagic) + "\"");
    }
    const std::vector<int> &PointLines() const { return mPointLines; }

private:
    bool Fail(std::string *error, std::size_t column, const std::string &why)
    {
        if (error)
            *error = mFile + ": line " + std::to_string(mLine) + ", column " + std::to_string(column) + ": " + why;
        return false;
    }
    bool Magic(const std::string &text, std::string *error)
    {
        std::istringstream in(text);
        std::string a, b;
        in >> a >> b;
        if (a + " " + b != kMagic)
            return Fail(error, 1, "a shape file starts with \"" + std::string(kMagic) + "\"");
        mSawMagic = true;
        return true;
    }
    bool Setting(const std::string &word, std::istringstream &in, std::string *error)
    {
        std::string value;
        in >> value;
        if (word == "kind" && (value == "bezier" || value == "bspline"))
            mTable.SetKey("kind", value);
        else if (word == "closed" && (value == "true" || value == "false"))
            mTable.SetKey("closed", value == "true");
        else
            return Fail(error, 1, "bad value \"" + value + "\" for " + word);
        return true;
    }
    bool Point(const std::string &text, std::istringstream &in, std::string *error)
    {
        ScriptVal point = ScriptVal::NewTable();
        std::string field;
        while (in >> field) {
            const std::size_t column =
                std::size_t(in.tellg() == -1 ? text.size() : std::size_t(in.tellg())) - field.size() + 1;
            const std::size_t eq = field.find('=');
            if (eq == std::string::npos || eq == 0)
                return Fail(error, column, "expected name=value, got \"" + field + "\"");
            const std::string name = field.substr(0, eq), value = field.substr(eq + 1);
            if (value == "true" || value == "false") {
                point.SetKey(name, value == "true");
                continue;
            }
            char *end = nullptr;
            const float64 v = std::strtod(value.c_str(), &end);
            if (value.empty() || *end || !std::isfinite(v))
                return Fail(error, column + eq + 1, name + " must be a finite number, got \"" + value + "\"");
            point.SetKey(name, v);
        }
        mPoints().Append(point);
        mPointLines.push_back(mLine);
        return true;
    }
    ScriptVal &mPoints()
    {
        if (!mTable.FindKey(ScriptVal("points")))
            mTable.SetKey("points", ScriptVal::NewTable());
        return *mTable.FindKey(ScriptVal("points"));
    }

    const std::string &mFile;
    ScriptVal &mTable;
    int mLine = 0;
    bool mSawMagic = false;
    std::vector<int> mPointLines;
};

void WriteNumber(std::ostream &out, float64 v)
{
    char buf[32];
    std::snprintf(buf, sizeof buf, "%.17g", v);
    out << buf;
}

PolyLine *FromStream(std::istream &in, const std::string &file, std::string *error)
{
    ScriptVal table = ScriptVal::NewTable();
    LineReader reader(file, table);
    std::string line;
    for (int n = 1; std::getline(in, line); ++n)
        if (!reader.Feed(line, n, error))
            return nullptr;
    if (!reader.Finish(error))
        return nullptr;
    const ScriptVal *kind = table.FindKeyConst(ScriptVal("kind"));
    const bool bspline = kind && std::string(kind->GetString()) == "bspline";
    std::string why;
    PolyLine *shape =
        PolyLineScript::FromScript(bspline ? CLSID_DataType_BSplinePolyline : CLSID_DataType_Polyline, table, &why);
    if (!shape && error) {
        // The table names the point by number; the file by line.
        int index = 0;
        std::sscanf(why.c_str(), "point %d", &index);
        const std::vector<int> &lines = reader.PointLines();
        const bool known = index >= 1 && index <= int(lines.size());
        *error = file + ": " + (known ? "line " + std::to_string(lines[std::size_t(index - 1)]) + ": " : "") + why;
    }
    return shape;
}


} // namespace

PolyLine *ShapeFile::Read(const std::string &file, std::string *error)
{
    std::ifstream in(file);
    if (!in) {
        if (error)
            *error = file + ": cannot open the file";
        return nullptr;
    }
    return FromStream(in, file, error);
}

PolyLine *ShapeFile::Parse(const std::string &text, const std::string &name, std::string *error)
{
    std::istringstream in(text);
    return FromStream(in, name, error);
}

std::string ShapeFile::Text(const PolyLine &shape)
{
    const ScriptVal table = PolyLineScript::ToScript(shape);
    std::ostringstream out;
    out << kMagic << "\n";
    out << "kind " << table.FindKeyConst(ScriptVal("kind"))->GetString() << "\n";
    out << "closed " << (shape.IsClosed() ? "true" : "false") << "\n";
    const ScriptVal &points = *table.FindKeyConst(ScriptVal("points"));
    for (int32 i = 1; i <= points.Length(); ++i) {
        out << "point";
        for (const auto &[key, value] : points.FindKeyConst(ScriptVal(i))->GetEntries()) {
            out << " " << key.GetString() << "=";
            if (value.IsBool())
                out << (value.GetBool() ? "true" : "false");
            else
                WriteNumber(out, value.GetNumber());
        }
        out << "\n";
    }
    return out.str();
}

bool ShapeFile::Write(const std::string &file, const PolyLine &shape, std::string *error)
{
    std::ofstream out(file, std::ios::trunc);
    if (out << Text(shape) && out.flush())
        return true;
    if (error)
        *error = file + ": cannot write the file";
    return false;
}

PolyLine *ShapeFile::Import(const std::string &file, std::string *error)
{
    return IsSvg(file) ? SvgPath::Read(file, error) : Read(file, error);
}

bool ShapeFile::Export(const std::string &file, const PolyLine &shape, float64 width, float64 height,
                       std::string *error)
{
    return IsSvg(file) ? SvgPath::Write(file, shape, width, height, error) : Write(file, shape, error);
}

} // namespace Orbane
