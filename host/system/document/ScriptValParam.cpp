#include "orbane/ScriptValParam.h"

#include "orbane/ClassIDs.h"

#include <cstring>

namespace Orbane {

namespace {
// Tables nested deeper than this are taken as they are: a table that holds
// itself must not recurse forever. Script values of tools are a few levels deep.
constexpr int kMaxDepth = 64;

ScriptVal CopyAt(const ScriptVal &v, int depth)
{
    if (!v.IsTable() || depth >= kMaxDepth)
        return v;
    ScriptVal copy = ScriptVal::NewTable();
    for (const ScriptVal::Entry &e : v.GetEntries())
        copy.SetKey(e.first, CopyAt(e.second, depth + 1));
    return copy;
}

bool EqualsAt(const ScriptVal &a, const ScriptVal &b, int depth)
{
    if (!a.IsTable() || !b.IsTable() || depth >= kMaxDepth)
        return a == b;
    if (a.GetEntries().size() != b.GetEntries().size())
        return false;
    for (const ScriptVal::Entry &e : a.GetEntries()) {
        const ScriptVal *other = b.FindKeyConst(e.first);
        if (!other || !EqualsAt(e.second, *other, depth + 1))
            return false;
    }
    return true;
}
} // namespace

const OrbID &ScriptValParam::DataType() const noexcept
{
    return CLSID_DataType_ScriptVal;
}

Parameter *ScriptValParam::Clone() const
{
    return new ScriptValParam(DeepCopy(Value));
}

namespace {

std::size_t FootprintOf(const ScriptVal &v)
{
    std::size_t bytes = sizeof(ScriptVal) + (v.IsString() ? std::strlen(v.GetString()) : 0);
    if (v.IsTable())
        for (const ScriptVal::Entry &entry : v.GetEntries())
            bytes += FootprintOf(entry.first) + FootprintOf(entry.second);
    return bytes;
}

} // namespace

std::size_t ScriptValParam::Footprint() const noexcept
{
    return kSmallFootprint + FootprintOf(Value);
}

bool ScriptValParam::Equals(const Parameter &o) const
{
    const auto *s = dynamic_cast<const ScriptValParam *>(&o);
    return s && DeepEquals(Value, s->Value);
}

ScriptVal ScriptValParam::DeepCopy(const ScriptVal &v)
{
    return CopyAt(v, 0);
}

bool ScriptValParam::DeepEquals(const ScriptVal &a, const ScriptVal &b)
{
    return EqualsAt(a, b, 0);
}

} // namespace Orbane
