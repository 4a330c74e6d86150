#pragma once

#include <benchmark/benchmark.h>

#include <map>
#include <string>
#include <vector>

/// Reports each benchmark as usual, without colours, and at the end the figures that compare them. These are taken
/// within one run, so that most of them do not depend on the machine.
///
/// A benchmark tells in its counter `items` how many things it does in an iteration, one when there is none; its cost
/// is the processor time of an iteration divided by that number, the median of all repetitions.
class FigureReporter : public benchmark::ConsoleReporter {
public:
    FigureReporter() : ConsoleReporter(OO_Tabular) {}

    void ReportRuns(const std::vector<Run>& runs) override;
    void Finalize() override;

private:
    struct Result {
        std::vector<double> seconds; // of an iteration, in every repetition
        double items = 1;
        double bytesPerItem = 0;
    };

    std::map<std::string, Result> results_; // by name of the benchmark
};
