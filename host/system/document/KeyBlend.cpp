#include "KeyBlend.h"

#include "orbane/Number.h"
#include "orbane/Point.h"

#include <iterator>

namespace Orbane {

namespace {

// A value as up to three numbers, for the kinds that blend number by number.
struct Components
{
    int count = 0;
    float64 c[3] = {0.0, 0.0, 0.0};
};

Components Split(const Parameter &p)
{
    if (const auto *n = dynamic_cast<const Number *>(&p))
        return Components{1, {n->Value, 0.0, 0.0}};
    if (const auto *pt = dynamic_cast<const Point *>(&p))
        return Components{3, {pt->X, pt->Y, pt->Z}};
    return Components{};
}

Parameter *Join(const Components &v)
{
    return v.count == 1 ? static_cast<Parameter *>(new Number(v.c[0])) : new Point(v.c[0], v.c[1], v.c[2]);
}

// The slope (value per unit of time) at a key: from its two neighbours, and
// flat at the first and the last key.
Components Slope(const KeyBlend::Keys &keys, KeyBlend::Keys::const_iterator at, int count)
{
    Components slope{count, {0.0, 0.0, 0.0}};
    if (at == keys.begin() || std::next(at) == keys.end())
        return slope;
    const auto prev = std::prev(at), next = std::next(at);
    const Components a = Split(*prev->second), b = Split(*next->second);
    for (int i = 0; i < count; ++i)
        slope.c[i] = (b.c[i] - a.c[i]) / (next->first - prev->first);
    return slope;
}

} // namespace

Parameter *KeyBlend::Between(const Keys &keys, Keys::const_iterator after, float64 time, Interpolation mode)
{
    const auto before = std::prev(after);
    const float64 span = after->first - before->first;
    const float64 s = (time - before->first) / span;
    if (mode == Interpolation::Linear)
        return before->second->Interpolate(*after->second, s);
    const Components v1 = Split(*before->second), v2 = Split(*after->second);
    if (v1.count == 0 || v1.count != v2.count)
        return before->second->Interpolate(*after->second, s * s * (3.0 - 2.0 * s));
    // Cubic Hermite on the span, its slopes scaled from time to the span.
    const Components m1 = Slope(keys, before, v1.count), m2 = Slope(keys, after, v1.count);
    const float64 s2 = s * s, s3 = s2 * s;
    const float64 h00 = 2 * s3 - 3 * s2 + 1, h10 = s3 - 2 * s2 + s, h01 = 3 * s2 - 2 * s3, h11 = s3 - s2;
    Components out{v1.count, {0.0, 0.0, 0.0}};
    for (int i = 0; i < v1.count; ++i)
        out.c[i] = h00 * v1.c[i] + h10 * span * m1.c[i] + h01 * v2.c[i] + h11 * span * m2.c[i];
    return Join(out);
}

} // namespace Orbane
