// Runs every benchmark inside one QApplication on the offscreen platform, so
// widgets paint for real without a display, then prints one line per goal.
// With --time-control-load the process only loads the control library and
// prints how long that took, in nanoseconds: the load benchmark runs it as a
// fresh process each time, because a library registers its classes once.
#include "BenchModule.h"
#include "GoalReporter.h"

#include <benchmark/benchmark.h>

#include <QApplication>

#include <chrono>
#include <cstdio>
#include <cstring>

namespace {

int TimeControlLoad()
{
    const auto start = std::chrono::steady_clock::now();
    if (!LoadControlModule())
        return 1;
    const auto elapsed = std::chrono::steady_clock::now() - start;
    std::printf("%lld\n", static_cast<long long>(std::chrono::nanoseconds(elapsed).count()));
    return 0;
}

} // namespace

int main(int argc, char **argv)
{
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    QApplication app(argc, argv);
    if (argc == 2 && std::strcmp(argv[1], "--time-control-load") == 0)
        return TimeControlLoad();
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv))
        return 1;
    GoalReporter reporter;
    benchmark::RunSpecifiedBenchmarks(&reporter);
    reporter.PrintGoals(Goals(), stdout);
    benchmark::Shutdown();
    return 0;
}
