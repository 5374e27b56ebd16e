#pragma once

#include "widgets/Curve.h"

#include "orbane/ScriptVal.h"

namespace Orbane {

// Curves as script tables, the form Inputs, tool files and scripts hold
// them in: an array of {x, y} pairs, with `linear = true` for straight
// segments: { {0, 0}, {0.5, 0.6}, {1, 1}, linear = true }. Entries that are
// not pairs of numbers are left out; the points are tidied as Curve does.
namespace CurveTable {

Curve ToCurve(const ScriptVal *table, const Curve &fallback);
ScriptVal FromCurve(const Curve &curve);
// A number of a table by key, or `def` where it is missing or not a number.
float64 NumberAt(const ScriptVal &table, const char *key, float64 def);

} // namespace CurveTable

} // namespace Orbane
