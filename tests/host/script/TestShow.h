#pragma once

#include "orbane/ScriptObject.h"
#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"
#include "orbane/TagMapping.h"

#include <cstdio>
#include <string>

// Compact texts of script values and tag lists, so a test states what it
// expects in one readable line.
namespace Orbane::TestKit {

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
    char number[32];
    std::snprintf(number, sizeof number, "%.15g", v.GetNumber());
    if (v.IsNumber())
        return number;
    if (v.IsBool())
        return v.GetBool() ? "true" : "false";
    return v.IsObject() ? v.GetObject()->ScriptTypeName() : v.GetString(v.TypeName());
}

// "30050000=Hello 80050003=#Fast": the tag, then the value; identifiers get a #.
inline std::string Show(const TagList &tags)
{
    std::string out;
    for (const TagItem &item : tags.Items()) {
        char tag[16];
        std::snprintf(tag, sizeof tag, "%s%08X=%s", out.empty() ? "" : " ", item.tag,
                      item.kind == TagKind::ID ? "#" : "");
        out += tag + Show(TagItemValue(item));
    }
    return out;
}

} // namespace Orbane::TestKit
