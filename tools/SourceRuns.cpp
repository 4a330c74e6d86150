#include "tools/SourceRuns.h"

#include "foundation/Today.h"
#include "tools/ChildProgram.h"

#include <algorithm>
#include <list>
#include <stdexcept>

namespace {

struct Running {
    Running(const QuoteSource::Run& aRun, std::chrono::milliseconds limit) : run(aRun), program(aRun.arguments, limit)
    {}
    const QuoteSource::Run& run;
    ChildProgram program;
};

/// Waits until one of the programs can go on. Throws when the whole is to end.
void wait(const std::list<Running>& all, const Descriptor& stop)
{
    std::vector<pollfd> waiting = {{stop.number, POLLIN, 0}};
    auto next = ChildProgram::Clock::time_point::max();
    for (const Running& one : all) {
        one.program.addWaiting(waiting);
        next = std::min(next, one.program.nextLook());
    }
    const auto left = std::chrono::ceil<std::chrono::milliseconds>(next - ChildProgram::Clock::now());
    poll(waiting.data(), waiting.size(), std::max(static_cast<int>(left.count()), 0));
    if (waiting.front().revents != 0)
        throw std::runtime_error("was told to stop, and has changed nothing");
}

} // namespace

SourceRuns::Answers SourceRuns::answers(const std::vector<QuoteSource::Run>& runs, const Progress& progress) const
{
    Answers answers;
    std::list<Running> running;
    int silent = 0; // in a row
    std::size_t done = 0;
    for (auto next = runs.begin(); next != runs.end() || !running.empty();) {
        while (next != runs.end() && running.size() < kMostRunning && silent < kMostSilent) {
            running.emplace_back(*next, limit_ * static_cast<int>(next->names.size()));
            ++next;
        }
        // Nothing runs only when the source is not asked any more.
        if (running.empty())
            break;
        wait(running, stop_);
        for (auto one = running.begin(); one != running.end();) {
            if (one->program.proceed()) {
                ++one;
                continue;
            }
            silent = one->program.hasTimedOut() ? silent + 1 : 0;
            answers.merge(answersOf(one->program, one->run, today()));
            progress(static_cast<double>(++done) / static_cast<double>(runs.size()));
            one = running.erase(one);
        }
    }
    for (const QuoteSource::Run& run : runs)
        for (const std::string& name : run.names)
            answers.try_emplace(name, SourceAnswer{{}, {}, "is not asked for: the source has been silent"});
    return answers;
}
