#pragma once

#include "Goal.h"

#include <benchmark/benchmark.h>

#include <cstdio>
#include <map>
#include <string>
#include <vector>

// Shows every run as the console reporter does and keeps each benchmark's
// best time per iteration, then prints one line per goal. The best of the
// repetitions, not the mean, because the machine is shared: noise only ever
// adds time. The time is the process's CPU time (the benchmarks run on one
// thread, painting included), unless a benchmark reports its own.
class GoalReporter : public benchmark::ConsoleReporter
{
public:
    void ReportRuns(const std::vector<Run> &runs) override;

    // One line per goal whose benchmarks ran; returns how many goals were missed.
    int PrintGoals(const std::vector<Goal> &goals, std::FILE *out) const;

private:
    // Best time per iteration in seconds, by "function/args".
    std::map<std::string, double> mBest;
};
