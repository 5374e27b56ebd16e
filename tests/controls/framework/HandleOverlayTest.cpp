#include "framework/HandleOverlay.h"

#include "orbane/ControlCommands.h"
#include "orbane/PreviewInfo.h"
#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

#include <gtest/gtest.h>

#include <vector>

using namespace Orbane;

namespace {

// One point handle in the middle of the image; it may fade.
class Probe : public HandleOverlay
{
public:
    explicit Probe(bool fades) : HandleOverlay(nullptr, ScriptVal(), TagList())
    {
        if (fades)
            EnableFade();
    }
    std::size_t SizeOf() const override { return sizeof(Probe); }

protected:
    void BuildHandles(const PreviewInfo &info, HandleSet &handles) const override
    {
        handles.Clear();
        handles.AddPixelSquare(info.TransformOut(kAt), 1);
    }
    float64 FadeDistance(const PreviewInfo &info) const override
    {
        return (info.TransformOut(kAt) - info.MouseInViewer()).Length();
    }

private:
    static constexpr OrbPoint kAt{0.5, 0.5};
};

struct Step
{
    float64 dx;    // mouse, viewer units right of the handle
    uint64 data;   // the flag word the viewer passes in (bit 0: claimed above)
    uint64 answer; // bit 0: claimed, bit 1: redraw
};

struct Row
{
    const char *name;
    bool fades;
    std::vector<Step> steps;
};

const Row kRows[] = {
    {"enter, stay, leave, stay away", false, {{3, 0, 3}, {4, 0, 1}, {20, 0, 2}, {30, 0, 0}}},
    {"claimed above: lets go once", false, {{3, 0, 3}, {3, 1, 3}, {3, 1, 1}, {3, 0, 3}}},
    {"6 units away is out, also for hover", false, {{6, 0, 0}, {5, 0, 3}}},
    {"fade: half from 60 on, repaints past 0.05", true, {{100, 0, 0}, {40, 0, 2}, {38, 0, 0}, {30, 0, 2}, {0, 0, 3}}},
};

PreviewInfo View()
{
    PreviewInfo info;
    info.SetMapping(ViewMapping::Centered(400, 200, 1.0, 1.0, 500, 300));
    return info;
}

TEST(HandleOverlayTest, HoverAnswersAndRepaintsOnlyOnChange)
{
    for (const Row &row : kRows) {
        SCOPED_TRACE(row.name);
        Probe *probe = new Probe(row.fades);
        PreviewInfo info = View();
        const OrbPoint handle = info.TransformOut(0.5, 0.5);
        for (const Step &step : row.steps) {
            info.SetMouseFromViewer(handle + OrbPoint(step.dx, 0));
            EXPECT_EQ(probe->ControlCommand(&info, CCMD_HitTest, step.data, nullptr), step.answer) << step.dx;
        }
        probe->DecRef();
    }
}

TEST(HandleOverlayTest, BoundsHoldTheHandleUnlessItFades)
{
    PreviewInfo info = View();
    OrbRect bounds;
    Probe *still = new Probe(false), *fading = new Probe(true);
    ASSERT_TRUE(still->HoverBounds(info, bounds));
    const OrbPoint at = info.TransformOut(0.5, 0.5);
    EXPECT_TRUE(bounds.Contains(at + OrbPoint(5.9, -5.9)));
    EXPECT_FALSE(bounds.Contains(at + OrbPoint(20, 0)));
    EXPECT_FALSE(fading->HoverBounds(info, bounds));
    still->DecRef();
    fading->DecRef();
}

TEST(HandleOverlayTest, FadeAt)
{
    EXPECT_EQ(HandleOverlay::FadeAt(10), 1.0f);
    EXPECT_FLOAT_EQ(HandleOverlay::FadeAt(35), 0.75f);
    EXPECT_EQ(HandleOverlay::FadeAt(60), 0.5f);
    EXPECT_EQ(HandleOverlay::FadeAt(500), 0.5f);
}

} // namespace
