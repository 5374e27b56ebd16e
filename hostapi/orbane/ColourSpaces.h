#pragma once

#include "orbane/Types.h"

#include <array>
#include <cstddef>

namespace Orbane {

// The colour conversions of the host, made by OpenColorIO from transforms
// built in code (no config file is read): the sRGB curve of IEC 61966-2-1
// over Rec. 709 primaries, and CIE XYZ with the D65 white. Every colour
// conversion of the controls and the viewer goes through here, so a swatch,
// a hex code, a picked pixel and a histogram agree to the last bit.
//
// All calls are safe from any thread: the processors are built once and
// only read.
namespace ColourSpaces {

// One value through the sRGB curve: encoded (what a screen or an 8-bit file
// holds) to linear light, and back. Values below 0 continue the curve's
// linear segment; NaN stays NaN.
float64 SrgbToLinear(float64 encoded);
float64 LinearToSrgb(float64 linear);

// The same over whole images, in place: `pixels` interleaved pixels of
// `channels` values each (1 to 4). Where `hasAlpha`, the last channel is
// alpha and left as it is; the values are taken as straight (not
// premultiplied) colour.
void SrgbToLinear(float *values, std::size_t pixels, int32 channels, bool hasAlpha);
void LinearToSrgb(float *values, std::size_t pixels, int32 channels, bool hasAlpha);

// The linear value of every 8-bit sRGB code, built once: decoding an 8-bit
// image is a look-up a value.
const std::array<float, 256> &Srgb8ToLinear();

// CIE 1931 XYZ (D65 white) to linear Rec. 709 RGB, in place, `count` triples.
void XyzToRec709(float *xyz, std::size_t count);

} // namespace ColourSpaces
} // namespace Orbane
