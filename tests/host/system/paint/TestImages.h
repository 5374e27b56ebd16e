#pragma once

#include <OpenImageIO/imageio.h>

#include <cmath>
#include <string>
#include <vector>

namespace Orbane {
namespace Test {

// Writes `pixels` (float, interleaved, rows from the top) to `path` in the
// file's format and sample `type`; `bits` asks for fewer bits per sample
// (DPX's 10). Alpha is written as given, not divided out.
inline bool WriteTestImage(const std::string &path, int width, int height, int channels, OIIO::TypeDesc type,
                           const std::vector<float> &pixels, int bits = 0)
{
    auto out = OIIO::ImageOutput::create(path);
    if (!out)
        return false;
    OIIO::ImageSpec desc(width, height, channels, type);
    if (bits)
        desc.attribute("oiio:BitsPerSample", bits);
    if (channels == 4)
        desc.alpha_channel = 3;
    desc.attribute("oiio:UnassociatedAlpha", 1);
    return out->open(path, desc) && out->write_image(OIIO::TypeDesc::FLOAT, pixels.data()) && out->close();
}

// A picture of one flat value in every channel.
inline bool WriteFlatImage(const std::string &path, int width, int height, float value)
{
    return WriteTestImage(path, width, height, 3, OIIO::TypeDesc::HALF,
                          std::vector<float>(std::size_t(width) * height * 3, value));
}

} // namespace Test
} // namespace Orbane
