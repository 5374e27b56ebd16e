#include "orbane/FloatImage.h"

#include "orbane/ColourSpaces.h"

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

// The linear values halfway between neighbouring 8-bit codes: the code of a
// value is how many of them lie at or below it. Searching these is the same
// as encoding and rounding, at a fraction of the cost of the curve's power.
const std::array<float, 255> &CodeThresholds()
{
    static const std::array<float, 255> thresholds = [] {
        std::array<float, 255> t{};
        for (int i = 0; i < 255; ++i)
            t[std::size_t(i)] = (float(i) + 0.5f) / 255.0f;
        ColourSpaces::SrgbToLinear(t.data(), t.size(), 1, false);
        return t;
    }();
    return thresholds;
}

uint8 Alpha8(float alpha)
{
    return uint8(std::lround(std::clamp(std::isfinite(alpha) ? alpha : 0.0f, 0.0f, 1.0f) * 255.0f));
}

// One premultiplied linear colour value as premultiplied 8-bit sRGB: the
// curve applies to the colour without its alpha.
uint8 Display8(float premultiplied, float alpha, uint8 alpha8)
{
    if (alpha >= 1.0f)
        return FloatImage::LinearToSrgb8(premultiplied);
    if (!(alpha > 0.0f))
        return 0;
    const int code = FloatImage::LinearToSrgb8(premultiplied / alpha);
    return uint8((code * alpha8 + 127) / 255);
}

} // namespace

FloatImage::FloatImage(int32 width, int32 height, int32 channels, std::vector<float> pixels)
{
    const bool fits = width > 0 && height > 0 && channels >= 1 && channels <= 4 &&
                      pixels.size() == std::size_t(width) * std::size_t(height) * std::size_t(channels);
    if (!fits)
        return;
    mWidth = width;
    mHeight = height;
    mChannels = channels;
    mPixels = std::make_shared<const std::vector<float>>(std::move(pixels));
}

FloatImage::Rgba FloatImage::At(int32 x, int32 y) const
{
    if (IsNull() || x < 0 || y < 0 || x >= mWidth || y >= mHeight)
        return {0, 0, 0, 0};
    const float *p = Pixels() + (std::size_t(y) * mWidth + x) * mChannels;
    switch (mChannels) {
    case 1:
        return {p[0], p[0], p[0], 1.0f};
    case 2:
        return {p[0], p[0], p[0], p[1]};
    case 3:
        return {p[0], p[1], p[2], 1.0f};
    default:
        return {p[0], p[1], p[2], p[3]};
    }
}

FloatImage::Rgba FloatImage::Average(const QRect &area) const
{
    const QRect inside = area.intersected(QRect(0, 0, mWidth, mHeight));
    Rgba mean{0, 0, 0, 0};
    if (IsNull() || inside.isEmpty())
        return mean;
    // Sums in double: a 64-megapixel area stays exact enough.
    std::array<double, 4> sum{0, 0, 0, 0};
    for (int32 y = inside.top(); y <= inside.bottom(); ++y)
        for (int32 x = inside.left(); x <= inside.right(); ++x) {
            const Rgba v = At(x, y);
            for (int c = 0; c < 4; ++c)
                sum[c] += v[c];
        }
    const double n = double(inside.width()) * inside.height();
    for (int c = 0; c < 4; ++c)
        mean[c] = float(sum[c] / n);
    return mean;
}

QImage FloatImage::ToDisplay() const
{
    if (IsNull())
        return QImage();
    QImage out(mWidth, mHeight, HasAlpha() ? QImage::Format_RGBA8888_Premultiplied : QImage::Format_RGBX8888);
    for (int32 y = 0; y < mHeight; ++y) {
        uchar *row = out.scanLine(y);
        for (int32 x = 0; x < mWidth; ++x) {
            const Rgba v = At(x, y);
            const uint8 a8 = Alpha8(v[3]);
            for (int c = 0; c < 3; ++c)
                row[4 * x + c] = Display8(v[c], v[3], a8);
            row[4 * x + 3] = HasAlpha() ? a8 : 255;
        }
    }
    return out;
}

FloatImage FloatImage::FromDisplay(const QImage &image)
{
    if (image.isNull())
        return FloatImage();
    const bool alpha = image.hasAlphaChannel();
    const QImage straight = image.convertToFormat(QImage::Format_RGBA8888);
    const int32 channels = alpha ? 4 : 3;
    std::vector<float> pixels(std::size_t(image.width()) * image.height() * channels);
    const std::array<float, 256> &toLinear = ColourSpaces::Srgb8ToLinear();
    float *out = pixels.data();
    for (int32 y = 0; y < straight.height(); ++y) {
        const uchar *row = straight.constScanLine(y);
        for (int32 x = 0; x < straight.width(); ++x, out += channels) {
            const float a = row[4 * x + 3] / 255.0f;
            for (int c = 0; c < 3; ++c)
                out[c] = toLinear[row[4 * x + c]] * (alpha ? a : 1.0f);
            if (alpha)
                out[3] = a;
        }
    }
    return FloatImage(image.width(), image.height(), channels, std::move(pixels));
}

uint8 FloatImage::LinearToSrgb8(float linear)
{
    if (!(linear > 0.0f)) // NaN too
        return 0;
    const std::array<float, 255> &t = CodeThresholds();
    return uint8(std::upper_bound(t.begin(), t.end(), linear) - t.begin());
}

} // namespace Orbane
