#include "GoalReporter.h"

#include <algorithm>

void GoalReporter::ReportRuns(const std::vector<Run> &runs)
{
    ConsoleReporter::ReportRuns(runs);
    for (const Run &run : runs) {
        if (run.run_type != Run::RT_Iteration || run.error_occurred)
            continue;
        std::string name = run.run_name.function_name;
        if (!run.run_name.args.empty())
            name += "/" + run.run_name.args;
        // CPU time, unless the benchmark times itself or asks for real time:
        // on a shared machine, real time counts the waits for a core.
        const bool real = !run.run_name.time_type.empty();
        const double seconds = (real ? run.GetAdjustedRealTime() : run.GetAdjustedCPUTime()) /
                               benchmark::GetTimeUnitMultiplier(run.time_unit);
        auto found = mBest.find(name);
        if (found == mBest.end())
            mBest.emplace(name, seconds);
        else
            found->second = std::min(found->second, seconds);
    }
}

int GoalReporter::PrintGoals(const std::vector<Goal> &goals, std::FILE *out) const
{
    int missed = 0;
    std::fprintf(out, "\nGoals (best of the repetitions in this run):\n");
    for (const Goal &goal : goals) {
        const auto num = mBest.find(goal.numerator);
        const auto den = goal.denominator ? mBest.find(goal.denominator) : mBest.end();
        const auto shared = goal.shared ? mBest.find(goal.shared) : mBest.end();
        const double common = shared == mBest.end() ? 0.0 : shared->second;
        if (num == mBest.end() || (goal.denominator && (den == mBest.end() || den->second <= common)) ||
            (goal.shared && shared == mBest.end()))
            continue; // filtered out, or skipped with an error shown above
        const bool ratio = goal.denominator != nullptr;
        const double figure = ratio ? (num->second - common) / (den->second - common) : num->second * 1e3;
        const bool met = figure <= goal.limit;
        missed += met ? 0 : 1;
        if (ratio && goal.shared)
            std::fprintf(out, "%s %s: %.2fx %s, after the %.2f us both spend in Qt's dispatch (goal at most %g)%s\n",
                         goal.id, goal.label, figure, goal.against, common * 1e6, goal.limit, met ? "" : "  NOT MET");
        else if (ratio)
            std::fprintf(out, "%s %s: %.2fx %s (goal at most %g)%s\n", goal.id, goal.label, figure, goal.against,
                         goal.limit, met ? "" : "  NOT MET");
        else
            std::fprintf(out, "%s %s: %.2f ms (goal under %g ms)%s\n", goal.id, goal.label, figure, goal.limit,
                         met ? "" : "  NOT MET");
    }
    return missed;
}
