// Shape values on the paths the user's hand waits on: reducing a freehand
// stroke to key points when the pen lifts, and finding the place on a large
// shape nearest to the mouse, against a plain scan of all its points.
#include "orbane/AutoRef.h"
#include "orbane/PolyLine.h"

#include <benchmark/benchmark.h>

#include <cmath>
#include <limits>
#include <vector>

namespace {

using namespace Orbane;

constexpr double kPi = 3.14159265358979323846;

// A hand-drawn loop in image coordinates with a little tremor, as a tablet
// delivers it: one sample per event, with time and pressure.
std::vector<PolyPoint> Stroke(int count)
{
    std::vector<PolyPoint> samples;
    for (int i = 0; i < count; ++i) {
        const double a = i * 2 * kPi / count;
        PolyPoint p(0.5 + 0.3 * std::cos(a) + 0.002 * std::sin(53 * a), 0.5 + 0.2 * std::sin(3 * a));
        p.Time = i / 120.0;
        p.Pressure = 0.5 + 0.4 * std::sin(a);
        samples.push_back(p);
    }
    return samples;
}

// Reduction within 2 viewer pixels on a 1920 x 1080 image.
void BM_PolyLine_Reduce(benchmark::State &state)
{
    const std::vector<PolyPoint> samples = Stroke(int(state.range(0)));
    for (auto _ : state) {
        AutoRef<PolyLine> shape(new PolyLine);
        shape->SetReducedPoints(samples, 2.0, 1.0 / 1920, 1.0 / 1080);
        benchmark::DoNotOptimize(shape->GetCount());
    }
}
BENCHMARK(BM_PolyLine_Reduce)->Arg(5000)->Unit(benchmark::kMillisecond);

AutoRef<PolyLine> BigShape(int count)
{
    AutoRef<PolyLine> shape(new PolyLine);
    for (const PolyPoint &p : Stroke(count))
        shape->AddPoint(p);
    shape->Close();
    shape->Smooth(nullptr);
    return shape;
}

// Mouse positions spread over the image, the same for both benchmarks.
OrbPoint Mouse(int64_t i)
{
    return {0.1 + 0.8 * double((i * 7919) % 1000) / 1000.0, 0.1 + 0.8 * double((i * 104729) % 997) / 997.0};
}

// The shape's segment index is built once, as it is for a shape the
// viewer shows: the value an Input holds does not change between moves.
void BM_PolyLine_Closest(benchmark::State &state)
{
    AutoRef<PolyLine> shape = BigShape(int(state.range(0)));
    double px, py;
    shape->CalcClosestPoint(0.5, 0.5, px, py);
    int64_t i = 0;
    for (auto _ : state) {
        const OrbPoint m = Mouse(i++);
        benchmark::DoNotOptimize(shape->CalcClosestPoint(m.x, m.y, px, py));
    }
}
BENCHMARK(BM_PolyLine_Closest)->Arg(100000);

// The plain alternative: the distance to every key point.
void BM_NaiveScan_Closest(benchmark::State &state)
{
    AutoRef<PolyLine> shape = BigShape(int(state.range(0)));
    int64_t i = 0;
    for (auto _ : state) {
        const OrbPoint m = Mouse(i++);
        double best = std::numeric_limits<double>::infinity();
        for (const PolyPoint &p : shape->Points())
            best = std::min(best, (p.Pos() - m).LengthSquared());
        benchmark::DoNotOptimize(best);
    }
}
BENCHMARK(BM_NaiveScan_Closest)->Arg(100000);

} // namespace
