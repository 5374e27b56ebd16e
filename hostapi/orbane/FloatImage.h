#pragma once

#include "orbane/Types.h"

#include <QImage>
#include <QRect>

#include <array>
#include <memory>
#include <vector>

namespace Orbane {

// Pixels as linear light in 32-bit floats: one to four interleaved channels
// (grey, grey and alpha, RGB, RGBA), rows from the top, colour premultiplied
// by alpha. What the viewer shows is made from it for the screen; colour
// pickers and histograms read it, so values above 1 and below 0 of a float
// file stay as they were. Copies share the pixels.
class FloatImage
{
public:
    using Rgba = std::array<float, 4>;

    FloatImage() = default;
    // `pixels` holds width * height * channels values; anything else gives a
    // null image.
    FloatImage(int32 width, int32 height, int32 channels, std::vector<float> pixels);

    bool IsNull() const { return !mPixels; }
    int32 Width() const { return mWidth; }
    int32 Height() const { return mHeight; }
    int32 Channels() const { return mChannels; }
    bool HasAlpha() const { return mChannels == 2 || mChannels == 4; }
    const float *Pixels() const { return mPixels ? mPixels->data() : nullptr; }
    // The pixel as RGBA: grey spread over RGB, alpha 1 where there is none.
    // Outside the image: zeros.
    Rgba At(int32 x, int32 y) const;
    // The mean RGBA over the part of `area` inside the image; zeros where
    // none of it is.
    Rgba Average(const QRect &area) const;

    // For the screen: sRGB-encoded 8 bits, values clamped to 0..1 (no
    // exposure or tone mapping: what is above 1 shows white).
    QImage ToDisplay() const;
    // An 8-bit image as read for the screen, its sRGB values made linear
    // (ColourSpaces::Srgb8ToLinear).
    static FloatImage FromDisplay(const QImage &image);

    // The nearest 8-bit sRGB code of a linear value, exact for every value
    // ColourSpaces::Srgb8ToLinear gives for a code: 8-bit files show as
    // they were.
    static uint8 LinearToSrgb8(float linear);

private:
    int32 mWidth = 0, mHeight = 0, mChannels = 0;
    std::shared_ptr<const std::vector<float>> mPixels;
};

} // namespace Orbane
