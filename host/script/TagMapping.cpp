#include "orbane/TagMapping.h"

#include "orbane/FFITagMap.h"
#include "orbane/FFIType.h"
#include "orbane/OrbColor.h"
#include "orbane/ScriptError.h"
#include "orbane/ScriptObject.h"
#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

#include <cmath>
#include <cstdio>
#include <cstring>
#include <string>

namespace Orbane {

namespace {

// Script types derive through FFIType base names; a loop must still end.
constexpr int kMaxDepth = 64;
constexpr const char *kColourHelp = "a colour (a packed integer or a table {R=, G=, B=, A=} of numbers from 0 to 1)";

// ---- descriptions for messages

std::string NumberText(float64 n)
{
    char text[32];
    if (n == std::floor(n) && std::fabs(n) < 1e15)
        std::snprintf(text, sizeof text, "%lld", static_cast<long long>(n));
    else
        std::snprintf(text, sizeof text, "%g", n);
    return text;
}

// "got 1.5", "got string", "got CheckboxControl".
std::string Describe(const ScriptVal &v)
{
    if (v.IsNumber())
        return NumberText(v.GetNumber());
    return v.IsObject() ? v.GetObject()->ScriptTypeName() : v.TypeName();
}

// An enumeration value as the script wrote it.
std::string Quoted(const ScriptVal &v)
{
    return v.IsString() ? std::string("\"") + v.GetString() + "\"" : Describe(v);
}

bool Problem(std::string &problem, std::string text)
{
    problem = std::move(text);
    return false;
}

// The script type whose tag map this table is, for "unknown tag" messages.
std::string ClassNameOf(const TagMapEntry *table)
{
    for (const FFITagMap *map : FFITagMap::All())
        if (map->Table() == table)
            return map->Type().ScriptName();
    return {};
}

// ---- small conversions

bool ToInteger(const ScriptVal &v, int64 &out)
{
    const float64 n = v.GetNumber();
    if (!v.IsNumber() || n != std::floor(n) || std::fabs(n) > 9.0e15)
        return false;
    out = int64(n);
    return true;
}

const EnumEntry *EnumValues(const TagMapEntry &row)
{
    const auto *values = static_cast<const EnumEntry *>(row.extra);
    return values && values->name && values->value == ENUM_NameRow ? values + 1 : values;
}

const char *EnumName(const TagMapEntry &row)
{
    const auto *values = static_cast<const EnumEntry *>(row.extra);
    return values && values->name && values->value == ENUM_NameRow ? values->name : "value";
}

std::string EnumChoices(const TagMapEntry &row)
{
    std::string list;
    for (const EnumEntry *e = EnumValues(row); e && e->name; ++e)
        list += (list.empty() ? "" : ", ") + std::string(e->name);
    return list;
}

bool ObjectIsA(const ScriptObject *obj, const char *want)
{
    std::string name = obj->ScriptTypeName();
    for (int depth = 0; depth < kMaxDepth && !name.empty(); ++depth) {
        if (name == want)
            return true;
        const FFIType *type = FFIType::FindScriptName(name.c_str());
        name = type ? type->BaseName() : "";
    }
    return false;
}

uint8 Channel(float64 v)
{
    return uint8(std::lround(std::fmin(1.0, std::fmax(0.0, v)) * 255.0));
}

// One channel by name, or by position in an {r, g, b, a} array.
const ScriptVal *ColourChannel(const ScriptVal &table, const char *name, int position)
{
    const ScriptVal *v = table.FindKeyConst(ScriptVal(name));
    return v ? v : table.FindKeyConst(ScriptVal(position));
}

// ---- script value into tag value, one occurrence

bool PlainLong(Tag tag, const ScriptVal &v, TagList &out, std::string &problem)
{
    int64 n = 0;
    if (v.IsBool())
        n = v.GetBool() ? 1 : 0;
    else if (!ToInteger(v, n))
        return Problem(problem, "expected an integer, got " + Describe(v));
    out.Add(tag, TagValue(static_cast<long long>(n)));
    return true;
}

// The value of a plain tag of any other type, or false where it does not fit.
bool PlainValueFits(Tag tag, const ScriptVal &v, TagList &out)
{
    switch (TagTypeOf(tag)) {
    case TAGTYPE_Double:
        if (v.IsNumber())
            out.Add(tag, v.GetNumber());
        return v.IsNumber();
    case TAGTYPE_String:
        if (v.IsString())
            out.Add(tag, v.GetString());
        return v.IsString();
    case TAGTYPE_ID:
        if (v.IsString())
            out.Add(tag, OrbID(v.GetString()));
        return v.IsString();
    case TAGTYPE_Object:
        if (v.IsObject())
            out.Add(tag, v.GetObject());
        return v.IsObject();
    case TAGTYPE_Ptr:
        if (v.IsPointer() || v.IsObject())
            out.Add(tag, v.IsPointer() ? v.GetPointer() : static_cast<void *>(v.GetObject()));
        return v.IsPointer() || v.IsObject();
    }
    return false;
}

bool PlainItem(Tag tag, const ScriptVal &v, TagList &out, std::string &problem)
{
    static const char *const wanted[16] = {
        nullptr, nullptr, "a number", "a string", "an object", nullptr, "a pointer", nullptr, "an identifier string"};
    const uint32 type = TagTypeOf(tag);
    if (type == TAGTYPE_Long)
        return PlainLong(tag, v, out, problem);
    if (PlainValueFits(tag, v, out))
        return true;
    if (!wanted[type])
        return Problem(problem, "this tag cannot be set from scripts");
    return Problem(problem, std::string("expected ") + wanted[type] + ", got " + Describe(v));
}

bool BoolItem(Tag tag, const ScriptVal &v, TagList &out, std::string &problem)
{
    int64 n = -1;
    if (v.IsBool())
        n = v.GetBool() ? 1 : 0;
    else if (!ToInteger(v, n) || (n != 0 && n != 1))
        return Problem(problem, "expected a boolean, got " + Describe(v));
    out.Add(tag, TagValue(static_cast<long long>(n)));
    return true;
}

bool EnumItem(const TagMapEntry &row, const ScriptVal &v, TagList &out, std::string &problem)
{
    if (!v.IsString() && !v.IsNumber())
        return Problem(problem,
                       std::string("expected a name of ") + EnumName(row) + " or a number, got " + Describe(v));
    for (const EnumEntry *e = EnumValues(row); e && e->name; ++e) {
        if (v.IsString() ? std::strcmp(e->name, v.GetString()) == 0 : float64(e->value) == v.GetNumber()) {
            out.Add(Tag(row.tag), TagValue(static_cast<long long>(e->value)));
            return true;
        }
    }
    return Problem(problem, "unknown value " + Quoted(v) + "; expected one of " + EnumChoices(row));
}

bool ObjectItem(const TagMapEntry &row, const ScriptVal &v, TagList &out, std::string &problem)
{
    const auto *want = static_cast<const char *>(row.extra);
    if (v.IsObject() && (!want || ObjectIsA(v.GetObject(), want))) {
        // A pointer-typed row (an overlay's Input given by a script) carries
        // the object's address; the object's owner keeps it alive.
        if (TagTypeOf(Tag(row.tag)) == TAGTYPE_Ptr)
            out.Add(Tag(row.tag), static_cast<void *>(v.GetObject()));
        else
            out.Add(Tag(row.tag), v.GetObject());
        return true;
    }
    const std::string type = want ? std::string("an object of type ") + want : "an object";
    return Problem(problem, "expected " + type + ", got " + Describe(v));
}

bool ColourFromTable(const ScriptVal &v, OrbColor &colour)
{
    const ScriptVal *r = ColourChannel(v, "R", 1), *g = ColourChannel(v, "G", 2), *b = ColourChannel(v, "B", 3);
    const ScriptVal *a = ColourChannel(v, "A", 4);
    if (!r || !g || !b || !r->IsNumber() || !g->IsNumber() || !b->IsNumber() || (a && !a->IsNumber()))
        return false;
    const float64 alpha = a ? a->GetNumber() : 1.0;
    colour = OrbColor(Channel(r->GetNumber()), Channel(g->GetNumber()), Channel(b->GetNumber()), Channel(alpha));
    return true;
}

bool ColourItem(Tag tag, const ScriptVal &v, TagList &out, std::string &problem)
{
    int64 packed = -1;
    OrbColor colour;
    if (v.IsTable() && ColourFromTable(v, colour))
        packed = colour.Packed();
    else if (!ToInteger(v, packed) || packed < 0 || packed > int64(OrbColor::None))
        packed = -1;
    if (packed < 0)
        return Problem(problem, std::string("expected ") + kColourHelp + ", got " + Describe(v));
    out.Add(tag, TagValue(static_cast<long long>(packed)));
    return true;
}

bool OneItem(const TagMapEntry &row, const ScriptVal &v, TagList &out, std::string &problem)
{
    const Tag tag = Tag(row.tag);
    switch (row.kind) {
    case TMK_Plain:
        return PlainItem(tag, v, out, problem);
    case TMK_Boolean:
        return BoolItem(tag, v, out, problem);
    case TMK_Enumeration:
        return EnumItem(row, v, out, problem);
    case TMK_Object:
        return ObjectItem(row, v, out, problem);
    case TMK_Color:
        return ColourItem(tag, v, out, problem);
    }
    return Problem(problem, "the tag map gives it an unknown kind " + std::to_string(row.kind));
}

// A repeatable tag takes an array, one occurrence per element. A colour table
// is one value, so only an array of tables is a list of colours.
bool IsValueList(const TagMapEntry &row, const ScriptVal &v)
{
    if (!TagIsRepeatable(Tag(row.tag)) || !v.IsTable())
        return false;
    const ScriptVal *first = v.FindKeyConst(ScriptVal(1));
    return row.kind != TMK_Color || (first && first->IsTable());
}

bool AddValues(const TagMapEntry &row, const ScriptVal &v, TagList &out, std::string &problem)
{
    if (!IsValueList(row, v))
        return OneItem(row, v, out, problem);
    const int32 n = v.Length();
    if (std::size_t(n) != v.GetEntries().size())
        return Problem(problem, "expected a value or an array of values, got a table with other keys");
    for (int32 i = 1; i <= n; ++i) {
        if (!OneItem(row, *v.FindKeyConst(ScriptVal(i)), out, problem))
            return Problem(problem, "item " + std::to_string(i) + ": " + problem);
    }
    return true;
}

const TagMapEntry *FindRow(const TagMapEntry *table, const char *name)
{
    for (const TagMapEntry *row = table; row && row->name; ++row)
        if (std::strcmp(row->name, name) == 0)
            return row;
    return nullptr;
}

bool Fail(const std::string &message)
{
    SetScriptError(message);
    return false;
}

bool MapEntry(const TagMapEntry *table, const ScriptVal::Entry &entry, TagList &out)
{
    if (!entry.first.IsString())
        return Fail("tag names must be strings, got " + Describe(entry.first));
    const char *name = entry.first.GetString();
    const TagMapEntry *row = FindRow(table, name);
    if (!row) {
        const std::string owner = ClassNameOf(table);
        return Fail(std::string("unknown tag \"") + name + "\"" + (owner.empty() ? "" : " for " + owner));
    }
    std::string problem;
    return AddValues(*row, entry.second, out, problem) || Fail(std::string(name) + ": " + problem);
}

bool IntoTags(const TagMapEntry *table, const ScriptVal &args, TagList &tags)
{
    if (args.IsNil())
        return true;
    if (!args.IsTable())
        return Fail("tags must be given as a table, got " + Describe(args));
    // Collected apart, so that a failure leaves the caller's list untouched.
    TagList out;
    for (const ScriptVal::Entry &entry : args.GetEntries())
        if (!MapEntry(table, entry, out))
            return false;
    tags.Append(out);
    return true;
}

// ---- tag value into script value

ScriptVal ColourTable(int64 packed)
{
    const OrbColor colour(uint32(packed & 0xFFFFFFFF));
    ScriptVal t = ScriptVal::NewTable();
    t.SetKey("R", colour.R() / 255.0);
    t.SetKey("G", colour.G() / 255.0);
    t.SetKey("B", colour.B() / 255.0);
    t.SetKey("A", colour.A() / 255.0);
    return t;
}

ScriptVal EnumValue(const TagMapEntry &row, int64 value)
{
    for (const EnumEntry *e = EnumValues(row); e && e->name; ++e)
        if (e->value == value)
            return ScriptVal(e->name);
    return ScriptVal(float64(value));
}

ScriptVal RowValue(const TagMapEntry &row, const TagItem &item)
{
    // A value of another kind than the tag promises reads as absent, as in TagList.
    if (!TagList::KindFits(item.tag, item.kind))
        return {};
    const bool isLong = item.kind == TagKind::Long;
    switch (row.kind) {
    case TMK_Boolean:
        return isLong ? ScriptVal(item.l != 0) : ScriptVal();
    case TMK_Enumeration:
        return isLong ? EnumValue(row, item.l) : ScriptVal();
    case TMK_Color:
        return isLong ? ColourTable(item.l) : ScriptVal();
    case TMK_Object:
        if (item.kind == TagKind::Ptr)
            return ScriptVal(static_cast<ScriptObject *>(item.ptr));
        return item.kind == TagKind::Object ? ScriptVal(item.obj) : ScriptVal();
    }
    return TagItemValue(item);
}

ScriptVal RowValues(const TagMapEntry &row, const TagList &tags, const TagItem *first)
{
    if (!TagIsRepeatable(first->tag))
        return RowValue(row, *first);
    ScriptVal list = ScriptVal::NewTable();
    for (const TagItem *item = first; item; item = tags.FindNext(item))
        list.Append(RowValue(row, *item));
    return list;
}

bool FromTags(const TagMapEntry *table, ScriptVal &args, const TagList &tags)
{
    if (!args.IsTable())
        args = ScriptVal::NewTable();
    for (const TagMapEntry *row = table; row && row->name; ++row)
        if (const TagItem *first = tags.Find(Tag(row->tag)))
            args.SetKey(row->name, RowValues(*row, tags, first));
    return true;
}

} // namespace

bool scriptval_maptags(const TagMapEntry *table, int32 direction, ScriptVal &args, TagList &tags)
{
    if (direction == MAP_FromTags)
        return FromTags(table, args, tags);
    return IntoTags(table, args, tags);
}

ScriptVal TagItemValue(const TagItem &item)
{
    switch (item.kind) {
    case TagKind::Long:
        return ScriptVal(float64(item.l));
    case TagKind::Double:
        return ScriptVal(item.d);
    case TagKind::Text:
        return ScriptVal(item.s);
    case TagKind::Object:
        return ScriptVal(item.obj);
    case TagKind::Ptr:
        return ScriptVal::FromPointer(item.ptr);
    case TagKind::ID:
        return item.id.IsEmpty() ? ScriptVal() : ScriptVal(item.id.c_str());
    }
    return {};
}

} // namespace Orbane
