#include "orbane/ToolLoader.h"

#include "CompInputs.h"
#include "CompWriter.h"

#include "orbane/AutoRef.h"
#include "orbane/ClassIDs.h"
#include "orbane/Gradient.h"
#include "orbane/Input.h"
#include "orbane/LuaRuntime.h"
#include "orbane/LuaSandbox.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/Parameter.h"
#include "orbane/ParameterScript.h"
#include "orbane/Registry.h"
#include "orbane/RegistryList.h"
#include "orbane/ScriptError.h"
#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

#include <QDir>
#include <QFileInfo>

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <set>
#include <string>
#include <vector>

namespace Orbane {

namespace {

// A comp lists its tools; more than this is not a comp anyone made by hand
// or by tool, and each one runs a file.
constexpr int32 kMaxCompTools = 4096;

const char *Str(const ScriptVal &table, const char *key, const char *def)
{
    const ScriptVal *v = table.FindKeyConst(ScriptVal(key));
    return v && v->IsString() ? v->GetString() : def;
}

// A field that may hold one class name or a list of them.
std::vector<std::string> Names(const ScriptVal &table, const char *key)
{
    std::vector<std::string> names;
    const ScriptVal *v = table.FindKeyConst(ScriptVal(key));
    if (v && v->IsString())
        names.emplace_back(v->GetString());
    else if (v && v->IsTable())
        for (int32 i = 1; i <= v->Length(); ++i)
            names.emplace_back(v->FindKeyConst(ScriptVal(i))->GetString());
    return names;
}

// Runs a description file as content (whoever asked for it: tool and comp
// files come from outside) and takes the table it returns.
bool RunDescription(const std::string &path, ScriptVal &out, std::string *error)
{
    lua_State *L = LuaRuntime::Instance().State();
    if (!LuaSandbox::RunFile(L, path, 1, error))
        return false;
    std::string why;
    const bool ok = LuaRuntime::ToScriptVal(L, -1, out, why);
    lua_pop(L, 1);
    if (!ok) {
        *error = path + ": the returned table: " + why;
        return false;
    }
    if (!out.IsTable()) {
        *error = path + ": the file must return a table";
        return false;
    }
    return true;
}

// An object-typed attribute given as a list of stops { pos, r, g, b [, a] }
// is a colour ramp (a slider's track gradient).
bool AddGradientAttr(Tag tag, const ScriptVal &stops, TagList &tags, std::string *error)
{
    AutoRef<Gradient> ramp(new Gradient);
    for (int32 i = 1; i <= stops.Length(); ++i) {
        const ScriptVal *stop = stops.FindKeyConst(ScriptVal(i));
        if (!stop || !stop->IsTable() || stop->Length() < 4) {
            *error = "attrs: a gradient stop is { pos, r, g, b [, a] }";
            return false;
        }
        auto at = [stop](int32 k, float64 def) {
            const ScriptVal *v = stop->FindKeyConst(ScriptVal(k));
            return v && v->IsNumber() ? v->GetNumber() : def;
        };
        ramp->AddStop(at(1, 0.0), GradientColor{at(2, 0.0), at(3, 0.0), at(4, 0.0), at(5, 1.0)});
    }
    tags.Add(tag, static_cast<ScriptObject *>(ramp.get()));
    return true;
}

// A key that is a whole number a tag id can hold, as that tag id; else 0.
Tag TagOf(const ScriptVal &key)
{
    const float64 n = key.GetNumber(-1);
    return n >= 0 && n <= float64(UINT32_MAX) && n == std::floor(n) ? Tag(n) : 0;
}

bool AddNumberedAttr(const ScriptVal &key, const ScriptVal &value, TagList &tags, std::string *error)
{
    const Tag tag = TagOf(key);
    const uint32 type = TagTypeOf(tag);
    if (type == 0) {
        *error = std::string("attrs: keys are tag ids, got ") + key.TypeName();
        return false;
    }
    if (type == TAGTYPE_Object && value.IsTable())
        return AddGradientAttr(tag, value, tags, error);
    // An integer tag holds what an int64 can; NaN and infinities are no value.
    const float64 number = value.IsBool() ? float64(value.GetBool()) : value.GetNumber();
    if (!value.IsString() && !(std::fabs(number) < (type == TAGTYPE_Double ? HUGE_VAL : 9.2e18))) {
        *error = "attrs: the value of tag " + std::to_string(tag) + " is out of range";
        return false;
    }
    if (value.IsString())
        type == TAGTYPE_ID ? tags.Add(tag, OrbID(value.GetString())) : tags.Add(tag, value.GetString());
    else if (type == TAGTYPE_Double)
        tags.Add(tag, value.GetNumber());
    else
        tags.Add(tag, int64(number));
    return true;
}

// Input attributes given by number: { [0x10050001] = 1 }, or, where their
// order matters (repeated item tags), as { tag, value } pairs in a list.
bool AddNumberedAttrs(const ScriptVal &attrs, TagList &tags, std::string *error)
{
    for (const auto &[key, value] : attrs.GetEntries()) {
        const bool pair = key.IsNumber() && TagTypeOf(TagOf(key)) == 0 && value.IsTable();
        const ScriptVal *pairTag = pair ? value.FindKeyConst(ScriptVal(1)) : nullptr;
        const ScriptVal *pairValue = pair ? value.FindKeyConst(ScriptVal(2)) : nullptr;
        if (pair && (!pairTag || !pairValue)) {
            *error = "attrs: a pair in the list must be { tag, value }";
            return false;
        }
        if (!AddNumberedAttr(pair ? *pairTag : key, pair ? *pairValue : value, tags, error))
            return false;
    }
    return true;
}

// Maps one named tag through the first of the Input's classes that knows it.
bool MapNamedTag(const std::vector<std::string> &classes, const ScriptVal &name, const ScriptVal &value, TagList &tags,
                 std::string *error)
{
    std::string why = std::string("unknown tag \"") + name.GetString("?") + "\"";
    for (const std::string &cls : classes) {
        const Registry *reg = ClassRegistry.FindScriptName(cls.c_str());
        TagMapHook hook = reg ? reg->FindMapHook() : nullptr;
        if (!hook)
            continue;
        ScriptVal one = ScriptVal::NewTable();
        one.SetKey(name, value);
        TagList mapped;
        if (hook(OrbID("Create"), 0, one, mapped)) {
            tags.Append(mapped);
            return true;
        }
        why = TakeScriptError();
    }
    *error = why;
    return false;
}

// A named tag whose value names another Input of the tool (RCP_Center =
// "Center"): it is given that Input once every Input exists.
struct InputLink
{
    int32 input;    // the Input that carries the tag, in declaration order
    ScriptVal name; // the tag's name
    std::string target;
};

// What the Inputs of a tool file say beyond each one alone.
struct ToolContext
{
    std::set<std::string> ids; // every Input id the file declares
    std::vector<InputLink> links;
    int32 current = 0;
    QDir base; // where relative image paths start
};

bool BuildNamedTags(const ScriptVal &named, const std::vector<std::string> &classes, TagList &tags, ToolContext &ctx,
                    std::string *error)
{
    for (const auto &[key, value] : named.GetEntries()) {
        // A tag without a script name is given by number.
        if (key.IsNumber()) {
            if (!AddNumberedAttr(key, value, tags, error))
                return false;
            continue;
        }
        if (MapNamedTag(classes, key, value, tags, error))
            continue;
        if (!value.IsString() || !ctx.ids.count(value.GetString()))
            return false;
        ctx.links.push_back({ctx.current, key, value.GetString()});
    }
    return true;
}

bool BuildAttrs(const ScriptVal &decl, const char *name, TagList &tags, ToolContext &ctx, std::string *error)
{
    tags.Add(INPA_Name, name);
    if (const char *label = Str(decl, "label", nullptr))
        tags.Add(LINKS_Name, label);
    if (const char *label2 = Str(decl, "label2", nullptr))
        tags.Add(LINKS_SecondName, label2);
    std::vector<std::string> classes = Names(decl, "control");
    for (const std::string &c : classes)
        tags.Add(INPA_InputControl, OrbID(c));
    for (const std::string &c : Names(decl, "overlay")) {
        tags.Add(INPA_PreviewControl, OrbID(c));
        classes.push_back(c);
    }
    if (const ScriptVal *ro = decl.FindKeyConst(ScriptVal("readOnly")); ro && ro->GetBool())
        tags.Add(INPA_ReadOnly, int64(1));
    for (const std::string &id : Names(decl, "overlayInputs"))
        tags.Add(INPA_OverlayInput, OrbID(id));
    if (const ScriptVal *attrs = decl.FindKeyConst(ScriptVal("attrs")); attrs && !AddNumberedAttrs(*attrs, tags, error))
        return false;
    if (const ScriptVal *named = decl.FindKeyConst(ScriptVal("tags")))
        return BuildNamedTags(*named, classes, tags, ctx, error);
    return true;
}

// Gives each deferred Input-valued tag its Input, mapped as an object.
bool ResolveLinks(Operator &tool, const ScriptVal &inputs, const ToolContext &ctx, std::string *error)
{
    for (const InputLink &link : ctx.links) {
        const ScriptVal &decl = *inputs.FindKeyConst(ScriptVal(link.input + 1));
        std::vector<std::string> classes = Names(decl, "control");
        for (const std::string &c : Names(decl, "overlay"))
            classes.push_back(c);
        Input *in = tool.Inputs()[std::size_t(link.input)];
        TagList mapped;
        std::string why;
        if (!MapNamedTag(classes, link.name, ScriptVal(tool.FindInput(OrbID(link.target.c_str()))), mapped, &why)) {
            *error = std::string("Input \"") + in->GetID().c_str() + "\": " + why;
            return false;
        }
        in->AddAttrs(mapped);
    }
    return true;
}

bool AddInputFrom(Operator &tool, const ScriptVal &decl, ToolContext &ctx, std::string *error)
{
    const char *id = Str(decl, "id", nullptr);
    if (!id) {
        *error = "an Input needs an id";
        return false;
    }
    const char *name = Str(decl, "name", id);
    const OrbID type(Str(decl, "type", "Number"));
    TagList attrs;
    AutoRef<Parameter> def;
    std::string why;
    if (!BuildAttrs(decl, name, attrs, ctx, &why)) {
        *error = std::string("Input \"") + id + "\": " + why;
        return false;
    }
    if (const ScriptVal *v = decl.FindKeyConst(ScriptVal("default"))) {
        // An image file is named relative to the tool file.
        const ScriptVal value = type == CLSID_DataType_Image && v->IsString()
                                    ? ScriptVal(ctx.base.filePath(QString::fromUtf8(v->GetString())).toStdString())
                                    : *v;
        def = AutoRef<Parameter>(ParameterScript::FromScript(type, value, &why));
        if (!def) {
            *error = std::string("Input \"") + id + "\": default: " + why;
            return false;
        }
    }
    // A shape Input without a default starts as an empty shape, so its
    // overlay has something to append to.
    if (!def && (type == CLSID_DataType_Polyline || type == CLSID_DataType_BSplinePolyline))
        def = AutoRef<Parameter>(ParameterScript::FromScript(type, ScriptVal::NewTable(), &why));
    if (!tool.AddInput(OrbID(id), name, type, attrs, def.get())) {
        *error = TakeScriptError();
        return false;
    }
    return true;
}

// What a comp file asks of the document, read and checked in full before
// any of it is applied, so that a comp that fails leaves the document as it
// was.
struct CompPlan
{
    std::vector<AutoRef<Operator>> tools;
    const ScriptVal *time = nullptr;
    const ScriptVal *aspect = nullptr;
    std::string image;
    ScriptVal comp;
};

bool Refuse(std::string *error, const std::string &path, const std::string &why)
{
    *error = path + ": " + why;
    return false;
}

bool IsFiniteNumber(const ScriptVal *v)
{
    return v && v->IsNumber() && std::isfinite(v->GetNumber());
}

// A tool entry's Inputs and lock, given to its fresh tool.
bool RestoreTool(Operator &tool, const ScriptVal &entry, const QDir &base, std::string *error)
{
    if (const ScriptVal *locked = entry.FindKeyConst(ScriptVal("locked")))
        tool.SetLocked(locked->GetBool());
    const ScriptVal *inputs = entry.FindKeyConst(ScriptVal("inputs"));
    return !inputs || CompInputs::Restore(tool, *inputs, base, error);
}

// `doc` is the document the tools join, whose names they must not take;
// null where they replace its tools.
bool ReadCompTools(const OrbaneDoc *doc, const std::string &path, CompPlan &plan, std::string *error)
{
    const QDir base = QFileInfo(QString::fromStdString(path)).absoluteDir();
    const ScriptVal *tools = plan.comp.FindKeyConst(ScriptVal("tools"));
    if (tools && !tools->IsTable())
        return Refuse(error, path, "tools must be a list");
    if (tools && tools->Length() > kMaxCompTools)
        return Refuse(error, path, "more than " + std::to_string(kMaxCompTools) + " tools");
    std::set<std::string> names;
    for (int32 i = 1; tools && i <= tools->Length(); ++i) {
        const ScriptVal &entry = *tools->FindKeyConst(ScriptVal(i));
        const char *file = Str(entry, "file", nullptr);
        if (!file)
            return Refuse(error, path, "tool " + std::to_string(i) + " names no file");
        const std::string name = Str(entry, "name", "Tool");
        if ((doc && doc->FindTool(name.c_str())) || !names.insert(name).second)
            return Refuse(error, path, "cannot add tool \"" + name + "\" (is the name taken?)");
        AutoRef<Operator> tool(
            ToolLoader::LoadTool(base.filePath(QString::fromUtf8(file)).toStdString(), name.c_str(), error));
        if (!tool)
            return false;
        std::string why;
        if (!RestoreTool(*tool, entry, base, &why))
            return Refuse(error, path, why);
        plan.tools.push_back(std::move(tool));
    }
    return true;
}

// A comp without a version is one of the first, which named tools only.
bool CheckVersion(const std::string &path, const ScriptVal &comp, std::string *error)
{
    const ScriptVal *version = comp.FindKeyConst(ScriptVal("version"));
    if (!version)
        return true;
    const float64 v = version->GetNumber(-1);
    if (!(v >= 1 && v == std::floor(v)))
        return Refuse(error, path, "version must be a whole number from 1");
    if (v > CompWriter::kVersion)
        return Refuse(error, path,
                      "the comp was written by a newer Orbane (comp version " +
                          std::to_string(int64(std::min(v, 1e9))) + "; this one reads up to " +
                          std::to_string(CompWriter::kVersion) + ")");
    return true;
}

bool ReadComp(const OrbaneDoc *doc, const std::string &path, CompPlan &plan, std::string *error)
{
    if (!RunDescription(path, plan.comp, error) || !CheckVersion(path, plan.comp, error) ||
        !ReadCompTools(doc, path, plan, error))
        return false;
    plan.time = plan.comp.FindKeyConst(ScriptVal("time"));
    if (plan.time && !IsFiniteNumber(plan.time))
        return Refuse(error, path, "time must be a finite number");
    plan.aspect = plan.comp.FindKeyConst(ScriptVal("pixelAspect"));
    if (plan.aspect && !(IsFiniteNumber(plan.aspect) && plan.aspect->GetNumber() > 0))
        return Refuse(error, path, "pixelAspect must be a finite number above 0");
    if (const ScriptVal *image = plan.comp.FindKeyConst(ScriptVal("image"))) {
        if (!image->IsString())
            return Refuse(error, path, "image must be a file name");
        const QDir base = QFileInfo(QString::fromStdString(path)).absoluteDir();
        plan.image = base.filePath(QString::fromUtf8(image->GetString())).toStdString();
    }
    return true;
}

bool ApplyComp(OrbaneDoc &doc, const std::string &path, const CompPlan &plan, std::string *error)
{
    for (std::size_t i = 0; i < plan.tools.size(); ++i) {
        if (doc.AddTool(plan.tools[i].get()))
            continue;
        // Checked before, so only a watcher of the document can get here.
        const std::string name = plan.tools[i]->GetName();
        while (i > 0)
            doc.RemoveTool(plan.tools[--i].get());
        return Refuse(error, path, "cannot add tool \"" + name + "\"");
    }
    doc.SetPref(PREF_CompFolder, QFileInfo(QString::fromStdString(path)).absolutePath().toStdString());
    if (plan.time)
        doc.SetCurrentTime(plan.time->GetNumber());
    // The pixel aspect first, so the image is fitted with it.
    if (plan.aspect)
        doc.SetPref(PREF_ViewerPixelAspect, plan.aspect->GetNumber());
    if (!plan.image.empty())
        doc.SetPref(PREF_ViewerImage, plan.image);
    return true;
}

} // namespace

Operator *ToolLoader::FromTable(const ScriptVal &desc, const char *name, std::string *error, const std::string &dir)
{
    AutoRef<Operator> tool(new Operator(name, Str(desc, "type", name)));
    const ScriptVal *inputs = desc.FindKeyConst(ScriptVal("inputs"));
    ToolContext ctx;
    ctx.base = QDir(QString::fromStdString(dir));
    for (int32 i = 1; inputs && i <= inputs->Length(); ++i)
        if (const char *id = Str(*inputs->FindKeyConst(ScriptVal(i)), "id", nullptr))
            ctx.ids.insert(id);
    std::string why;
    for (int32 i = 1; inputs && i <= inputs->Length(); ++i) {
        ctx.current = i - 1;
        if (!AddInputFrom(*tool, *inputs->FindKeyConst(ScriptVal(i)), ctx, &why)) {
            *error = std::string("tool \"") + name + "\": " + why;
            return nullptr;
        }
    }
    if (inputs && !ResolveLinks(*tool, *inputs, ctx, &why)) {
        *error = std::string("tool \"") + name + "\": " + why;
        return nullptr;
    }
    return tool.Take();
}

Operator *ToolLoader::LoadTool(const std::string &path, const char *name, std::string *error)
{
    ScriptVal desc;
    if (!RunDescription(path, desc, error))
        return nullptr;
    const QFileInfo file(QString::fromStdString(path));
    Operator *tool = FromTable(desc, name, error, file.absolutePath().toStdString());
    if (!tool)
        *error = path + ": " + *error;
    else
        tool->SetSourceFile(file.absoluteFilePath().toStdString());
    return tool;
}

bool ToolLoader::LoadComp(OrbaneDoc &doc, const std::string &path, std::string *error)
{
    CompPlan plan;
    const bool fresh = doc.Tools().empty();
    if (!ReadComp(&doc, path, plan, error) || !ApplyComp(doc, path, plan, error))
        return false;
    // Into empty work the comp is the document; into work that has tools it
    // is an addition to that work.
    if (fresh)
        doc.MarkSaved(QFileInfo(QString::fromStdString(path)).absoluteFilePath().toStdString());
    return true;
}

bool ToolLoader::OpenComp(OrbaneDoc &doc, const std::string &path, std::string *error)
{
    CompPlan plan;
    if (!ReadComp(nullptr, path, plan, error))
        return false;
    doc.Clear();
    if (!ApplyComp(doc, path, plan, error))
        return false;
    doc.MarkSaved(QFileInfo(QString::fromStdString(path)).absoluteFilePath().toStdString());
    return true;
}

bool ToolLoader::WriteComp(const OrbaneDoc &doc, const std::string &path, std::string *error)
{
    return CompWriter::Write(doc, path, error);
}

bool ToolLoader::SaveComp(OrbaneDoc &doc, const std::string &path, std::string *error)
{
    if (!CompWriter::Write(doc, path, error))
        return false;
    doc.MarkSaved(QFileInfo(QString::fromStdString(path)).absoluteFilePath().toStdString());
    return true;
}

} // namespace Orbane
