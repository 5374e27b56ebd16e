#include "orbane/ColourSpaces.h"
#include "orbane/FloatImage.h"

#include <gtest/gtest.h>

#include <cmath>
#include <vector>

using namespace Orbane;

namespace {

// The published values carry five to seven significant digits.
constexpr double kPublished = 2e-6;
// On the straight segment OpenColorIO's line meets the power curve with the
// same slope, 1 / 12.9232, where the standard rounds it to 1 / 12.92: the
// two lie 2.5e-4 apart relative there.
constexpr double kSegment = 2e-5;

struct CurveRow
{
    const char *name;
    double encoded, linear, tolerance;
};

// IEC 61966-2-1 and the values colourists quote: the break of the two
// segments, mid grey, and the codes the colour tests use.
const CurveRow kCurve[] = {
    {"black", 0.0, 0.0, kPublished},
    {"white", 1.0, 1.0, kPublished},
    {"the break", 0.04045, 0.0031308, kPublished},
    {"half", 0.5, 0.2140411, kPublished},
    {"code 0x33", 0x33 / 255.0, 0.0331048, kPublished},
    {"code 0x80", 0x80 / 255.0, 0.2158605, kPublished},
    {"18 percent grey", 0.4613561, 0.18, kPublished},
    {"on the straight segment", 0.02, 0.0015480, kSegment},
    {"negative: the line goes on", -0.05, -0.0038700, kSegment},
};

class SrgbCurve : public ::testing::TestWithParam<CurveRow>
{
};

TEST_P(SrgbCurve, DecodesAndEncodesPublishedValues)
{
    const CurveRow row = GetParam();
    EXPECT_NEAR(ColourSpaces::SrgbToLinear(row.encoded), row.linear, row.tolerance);
    EXPECT_NEAR(ColourSpaces::LinearToSrgb(row.linear), row.encoded, row.tolerance);
}

INSTANTIATE_TEST_SUITE_P(Published, SrgbCurve, ::testing::ValuesIn(kCurve), [](const auto &info) {
    std::string name;
    for (const char *c = info.param.name; *c; ++c)
        name += std::isalnum(static_cast<unsigned char>(*c)) ? *c : '_';
    return name;
});

// Every 8-bit code decoded and encoded again comes back to itself, through
// the cached table and through the quantiser of the viewer's display.
TEST(SrgbCurve, EveryCodeRoundTrips)
{
    const std::array<float, 256> &table = ColourSpaces::Srgb8ToLinear();
    for (int code = 0; code < 256; ++code) {
        EXPECT_NEAR(ColourSpaces::LinearToSrgb(table[std::size_t(code)]) * 255.0, code, 1e-3) << code;
        EXPECT_EQ(FloatImage::LinearToSrgb8(table[std::size_t(code)]), code);
        EXPECT_NEAR(table[std::size_t(code)], ColourSpaces::SrgbToLinear(code / 255.0), 1e-7) << code;
    }
}

// Whole images: colour channels go through the curve, alpha stays, and
// every layout gives what one value at a time gives.
TEST(SrgbCurve, BuffersLeaveAlphaAndMatchSingleValues)
{
    for (int channels = 1; channels <= 4; ++channels)
        for (bool alpha : {false, true}) {
            if (alpha && channels == 1)
                continue;
            std::vector<float> pixels;
            for (int i = 0; i < 5000 * channels; ++i)
                pixels.push_back(float(i % 257) / 256.0f);
            std::vector<float> decoded = pixels;
            ColourSpaces::SrgbToLinear(decoded.data(), 5000, channels, alpha);
            for (std::size_t i = 0; i < pixels.size(); ++i) {
                const bool isAlpha = alpha && int(i % std::size_t(channels)) == channels - 1;
                const double want = isAlpha ? pixels[i] : ColourSpaces::SrgbToLinear(pixels[i]);
                ASSERT_NEAR(decoded[i], want, 1e-7) << channels << " channels, value " << i;
            }
            ColourSpaces::LinearToSrgb(decoded.data(), 5000, channels, alpha);
            for (std::size_t i = 0; i < pixels.size(); ++i)
                ASSERT_NEAR(decoded[i], pixels[i], 2e-6) << channels << " channels, value " << i;
        }
}

struct XyzRow
{
    const char *name;
    double x, y, luminance; // chromaticity and Y
    double r, g, b;
};

// XYZ of the Rec. 709 primaries and white (ITU-R BT.709-6: chromaticities,
// and luma weights as each primary's share of white's luminance) are pure
// Rec. 709 colours. The weights carry four digits.
const XyzRow kXyz[] = {
    {"D65 white", 0.3127, 0.3290, 1.0, 1.0, 1.0, 1.0},
    {"red primary", 0.64, 0.33, 0.2126, 1.0, 0.0, 0.0},
    {"green primary", 0.30, 0.60, 0.7152, 0.0, 1.0, 0.0},
    {"blue primary", 0.15, 0.06, 0.0722, 0.0, 0.0, 1.0},
};

class XyzToRec709 : public ::testing::TestWithParam<XyzRow>
{
};

TEST_P(XyzToRec709, PublishedPrimariesAreUnitColours)
{
    const XyzRow row = GetParam();
    float xyz[3] = {float(row.x / row.y * row.luminance), float(row.luminance),
                    float((1.0 - row.x - row.y) / row.y * row.luminance)};
    ColourSpaces::XyzToRec709(xyz, 1);
    EXPECT_NEAR(xyz[0], row.r, 5e-4);
    EXPECT_NEAR(xyz[1], row.g, 5e-4);
    EXPECT_NEAR(xyz[2], row.b, 5e-4);
}

INSTANTIATE_TEST_SUITE_P(Published, XyzToRec709, ::testing::ValuesIn(kXyz));

} // namespace
