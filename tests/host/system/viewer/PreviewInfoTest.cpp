#include "orbane/PreviewInfo.h"

#include <QCursor>

#include <gtest/gtest.h>

#include <cmath>
#include <ostream>
#include <string>
#include <vector>

namespace Orbane {
namespace {

// Parameter rows print as their names in test output.
template <typename Row> auto operator<<(std::ostream &os, const Row &row) -> decltype(row.name, os)
{
    return os << row.name;
}

struct InfoCase
{
    const char *name;
    int32 imageWidth;
    int32 imageHeight;
    float64 pixelAspect;
    float64 zoom;
    OrbPoint pan;
};

class PreviewInfoCases : public testing::TestWithParam<InfoCase>
{
protected:
    void SetUp() override
    {
        const InfoCase &c = GetParam();
        info.SetMapping(ViewMapping::Centered(c.imageWidth, c.imageHeight, c.pixelAspect, c.zoom, 1024, 768, c.pan));
    }
    PreviewInfo info;
};

const InfoCase InfoCases[] = {
    {"Square", 256, 256, 1.0, 2.0, {0, 0}},
    {"WideHd", 1920, 1080, 1.0, 0.5, {33, -12}},
    {"WideHdOddZoom", 1920, 1080, 1.0, 0.3712, {0, 0}},
    {"Tall", 600, 1600, 1.0, 0.4, {-100, 50}},
    {"Anamorphic", 2048, 858, 2.0, 0.2, {0, 0}},
};

INSTANTIATE_TEST_SUITE_P(Views, PreviewInfoCases, testing::ValuesIn(InfoCases),
                         [](const testing::TestParamInfo<InfoCase> &info) { return std::string(info.param.name); });

TEST_P(PreviewInfoCases, MappingFillsTheSizeFields)
{
    const InfoCase &c = GetParam();
    EXPECT_EQ(info.ImageWidth, c.imageWidth);
    EXPECT_EQ(info.ImageHeight, c.imageHeight);
    EXPECT_NEAR(info.ViewWidth, c.imageWidth * c.pixelAspect * c.zoom, 0.5);
    EXPECT_NEAR(info.ViewHeight, c.imageHeight * c.zoom, 0.5);
}

// What an overlay does in a drag: a grab offset in viewer units divided by
// ViewWidth/ViewHeight and added to the mouse must give the handle back.
// This only holds if the spans have the sign and size of TransformOut's.
TEST_P(PreviewInfoCases, GrabOffsetOverViewSizeLeadsBackToTheHandle)
{
    const std::vector<std::pair<OrbPoint, OrbPoint>> handleAndMouse = {
        {{0.5, 0.5}, {0.503, 0.497}}, {{0.2, 0.9}, {0.19, 0.91}}, {{0.7, 0.1}, {0.7, 0.1}}};
    for (const auto &[handle, mouse] : handleAndMouse) {
        info.SetMouseFromViewer(info.TransformOut(mouse));
        OrbPoint grab = info.TransformOut(handle) - info.TransformOut(info.MouseX, info.MouseY);
        OrbPoint back(grab.x / info.ViewWidth + info.MouseX, grab.y / info.ViewHeight + info.MouseY);
        // ViewWidth is rounded to whole units: off by at most half a unit in the span.
        EXPECT_NEAR(back.x, handle.x, 0.5 * std::abs(grab.x) / info.ViewWidth / info.ViewWidth + 1e-9);
        EXPECT_NEAR(back.y, handle.y, 0.5 * std::abs(grab.y) / info.ViewHeight / info.ViewHeight + 1e-9);
        EXPECT_GE((back - mouse).Dot(handle - mouse), 0.0) << "the handle is on the same side of the mouse";
    }
}

TEST_P(PreviewInfoCases, PointRectAndThreeValueFormsAgree)
{
    const OrbPoint p(0.31, 0.77);
    OrbPoint out = info.TransformOut(p);
    EXPECT_EQ(out, info.TransformOut(p.x, p.y));
    EXPECT_DOUBLE_EQ(out.x, info.TransformXOut(p.x));
    EXPECT_DOUBLE_EQ(out.y, info.TransformYOut(p.y));
    EXPECT_DOUBLE_EQ(info.TransformXIn(out.x), info.TransformIn(out).x);
    EXPECT_DOUBLE_EQ(info.TransformYIn(out.y), info.TransformIn(out).y);

    float64 x = p.x, y = p.y, z = 0.25;
    info.TransformOut(x, y, z);
    EXPECT_EQ(OrbPoint(x, y), out);
    EXPECT_NEAR(z, 0.25 * (info.TransformXOut(1.0) - info.TransformXOut(0.0)), 1e-9) << "depth scales like X";
    info.TransformIn(x, y, z);
    EXPECT_NEAR(x, p.x, 1e-12);
    EXPECT_NEAR(y, p.y, 1e-12);
    EXPECT_NEAR(z, 0.25, 1e-12);

    OrbRect r(0.1, 0.2, 0.6, 0.9);
    OrbRect rOut = info.TransformOut(r);
    EXPECT_EQ(rOut.Corner1(), info.TransformOut(r.Corner1()));
    EXPECT_EQ(rOut.Corner2(), info.TransformOut(r.Corner2()));
    OrbRect rBack = info.TransformIn(rOut);
    EXPECT_NEAR(rBack.x1, r.x1, 1e-12);
    EXPECT_NEAR(rBack.y2, r.y2, 1e-12);
}

TEST_P(PreviewInfoCases, AspectScaledCircleIsRoundInViewerUnits)
{
    const OrbPoint centre(0.5, 0.5);
    const float64 radius = 0.1;
    OrbPoint c = info.TransformOut(centre);
    for (int step = 0; step < 12; ++step) {
        float64 a = step * 3.14159265358979 / 6;
        OrbPoint onCircle(centre.x + info.AspectScaleXOut(std::cos(a) * radius),
                          centre.y + info.AspectScaleYOut(std::sin(a) * radius));
        EXPECT_NEAR((info.TransformOut(onCircle) - c).Length(),
                    radius * (info.TransformXOut(1) - info.TransformXOut(0)), 1e-9);
        // And back: the image offset through the In functions gives the direction.
        OrbPoint d(info.AspectScaleXIn(onCircle.x - centre.x), info.AspectScaleYIn(onCircle.y - centre.y));
        EXPECT_NEAR(d.x / d.Length(), std::cos(a), 1e-9);
        EXPECT_NEAR(d.y / d.Length(), std::sin(a), 1e-9);
    }
}

TEST_P(PreviewInfoCases, MouseFromViewerRoundTrips)
{
    const OrbPoint viewer(411.5, 290.25);
    info.SetMouseFromViewer(viewer);
    EXPECT_NEAR(info.MouseInViewer().x, viewer.x, 1e-9);
    EXPECT_NEAR(info.MouseInViewer().y, viewer.y, 1e-9);
    EXPECT_EQ(OrbPoint(info.MouseX, info.MouseY), info.TransformIn(viewer));
}

TEST(PreviewInfo, ZoomedToNothingStillHasNonZeroDivisors)
{
    PreviewInfo info;
    info.SetMapping(ViewMapping(4, 4, 1.0, 0.01, {}, 100));
    EXPECT_GE(info.ViewWidth, 1);
    EXPECT_GE(info.ViewHeight, 1);
}

TEST(PreviewInfo, ViewerPixelsAreYUp)
{
    PreviewInfo info;
    info.SetMapping(ViewMapping::Centered(100, 100, 1.0, 1.0, 200, 200));
    EXPECT_EQ(info.TransformOut(0, 0), OrbPoint(50, 50));
    EXPECT_EQ(info.TransformOut(1, 1), OrbPoint(150, 150));
    EXPECT_EQ(info.TransformIn(100, 175), OrbPoint(0.5, 1.25));
}

struct ColorCase
{
    const char *name;
    OrbColor asked;
    Graphics::GColor color;
    Graphics::GColor shadow;
};

class PreviewInfoColors : public testing::TestWithParam<ColorCase>
{
};

TEST_P(PreviewInfoColors, ColourAndMatchingShadow)
{
    const ColorCase &c = GetParam();
    PreviewInfo info;
    info.OverlayColor = OrbColor(255, 255, 0, 255);
    info.ShadowColor = OrbColor(0, 0, 0, 204);
    Graphics::GColor color = info.GetColor(c.asked);
    Graphics::GColor shadow = info.GetShadow(c.asked);
    EXPECT_FLOAT_EQ(color.r, c.color.r);
    EXPECT_FLOAT_EQ(color.g, c.color.g);
    EXPECT_FLOAT_EQ(color.b, c.color.b);
    EXPECT_FLOAT_EQ(color.a, c.color.a);
    EXPECT_FLOAT_EQ(shadow.r, c.shadow.r);
    EXPECT_FLOAT_EQ(shadow.a, c.shadow.a);
}

const ColorCase ColorCases[] = {
    {"NoneMeansTheOverlayColour", OrbColor(), {1, 1, 0, 1}, {0, 0, 0, 0.8f}},
    {"OwnColour", OrbColor(255, 0, 255, 255), {1, 0, 1, 1}, {0, 0, 0, 0.8f}},
    {"HalfFadedColourFadesItsShadow", OrbColor(0, 255, 255, 51), {0, 1, 1, 0.2f}, {0, 0, 0, 0.16f}},
    {"InvisibleColourHasNoShadow", OrbColor(0, 255, 0, 0), {0, 1, 0, 0}, {0, 0, 0, 0}},
};

INSTANTIATE_TEST_SUITE_P(Colors, PreviewInfoColors, testing::ValuesIn(ColorCases),
                         [](const testing::TestParamInfo<ColorCase> &info) { return std::string(info.param.name); });

TEST(PreviewInfo, SetCursorGoesToTheViewersHandler)
{
    PreviewInfo info;
    QCursor cross(Qt::CrossCursor);
    info.SetCursor(&cross); // no handler yet: nothing happens

    std::vector<const QCursor *> seen;
    info.SetCursorHandler([&](const QCursor *c) { seen.push_back(c); });
    info.SetCursor(&cross);
    info.SetCursor(nullptr);
    ASSERT_EQ(seen.size(), 2u);
    EXPECT_EQ(seen[0], &cross);
    EXPECT_EQ(seen[1], nullptr);
}

} // namespace
} // namespace Orbane
