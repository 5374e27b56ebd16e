#include "LuaLiteral.h"

#include "orbane/ScriptVal.h"

#include <cctype>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <vector>

namespace Orbane {

namespace {

// Deeper than this is a table that holds itself, or no document anyone made.
constexpr int kMaxDepth = 64;
// A table whose one-line text fits this many columns stays on one line.
constexpr std::size_t kLineWidth = 100;

bool IsName(const char *s)
{
    static const char *const kKeywords[] = {"and",      "break",  "do",   "else", "elseif", "end",  "false", "for",
                                            "function", "goto",   "if",   "in",   "local",  "nil",  "not",   "or",
                                            "repeat",   "return", "then", "true", "until",  "while"};
    if (!*s || !(std::isalpha(static_cast<unsigned char>(*s)) || *s == '_'))
        return false;
    for (const char *c = s; *c; ++c)
        if (!(std::isalnum(static_cast<unsigned char>(*c)) || *c == '_'))
            return false;
    for (const char *k : kKeywords)
        if (std::strcmp(k, s) == 0)
            return false;
    return true;
}

class Writer
{
public:
    explicit Writer(std::string *error) : mError(error) {}

    bool Value(const ScriptVal &v, std::string &out, int indent, int depth);

private:
    bool Table(const ScriptVal &t, std::string &out, int indent, int depth);
    bool Key(const ScriptVal &key, std::string &out);
    bool Fail(const std::string &why)
    {
        if (mError)
            *mError = why;
        return false;
    }

    std::string *mError;
};

bool Writer::Value(const ScriptVal &v, std::string &out, int indent, int depth)
{
    switch (v.GetType()) {
    case ScriptVal::Nil:
        out += "nil";
        return true;
    case ScriptVal::Boolean:
        out += v.GetBool() ? "true" : "false";
        return true;
    case ScriptVal::Number:
        out += LuaLiteral::Number(v.GetNumber());
        return true;
    case ScriptVal::String:
        out += LuaLiteral::String(v.GetString());
        return true;
    case ScriptVal::Table:
        return Table(v, out, indent, depth);
    default:
        return Fail(std::string("a value of type ") + v.TypeName() + " cannot be written as text");
    }
}

bool Writer::Key(const ScriptVal &key, std::string &out)
{
    if (key.IsString() && IsName(key.GetString())) {
        out += key.GetString();
        return true;
    }
    if (!key.IsString() && !key.IsNumber() && !key.IsBool())
        return Fail(std::string("a table key of type ") + key.TypeName() + " cannot be written as text");
    out += '[';
    Value(key, out, 0, kMaxDepth);
    out += ']';
    return true;
}

// The array part 1..n goes first without keys, the other keys after it in
// their order; on one line where that is short, else one entry a line.
bool Writer::Table(const ScriptVal &t, std::string &out, int indent, int depth)
{
    if (depth >= kMaxDepth)
        return Fail("tables nested too deep (does a table hold itself?)");
    const int32 length = t.Length();
    std::vector<std::string> items;
    for (int32 i = 1; i <= length; ++i) {
        std::string item;
        if (!Value(*t.FindKeyConst(ScriptVal(i)), item, indent + 1, depth + 1))
            return false;
        items.push_back(std::move(item));
    }
    for (const ScriptVal::Entry &e : t.GetEntries()) {
        const float64 n = e.first.GetNumber(0.0);
        if (e.first.IsNumber() && n >= 1 && n <= length && n == std::floor(n))
            continue;
        std::string item;
        if (!Key(e.first, item))
            return false;
        item += " = ";
        if (!Value(e.second, item, indent + 1, depth + 1))
            return false;
        items.push_back(std::move(item));
    }
    if (items.empty()) {
        out += "{}";
        return true;
    }
    std::string line = "{ ";
    bool multiLine = false;
    for (std::size_t i = 0; i < items.size(); ++i) {
        line += items[i] + (i + 1 < items.size() ? ", " : " }");
        multiLine = multiLine || items[i].find('\n') != std::string::npos;
    }
    if (!multiLine && line.size() + std::size_t(indent) * 4 <= kLineWidth) {
        out += line;
        return true;
    }
    const std::string pad(std::size_t(indent + 1) * 4, ' ');
    out += "{\n";
    for (const std::string &item : items)
        out += pad + item + ",\n";
    out += std::string(std::size_t(indent) * 4, ' ') + "}";
    return true;
}

} // namespace

bool LuaLiteral::Write(const ScriptVal &value, std::string &out, int indent, std::string *error)
{
    return Writer(error).Value(value, out, indent, 0);
}

std::string LuaLiteral::Number(double n)
{
    if (std::isnan(n))
        return "0/0";
    if (std::isinf(n))
        return n > 0 ? "1/0" : "-1/0";
    char text[40];
    for (int digits = 15; digits <= 17; ++digits) {
        std::snprintf(text, sizeof text, "%.*g", digits, n);
        if (std::strtod(text, nullptr) == n)
            break;
    }
    return text;
}

// Quotes with escapes for the quote, the backslash and every control byte;
// the decimal escapes take three digits so a digit after them stays a digit.
std::string LuaLiteral::String(const std::string &text)
{
    std::string out = "\"";
    for (const char c : text) {
        const auto byte = static_cast<unsigned char>(c);
        if (c == '"' || c == '\\') {
            out += '\\';
            out += c;
        } else if (c == '\n') {
            out += "\\n";
        } else if (byte < 0x20 || byte == 0x7f) {
            char esc[8];
            std::snprintf(esc, sizeof esc, "\\%03u", unsigned(byte));
            out += esc;
        } else {
            out += c;
        }
    }
    return out + "\"";
}

} // namespace Orbane
