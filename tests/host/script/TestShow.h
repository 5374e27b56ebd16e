#pragma once

#include "orbane/ScriptObject.h"
#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

#include <cstdio>
#include <string>

// Compact texts of tag lists and script values, so a test states what it
// expects in one readable line.
namespace Orbane::TestKit {

inline std::string Number(float64 n)
{
    char text[32];
    std::snprintf(text, sizeof text, "%g", n);
    return text;
}

// "30050000=Hello 80050003=#Fast": the tag, then the value; identifiers get a #.
inline std::string Show(const TagList &tags)
{
    std::string out;
    for (const TagItem &item : tags.Items()) {
        char tag[16];
        std::snprintf(tag, sizeof tag, "%08X=", item.tag);
        out += (out.empty() ? "" : " ") + std::string(tag);
        switch (item.kind) {
        case TagKind::Long:
            out += std::to_string(item.l);
            break;
        case TagKind::Double:
            out += Number(item.d);
            break;
        case TagKind::Text:
            out += item.s.str();
            break;
        case TagKind::ID:
            out += "#" + item.id.str();
            break;
        case TagKind::Object:
            out += item.obj->ScriptTypeName();
            break;
        case TagKind::Ptr:
            out += "ptr";
            break;
        }
    }
    return out;
}

// "WGT_Title=Hello; WGT_AddItem={a, b}; WGT_Color={R=1, G=0, B=0, A=1}".
inline std::string Show(const ScriptVal &v, const char *separator = "; ")
{
    if (v.IsTable()) {
        std::string out;
        for (const auto &[key, value] : v.GetEntries()) {
            out += out.empty() ? "" : separator;
            out += key.IsString() ? std::string(key.GetString()) + "=" : "";
            out += value.IsTable() ? "{" + Show(value, ", ") + "}" : Show(value);
        }
        return out;
    }
    if (v.IsNumber())
        return Number(v.GetNumber());
    if (v.IsBool())
        return v.GetBool() ? "true" : "false";
    return v.IsObject() ? v.GetObject()->ScriptTypeName() : v.GetString(v.TypeName());
}

} // namespace Orbane::TestKit
