#include "orbane/ColourSpaces.h"

#include <OpenColorIO/OpenColorIO.h>

#include <QtGlobal>

#include <algorithm>
#include <vector>

namespace OCIO = OCIO_NAMESPACE;

namespace Orbane {
namespace ColourSpaces {

namespace {

// The colour spaces of the host's config. Its reference is linear Rec. 709
// (scene linear): the values the Inputs hold and the viewer keeps.
constexpr const char *kLinear = "Linear Rec.709";
constexpr const char *kSrgb = "sRGB";
constexpr const char *kXyz = "CIE-XYZ-D65";

// IEC 61966-2-1: ((v + 0.055) / 1.055) ^ 2.4 above the break, a straight
// line below it. OpenColorIO's form of it puts the break where line and
// power meet with the same slope, so decoding and encoding are exact
// inverses (the standard's own break, 0.04045, leaves a step of 1e-7 there).
OCIO::TransformRcPtr SrgbCurve()
{
    auto curve = OCIO::ExponentWithLinearTransform::Create();
    const double gamma[4] = {2.4, 2.4, 2.4, 2.4};
    const double offset[4] = {0.055, 0.055, 0.055, 0.055};
    curve->setGamma(gamma);
    curve->setOffset(offset);
    return curve;
}

// XYZ (D65) to linear Rec. 709, from OpenColorIO's built-in matrices, which
// it derives from the published primaries: XYZ to ACES AP1 and AP1 to
// Rec. 709, each with the same Bradford adaptation between the D60 and D65
// whites, so the adaptations cancel and no matrix is typed in here.
OCIO::TransformRcPtr XyzToLinear()
{
    auto fromXyz = OCIO::BuiltinTransform::Create();
    fromXyz->setStyle("UTILITY - ACES-AP1_to_CIE-XYZ-D65_BFD");
    fromXyz->setDirection(OCIO::TRANSFORM_DIR_INVERSE);
    auto toRec709 = OCIO::BuiltinTransform::Create();
    toRec709->setStyle("UTILITY - ACES-AP1_to_LINEAR-REC709_BFD");
    auto group = OCIO::GroupTransform::Create();
    group->appendTransform(fromXyz);
    group->appendTransform(toRec709);
    return group;
}

OCIO::ColorSpaceRcPtr Space(const char *name, const OCIO::TransformRcPtr &toReference)
{
    auto space = OCIO::ColorSpace::Create();
    space->setName(name);
    if (toReference)
        space->setTransform(toReference, OCIO::COLORSPACE_DIR_TO_REFERENCE);
    return space;
}

OCIO::ConstConfigRcPtr BuildConfig()
{
    OCIO::ConfigRcPtr config = OCIO::Config::CreateRaw()->createEditableCopy();
    config->addColorSpace(Space(kLinear, nullptr));
    config->addColorSpace(Space(kSrgb, SrgbCurve()));
    config->addColorSpace(Space(kXyz, XyzToLinear()));
    config->setRole(OCIO::ROLE_SCENE_LINEAR, kLinear);
    config->validate();
    return config;
}

// The processors, built once. Lossless: no fast approximations of pow, so
// a code decoded and encoded again comes back to itself.
struct Processors
{
    OCIO::ConstCPUProcessorRcPtr decode, encode, xyz;

    Processors()
    {
        try {
            const OCIO::ConstConfigRcPtr config = BuildConfig();
            decode = Cpu(*config, kSrgb, kLinear);
            encode = Cpu(*config, kLinear, kSrgb);
            xyz = Cpu(*config, kXyz, kLinear);
        } catch (const OCIO::Exception &e) {
            // The transforms are fixed: failing here is a broken install.
            qFatal("OpenColorIO cannot build the host's colour conversions: %s", e.what());
        }
    }

    static OCIO::ConstCPUProcessorRcPtr Cpu(const OCIO::Config &config, const char *from, const char *to)
    {
        return config.getProcessor(from, to)->getOptimizedCPUProcessor(OCIO::OPTIMIZATION_LOSSLESS);
    }
};

const Processors &Get()
{
    static const Processors processors;
    return processors;
}

float64 ApplyOne(const OCIO::CPUProcessor &cpu, float64 v)
{
    float rgb[3] = {float(v), float(v), float(v)};
    cpu.applyRGB(rgb);
    return rgb[0];
}

void ApplyTriples(const OCIO::CPUProcessor &cpu, float *rgb, std::size_t triples)
{
    if (triples == 0)
        return;
    OCIO::PackedImageDesc desc(rgb, long(triples), 1, 3);
    cpu.apply(desc);
}

// The colour channels of any layout, gathered a band at a time into RGB
// triples for the processor and put back: one path for grey, grey and
// alpha, RGB and RGBA, alpha never touched.
void ApplyInterleaved(const OCIO::CPUProcessor &cpu, float *values, std::size_t pixels, int32 channels, bool hasAlpha)
{
    const std::size_t stride = std::size_t(std::clamp(channels, 1, 4));
    const std::size_t colours = hasAlpha && stride > 1 ? stride - 1 : stride;
    constexpr std::size_t kBand = 3 * 4096;
    std::vector<float> band;
    band.reserve(kBand);
    const std::size_t bandPixels = kBand / colours;
    for (std::size_t start = 0; start < pixels; start += bandPixels) {
        const std::size_t count = std::min(bandPixels, pixels - start);
        float *first = values + start * stride;
        band.clear();
        for (std::size_t i = 0; i < count; ++i)
            band.insert(band.end(), first + i * stride, first + i * stride + colours);
        band.resize((band.size() + 2) / 3 * 3, 0.0f);
        ApplyTriples(cpu, band.data(), band.size() / 3);
        for (std::size_t i = 0; i < count; ++i)
            std::copy_n(band.data() + i * colours, colours, first + i * stride);
    }
}

} // namespace

float64 SrgbToLinear(float64 encoded)
{
    return ApplyOne(*Get().decode, encoded);
}

float64 LinearToSrgb(float64 linear)
{
    return ApplyOne(*Get().encode, linear);
}

void SrgbToLinear(float *values, std::size_t pixels, int32 channels, bool hasAlpha)
{
    ApplyInterleaved(*Get().decode, values, pixels, channels, hasAlpha);
}

void LinearToSrgb(float *values, std::size_t pixels, int32 channels, bool hasAlpha)
{
    ApplyInterleaved(*Get().encode, values, pixels, channels, hasAlpha);
}

const std::array<float, 256> &Srgb8ToLinear()
{
    static const std::array<float, 256> table = [] {
        std::array<float, 256> t{};
        for (int i = 0; i < 256; ++i)
            t[std::size_t(i)] = float(i) / 255.0f;
        SrgbToLinear(t.data(), t.size(), 1, false);
        return t;
    }();
    return table;
}

void XyzToRec709(float *xyz, std::size_t count)
{
    ApplyTriples(*Get().xyz, xyz, count);
}

} // namespace ColourSpaces
} // namespace Orbane
