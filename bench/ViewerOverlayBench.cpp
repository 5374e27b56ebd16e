// A viewer with many point overlays (a chain, each joined to the one before)
// against a naive QPainter loop that draws the same squares and lines: the
// cost of a repaint, and of finding the handle under a press; and hovering
// with the viewer's spatial index against the plain walk over every overlay.
#include "BenchModule.h"
#include "BenchViewer.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ViewerPanel.h"

#include <benchmark/benchmark.h>

#include <QApplication>
#include <QMouseEvent>
#include <QPainter>

#include <chrono>
#include <cmath>
#include <memory>
#include <vector>

namespace {

using namespace Orbane;

constexpr int Width = BenchViewer::Width, Height = BenchViewer::Height;
constexpr int ImageWidth = BenchViewer::ImageWidth, ImageHeight = BenchViewer::ImageHeight;
constexpr int Tolerance = 6;

// Points on a wavy line across the image, in image coordinates.
std::vector<OrbPoint> Points(int count)
{
    std::vector<OrbPoint> points;
    for (int i = 0; i < count; ++i) {
        const double t = (i + 0.5) / count;
        points.emplace_back(0.05 + 0.9 * t, 0.5 + 0.35 * std::sin(t * 25.0));
    }
    return points;
}

// A document whose one tool has `count` point Inputs, each drawn joined to
// the one before, shown in a viewer.
struct ViewerRig : BenchViewer
{
    explicit ViewerRig(int count) : BenchViewer("Points1", "Points")
    {
        const std::vector<OrbPoint> points = Points(count);
        for (int i = 0; i < count; ++i) {
            TagList attrs{{INPA_PreviewControl, OrbID("PointControl")}};
            if (i > 0)
                attrs.Set(0x80058000, OrbID(("P" + std::to_string(i - 1)).c_str())); // PCID_PrevPoint
            const AutoPoint def(points[std::size_t(i)].x, points[std::size_t(i)].y);
            tool->AddInput(OrbID(("P" + std::to_string(i)).c_str()), nullptr, CLSID_DataType_Point, attrs, def);
        }
        Show();
    }
};

void SendMouse(QWidget *w, QEvent::Type type, QPointF at, Qt::MouseButtons held)
{
    QMouseEvent event(type, at, w->mapToGlobal(at.toPoint()), type == QEvent::MouseMove ? Qt::NoButton : Qt::LeftButton,
                      held, Qt::NoModifier);
    QApplication::sendEvent(w, &event);
}

// --- drawing ---

void BM_Viewer_DrawPointOverlays(benchmark::State &state)
{
    if (!LoadControlModule())
        return state.SkipWithError("the control library did not load");
    ViewerRig rig(int(state.range(0)));
    rig.Repaints(state);
}

// The same picture drawn straight: the image, then for each point a shadow
// and a light square and a line to the point before, antialiased.
void BM_NaiveQPainter_DrawPoints(benchmark::State &state)
{
    const int count = int(state.range(0));
    const QImage image = BenchViewer::Backdrop();
    std::vector<QPointF> points;
    const double zoom = std::min(double(Width) / ImageWidth, double(Height) / ImageHeight);
    const QPointF origin((Width - ImageWidth * zoom) / 2, (Height - ImageHeight * zoom) / 2);
    for (const OrbPoint &p : Points(count))
        points.emplace_back(origin.x() + p.x * ImageWidth * zoom, origin.y() + (1 - p.y) * ImageHeight * zoom);
    QImage target(Width, Height, QImage::Format_ARGB32_Premultiplied);
    const QPen light(QColor(230, 230, 230)), shadow(QColor(0, 0, 0, 160));
    for (auto _ : state) {
        QPainter p(&target);
        p.fillRect(target.rect(), QColor(36, 36, 36));
        p.drawImage(QRectF(origin, QSizeF(ImageWidth * zoom, ImageHeight * zoom)), image);
        p.setRenderHint(QPainter::Antialiasing);
        for (const QPointF &offset : {QPointF(1.5, 1.5), QPointF(0.5, 0.5)}) {
            p.setPen(offset.x() > 1 ? shadow : light);
            for (std::size_t i = 0; i < points.size(); ++i) {
                const QPointF at = points[i] + offset;
                p.drawRect(QRectF(at - QPointF(2, 2), QSizeF(4, 4)));
                if (i > 0)
                    p.drawLine(at, points[i - 1] + offset);
            }
        }
        p.end();
        benchmark::DoNotOptimize(target.bits());
    }
    state.SetItemsProcessed(state.iterations() * count);
}

// --- hit-testing ---

// A press on the handle that is asked last (the first Input's, below all the
// others) and its release: every overlay is asked, then told of the release.
// The repaint the release asks for is left out, as the event loop would do
// it between two presses.
void BM_Viewer_PressHitTest(benchmark::State &state)
{
    if (!LoadControlModule())
        return state.SkipWithError("the control library did not load");
    ViewerRig rig(int(state.range(0)));
    const QPointF at = rig.viewer.ImageToWidget(Points(int(state.range(0))).front());
    for (auto _ : state) {
        SendMouse(&rig.viewer, QEvent::MouseButtonPress, at, Qt::LeftButton);
        benchmark::DoNotOptimize(rig.viewer.HotControl());
        SendMouse(&rig.viewer, QEvent::MouseButtonRelease, at, Qt::NoButton);
        state.PauseTiming();
        QApplication::processEvents();
        state.ResumeTiming();
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

// Hovering between two places near the lowest handle: every overlay is asked
// CCMD_HitTest on each move, and nothing needs a repaint.
void BM_Viewer_HoverHitTest(benchmark::State &state)
{
    if (!LoadControlModule())
        return state.SkipWithError("the control library did not load");
    ViewerRig rig(int(state.range(0)));
    const QPointF at = rig.viewer.ImageToWidget(Points(int(state.range(0))).front());
    int i = 0;
    for (auto _ : state)
        SendMouse(&rig.viewer, QEvent::MouseMove, at + QPointF(++i % 2, 0), Qt::NoButton);
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

// The same search over plain points: each mapped to the screen and tested
// against the tolerance square, topmost first.
void BM_NaiveLoop_HitTest(benchmark::State &state)
{
    const std::vector<OrbPoint> points = Points(int(state.range(0)));
    const double span = 800.0;
    const QPointF mouse(points.front().x * span, points.front().y * span);
    for (auto _ : state) {
        int hit = -1;
        for (int i = int(points.size()) - 1; i >= 0 && hit < 0; --i) {
            const QPointF d = QPointF(points[std::size_t(i)].x * span, points[std::size_t(i)].y * span) - mouse;
            if (std::fabs(d.x()) < Tolerance && std::fabs(d.y()) < Tolerance)
                hit = i;
        }
        benchmark::DoNotOptimize(hit);
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

// Hovering over the viewer along a fixed path that passes handles (so that
// hovers claim and let go), with the spatial index and with the plain walk
// that asks every overlay, in turns within the same run. The row's time is
// the indexed hover's; `index/plain` is the ratio of the two.
void BM_Viewer_HoverIndexVsPlainWalk(benchmark::State &state)
{
    if (!LoadControlModule())
        return state.SkipWithError("the control library did not load");
    const int count = int(state.range(0));
    ViewerRig rig(count);
    std::vector<QPointF> path;
    const std::vector<OrbPoint> points = Points(count);
    for (int i = 0; i < 64; ++i)
        path.push_back(rig.viewer.ImageToWidget(points[std::size_t(i * 37 % count)]) + QPointF(i % 5 - 2, i % 3 - 1));
    int64_t asked = 0;
    const auto hoverPath = [&](bool plain) {
        rig.viewer.SetPlainHover(plain);
        const auto start = std::chrono::steady_clock::now();
        for (const QPointF &at : path) {
            SendMouse(&rig.viewer, QEvent::MouseMove, at, Qt::NoButton);
            asked += plain ? 0 : rig.viewer.HoverAsked();
        }
        return std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
    };
    double indexed = 0.0, plain = 0.0;
    for (auto _ : state) {
        const double t = hoverPath(false);
        indexed += t;
        plain += hoverPath(true);
        state.SetIterationTime(t);
    }
    // The ratio and how many overlays an indexed hover asks on average.
    state.counters["index/plain"] = plain > 0.0 ? indexed / plain : 0.0;
    state.counters["asked"] = double(asked) / double(state.iterations() * int64_t(path.size()));
    state.SetItemsProcessed(state.iterations() * int64_t(path.size()));
}

BENCHMARK(BM_Viewer_DrawPointOverlays)->Arg(100)->Arg(1000)->Unit(benchmark::kMicrosecond);
BENCHMARK(BM_NaiveQPainter_DrawPoints)->Arg(100)->Arg(1000)->Unit(benchmark::kMicrosecond);
BENCHMARK(BM_Viewer_PressHitTest)->Arg(100)->Arg(1000)->Unit(benchmark::kMicrosecond);
BENCHMARK(BM_Viewer_HoverHitTest)->Arg(100)->Arg(1000)->Unit(benchmark::kMicrosecond);
BENCHMARK(BM_NaiveLoop_HitTest)->Arg(100)->Arg(1000)->Unit(benchmark::kMicrosecond);
BENCHMARK(BM_Viewer_HoverIndexVsPlainWalk)->Arg(10)->Arg(1000)->UseManualTime()->Unit(benchmark::kMicrosecond);

} // namespace
