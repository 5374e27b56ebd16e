#include "orbane/PreviewInfo.h"

#include <gtest/gtest.h>

#include <cmath>
#include <utility>

namespace Orbane {
namespace {

// What an overlay does in a drag: a grab offset in viewer units divided by
// ViewWidth/ViewHeight and added to the mouse must give the handle back.
// This only holds if the spans have the sign and size of TransformOut's.
TEST(PreviewInfo, GrabOffsetOverViewSizeLeadsBackToTheHandle)
{
    const ViewMapping views[] = {
        ViewMapping::Centered(256, 256, 1.0, 2.0, 1024, 768),
        ViewMapping::Centered(1920, 1080, 1.0, 0.3712, 1024, 768, {33, -12}),
        ViewMapping::Centered(600, 1600, 1.0, 0.4, 1024, 768, {-100, 50}),
        ViewMapping::Centered(2048, 858, 2.0, 0.2, 1024, 768), // anamorphic
    };
    const std::pair<OrbPoint, OrbPoint> handleAndMouse[] = {{{0.5, 0.5}, {0.503, 0.497}}, {{0.2, 0.9}, {0.19, 0.91}}};
    PreviewInfo info;
    for (const ViewMapping &view : views) {
        info.SetMapping(view);
        SCOPED_TRACE(view.ImageWidth());
        for (const auto &[handle, mouse] : handleAndMouse) {
            info.SetMouseFromViewer(info.TransformOut(mouse));
            OrbPoint grab = info.TransformOut(handle) - info.MouseInViewer();
            OrbPoint back(grab.x / info.ViewWidth + info.MouseX, grab.y / info.ViewHeight + info.MouseY);
            // ViewWidth is rounded to whole units: off by at most half a unit in the span.
            EXPECT_NEAR(back.x, handle.x, 0.5 * std::abs(grab.x) / info.ViewWidth / info.ViewWidth + 1e-9);
            EXPECT_NEAR(back.y, handle.y, 0.5 * std::abs(grab.y) / info.ViewHeight / info.ViewHeight + 1e-9);
            EXPECT_GE((back - mouse).Dot(handle - mouse), 0.0) << "the handle is on the same side of the mouse";
        }
    }
}

TEST(PreviewInfo, ZoomedToNothingStillHasNonZeroDivisors)
{
    PreviewInfo info;
    info.SetMapping(ViewMapping(4, 4, 1.0, 0.01, {}, 100));
    EXPECT_GE(info.ViewWidth, 1);
    EXPECT_GE(info.ViewHeight, 1);
}

// The colour asked for, or the overlay colour for none, and the shadow
// colour faded with it.
TEST(PreviewInfo, ColourAndMatchingShadow)
{
    PreviewInfo info;
    info.OverlayColor = OrbColor(255, 255, 0, 255);
    info.ShadowColor = OrbColor(0, 0, 0, 204);
    const struct
    {
        const char *name;
        OrbColor asked;
        Graphics::GColor color;
        float32 shadowAlpha;
    } cases[] = {
        {"none: the overlay colour", OrbColor(), {1, 1, 0, 1}, 0.8f},
        {"own colour", OrbColor(255, 0, 255, 255), {1, 0, 1, 1}, 0.8f},
        {"faded colour, faded shadow", OrbColor(0, 255, 255, 51), {0, 1, 1, 0.2f}, 0.16f},
        {"invisible: no shadow", OrbColor(0, 255, 0, 0), {0, 1, 0, 0}, 0.0f},
    };
    for (const auto &c : cases) {
        SCOPED_TRACE(c.name);
        const Graphics::GColor color = info.GetColor(c.asked), shadow = info.GetShadow(c.asked);
        EXPECT_FLOAT_EQ(color.r, c.color.r);
        EXPECT_FLOAT_EQ(color.g, c.color.g);
        EXPECT_FLOAT_EQ(color.b, c.color.b);
        EXPECT_FLOAT_EQ(color.a, c.color.a);
        EXPECT_FLOAT_EQ(shadow.r, 0.0f);
        EXPECT_FLOAT_EQ(shadow.a, c.shadowAlpha);
    }
}

} // namespace
} // namespace Orbane
