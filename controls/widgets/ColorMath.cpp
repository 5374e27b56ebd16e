#include "widgets/ColorMath.h"

#include "orbane/ColourSpaces.h"

#include <algorithm>
#include <cmath>

namespace Orbane {
namespace ColorMath {

namespace {

// Rec. 709 luma weights (ITU-R BT.709-6, item 3.2).
constexpr float64 kKr = 0.2126, kKb = 0.0722, kKg = 1.0 - kKr - kKb;

float64 Hue(float64 r, float64 g, float64 b, float64 max, float64 delta)
{
    if (delta <= 0.0)
        return 0.0;
    float64 h = max == r ? (g - b) / delta : max == g ? 2.0 + (b - r) / delta : 4.0 + (r - g) / delta;
    h *= 60.0;
    return h < 0.0 ? h + 360.0 : h;
}

// The RGB of a hue at full saturation and value, 0..1 each.
ColorRGBA HueRgb(float64 hue)
{
    const float64 h = std::fmod(std::fmod(hue, 360.0) + 360.0, 360.0) / 60.0;
    const float64 x = 1.0 - std::fabs(std::fmod(h, 2.0) - 1.0);
    switch (int(h)) {
    case 0:
        return {1.0, x, 0.0, 1.0};
    case 1:
        return {x, 1.0, 0.0, 1.0};
    case 2:
        return {0.0, 1.0, x, 1.0};
    case 3:
        return {0.0, x, 1.0, 1.0};
    case 4:
        return {x, 0.0, 1.0, 1.0};
    default:
        return {1.0, 0.0, x, 1.0};
    }
}

int HexDigits(const QString &t, int at, int count)
{
    bool ok = false;
    const int v = t.mid(at, count).toInt(&ok, 16);
    return ok ? (count == 1 ? v * 17 : v) : -1;
}

} // namespace

ColorTriple RgbToHsv(const ColorRGBA &c)
{
    const float64 max = std::max({c.r, c.g, c.b}), min = std::min({c.r, c.g, c.b});
    const float64 delta = max - min;
    return {{Hue(c.r, c.g, c.b, max, delta), max > 0.0 ? delta / max : 0.0, max}};
}

ColorRGBA HsvToRgb(const ColorTriple &t, float64 alpha)
{
    const ColorRGBA pure = HueRgb(t.c[0]);
    const float64 s = t.c[1], v = t.c[2];
    // Each channel moves from white (s = 0) to the pure hue, scaled by value.
    const auto mix = [&](float64 p) { return v * (1.0 - s + s * p); };
    return {mix(pure.r), mix(pure.g), mix(pure.b), alpha};
}

ColorTriple RgbToHls(const ColorRGBA &c)
{
    const float64 max = std::max({c.r, c.g, c.b}), min = std::min({c.r, c.g, c.b});
    const float64 delta = max - min, l = (max + min) * 0.5;
    const float64 denom = 1.0 - std::fabs(2.0 * l - 1.0);
    return {{Hue(c.r, c.g, c.b, max, delta), l, denom > 0.0 ? delta / denom : 0.0}};
}

ColorRGBA HlsToRgb(const ColorTriple &t, float64 alpha)
{
    const ColorRGBA pure = HueRgb(t.c[0]);
    const float64 l = t.c[1], s = t.c[2];
    const float64 chroma = (1.0 - std::fabs(2.0 * l - 1.0)) * s, m = l - chroma * 0.5;
    return {m + chroma * pure.r, m + chroma * pure.g, m + chroma * pure.b, alpha};
}

ColorTriple RgbToYuv(const ColorRGBA &c)
{
    const float64 y = kKr * c.r + kKg * c.g + kKb * c.b;
    return {{y, (c.b - y) / (2.0 * (1.0 - kKb)), (c.r - y) / (2.0 * (1.0 - kKr))}};
}

ColorRGBA YuvToRgb(const ColorTriple &t, float64 alpha)
{
    const float64 y = t.c[0];
    const float64 r = y + 2.0 * (1.0 - kKr) * t.c[2];
    const float64 b = y + 2.0 * (1.0 - kKb) * t.c[1];
    return {r, (y - kKr * r - kKb * b) / kKg, b, alpha};
}

ColorTriple ToModel(const ColorRGBA &rgb, int32 model)
{
    return model == Model_HLS ? RgbToHls(rgb) : model == Model_YUV ? RgbToYuv(rgb) : RgbToHsv(rgb);
}

ColorRGBA FromModel(const ColorTriple &t, int32 model, float64 alpha)
{
    return model == Model_HLS ? HlsToRgb(t, alpha) : model == Model_YUV ? YuvToRgb(t, alpha) : HsvToRgb(t, alpha);
}

const char *ModelName(int32 model)
{
    return model == Model_HLS ? "HLS" : model == Model_YUV ? "YUV" : "HSV";
}

float64 Clip(float64 v)
{
    return std::isnan(v) ? 0.0 : std::clamp(v, 0.0, 1.0);
}

QColor ToDisplay(const ColorRGBA &c)
{
    return QColor::fromRgbF(ColourSpaces::LinearToSrgb(Clip(c.r)), ColourSpaces::LinearToSrgb(Clip(c.g)),
                            ColourSpaces::LinearToSrgb(Clip(c.b)), Clip(c.a));
}

ColorRGBA FromQColor(const QColor &q)
{
    return {ColourSpaces::SrgbToLinear(q.redF()), ColourSpaces::SrgbToLinear(q.greenF()),
            ColourSpaces::SrgbToLinear(q.blueF()), q.alphaF()};
}

QString ToHex(const ColorRGBA &c, bool withAlpha)
{
    const QColor q = ToDisplay(c);
    QString hex = QString::asprintf("#%02X%02X%02X", q.red(), q.green(), q.blue());
    return withAlpha ? hex + QString::asprintf("%02X", q.alpha()) : hex;
}

bool FromHex(const QString &text, ColorRGBA &out)
{
    QString t = text.trimmed();
    if (t.startsWith('#'))
        t.remove(0, 1);
    const int n = t.size();
    if (n != 3 && n != 6 && n != 8)
        return false;
    const int w = n == 3 ? 1 : 2;
    const int r = HexDigits(t, 0, w), g = HexDigits(t, w, w), b = HexDigits(t, 2 * w, w);
    const int a = n == 8 ? HexDigits(t, 6, 2) : 0;
    if (r < 0 || g < 0 || b < 0 || a < 0)
        return false;
    out.r = ColourSpaces::SrgbToLinear(r / 255.0);
    out.g = ColourSpaces::SrgbToLinear(g / 255.0);
    out.b = ColourSpaces::SrgbToLinear(b / 255.0);
    if (n == 8)
        out.a = a / 255.0;
    return true;
}

} // namespace ColorMath
} // namespace Orbane
