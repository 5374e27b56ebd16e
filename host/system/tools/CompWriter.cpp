#include "CompWriter.h"

#include "CompInputs.h"
#include "LuaLiteral.h"

#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ScriptVal.h"

#include <QDir>
#include <QFileInfo>
#include <QSaveFile>

namespace Orbane {

namespace {

bool ToolEntry(const Operator &tool, const QDir &base, ScriptVal &entry, std::string *error)
{
    if (tool.GetSourceFile().empty()) {
        *error = std::string("tool \"") + tool.GetName() + "\" was made from no tool file, so a comp cannot name it";
        return false;
    }
    entry = ScriptVal::NewTable();
    entry.SetKey("file", CompInputs::PathFrom(base, tool.GetSourceFile()));
    entry.SetKey("name", tool.GetName());
    if (tool.IsLocked())
        entry.SetKey("locked", true);
    entry.SetKey("inputs", CompInputs::Save(tool, base));
    return true;
}

} // namespace

bool CompWriter::Text(const OrbaneDoc &doc, const std::string &folder, std::string &out, std::string *error)
{
    const QDir base(QString::fromStdString(folder));
    ScriptVal comp = ScriptVal::NewTable();
    comp.SetKey("version", kVersion);
    comp.SetKey("time", doc.GetCurrentTime());
    if (const char *image = doc.GetPrefs().GetString(PREF_ViewerImage, ""); *image)
        comp.SetKey("image", CompInputs::PathFrom(base, image));
    comp.SetKey("pixelAspect", doc.GetPrefs().GetDouble(PREF_ViewerPixelAspect, 1.0));
    ScriptVal tools = ScriptVal::NewTable();
    for (const Operator *tool : doc.Tools()) {
        ScriptVal entry;
        if (!ToolEntry(*tool, base, entry, error))
            return false;
        tools.Append(entry);
    }
    comp.SetKey("tools", tools);
    out = "-- Orbane comp\nreturn ";
    std::string why;
    if (!LuaLiteral::Write(comp, out, 0, &why)) {
        *error = "the document cannot be written: " + why;
        return false;
    }
    out += "\n";
    return true;
}

bool CompWriter::Write(const OrbaneDoc &doc, const std::string &path, std::string *error)
{
    const QString file = QString::fromStdString(path);
    std::string text;
    if (!Text(doc, QFileInfo(file).absolutePath().toStdString(), text, error)) {
        *error = path + ": " + *error;
        return false;
    }
    QSaveFile out(file);
    const bool ok = out.open(QIODevice::WriteOnly) &&
                    out.write(text.data(), qint64(text.size())) == qint64(text.size()) && out.commit();
    if (!ok)
        *error = path + ": cannot write: " + out.errorString().toStdString();
    return ok;
}

} // namespace Orbane
