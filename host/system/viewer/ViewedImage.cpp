#include "orbane/ViewedImage.h"

namespace Orbane {

ViewedImage &ViewedImage::Instance()
{
    static ViewedImage instance;
    return instance;
}

void ViewedImage::Set(const QImage &image)
{
    mImage = image;
    ++mSerial;
    emit Changed();
}

// RGBA64 keeps 16-bit sources exact and scales 8-bit ones exactly too
// (v * 257 / 65535 == v / 255).
FloatRGBAImage ViewedImage::ToFloatRGBA(const QImage &image)
{
    FloatRGBAImage out;
    if (image.isNull())
        return out;
    const QImage wide = image.convertToFormat(QImage::Format_RGBA64);
    out.width = wide.width();
    out.height = wide.height();
    out.rgba.resize(out.PixelCount() * 4);
    constexpr float kScale = 1.0f / 65535.0f;
    float *dst = out.rgba.data();
    for (int32 y = 0; y < out.height; ++y) {
        const auto *row = reinterpret_cast<const quint16 *>(wide.constScanLine(y));
        for (int32 i = 0; i < out.width * 4; ++i)
            *dst++ = float(row[i]) * kScale;
    }
    return out;
}

} // namespace Orbane
