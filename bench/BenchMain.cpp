// Runs every benchmark inside one QApplication on the offscreen platform, so
// widgets paint for real without a display, then prints one line per goal.
// With --time-control-load the process only loads the control library and
// prints the CPU time that took, in nanoseconds: the load benchmark runs it as a
// fresh process each time, because a library registers its classes once.
#include "BenchModule.h"
#include "GoalReporter.h"

#include <benchmark/benchmark.h>

#include <QApplication>

#include <cstdint>
#include <cstdio>
#include <cstring>
#include <ctime>

namespace {

// CPU time of the process: what the load costs, not how long the shared
// machine kept the process waiting.
int64_t ProcessCpuNanoseconds()
{
    timespec now{};
    clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &now);
    return int64_t(now.tv_sec) * 1000000000 + now.tv_nsec;
}

int TimeControlLoad()
{
    const int64_t start = ProcessCpuNanoseconds();
    if (!LoadControlModule())
        return 1;
    std::printf("%lld\n", static_cast<long long>(ProcessCpuNanoseconds() - start));
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
