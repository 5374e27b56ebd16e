#pragma once

#include <vector>

// One performance goal, checked from the benchmarks of one run. A goal with a
// denominator is a ratio of two benchmarks' times (the hot path over its plain
// alternative, or a large case over a small one); one without is an absolute
// time in milliseconds. The row is met when the figure is at most `limit`.
struct Goal
{
    const char *id;          // "P1"
    const char *label;       // "inspector build, 500 sliders"
    const char *numerator;   // benchmark name with its arguments, "BM_Inspector_Build/500"
    const char *denominator; // the same for the alternative; nullptr for an absolute time
    double limit;            // at most this ratio, or under this many milliseconds
    const char *against;     // what the ratio is against: "stock Qt rows"
    // A benchmark of the work both sides share and neither can change (Qt's
    // own event dispatch around a paint), taken from both before the ratio.
    const char *shared = nullptr;
};

// The goals, in the order they are printed (GoalTable.cpp: one line a goal).
const std::vector<Goal> &Goals();
