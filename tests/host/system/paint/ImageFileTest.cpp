#include "TestImages.h"

#include "orbane/ClipSequence.h"
#include "orbane/ColourSpaces.h"
#include "orbane/FloatImage.h"
#include "orbane/ImageFile.h"

#include <QDir>
#include <QFile>
#include <QTemporaryDir>
#include <QtEndian>

#include <gtest/gtest.h>

#include <cmath>

using namespace Orbane;
using Orbane::Test::WriteFlatImage;
using Orbane::Test::WriteTestImage;

namespace {

constexpr int kWidth = 7, kHeight = 5;

// A value per sample that differs between neighbours and channels; `range`
// above 1 reaches past white, as float files may.
float Sample(int x, int y, int c, float range)
{
    return range * std::fmod((x * 7 + y * 13 + c * 5) / 37.0f, 1.0f);
}

struct FormatRow
{
    const char *name;
    const char *ext;
    OIIO::TypeDesc type;
    int channels;
    int bits;     // 0: all of the type's
    float range;  // of the written values
    bool encoded; // integer samples hold sRGB codes: read back through the curve
};

float TopCode(const FormatRow &row)
{
    return row.bits ? float((1 << row.bits) - 1) : row.type == OIIO::TypeDesc::UINT8 ? 255.0f : 65535.0f;
}

// What reading should give: the written value at the file's precision,
// linear.
float Expected(const FormatRow &row, float written)
{
    return row.encoded ? float(ColourSpaces::SrgbToLinear(std::round(written * TopCode(row)) / TopCode(row))) : written;
}

// The file's precision: half a float's ten bits; one code of an integer
// sample (writers may round or cut), through the curve.
float Tolerance(const FormatRow &row, float written)
{
    if (row.type == OIIO::TypeDesc::HALF)
        return 1e-3f * std::max(1.0f, std::fabs(written));
    if (!row.encoded)
        return 1e-6f;
    const float code = 1.0f / TopCode(row);
    return float(ColourSpaces::SrgbToLinear(std::min(1.0f, written + code))) -
           float(ColourSpaces::SrgbToLinear(std::max(0.0f, written - code)));
}

class ImageFormats : public ::testing::TestWithParam<FormatRow>
{
protected:
    QTemporaryDir dir;
};

// Each format's file, written by OpenImageIO and read back: every sample
// within the format's precision, linear, premultiplied by alpha.
TEST_P(ImageFormats, ReadsBackWithinPrecision)
{
    const FormatRow &row = GetParam();
    std::vector<float> written;
    for (int y = 0; y < kHeight; ++y)
        for (int x = 0; x < kWidth; ++x)
            for (int c = 0; c < row.channels; ++c)
                written.push_back(c == 3 ? 0.25f + 0.5f * (x % 2) : Sample(x, y, c, row.range));
    const QString path = dir.filePath(QString("picture.") + row.ext);
    ASSERT_TRUE(WriteTestImage(path.toStdString(), kWidth, kHeight, row.channels, row.type, written, row.bits));

    ImageFile::Header header;
    QString error;
    ASSERT_TRUE(ImageFile::ReadHeader(path, &header, &error)) << error.toStdString();
    EXPECT_EQ(header.width, kWidth);
    EXPECT_EQ(header.height, kHeight);
    EXPECT_EQ(header.channels, row.channels);
    const FloatImage image = ImageFile::ReadLinear(path, &error);
    ASSERT_FALSE(image.IsNull()) << error.toStdString();
    ASSERT_EQ(image.Channels(), row.channels);
    for (int y = 0; y < kHeight; ++y)
        for (int x = 0; x < kWidth; ++x) {
            const float *in = &written[(y * kWidth + x) * row.channels];
            const float alpha = row.channels == 4 ? in[3] : 1.0f;
            const FloatImage::Rgba got = image.At(x, y);
            for (int c = 0; c < std::min(row.channels, 3); ++c) {
                const float want = Expected(row, in[c]) * (row.channels == 4 ? std::round(alpha * 255) / 255 : 1.0f);
                ASSERT_NEAR(got[c], want, Tolerance(row, in[c])) << "x " << x << " y " << y << " c " << c;
            }
        }
}

INSTANTIATE_TEST_SUITE_P(Files, ImageFormats,
                         ::testing::Values(FormatRow{"ExrHalf", "exr", OIIO::TypeDesc::HALF, 3, 0, 4.0f, false},
                                           FormatRow{"ExrFloat", "exr", OIIO::TypeDesc::FLOAT, 3, 0, 4.0f, false},
                                           FormatRow{"TiffFloat", "tif", OIIO::TypeDesc::FLOAT, 3, 0, 2.0f, false},
                                           FormatRow{"Tiff16", "tif", OIIO::TypeDesc::UINT16, 3, 0, 1.0f, true},
                                           FormatRow{"Dpx10", "dpx", OIIO::TypeDesc::UINT16, 3, 10, 1.0f, true},
                                           FormatRow{"Png8", "png", OIIO::TypeDesc::UINT8, 3, 0, 1.0f, true},
                                           FormatRow{"Png8Alpha", "png", OIIO::TypeDesc::UINT8, 4, 0, 1.0f, true}),
                         [](const ::testing::TestParamInfo<FormatRow> &info) { return std::string(info.param.name); });

// An 8-bit file shows exactly as it was: the screen's codes are the file's.
TEST(ImageDisplay, EightBitCodesSurviveTheLinearRoundTrip)
{
    QTemporaryDir dir;
    std::vector<float> codes;
    for (int i = 0; i < 256; ++i)
        for (int c = 0; c < 3; ++c)
            codes.push_back(((i + 85 * c) % 256) / 255.0f);
    const QString path = dir.filePath("codes.png");
    ASSERT_TRUE(WriteTestImage(path.toStdString(), 256, 1, 3, OIIO::TypeDesc::UINT8, codes));
    const QImage shown = ImageFile::ReadLinear(path).ToDisplay();
    ASSERT_EQ(shown.width(), 256);
    for (int i = 0; i < 256; ++i) {
        const QColor got = shown.pixelColor(i, 0);
        ASSERT_EQ(got.red(), i);
        ASSERT_EQ(got.green(), (i + 85) % 256);
        ASSERT_EQ(got.blue(), (i + 170) % 256);
    }
}

// DPX keeps the picture's size at fixed places of its header: a small
// file made to claim a large size, with no pixels for it.
bool ClaimSize(const QString &path, quint32 width, quint32 height)
{
    QFile file(path);
    if (!file.open(QIODevice::ReadWrite))
        return false;
    const QByteArray magic = file.read(4);
    uchar size[8];
    const bool big = magic == "SDPX";
    big ? qToBigEndian(width, size) : qToLittleEndian(width, size);
    big ? qToBigEndian(height, size + 4) : qToLittleEndian(height, size + 4);
    return file.seek(772) && file.write(reinterpret_cast<const char *>(size), 8) == 8;
}

struct BadRow
{
    const char *name;
    const char *ext;
    std::function<bool(const QString &path)> make;
    const char *says;
};

class BadFiles : public ::testing::TestWithParam<BadRow>
{
};

// A file too large by its header, a truncated one, one that is no picture,
// one not there: refused with its reason, nothing read.
TEST_P(BadFiles, AreRefusedWithTheReason)
{
    QTemporaryDir dir;
    const BadRow &row = GetParam();
    const QString path = dir.filePath(QString("bad.") + row.ext);
    ASSERT_TRUE(row.make(path));
    QString error;
    const FloatImage image = ImageFile::ReadLinear(path, &error);
    EXPECT_TRUE(image.IsNull());
    EXPECT_TRUE(error.contains(row.says)) << error.toStdString();
    EXPECT_TRUE(error.startsWith(path)) << error.toStdString();
    // What comps and image Inputs check is refused the same way.
    EXPECT_TRUE(ImageFile::Read(path).isNull());
}

INSTANTIATE_TEST_SUITE_P(
    Files, BadFiles,
    ::testing::Values(BadRow{"OverTheLimit", "dpx",
                             [](const QString &path) {
                                 return WriteFlatImage(path.toStdString(), 4, 4, 0.5f) && ClaimSize(path, 9000, 9000);
                             },
                             "9000 x 9000 pixels is more than the limit"},
                      BadRow{"Truncated", "exr",
                             [](const QString &path) {
                                 if (!WriteFlatImage(path.toStdString(), 64, 64, 0.5f))
                                     return false;
                                 // The header and the table of chunks stay; pixels go.
                                 QFile file(path);
                                 return file.resize(file.size() - 64);
                             },
                             "cannot read the pixels"},
                      BadRow{"NoPicture", "exr",
                             [](const QString &path) {
                                 QFile file(path);
                                 return file.open(QIODevice::WriteOnly) && file.write("not a picture at all") > 0;
                             },
                             "not a readable image"},
                      BadRow{"Missing", "exr", [](const QString &) { return true; }, "no such file"}),
    [](const ::testing::TestParamInfo<BadRow> &info) { return std::string(info.param.name); });

// A folder of generated EXR frames, 1, 2, 4 and 5, with names that only
// look like frames beside them.
class SequenceFolder : public ::testing::Test
{
protected:
    void SetUp() override
    {
        for (const char *name : {"plate.0001.exr", "plate.0002.exr", "plate.0004.exr", "plate.0005.exr",
                                 "plate.003.exr", "plate.v2.exr", "other.0003.exr"})
            ASSERT_TRUE(WriteFlatImage(dir.filePath(name).toStdString(), 2, 2, 0.1f));
    }
    QTemporaryDir dir;
};

TEST_F(SequenceFolder, FindsFramesByEveryPatternForm)
{
    for (const char *form : {"plate.####.exr", "plate.%04d.exr", "plate.0002.exr"}) {
        const ClipSequence clip = ClipSequence::Detect(dir.filePath(form));
        SCOPED_TRACE(form);
        EXPECT_EQ(clip.pattern, dir.filePath("plate.####.exr"));
        EXPECT_EQ(clip.frames, (std::vector<int32>{1, 2, 4, 5}));
        EXPECT_EQ(clip.Gaps(), 1);
        EXPECT_EQ(clip.FrameFile(4), dir.filePath("plate.0004.exr"));
    }
    EXPECT_TRUE(ClipSequence::IsPattern("plate.%04d.exr"));
    EXPECT_TRUE(ClipSequence::IsPattern("a/plate.####.exr"));
    EXPECT_FALSE(ClipSequence::IsPattern("a/plate.0004.exr"));
}

TEST_F(SequenceFolder, HoldsTheLastEarlierFrameWhereOneIsMissing)
{
    const ClipSequence clip = ClipSequence::Detect(dir.filePath("plate.####.exr"));
    const std::pair<int32, int32> shownFor[] = {{-3, 1}, {1, 1}, {2, 2}, {3, 2}, {4, 4}, {5, 5}, {900, 5}};
    for (const auto &[frame, held] : shownFor) {
        EXPECT_EQ(clip.HasFrame(frame), frame == held) << frame;
        EXPECT_EQ(clip.HeldFrame(frame), held) << frame;
    }
}

TEST(Sequence, UnpaddedPrintfFramesSortByNumber)
{
    QTemporaryDir dir;
    for (const char *name : {"shot.9.exr", "shot.10.exr", "shot.011.exr"})
        ASSERT_TRUE(WriteFlatImage(dir.filePath(name).toStdString(), 1, 1, 0.0f));
    const ClipSequence clip = ClipSequence::Detect(dir.filePath("shot.%d.exr"));
    EXPECT_EQ(clip.frames, (std::vector<int32>{9, 10}));
    EXPECT_EQ(clip.FrameFile(10), dir.filePath("shot.10.exr"));
}

} // namespace
