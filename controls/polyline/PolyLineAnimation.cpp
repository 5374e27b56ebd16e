#include "polyline/PolyLineAnimation.h"

#include "orbane/PolyLine.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

bool Selected(const uint8 *selected, int32 i)
{
    return !selected || selected[i];
}

// The six coordinates of a key point, for blending whole points.
struct Coords
{
    float64 v[6];
};

Coords CoordsOf(const PolyPoint &p)
{
    return {{p.X, p.Y, p.InX, p.InY, p.OutX, p.OutY}};
}

void SetCoords(PolyPoint &p, const Coords &c)
{
    p.X = c.v[0], p.Y = c.v[1], p.InX = c.v[2], p.InY = c.v[3], p.OutX = c.v[4], p.OutY = c.v[5];
}

} // namespace

bool PolyLineAnimation::SmoothPoints(PolyLine &shape, const uint8 *selected, float64 amount, int32 passes)
{
    const int32 n = shape.GetCount();
    if (n < 3 || !(amount > 0.0) || passes < 1)
        return false;
    amount = std::min(amount, 1.0);
    bool changed = false;
    for (int32 pass = 0; pass < passes; ++pass) {
        // Every point moves from where its neighbours were before the pass.
        const std::vector<PolyPoint> before = shape.Points();
        for (int32 i = 0; i < n; ++i) {
            const bool end = !shape.IsClosed() && (i == 0 || i == n - 1);
            if (end || !Selected(selected, i))
                continue;
            const PolyPoint &prev = before[std::size_t((i + n - 1) % n)], &next = before[std::size_t((i + 1) % n)];
            PolyPoint p = before[std::size_t(i)];
            const float64 dx = amount * ((prev.X + next.X) / 2.0 - p.X);
            const float64 dy = amount * ((prev.Y + next.Y) / 2.0 - p.Y);
            if (dx == 0.0 && dy == 0.0)
                continue;
            p.Offset(dx, dy);
            changed = shape.SetPoint(i, p) || changed;
        }
    }
    return changed;
}

bool PolyLineAnimation::CardinalToBezier(PolyLine &shape, const uint8 *selected, float64 tension)
{
    const int32 n = shape.GetCount();
    if (n < 2)
        return false;
    const float64 scale = (1.0 - std::clamp(tension, 0.0, 1.0)) / 6.0;
    const std::vector<PolyPoint> points = shape.Points();
    bool changed = false;
    for (int32 i = 0; i < n; ++i) {
        if (!Selected(selected, i))
            continue;
        const bool closed = shape.IsClosed();
        // The tangent from the neighbours; an open end has one of them, so
        // it counts twice (the end aims a third of the way to it).
        const int32 a = closed ? (i + n - 1) % n : std::max(i - 1, 0);
        const int32 b = closed ? (i + 1) % n : std::min(i + 1, n - 1);
        const float64 span = (a == i || b == i) ? 2.0 : 1.0;
        const float64 tx = span * scale * (points[std::size_t(b)].X - points[std::size_t(a)].X);
        const float64 ty = span * scale * (points[std::size_t(b)].Y - points[std::size_t(a)].Y);
        PolyPoint p = points[std::size_t(i)];
        p.InX = p.X - tx, p.InY = p.Y - ty, p.OutX = p.X + tx, p.OutY = p.Y + ty;
        p.Flags &= ~uint32(PPF_Linear);
        if (p != points[std::size_t(i)])
            changed = shape.SetPoint(i, p) || changed;
    }
    return changed;
}

bool PolyLineAnimation::SmoothKeys(std::vector<AutoRef<PolyLine>> &keys, const std::vector<float64> &times,
                                   const uint8 *selected, float64 amount, int32 passes)
{
    const std::size_t k = keys.size();
    if (k < 3 || times.size() != k || !(amount > 0.0) || passes < 1)
        return false;
    const int32 n = keys.front()->GetCount();
    for (const AutoRef<PolyLine> &key : keys)
        if (key->GetCount() != n)
            return false;
    amount = std::min(amount, 1.0);
    bool changed = false;
    for (int32 pass = 0; pass < passes; ++pass) {
        std::vector<std::vector<PolyPoint>> before;
        for (const AutoRef<PolyLine> &key : keys)
            before.push_back(key->Points());
        for (std::size_t j = 1; j + 1 < k; ++j) {
            // Where an even motion from the key before to the key after is
            // at this key's time.
            const float64 span = times[j + 1] - times[j - 1];
            const float64 f = span > 0.0 ? (times[j] - times[j - 1]) / span : 0.5;
            for (int32 i = 0; i < n; ++i) {
                if (!Selected(selected, i))
                    continue;
                const Coords a = CoordsOf(before[j - 1][std::size_t(i)]), b = CoordsOf(before[j + 1][std::size_t(i)]);
                Coords c = CoordsOf(before[j][std::size_t(i)]);
                for (int32 m = 0; m < 6; ++m)
                    c.v[m] += amount * (a.v[m] + f * (b.v[m] - a.v[m]) - c.v[m]);
                PolyPoint p = before[j][std::size_t(i)];
                SetCoords(p, c);
                if (p != before[j][std::size_t(i)])
                    changed = keys[j]->SetPoint(i, p) || changed;
            }
        }
    }
    return changed;
}

float64 PolyLineAnimation::Ease(float64 u, float64 in, float64 out) noexcept
{
    u = std::clamp(u, 0.0, 1.0);
    // A cubic Hermite from (0, 0) to (1, 1) with the end slopes 1 - in and
    // 1 - out; slopes within 0..1 keep it rising.
    const float64 s0 = 1.0 - std::clamp(in, 0.0, 1.0), s1 = 1.0 - std::clamp(out, 0.0, 1.0);
    const float64 u2 = u * u, u3 = u2 * u;
    return s0 * (u3 - 2.0 * u2 + u) + (3.0 * u2 - 2.0 * u3) + s1 * (u3 - u2);
}

bool PolyLineAnimation::CopyPoints(PolyLine &to, const PolyLine &from, const uint8 *selected)
{
    const int32 n = to.GetCount();
    if (from.GetCount() != n)
        return false;
    bool changed = false;
    for (int32 i = 0; i < n; ++i) {
        if (!Selected(selected, i))
            continue;
        PolyPoint p = *to.GetPoint(i);
        SetCoords(p, CoordsOf(*from.GetPoint(i)));
        if (p != *to.GetPoint(i))
            changed = to.SetPoint(i, p) || changed;
    }
    return changed;
}

} // namespace Orbane
