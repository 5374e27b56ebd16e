#include "inputcontrols/CurveTable.h"

#include <limits>

namespace Orbane {
namespace CurveTable {

namespace {

constexpr float64 kNaN = std::numeric_limits<float64>::quiet_NaN();

bool ReadPoint(const ScriptVal &pair, CurvePoint &out)
{
    if (!pair.IsTable() || pair.Length() < 2)
        return false;
    const auto &entries = pair.GetEntries();
    out.x = entries[0].second.GetNumber(kNaN);
    out.y = entries[1].second.GetNumber(kNaN);
    return true;
}

} // namespace

float64 NumberAt(const ScriptVal &table, const char *key, float64 def)
{
    if (!key || !table.IsTable())
        return def;
    const ScriptVal *v = table.FindKeyConst(ScriptVal(key));
    return v ? v->GetNumber(def) : def;
}

Curve ToCurve(const ScriptVal *table, const Curve &fallback)
{
    if (!table || !table->IsTable())
        return fallback;
    std::vector<CurvePoint> points;
    for (const auto &[key, value] : table->GetEntries()) {
        CurvePoint p;
        if (key.IsNumber() && ReadPoint(value, p))
            points.push_back(p);
    }
    const ScriptVal *linear = table->FindKeyConst(ScriptVal("linear"));
    return Curve(std::move(points), linear && linear->GetBool());
}

ScriptVal FromCurve(const Curve &curve)
{
    ScriptVal table = ScriptVal::NewTable();
    for (const CurvePoint &p : curve.Points()) {
        ScriptVal pair = ScriptVal::NewTable();
        pair.Append(p.x);
        pair.Append(p.y);
        table.Append(pair);
    }
    if (curve.IsLinear())
        table.SetKey(ScriptVal("linear"), ScriptVal(true));
    return table;
}

} // namespace CurveTable
} // namespace Orbane
