#pragma once

#include "tests/bench/GeneratedFiles.h"

/// How much data is worked on, and how many items that is for the figures.
struct Load {
    DataSize size;
    double items;
};

/// Has what the window does measured with the others: loading `market`, and the evolution of `portfolio`. `files` stays
/// the caller's and outlives the run.
void registerAppBenchmarks(GeneratedFiles& files, const Load& market, const Load& portfolio);
