#pragma once

#include <benchmark/benchmark.h>
#include <functional>

/// One run of a piece of work in a child process, which ends without clean-up: memory is as fresh as in a program that
/// has just been started, and what one run leaves behind does not help or hinder the next.
struct ChildRun {
    bool succeeded = false; // both functions have returned true
    double seconds = 0;     // of processor time in `work`; on a quiet machine, what the clock shows
    double bytes = 0;       // growth of the child's peak resident memory during `work`

    ChildRun(const std::function<bool()>& prepare, const std::function<bool()>& work);
};

/// Measures runs of `work`, each in a child of its own, for the figures of so many items.
void measureInChildren(benchmark::State& state, double items, const std::function<bool()>& prepare,
                       const std::function<bool()>& work);
