#include "widgets/GradientStops.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

float64 Channel(const ScriptVal &stop, int32 index, float64 def)
{
    const ScriptVal *v = stop.FindKeyConst(ScriptVal(index));
    return v && v->IsNumber() ? v->GetNumber() : def;
}

ColorRGBA Mix(const ColorRGBA &a, const ColorRGBA &b, float64 t)
{
    return {a.r + (b.r - a.r) * t, a.g + (b.g - a.g) * t, a.b + (b.b - a.b) * t, a.a + (b.a - a.a) * t};
}

bool SameChannel(float64 a, float64 b)
{
    return a == b || (std::isnan(a) && std::isnan(b));
}

} // namespace

GradientStops GradientStops::Default()
{
    GradientStops g;
    g.stops = {{0.0, {0.0, 0.0, 0.0, 1.0}}, {1.0, {1.0, 1.0, 1.0, 1.0}}};
    return g;
}

bool GradientStops::FromScript(const ScriptVal &value, GradientStops &out, std::string *why)
{
    const ScriptVal *list = value.FindKeyConst(ScriptVal("stops"));
    if (!value.IsTable() || !list || !list->IsTable()) {
        *why = "a gradient is a table with a table of stops";
        return false;
    }
    GradientStops g;
    for (int32 i = 1; i <= list->Length(); ++i) {
        const ScriptVal &s = *list->FindKeyConst(ScriptVal(i));
        const float64 pos = Channel(s, 1, std::nan(""));
        if (!s.IsTable() || std::isnan(pos))
            continue;
        g.stops.push_back({std::clamp(pos, 0.0, 1.0),
                           {Channel(s, 2, 0.0), Channel(s, 3, 0.0), Channel(s, 4, 0.0), Channel(s, 5, 1.0)}});
    }
    if (int32(g.stops.size()) < kMinStops) {
        *why = "a gradient needs at least two stops with a position";
        return false;
    }
    std::stable_sort(g.stops.begin(), g.stops.end(), [](const Stop &a, const Stop &b) { return a.pos < b.pos; });
    const ScriptVal *interp = value.FindKeyConst(ScriptVal("interpolation"));
    g.smooth = interp && std::string(interp->GetString()) == "smooth";
    out = std::move(g);
    return true;
}

ScriptVal GradientStops::ToScript() const
{
    ScriptVal list = ScriptVal::NewTable();
    for (const Stop &s : stops) {
        ScriptVal row = ScriptVal::NewTable();
        for (float64 v : {s.pos, s.color.r, s.color.g, s.color.b, s.color.a})
            row.Append(ScriptVal(v));
        list.Append(row);
    }
    ScriptVal table = ScriptVal::NewTable();
    table.SetKey(ScriptVal("interpolation"), ScriptVal(smooth ? "smooth" : "linear"));
    table.SetKey(ScriptVal("stops"), list);
    return table;
}

ColorRGBA GradientStops::Evaluate(float64 pos) const
{
    if (stops.empty())
        return {0.0, 0.0, 0.0, 0.0};
    if (pos <= stops.front().pos)
        return stops.front().color;
    if (pos >= stops.back().pos)
        return stops.back().color;
    const auto after =
        std::upper_bound(stops.begin(), stops.end(), pos, [](float64 p, const Stop &s) { return p < s.pos; });
    const Stop &a = *(after - 1), &b = *after;
    // Coincident stops make a hard edge: the later one wins from its position on.
    float64 t = b.pos > a.pos ? (pos - a.pos) / (b.pos - a.pos) : 1.0;
    if (smooth)
        t = t * t * (3.0 - 2.0 * t);
    return Mix(a.color, b.color, t);
}

int32 GradientStops::Add(float64 pos)
{
    pos = std::clamp(pos, 0.0, 1.0);
    const Stop stop{pos, Evaluate(pos)};
    const auto at =
        std::upper_bound(stops.begin(), stops.end(), pos, [](float64 p, const Stop &s) { return p < s.pos; });
    // Insert first: it may move the stops, and begin() must be read after.
    const auto inserted = stops.insert(at, stop);
    return int32(inserted - stops.begin());
}

int32 GradientStops::Move(int32 index, float64 pos)
{
    if (index < 0 || index >= int32(stops.size()))
        return index;
    Stop stop = stops[size_t(index)];
    stop.pos = std::isnan(pos) ? stop.pos : std::clamp(pos, 0.0, 1.0);
    stops.erase(stops.begin() + index);
    const auto at =
        std::upper_bound(stops.begin(), stops.end(), stop.pos, [](float64 p, const Stop &s) { return p < s.pos; });
    // Insert first: it may move the stops, and begin() must be read after.
    const auto inserted = stops.insert(at, stop);
    return int32(inserted - stops.begin());
}

bool GradientStops::Remove(int32 index)
{
    if (index < 0 || index >= int32(stops.size()) || int32(stops.size()) <= kMinStops)
        return false;
    stops.erase(stops.begin() + index);
    return true;
}

bool GradientStops::operator==(const GradientStops &o) const
{
    if (smooth != o.smooth || stops.size() != o.stops.size())
        return false;
    for (size_t i = 0; i < stops.size(); ++i) {
        const Stop &a = stops[i], &b = o.stops[i];
        if (!SameChannel(a.pos, b.pos) || !SameChannel(a.color.r, b.color.r) || !SameChannel(a.color.g, b.color.g) ||
            !SameChannel(a.color.b, b.color.b) || !SameChannel(a.color.a, b.color.a))
            return false;
    }
    return true;
}

} // namespace Orbane
