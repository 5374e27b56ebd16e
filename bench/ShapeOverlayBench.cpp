// Hovering over a viewer full of shape overlays: 100 turned rectangles and
// 100 angle dials on a grid. The viewer asks only the rectangles near the
// mouse (their hover bounds) and every dial (a dial fades with the mouse's
// distance, so it hears every move) for CCMD_HitTest, against a naive loop
// that tests the same rectangles' edges and the dials' rings with plain
// arithmetic. The goal: under 0.5 ms per mouse event.
#include "BenchModule.h"
#include "BenchViewer.h"
#include "ViewerHover.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ViewerPanel.h"

#include <benchmark/benchmark.h>

#include <QApplication>
#include <QMouseEvent>

#include <algorithm>
#include <cmath>
#include <string>
#include <vector>

namespace {

using namespace Orbane;

constexpr int Width = BenchViewer::Width, Height = BenchViewer::Height;
constexpr int ImageWidth = BenchViewer::ImageWidth, ImageHeight = BenchViewer::ImageHeight;
constexpr double Tolerance = 6;
constexpr Tag RCD_SetX = 0x20058000, RCD_SetY = 0x20058001, RCD_SetAngle = 0x20058002;
constexpr Tag ACID_Center = 0x80058000;
// The dial's ring, in viewer pixels at handle scale 1.
constexpr double RingRadius = 50;

struct Rect
{
    OrbPoint center;
    double angle, width, height;
};

// A 10 x 10 grid of small rectangles, each turned a little more.
std::vector<Rect> Rects(int count)
{
    std::vector<Rect> rects;
    for (int i = 0; i < count; ++i)
        rects.push_back({{0.05 + 0.09 * (i % 10), 0.05 + 0.09 * (i / 10 % 10)}, 7.0 * i, 0.04, 0.02});
    return rects;
}

// Dials on the same grid, between the rectangles.
std::vector<OrbPoint> Dials(int count)
{
    std::vector<OrbPoint> dials;
    for (int i = 0; i < count; ++i)
        dials.emplace_back(0.095 + 0.09 * (i % 10), 0.095 + 0.09 * (i / 10 % 10));
    return dials;
}

struct ShapeRig : BenchViewer
{
    ShapeRig(int rectangles, int dials) : BenchViewer("Shapes1", "Shapes")
    {
        int i = 0;
        for (const Rect &r : Rects(rectangles)) {
            const std::string w = "W" + std::to_string(i), h = "H" + std::to_string(i++);
            const TagList attrs{{INPA_PreviewControl, OrbID("RectangleControl")},
                                {INPA_OverlayInput, OrbID(h.c_str())},
                                {RCD_SetX, r.center.x},
                                {RCD_SetY, r.center.y},
                                {RCD_SetAngle, r.angle}};
            tool->AddInput(OrbID(w.c_str()), nullptr, CLSID_DataType_Number, attrs, AutoNumber(r.width));
            tool->AddInput(OrbID(h.c_str()), nullptr, CLSID_DataType_Number, TagList(), AutoNumber(r.height));
        }
        i = 0;
        for (const OrbPoint &c : Dials(dials)) {
            const std::string a = "A" + std::to_string(i), centre = "C" + std::to_string(i++);
            tool->AddInput(OrbID(centre.c_str()), nullptr, CLSID_DataType_Point, TagList(), AutoPoint(c.x, c.y, 0.0));
            const TagList attrs{{INPA_PreviewControl, OrbID("AngleControl")}, {ACID_Center, OrbID(centre.c_str())}};
            tool->AddInput(OrbID(a.c_str()), nullptr, CLSID_DataType_Number, attrs, AutoNumber(7.0 * i));
        }
        Show();
    }
};

void BM_Viewer_HoverShapes(benchmark::State &state)
{
    if (!LoadControlModule())
        return state.SkipWithError("the control library did not load");
    ShapeRig rig(int(state.range(0)), int(state.range(1)));
    ViewerHover::Run(state, rig.viewer, ViewerHover::Path(Width, Height));
}

// The plain alternative: every rectangle's frame worked out from scratch
// and its four edges tested against the tolerance, topmost first; then every
// dial's ring, each one's fade taken from the mouse's distance to it.
void BM_NaiveLoop_HoverShapes(benchmark::State &state)
{
    const std::vector<Rect> rects = Rects(int(state.range(0)));
    const std::vector<OrbPoint> dials = Dials(int(state.range(1)));
    std::vector<float> fades(dials.size(), 0.5f);
    const std::vector<QPointF> path = ViewerHover::Path(Width, Height);
    const double zoom = std::min(double(Width) / ImageWidth, double(Height) / ImageHeight);
    const QPointF origin((Width - ImageWidth * zoom) / 2, (Height - ImageHeight * zoom) / 2);
    std::size_t i = 0;
    for (auto _ : state) {
        const QPointF at = path[i++ % path.size()];
        const OrbPoint mouse((at.x() - origin.x()) / (ImageWidth * zoom),
                             1 - (at.y() - origin.y()) / (ImageHeight * zoom));
        int hit = -1;
        for (int k = int(rects.size()) - 1; k >= 0 && hit < 0; --k) {
            const Rect &r = rects[std::size_t(k)];
            const double a = r.angle * M_PI / 180, c = std::cos(a), s = std::sin(a);
            const double dx = (mouse.x - r.center.x) * ImageWidth * zoom,
                         dy = (mouse.y - r.center.y) * ImageHeight * zoom;
            const double x = std::fabs(dx * c + dy * s), y = std::fabs(-dx * s + dy * c);
            const double hw = r.width * ImageWidth * zoom / 2, hh = r.height * ImageWidth * zoom / 2;
            if ((std::fabs(x - hw) < Tolerance && y <= hh + Tolerance) ||
                (std::fabs(y - hh) < Tolerance && x <= hw + Tolerance))
                hit = k;
        }
        for (std::size_t k = 0; k < dials.size(); ++k) {
            const double dx = (mouse.x - dials[k].x) * ImageWidth * zoom,
                         dy = (mouse.y - dials[k].y) * ImageHeight * zoom;
            const double off = std::fabs(std::hypot(dx, dy) - RingRadius);
            if (hit < 0 && off <= Tolerance)
                hit = int(rects.size() + k);
            fades[k] = float(std::clamp(1.0 - (off - 10.0) / 100.0, 0.5, 1.0));
        }
        benchmark::DoNotOptimize(hit);
        benchmark::DoNotOptimize(fades.data());
    }
    state.SetItemsProcessed(state.iterations());
}

// Arguments: rectangles, dials.
BENCHMARK(BM_Viewer_HoverShapes)->Args({100, 100})->Unit(benchmark::kMicrosecond);
BENCHMARK(BM_NaiveLoop_HoverShapes)->Args({100, 100})->Unit(benchmark::kMicrosecond);

} // namespace
