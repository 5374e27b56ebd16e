#include "overlays/MeshGrid.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

// Meshes beyond this many vertices are refused as no mesh: a table that
// large is a mistake, and drawing it would stall the viewer.
constexpr int32 kMaxVertices = 1 << 20;

float64 Snap(float64 v, float64 step)
{
    return step > 0.0 ? std::round(v / step) * step : v;
}

// The part of `delta` vertex `i` may take: none where it is locked, only
// along its side where outline vertices slide.
OrbPoint Allowed(const MeshGrid &m, int32 i, OrbPoint delta, const MeshMoveRules &r)
{
    if ((r.lockCorners && m.IsCorner(i)) || (r.lockBorder && m.IsBorder(i)))
        return {};
    if (r.slideBorder) {
        const int32 c = m.ColOf(i), row = m.RowOf(i);
        if (c == 0 || c == m.cols - 1)
            delta.x = 0.0;
        if (row == 0 || row == m.rows - 1)
            delta.y = 0.0;
    }
    return delta;
}

OrbPoint Place(OrbPoint p, const MeshMoveRules &r)
{
    p = {Snap(p.x, r.snapX), Snap(p.y, r.snapY)};
    if (r.clampToImage)
        p = {std::clamp(p.x, 0.0, 1.0), std::clamp(p.y, 0.0, 1.0)};
    return p;
}

// Distance from `p` to the nearest selected vertex, in units of the falloff
// radius (so that the radius may differ per axis, as image pixels do).
float64 FalloffDistance(const MeshGrid &m, const std::vector<uint8> &selected, OrbPoint p, const MeshMoveRules &r)
{
    float64 best = HUGE_VAL;
    for (int32 j = 0; j < m.Count(); ++j)
        if (selected[std::size_t(j)]) {
            const OrbPoint d = m.points[std::size_t(j)] - p;
            best = std::min(best, std::hypot(d.x / r.falloffX, d.y / r.falloffY));
        }
    return best;
}

} // namespace

bool MeshGrid::IsBorder(int32 i) const noexcept
{
    const int32 c = ColOf(i), r = RowOf(i);
    return c == 0 || r == 0 || c == cols - 1 || r == rows - 1;
}

bool MeshGrid::IsCorner(int32 i) const noexcept
{
    const int32 c = ColOf(i), r = RowOf(i);
    return (c == 0 || c == cols - 1) && (r == 0 || r == rows - 1);
}

MeshGrid MeshGrid::Regular(int32 cols, int32 rows)
{
    MeshGrid m;
    m.cols = std::clamp(cols, 2, 1024);
    m.rows = std::clamp(rows, 2, 1024);
    m.points.reserve(std::size_t(m.cols) * std::size_t(m.rows));
    for (int32 r = 0; r < m.rows; ++r)
        for (int32 c = 0; c < m.cols; ++c)
            m.points.emplace_back(float64(c) / (m.cols - 1), float64(r) / (m.rows - 1));
    return m;
}

MeshGrid MeshGrid::FromScript(const ScriptVal &v)
{
    MeshGrid m;
    if (!v.IsTable())
        return m;
    const ScriptVal *cols = v.FindKeyConst(ScriptVal("cols"));
    const ScriptVal *rows = v.FindKeyConst(ScriptVal("rows"));
    const ScriptVal *points = v.FindKeyConst(ScriptVal("points"));
    if (!cols || !rows || !points || !points->IsTable())
        return m;
    const float64 c = cols->GetNumber(0.0), r = rows->GetNumber(0.0);
    if (!(c >= 1 && r >= 1 && c * r <= kMaxVertices) || c != std::floor(c) || r != std::floor(r))
        return m;
    const std::size_t count = std::size_t(c) * std::size_t(r);
    if (std::size_t(points->Length()) != 2 * count)
        return m;
    // Placed by key, so that a table built in any order reads the same.
    std::vector<float64> values(2 * count, std::nan(""));
    for (const auto &[key, value] : points->GetEntries()) {
        const float64 k = key.GetNumber(0.0);
        if (!(k >= 1 && k <= float64(values.size())) || !value.IsNumber())
            return m;
        values[std::size_t(k) - 1] = value.GetNumber();
    }
    m.points.reserve(count);
    for (std::size_t i = 0; i < count; ++i) {
        const OrbPoint p(values[2 * i], values[2 * i + 1]);
        if (!std::isfinite(p.x) || !std::isfinite(p.y))
            return MeshGrid();
        m.points.push_back(p);
    }
    m.cols = int32(c);
    m.rows = int32(r);
    return m;
}

ScriptVal MeshGrid::ToScript() const
{
    ScriptVal t = ScriptVal::NewTable();
    t.SetKey(ScriptVal("cols"), ScriptVal(cols));
    t.SetKey(ScriptVal("rows"), ScriptVal(rows));
    ScriptVal list = ScriptVal::NewTable();
    for (const OrbPoint &p : points) {
        list.Append(ScriptVal(p.x));
        list.Append(ScriptVal(p.y));
    }
    t.SetKey(ScriptVal("points"), list);
    return t;
}

MeshGrid MeshEdit::Moved(const MeshGrid &from, const std::vector<uint8> &selected, OrbPoint delta,
                         const MeshMoveRules &rules)
{
    MeshGrid out = from;
    if (selected.size() != from.points.size())
        return out;
    const bool soft = rules.falloffX > 0.0 && rules.falloffY > 0.0;
    for (int32 i = 0; i < from.Count(); ++i) {
        const std::size_t k = std::size_t(i);
        OrbPoint d;
        if (selected[k])
            d = delta;
        else if (rules.mirrorX && selected[std::size_t(from.MirrorOf(i))])
            d = {-delta.x, delta.y};
        else if (soft)
            d = delta * FalloffWeight(FalloffDistance(from, selected, from.points[k], rules));
        else
            continue;
        d = Allowed(from, i, d, rules);
        if (d.x == 0.0 && d.y == 0.0)
            continue;
        // Only the vertices the hand moves snap; those that follow softly keep
        // their weight's share of the move.
        out.points[k] = selected[k] ? Place(from.points[k] + d, rules) : from.points[k] + d;
    }
    return out;
}

std::vector<int32> MeshEdit::InBox(const MeshGrid &mesh, OrbPoint a, OrbPoint b)
{
    const OrbPoint lo(std::min(a.x, b.x), std::min(a.y, b.y)), hi(std::max(a.x, b.x), std::max(a.y, b.y));
    std::vector<int32> inside;
    for (int32 i = 0; i < mesh.Count(); ++i) {
        const OrbPoint &p = mesh.points[std::size_t(i)];
        if (p.x >= lo.x && p.x <= hi.x && p.y >= lo.y && p.y <= hi.y)
            inside.push_back(i);
    }
    return inside;
}

float64 MeshEdit::FalloffWeight(float64 distance) noexcept
{
    if (!(distance < 1.0))
        return 0.0;
    const float64 t = 1.0 - std::max(distance, 0.0);
    return t * t * (3.0 - 2.0 * t); // smoothstep: no kink where the falloff ends
}

} // namespace Orbane
