#pragma once

#include "foundation/Date.h"
#include "storage/Descriptor.h"
#include "tools/QuoteSource.h"
#include "tools/SourceAnswer.h"

#include <chrono>
#include <functional>
#include <map>
#include <string>
#include <vector>

/// Asks a source for many names, several at a time, and waits for it.
class SourceRuns {
public:
    using Answers = std::map<std::string, SourceAnswer>;
    /// Is told now and then how much is done, from 0 to 1.
    using Progress = std::function<void(double)>;

    /// @param limit for each name of a run.
    /// @param stop when there is something to read, the asking ends with a std::runtime_error.
    SourceRuns(std::chrono::milliseconds limit, const Descriptor& stop) : limit_(limit), stop_(stop) {}

    /// The answers to all of `runs`. When so many as `kMostSilent` have run out of time one after the other, the rest
    /// is not asked any more.
    Answers answers(const std::vector<QuoteSource::Run>& runs, const Progress& progress) const;

private:
    static constexpr std::size_t kMostRunning = 4;
    static constexpr int kMostSilent = 3;

    std::chrono::milliseconds limit_;
    const Descriptor& stop_;
};
