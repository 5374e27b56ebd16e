#include "orbane/ViewerPanel.h"

#include "ViewerBackdrop.h"

#include <cmath>

namespace Orbane {

namespace {

// The sRGB decoding of every 8-bit code (IEC 61966-2-1), built once.
struct SrgbTable
{
    SrgbTable()
    {
        for (int i = 0; i < 256; ++i) {
            const float64 v = i / 255.0;
            linear[i] = v <= 0.04045 ? v / 12.92 : std::pow((v + 0.055) / 1.055, 2.4);
        }
    }
    float64 linear[256];
};

const SrgbTable &Srgb()
{
    static const SrgbTable table;
    return table;
}

} // namespace

// Today's viewer holds an 8-bit image; it is decoded here so that a float
// image can later answer the same call with its own values.
bool ViewerPanel::SampleLinear(const QRect &pixels, std::array<float64, 4> &rgba) const
{
    const QImage &image = mBackdrop->Image();
    const QRect area = pixels.normalized().intersected(image.rect());
    if (image.isNull() || area.isEmpty())
        return false;
    const QImage block = image.copy(area).convertToFormat(QImage::Format_RGBA8888);
    const SrgbTable &srgb = Srgb();
    std::array<float64, 4> sum{};
    for (int y = 0; y < block.height(); ++y) {
        const uchar *p = block.constScanLine(y);
        for (int x = 0; x < block.width(); ++x, p += 4) {
            for (int c = 0; c < 3; ++c)
                sum[size_t(c)] += srgb.linear[p[c]];
            sum[3] += p[3] / 255.0;
        }
    }
    const float64 count = float64(block.width()) * block.height();
    for (float64 &s : sum)
        s /= count;
    rgba = sum;
    return true;
}

} // namespace Orbane
