// Hovering over a viewer full of shape overlays: 100 turned rectangles on a
// grid (the angle dials will join them), each asked CCMD_HitTest on every
// mouse move, against a naive loop that tests the same rectangles' edges
// with plain arithmetic. The goal: under 0.5 ms per mouse event.
#include "BenchModule.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ViewerPanel.h"

#include <benchmark/benchmark.h>

#include <QApplication>
#include <QMouseEvent>

#include <cmath>
#include <string>
#include <vector>

namespace {

using namespace Orbane;

constexpr int Width = 800, Height = 450;
constexpr int ImageWidth = 1600, ImageHeight = 900;
constexpr double Tolerance = 6;
constexpr Tag RCD_SetX = 0x20058000, RCD_SetY = 0x20058001, RCD_SetAngle = 0x20058002;

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

struct RectangleRig
{
    explicit RectangleRig(int count) : viewer(&doc)
    {
        auto *tool = new Operator("Shapes1", "Shapes");
        doc.AddTool(tool);
        tool->DecRef();
        int i = 0;
        for (const Rect &r : Rects(count)) {
            const std::string w = "W" + std::to_string(i), h = "H" + std::to_string(i++);
            const TagList attrs{{INPA_PreviewControl, OrbID("RectangleControl")},
                                {INPA_OverlayInput, OrbID(h.c_str())},
                                {RCD_SetX, r.center.x},
                                {RCD_SetY, r.center.y},
                                {RCD_SetAngle, r.angle}};
            tool->AddInput(OrbID(w.c_str()), nullptr, CLSID_DataType_Number, attrs, AutoNumber(r.width));
            tool->AddInput(OrbID(h.c_str()), nullptr, CLSID_DataType_Number, TagList(), AutoNumber(r.height));
        }
        QImage image(ImageWidth, ImageHeight, QImage::Format_ARGB32_Premultiplied);
        image.fill(QColor(40, 60, 90));
        viewer.SetImage(image);
        viewer.resize(Width, Height);
        viewer.ShowTool(tool);
        viewer.show();
        QApplication::processEvents();
    }

    OrbaneDoc doc;
    ViewerPanel viewer;
};

// The mouse walks a fixed path across the viewer, over edges and between
// them; the repaints that hovers ask for are left to the event loop.
std::vector<QPointF> Path()
{
    std::vector<QPointF> path;
    for (int i = 0; i < 256; ++i)
        path.emplace_back(40 + (i * 37) % (Width - 80), 30 + (i * 53) % (Height - 60));
    return path;
}

void BM_Viewer_HoverRectangles(benchmark::State &state)
{
    if (!LoadControlModule())
        return state.SkipWithError("the control library did not load");
    RectangleRig rig(int(state.range(0)));
    const std::vector<QPointF> path = Path();
    std::size_t i = 0;
    for (auto _ : state) {
        const QPointF at = path[i++ % path.size()];
        QMouseEvent event(QEvent::MouseMove, at, rig.viewer.mapToGlobal(at.toPoint()), Qt::NoButton, Qt::NoButton,
                          Qt::NoModifier);
        QApplication::sendEvent(&rig.viewer, &event);
        benchmark::DoNotOptimize(rig.viewer.HoverControl());
        if (i % 64 == 0) {
            state.PauseTiming();
            QApplication::processEvents();
            state.ResumeTiming();
        }
    }
    state.SetItemsProcessed(state.iterations());
}

// The plain alternative: every rectangle's frame worked out from scratch
// and its four edges tested against the tolerance, topmost first.
void BM_NaiveLoop_HoverRectangles(benchmark::State &state)
{
    const std::vector<Rect> rects = Rects(int(state.range(0)));
    const std::vector<QPointF> path = Path();
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
        benchmark::DoNotOptimize(hit);
    }
    state.SetItemsProcessed(state.iterations());
}

BENCHMARK(BM_Viewer_HoverRectangles)->Arg(100)->Unit(benchmark::kMicrosecond);
BENCHMARK(BM_NaiveLoop_HoverRectangles)->Arg(100)->Unit(benchmark::kMicrosecond);

} // namespace
