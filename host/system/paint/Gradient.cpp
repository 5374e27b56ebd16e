#include "orbane/Gradient.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

// Hue, then two channels, all 0..1; s == 0 means the hue carries no colour.
struct HueColor
{
    float64 H, S, V;
};

HueColor RgbToHsv(const GradientColor &c)
{
    const float64 max = std::max({c.R, c.G, c.B}), min = std::min({c.R, c.G, c.B});
    const float64 delta = max - min;
    HueColor out{0.0, max > 0.0 ? delta / max : 0.0, max};
    if (delta <= 0.0)
        return out;
    if (max == c.R)
        out.H = (c.G - c.B) / delta;
    else if (max == c.G)
        out.H = 2.0 + (c.B - c.R) / delta;
    else
        out.H = 4.0 + (c.R - c.G) / delta;
    out.H = out.H / 6.0 - std::floor(out.H / 6.0);
    return out;
}

GradientColor HsvToRgb(const HueColor &c, float64 alpha)
{
    const float64 h = (c.H - std::floor(c.H)) * 6.0;
    const int32 sector = int32(h) % 6;
    const float64 f = h - std::floor(h);
    const float64 p = c.V * (1.0 - c.S), q = c.V * (1.0 - c.S * f), t = c.V * (1.0 - c.S * (1.0 - f));
    switch (sector) {
    case 0:
        return {c.V, t, p, alpha};
    case 1:
        return {q, c.V, p, alpha};
    case 2:
        return {p, c.V, t, alpha};
    case 3:
        return {p, q, c.V, alpha};
    case 4:
        return {t, p, c.V, alpha};
    default:
        return {c.V, p, q, alpha};
    }
}

// HLS reuses the HSV hue; lightness and saturation follow the usual cone.
HueColor RgbToHls(const GradientColor &c)
{
    const float64 max = std::max({c.R, c.G, c.B}), min = std::min({c.R, c.G, c.B});
    const float64 l = (max + min) / 2.0, delta = max - min;
    const float64 s = delta <= 0.0 ? 0.0 : delta / (1.0 - std::fabs(2.0 * l - 1.0));
    return {RgbToHsv(c).H, s, l};
}

GradientColor HlsToRgb(const HueColor &c, float64 alpha)
{
    const float64 v = c.V + c.S * std::min(c.V, 1.0 - c.V);
    const float64 sv = v <= 0.0 ? 0.0 : 2.0 * (1.0 - c.V / v);
    return HsvToRgb({c.H, sv, v}, alpha);
}

float64 Lerp(float64 a, float64 b, float64 t)
{
    return a + (b - a) * t;
}

// Hue the shortest way round; a colourless end takes the other end's hue.
HueColor LerpHue(HueColor a, HueColor b, float64 t)
{
    if (a.S <= 0.0)
        a.H = b.H;
    if (b.S <= 0.0)
        b.H = a.H;
    float64 dh = b.H - a.H;
    if (dh > 0.5)
        dh -= 1.0;
    else if (dh < -0.5)
        dh += 1.0;
    return {a.H + dh * t, Lerp(a.S, b.S, t), Lerp(a.V, b.V, t)};
}

GradientColor Interpolate(const GradientColor &a, const GradientColor &b, float64 t, int32 space)
{
    const float64 alpha = Lerp(a.A, b.A, t);
    switch (space) {
    case GCS_HSV:
        return HsvToRgb(LerpHue(RgbToHsv(a), RgbToHsv(b), t), alpha);
    case GCS_HLS:
        return HlsToRgb(LerpHue(RgbToHls(a), RgbToHls(b), t), alpha);
    default:
        return {Lerp(a.R, b.R, t), Lerp(a.G, b.G, t), Lerp(a.B, b.B, t), alpha};
    }
}

} // namespace

Gradient::Gradient() = default;

Gradient::~Gradient() = default;

void Gradient::AddStop(float64 pos, const GradientColor &colour)
{
    auto at = std::upper_bound(mStops.begin(), mStops.end(), pos, [](float64 p, const Stop &s) { return p < s.Pos; });
    mStops.insert(at, Stop{pos, colour});
    ++mSerial;
    for (auto &table : mTables)
        table.reset();
}

void Gradient::Clear()
{
    mStops.clear();
    ++mSerial;
    for (auto &table : mTables)
        table.reset();
}

GradientColor Gradient::Evaluate(float64 pos, int32 space) const
{
    if (mStops.empty())
        return {0.0, 0.0, 0.0, 0.0};
    pos = std::min(1.0, std::max(0.0, pos));
    auto upper =
        std::upper_bound(mStops.begin(), mStops.end(), pos, [](float64 p, const Stop &s) { return p < s.Pos; });
    if (upper == mStops.begin())
        return upper->Color;
    if (upper == mStops.end())
        return mStops.back().Color;
    const Stop &a = *(upper - 1), &b = *upper;
    return Interpolate(a.Color, b.Color, (pos - a.Pos) / (b.Pos - a.Pos), space);
}

GradientColor Gradient::QuickEvaluate(float64 pos, int32 space) const
{
    const Table &table = TableFor(space);
    const float64 f = std::min(1.0, std::max(0.0, pos)) * (TableSize - 1);
    const int32 i = std::min(int32(f), TableSize - 2);
    return Interpolate(table[size_t(i)], table[size_t(i + 1)], f - i, GCS_RGB);
}

const Gradient::Table &Gradient::TableFor(int32 space) const
{
    if (space < 0 || space >= GCS_Count)
        space = GCS_RGB;
    std::unique_ptr<Table> &table = mTables[size_t(space)];
    if (!table) {
        table = std::make_unique<Table>(size_t(TableSize));
        for (int32 i = 0; i < TableSize; ++i)
            (*table)[size_t(i)] = Evaluate(float64(i) / (TableSize - 1), space);
    }
    return *table;
}

} // namespace Orbane
