#pragma once

#include "orbane/Types.h"

#include <QColor>
#include <QString>

namespace Orbane {

// A colour as the controls hold it: linear float channels, nominally 0..1.
// Values outside (HDR, negative) and NaN are kept as they are; only what is
// shown on screen is clipped (ToDisplay). What the screen and hexadecimal
// texts show is the sRGB encoding of the linear value, so that a hex code
// typed in is the colour a person sees, and a picked pixel keeps its light.
struct ColorRGBA
{
    float64 r = 0.0, g = 0.0, b = 0.0, a = 1.0;
};

// Three channels of another colour model: hue in degrees 0..360, the rest
// nominally 0..1 (YUV: Y 0..1, U and V about -0.5..0.5).
struct ColorTriple
{
    float64 c[3] = {0.0, 0.0, 0.0};
};

// The pure conversions of the colour controls. No widget state: they are
// tested as tables and shared by every control that shows a colour.
namespace ColorMath {

// The colour models a control can show beside RGB, in the order of the
// "ColorSpace" enumeration of the tags.
enum Model : int32
{
    Model_HSV = 0,
    Model_HLS = 1,
    Model_YUV = 2,
    Model_Count
};

ColorTriple RgbToHsv(const ColorRGBA &rgb);
ColorRGBA HsvToRgb(const ColorTriple &hsv, float64 alpha = 1.0);
// Hue, lightness, saturation, in that order (the HLS order of the tags).
ColorTriple RgbToHls(const ColorRGBA &rgb);
ColorRGBA HlsToRgb(const ColorTriple &hls, float64 alpha = 1.0);
// Rec. 709 luma and colour differences, scaled so that U and V lie in -0.5..0.5.
ColorTriple RgbToYuv(const ColorRGBA &rgb);
ColorRGBA YuvToRgb(const ColorTriple &yuv, float64 alpha = 1.0);
ColorTriple ToModel(const ColorRGBA &rgb, int32 model);
ColorRGBA FromModel(const ColorTriple &t, int32 model, float64 alpha);
const char *ModelName(int32 model);

// "#RRGGBB" or "#RRGGBBAA" of the clipped colour, sRGB-encoded (alpha as is).
QString ToHex(const ColorRGBA &c, bool withAlpha);
// Reads "#RGB", "RRGGBB", "#RRGGBBAA" (the '#' optional); false where it is
// not such a text. Without alpha digits the alpha of `out` stays.
bool FromHex(const QString &text, ColorRGBA &out);

// One channel clipped for the screen: NaN shows as 0, the rest clamps to 0..1.
float64 Clip(float64 v);
// What a swatch paints: the clipped colour sRGB-encoded, straight alpha.
QColor ToDisplay(const ColorRGBA &c);
ColorRGBA FromQColor(const QColor &q);

} // namespace ColorMath
} // namespace Orbane
