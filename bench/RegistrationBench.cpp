// Loading the control library, which registers every control class with the
// host's class registry and script layer. A library registers once per
// process, so each iteration is a fresh process that times only its load
// (see BenchMain); process start-up is not counted.
#include <benchmark/benchmark.h>

#include <QCoreApplication>
#include <QProcess>

namespace {

void BM_ControlLibrary_Load(benchmark::State &state)
{
    for (auto _ : state) {
        QProcess child;
        child.start(QCoreApplication::applicationFilePath(), {"--time-control-load"});
        bool parsed = false;
        const double ns = child.waitForFinished(30000) && child.exitCode() == 0
                              ? child.readAllStandardOutput().trimmed().toDouble(&parsed)
                              : 0.0;
        if (!parsed)
            return state.SkipWithError("the control library did not load in a fresh process");
        state.SetIterationTime(ns * 1e-9);
    }
}
BENCHMARK(BM_ControlLibrary_Load)->UseManualTime()->Iterations(15)->Unit(benchmark::kMillisecond);

} // namespace
