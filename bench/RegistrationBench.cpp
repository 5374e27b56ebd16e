// Loading the control library, which registers every control class with the
// host's class registry and script layer. A library registers once per
// process, so each load is a fresh process that times only its load (see
// BenchMain); process start-up is not counted.
#include <benchmark/benchmark.h>

#include <QCoreApplication>
#include <QProcess>

#include <algorithm>

namespace {

constexpr int Loads = 5;

// How long one fresh process took to load the library, in seconds; negative
// where it failed.
double TimeOneLoad()
{
    QProcess child;
    child.start(QCoreApplication::applicationFilePath(), {"--time-control-load"});
    bool parsed = false;
    const double ns = child.waitForFinished(30000) && child.exitCode() == 0
                          ? child.readAllStandardOutput().trimmed().toDouble(&parsed)
                          : 0.0;
    return parsed ? ns * 1e-9 : -1.0;
}

// Each iteration is the fastest of a few loads, so that the page cache and
// the machine's other work weigh as little as they can.
void BM_ControlLibrary_Load(benchmark::State &state)
{
    for (auto _ : state) {
        double best = 1e9;
        for (int i = 0; i < Loads; ++i) {
            const double seconds = TimeOneLoad();
            if (seconds < 0.0)
                return state.SkipWithError("the control library did not load in a fresh process");
            best = std::min(best, seconds);
        }
        state.SetIterationTime(best);
    }
}
BENCHMARK(BM_ControlLibrary_Load)->UseManualTime()->Iterations(5)->Unit(benchmark::kMillisecond);

} // namespace
