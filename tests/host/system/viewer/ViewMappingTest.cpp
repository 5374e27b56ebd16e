#include "orbane/ViewMapping.h"

#include <gtest/gtest.h>

#include <ostream>
#include <string>

namespace Orbane {
namespace {

// Parameter rows print as their names in test output.
template <typename Row> auto operator<<(std::ostream &os, const Row &row) -> decltype(row.name, os)
{
    return os << row.name;
}

// Round trips go through a multiply and a divide: a few ulps of 1.
constexpr float64 RoundTripTolerance = 1e-9;

struct ViewCase
{
    const char *name;
    int32 imageWidth;
    int32 imageHeight;
    float64 pixelAspect;
    float64 zoom;
    float64 viewportWidth;
    float64 viewportHeight;
    OrbPoint pan;
};

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
    {"SquareAtOne", 512, 512, 1.0, 1.0, 800, 600, {0, 0}},
    {"HdZoomedOut", 1920, 1080, 1.0, 0.37, 1000, 700, {0, 0}},
    {"HdZoomedInAndPanned", 1920, 1080, 1.0, 4.0, 1000, 700, {-350.25, 120.5}},
    {"PortraitImage", 1080, 1920, 1.0, 0.5, 900, 1200, {40, -60}},
    {"AnamorphicSqueeze", 1828, 1556, 2.0, 0.25, 1200, 800, {0, 0}},
    {"NarrowPixels", 720, 576, 0.9375, 1.5, 1400, 1000, {10.5, 3.25}},
    {"TinyZoom", 4096, 2160, 1.0, 0.01, 300, 200, {0, 0}},
};

INSTANTIATE_TEST_SUITE_P(Views, ViewMappingCases, testing::ValuesIn(ViewCases),
                         [](const testing::TestParamInfo<ViewCase> &info) { return std::string(info.param.name); });

TEST_P(ViewMappingCases, ImageToViewerAndBackIsTheIdentity)
{
    ViewMapping m = Mapping();
    for (OrbPoint p : {OrbPoint(0, 0), OrbPoint(1, 1), OrbPoint(0.5, 0.5), OrbPoint(0.123, 0.987), OrbPoint(-0.4, 1.7),
                       OrbPoint(3.0, -2.0)}) {
        OrbPoint back = m.ToImage(m.ToViewer(p));
        EXPECT_NEAR(back.x, p.x, RoundTripTolerance);
        EXPECT_NEAR(back.y, p.y, RoundTripTolerance);
    }
}

TEST_P(ViewMappingCases, ViewerToImageAndBackIsTheIdentity)
{
    ViewMapping m = Mapping();
    for (OrbPoint v : {OrbPoint(0, 0), OrbPoint(17.5, 433.25), OrbPoint(-50, 2000)}) {
        OrbPoint back = m.ToViewer(m.ToImage(v));
        EXPECT_NEAR(back.x, v.x, 1e-6);
        EXPECT_NEAR(back.y, v.y, 1e-6);
    }
}

TEST_P(ViewMappingCases, ImageCentreSitsAtTheViewportCentrePlusPan)
{
    const ViewCase &c = GetParam();
    OrbPoint centre = Mapping().ToViewer({0.5, 0.5});
    EXPECT_NEAR(centre.x, c.viewportWidth / 2 + c.pan.x, 1e-9);
    EXPECT_NEAR(centre.y, c.viewportHeight / 2 + c.pan.y, 1e-9);
}

TEST_P(ViewMappingCases, UnitSquareCoversTheDisplayedImage)
{
    const ViewCase &c = GetParam();
    ViewMapping m = Mapping();
    OrbPoint span = m.ToViewer({1, 1}) - m.ToViewer({0, 0});
    // Each image pixel is zoom high and zoom times its aspect wide.
    EXPECT_NEAR(span.x, c.imageWidth * c.pixelAspect * c.zoom, 1e-9);
    EXPECT_NEAR(span.y, c.imageHeight * c.zoom, 1e-9);
    EXPECT_DOUBLE_EQ(m.SpanX(), span.x);
    EXPECT_DOUBLE_EQ(m.SpanY(), span.y);
}

TEST_P(ViewMappingCases, ImageYUpIsViewerYUpAndWidgetYDown)
{
    ViewMapping m = Mapping();
    OrbPoint low = m.ToViewer({0.5, 0.2});
    OrbPoint high = m.ToViewer({0.5, 0.8});
    EXPECT_GT(high.y, low.y);
    EXPECT_LT(m.ViewerToWidget(high).y, m.ViewerToWidget(low).y) << "higher in the image is nearer the widget top";
}

TEST_P(ViewMappingCases, AspectLengthsAreTheSameOnScreenAlongBothAxes)
{
    ViewMapping m = Mapping();
    const OrbPoint centre(0.4, 0.6);
    for (float64 r : {0.01, 0.1, 0.35}) {
        float64 alongX = (m.ToViewer(centre + OrbPoint(m.AspectXOut(r), 0)) - m.ToViewer(centre)).Length();
        float64 alongY = (m.ToViewer(centre + OrbPoint(0, m.AspectYOut(r))) - m.ToViewer(centre)).Length();
        EXPECT_NEAR(alongX, alongY, 1e-9);
        EXPECT_NEAR(alongX, r * m.SpanX(), 1e-9) << "the unit is one displayed image width";
        EXPECT_NEAR(m.AspectXIn(m.AspectXOut(r)), r, RoundTripTolerance);
        EXPECT_NEAR(m.AspectYIn(m.AspectYOut(r)), r, RoundTripTolerance);
    }
}

TEST_P(ViewMappingCases, ZoomAboutAPointKeepsItsImagePointStill)
{
    ViewMapping m = Mapping();
    const OrbPoint anchor(123.5, 321.25);
    OrbPoint before = m.ToImage(anchor);
    ViewMapping zoomed = m.ZoomedAbout(m.Zoom() * 3.0, anchor);
    OrbPoint after = zoomed.ToImage(anchor);
    EXPECT_NEAR(after.x, before.x, RoundTripTolerance);
    EXPECT_NEAR(after.y, before.y, RoundTripTolerance);
    EXPECT_NEAR(zoomed.SpanX(), m.SpanX() * 3.0, 1e-9);
}

TEST_P(ViewMappingCases, FittedImageFillsOneSideAndFitsTheOther)
{
    const ViewCase &c = GetParam();
    ViewMapping m = ViewMapping::Fitted(c.imageWidth, c.imageHeight, c.pixelAspect, c.viewportWidth, c.viewportHeight);
    EXPECT_LE(m.SpanX(), c.viewportWidth + 1e-9);
    EXPECT_LE(m.SpanY(), c.viewportHeight + 1e-9);
    EXPECT_TRUE(std::abs(m.SpanX() - c.viewportWidth) < 1e-9 || std::abs(m.SpanY() - c.viewportHeight) < 1e-9);
    OrbPoint centre = m.ToViewer({0.5, 0.5});
    EXPECT_NEAR(centre.x, c.viewportWidth / 2, 1e-9);
    EXPECT_NEAR(centre.y, c.viewportHeight / 2, 1e-9);
}

struct FlipCase
{
    const char *name;
    float64 viewportHeight;
    OrbPoint widget;
    OrbPoint viewer;
};

class ViewMappingFlip : public testing::TestWithParam<FlipCase>
{
};

TEST_P(ViewMappingFlip, WidgetAndViewerDifferByTheFlip)
{
    const FlipCase &c = GetParam();
    ViewMapping m(100, 100, 1.0, 1.0, {}, c.viewportHeight);
    EXPECT_EQ(m.WidgetToViewer(c.widget), c.viewer);
    EXPECT_EQ(m.ViewerToWidget(c.viewer), c.widget);
}

const FlipCase FlipCases[] = {
    {"TopLeftCorner", 600, {0, 0}, {0, 600}},
    {"BottomLeftCorner", 600, {0, 600}, {0, 0}},
    {"Middle", 480, {320.5, 240}, {320.5, 240}},
    {"NearTop", 480, {10, 3.25}, {10, 476.75}},
};

INSTANTIATE_TEST_SUITE_P(Flips, ViewMappingFlip, testing::ValuesIn(FlipCases),
                         [](const testing::TestParamInfo<FlipCase> &info) { return std::string(info.param.name); });

struct TidyCase
{
    const char *name;
    int32 width;
    int32 height;
    float64 aspect;
    float64 zoom;
    int32 expectWidth;
    int32 expectHeight;
    float64 expectAspect;
    float64 expectZoom;
};

class ViewMappingTidy : public testing::TestWithParam<TidyCase>
{
};

TEST_P(ViewMappingTidy, BadInputBecomesUsable)
{
    const TidyCase &c = GetParam();
    ViewMapping m(c.width, c.height, c.aspect, c.zoom, {5, 5}, 100);
    EXPECT_EQ(m.ImageWidth(), c.expectWidth);
    EXPECT_EQ(m.ImageHeight(), c.expectHeight);
    EXPECT_EQ(m.PixelAspect(), c.expectAspect);
    EXPECT_EQ(m.Zoom(), c.expectZoom);
    OrbPoint back = m.ToImage(m.ToViewer({0.25, 0.75}));
    EXPECT_NEAR(back.x, 0.25, RoundTripTolerance);
    EXPECT_NEAR(back.y, 0.75, RoundTripTolerance);
}

const TidyCase TidyCases[] = {
    {"ZeroSizedImage", 0, 0, 1.0, 1.0, 1, 1, 1.0, 1.0},  {"NegativeSize", -20, 30, 1.0, 2.0, 1, 30, 1.0, 2.0},
    {"ZeroZoom", 100, 50, 1.0, 0.0, 100, 50, 1.0, 1.0},  {"NegativeAspect", 100, 50, -2.0, 0.5, 100, 50, 1.0, 0.5},
    {"Valid", 640, 480, 1.5, 0.75, 640, 480, 1.5, 0.75},
};

INSTANTIATE_TEST_SUITE_P(Inputs, ViewMappingTidy, testing::ValuesIn(TidyCases),
                         [](const testing::TestParamInfo<TidyCase> &info) { return std::string(info.param.name); });

} // namespace
} // namespace Orbane
