#pragma once

#include "orbane/Parameter.h"
#include "orbane/ScriptVal.h"

namespace Orbane {

// A script value (CLSID_DataType_ScriptVal), usually a table; steps between
// keys. Tables are shared on ScriptVal copy, so Clone copies them deeply:
// an undo record must not change when a script edits the table it wrote.
class ScriptValParam : public Parameter
{
public:
    explicit ScriptValParam(ScriptVal value = ScriptVal()) : Value(std::move(value)) {}

    const OrbID &DataType() const noexcept override;
    Parameter *Clone() const override;
    std::size_t Footprint() const noexcept override;
    // Tables compare by content, whatever the order their keys were set in.
    bool Equals(const Parameter &o) const override;

    // A copy of `v` that shares no table with it.
    static ScriptVal DeepCopy(const ScriptVal &v);
    static bool DeepEquals(const ScriptVal &a, const ScriptVal &b);

    ScriptVal Value;
};

} // namespace Orbane
