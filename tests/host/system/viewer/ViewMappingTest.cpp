#include "orbane/ViewMapping.h"
#include "orbane/PreviewInfo.h"

#include <gtest/gtest.h>

#include <ostream>
#include <string>

namespace Orbane {
namespace {

// Round trips go through a multiply and a divide: a few ulps of 1.
constexpr float64 RoundTripTolerance = 1e-9;

void ExpectNear(OrbPoint actual, OrbPoint expected, float64 tolerance)
{
    EXPECT_NEAR(actual.x, expected.x, tolerance);
    EXPECT_NEAR(actual.y, expected.y, tolerance);
}

struct ViewCase
{
    const char *name;
    int32 imageWidth, imageHeight;
    float64 pixelAspect, zoom;
    float64 viewportWidth, viewportHeight;
    OrbPoint pan;
};

std::ostream &operator<<(std::ostream &os, const ViewCase &c)
{
    return os << c.name;
}

class ViewMappingCases : public testing::TestWithParam<ViewCase>
{
protected:
    ViewMapping Mapping() const
    {
        const ViewCase &c = GetParam();
        return ViewMapping::Centered(c.imageWidth, c.imageHeight, c.pixelAspect, c.zoom, c.viewportWidth,
                                     c.viewportHeight, c.pan);
    }
};

const ViewCase ViewCases[] = {
    {"HdZoomedInAndPanned", 1920, 1080, 1.0, 4.0, 1000, 700, {-350.25, 120.5}},
    {"PortraitImage", 1080, 1920, 1.0, 0.5, 900, 1200, {40, -60}},
    {"AnamorphicSqueeze", 1828, 1556, 2.0, 0.25, 1200, 800, {0, 0}},
    {"TinyZoom", 4096, 2160, 1.0, 0.01, 300, 200, {0, 0}},
};

INSTANTIATE_TEST_SUITE_P(Views, ViewMappingCases, testing::ValuesIn(ViewCases), testing::PrintToStringParamName());

TEST_P(ViewMappingCases, RoundTripsAreTheIdentity)
{
    ViewMapping m = Mapping();
    for (OrbPoint p : {OrbPoint(0, 0), OrbPoint(1, 1), OrbPoint(0.123, 0.987), OrbPoint(-0.4, 1.7)})
        ExpectNear(m.ToImage(m.ToViewer(p)), p, RoundTripTolerance);
    for (OrbPoint v : {OrbPoint(0, 0), OrbPoint(17.5, 433.25), OrbPoint(-50, 2000)}) {
        ExpectNear(m.ToViewer(m.ToImage(v)), v, 1e-6);
        ExpectNear(m.ViewerToWidget(m.WidgetToViewer(v)), v, 0.0);
    }
}

TEST_P(ViewMappingCases, PlacesAndSizesTheImageYUpWithItsAspect)
{
    const ViewCase &c = GetParam();
    ViewMapping m = Mapping();
    ExpectNear(m.ToViewer({0.5, 0.5}), {c.viewportWidth / 2 + c.pan.x, c.viewportHeight / 2 + c.pan.y}, 1e-9);
    const OrbPoint span = m.ToViewer({1, 1}) - m.ToViewer({0, 0});
    EXPECT_NEAR(span.x, c.imageWidth * c.pixelAspect * c.zoom, 1e-9);
    EXPECT_NEAR(span.y, c.imageHeight * c.zoom, 1e-9);
    const OrbPoint top = m.ToViewer({0.5, 1.0});
    EXPECT_NEAR(m.ViewerToWidget(top).y, c.viewportHeight / 2 - c.pan.y - span.y / 2, 1e-9);

    // Aspect lengths are as long on screen along Y as along X.
    const OrbPoint centre(0.4, 0.6);
    const float64 r = 0.35;
    const float64 alongX = (m.ToViewer(centre + OrbPoint(m.AspectXOut(r), 0)) - m.ToViewer(centre)).Length();
    const float64 alongY = (m.ToViewer(centre + OrbPoint(0, m.AspectYOut(r))) - m.ToViewer(centre)).Length();
    EXPECT_NEAR(alongX, r * span.x, 1e-9) << "the unit is one displayed image width";
    EXPECT_NEAR(alongY, alongX, 1e-9);
    EXPECT_NEAR(m.AspectYIn(m.AspectYOut(r)), r, RoundTripTolerance);
}

// Overlays divide by the view size: a view zoomed to nothing must not give 0.
TEST(PreviewInfo, ZoomedToNothingStillHasNonZeroDivisors)
{
    PreviewInfo info;
    info.SetMapping(ViewMapping(4, 4, 1.0, 0.01, {}, 100));
    EXPECT_GE(info.ViewWidth, 1);
    EXPECT_GE(info.ViewHeight, 1);
}

} // namespace
} // namespace Orbane
