// The tone controls' hot paths: the histogram of a 4K float image, and the
// repaint of a curve graph while a point is dragged.
#include "widgets/CurveGraph.h"
#include "widgets/Histogram.h"

#include "orbane/FloatImage.h"

#include <benchmark/benchmark.h>

#include <QApplication>
#include <QThread>

#include <random>

namespace {

Orbane::FloatImage NoiseImage(int width, int height)
{
    std::vector<float> rgba(std::size_t(width) * std::size_t(height) * 4);
    std::mt19937 random(7);
    std::uniform_real_distribution<float> value(-0.1f, 1.2f);
    for (float &v : rgba)
        v = value(random);
    return Orbane::FloatImage(width, height, 4, std::move(rgba));
}

// Shared out over the machine's threads, as the histogram feed counts.
void BM_Histogram_4K(benchmark::State &state)
{
    static const Orbane::FloatImage image = NoiseImage(3840, 2160);
    const int threads = std::max(1, QThread::idealThreadCount());
    for (auto _ : state)
        benchmark::DoNotOptimize(Orbane::Histogram::CountParallel(image, threads));
}
BENCHMARK(BM_Histogram_4K)->Unit(benchmark::kMillisecond)->UseRealTime();

// The same on one thread: what the sharing saves.
void BM_Histogram_4K_OneThread(benchmark::State &state)
{
    static const Orbane::FloatImage image = NoiseImage(3840, 2160);
    for (auto _ : state)
        benchmark::DoNotOptimize(Orbane::Histogram::Count(image));
}
BENCHMARK(BM_Histogram_4K_OneThread)->Unit(benchmark::kMillisecond)->UseRealTime();

// One step of a point drag: the curve changes, the graph repaints (five
// curves, a histogram behind them).
void BM_CurveGraph_DragRepaint(benchmark::State &state)
{
    Orbane::CurveGraph graph;
    std::vector<Orbane::CurveGraph::Line> lines(5);
    for (auto &line : lines) {
        line.curve = Orbane::Curve({{0, 0}, {0.25, 0.2}, {0.5, 0.55}, {0.75, 0.8}, {1, 1}});
        line.colour = QColor(200, 200, 200);
    }
    graph.SetLines(lines);
    graph.SetHistogram(std::vector<float>(256, 0.5f), QColor(128, 128, 128, 100));
    graph.resize(320, 160);
    graph.show();
    QApplication::processEvents();
    Orbane::Curve curve = lines[0].curve;
    int i = 0;
    for (auto _ : state) {
        curve.Move(2, {0.5, 0.3 + (++i % 50) / 100.0});
        graph.SetCurve(0, curve);
        graph.repaint();
    }
}
BENCHMARK(BM_CurveGraph_DragRepaint)->Unit(benchmark::kMillisecond);

} // namespace
