#include "orbane/ImageFile.h"

#include "orbane/ColourSpaces.h"

#include <OpenImageIO/imageio.h>

#include <QFileInfo>
#include <QImageReader>

#include <algorithm>

namespace Orbane {

namespace {

bool Fail(QString *error, const QString &why)
{
    if (error)
        *error = why;
    return false;
}

bool CheckSize(const QString &path, qint64 width, qint64 height, QString *error)
{
    if (width * height <= ImageFile::kMaxPixels)
        return true;
    return Fail(error, QString("%1: %2 x %3 pixels is more than the limit of %4")
                           .arg(path)
                           .arg(width)
                           .arg(height)
                           .arg(ImageFile::kMaxPixels));
}

bool CheckReader(QImageReader &reader, const QString &path, QString *error)
{
    const QSize size = reader.size();
    if (!reader.canRead() || !size.isValid())
        return Fail(error, QString("%1: not a readable image").arg(path));
    return CheckSize(path, size.width(), size.height(), error);
}

// Straight alpha from PNG and TIFF, so the sRGB curve is undone on the
// colour alone; premultiplied here afterwards.
OIIO::ImageSpec OpenConfig()
{
    OIIO::ImageSpec config;
    config.attribute("oiio:UnassociatedAlpha", 1);
    return config;
}

bool CheckHeader(const QString &path, const OIIO::ImageSpec &desc, QString *error)
{
    if (desc.width <= 0 || desc.height <= 0 || desc.depth > 1 || desc.nchannels <= 0)
        return Fail(error, QString("%1: not a flat image of at least one pixel").arg(path));
    return CheckSize(path, desc.width, desc.height, error);
}

// OpenImageIO's description of the file's first image (size, channels,
// pixel type); the name is its own.
const OIIO::ImageSpec &Described(const OIIO::ImageInput &in)
{
    return in.spec();
}

// Opens the file and checks its header (size, channels) before any pixel is read.
std::unique_ptr<OIIO::ImageInput> Open(const QString &path, QString *error)
{
    if (!QFileInfo(path).isFile())
        return Fail(error, QString("%1: no such file").arg(path)), nullptr;
    const OIIO::ImageSpec config = OpenConfig();
    auto in = OIIO::ImageInput::open(path.toStdString(), &config);
    if (!in) {
        const QString why = QString::fromStdString(OIIO::geterror());
        return Fail(error, QString("%1: not a readable image (%2)").arg(path, why.trimmed())), nullptr;
    }
    return CheckHeader(path, Described(*in), error) ? std::move(in) : nullptr;
}

// Does the file hold sRGB-encoded values (rather than linear light)?
bool IsEncoded(const OIIO::ImageSpec &desc)
{
    const QString space = QString::fromStdString(desc.get_string_attribute("oiio:ColorSpace")).toLower();
    if (space.contains("linear"))
        return false;
    if (space.contains("srgb"))
        return true;
    return !desc.format.is_floating_point();
}

// Colour values of pixels with alpha multiplied by it, or divided by it
// (colour under no alpha is lost either way: 0).
void ScaleByAlpha(std::vector<float> &pixels, int channels, bool divide)
{
    for (std::size_t i = 0; i < pixels.size(); i += std::size_t(channels)) {
        float *p = &pixels[i];
        const float a = p[channels - 1];
        for (int c = 0; c < channels - 1; ++c)
            p[c] = divide ? (a > 0.0f ? p[c] / a : 0.0f) : p[c] * a;
    }
}

// Read values to premultiplied linear light, in place. The sRGB curve
// applies to straight colour.
void MakeLinear(std::vector<float> &pixels, int channels, bool encoded, bool straight)
{
    const bool alpha = channels == 2 || channels == 4;
    if (alpha && encoded && !straight)
        ScaleByAlpha(pixels, channels, true);
    if (encoded)
        ColourSpaces::SrgbToLinear(pixels.data(), pixels.size() / std::size_t(channels), channels, alpha);
    if (alpha && (encoded || straight))
        ScaleByAlpha(pixels, channels, false);
}

// Rows read between progress reports: small enough for a smooth bar, large
// enough to cost nothing.
constexpr int kBandRows = 64;

// Scanline files are read in bands, with a report after each: OpenImageIO
// reports the progress of a whole-image read for some formats only. Tiled
// files are read whole.
bool ReadPixels(OIIO::ImageInput &in, int channels, float *data, const ImageFile::Progress &progress, bool *stopped)
{
    const OIIO::ImageSpec &desc = Described(in);
    if (desc.tile_width > 0)
        return in.read_image(0, 0, 0, channels, OIIO::TypeDesc::FLOAT, data);
    const std::size_t rowValues = std::size_t(desc.width) * std::size_t(channels);
    for (int y = 0; y < desc.height; y += kBandRows) {
        const int end = std::min(desc.height, y + kBandRows);
        if (!in.read_scanlines(0, 0, desc.y + y, desc.y + end, 0, 0, channels, OIIO::TypeDesc::FLOAT,
                               data + std::size_t(y) * rowValues))
            return false;
        if (progress && !progress(float(end) / float(desc.height)))
            return !(*stopped = true);
    }
    return true;
}

} // namespace

bool ImageFile::Check(const QString &path, QString *error)
{
    QImageReader reader(path);
    if (reader.canRead())
        return CheckReader(reader, path, error);
    Header header;
    return ReadHeader(path, &header, error);
}

QImage ImageFile::Read(const QString &path, QString *error)
{
    QImageReader reader(path);
    if (!reader.canRead())
        return ReadLinear(path, error).ToDisplay();
    if (!CheckReader(reader, path, error))
        return QImage();
    const QImage image = reader.read();
    if (image.isNull())
        Fail(error, QString("%1: %2").arg(path, reader.errorString()));
    return image;
}

bool ImageFile::ReadHeader(const QString &path, Header *header, QString *error)
{
    const auto in = Open(path, error);
    if (!in)
        return false;
    const OIIO::ImageSpec &desc = Described(*in);
    header->width = desc.width;
    header->height = desc.height;
    header->channels = desc.nchannels;
    header->isFloat = desc.format.is_floating_point();
    header->format = QString::fromUtf8(in->format_name());
    return true;
}

FloatImage ImageFile::ReadLinear(const QString &path, QString *error, const Progress &progress)
{
    const auto in = Open(path, error);
    if (!in)
        return FloatImage();
    const OIIO::ImageSpec &desc = Described(*in);
    const int channels = std::min(desc.nchannels, 4);
    std::vector<float> pixels(std::size_t(desc.width) * std::size_t(desc.height) * std::size_t(channels));
    bool stopped = false;
    const bool read = ReadPixels(*in, channels, pixels.data(), progress, &stopped);
    if (stopped)
        return Fail(error, QString("%1: reading stopped").arg(path)), FloatImage();
    if (!read) {
        const QString why = QString::fromStdString(in->geterror()).trimmed();
        return Fail(error, QString("%1: cannot read the pixels (%2)").arg(path, why)), FloatImage();
    }
    // Of two or four channels the last is taken as alpha, as the files
    // these readers see order them.
    const bool straight = desc.get_int_attribute("oiio:UnassociatedAlpha", 0) != 0;
    MakeLinear(pixels, channels, IsEncoded(desc), straight);
    return FloatImage(desc.width, desc.height, channels, std::move(pixels));
}

} // namespace Orbane
