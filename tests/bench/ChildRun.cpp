#include "tests/bench/ChildRun.h"

#include <ctime>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

namespace {

double peakBytes()
{
    rusage usage{};
    getrusage(RUSAGE_SELF, &usage);
    return 1024.0 * static_cast<double>(usage.ru_maxrss);
}

double processorSeconds()
{
    return static_cast<double>(std::clock()) / CLOCKS_PER_SEC;
}

} // namespace

ChildRun::ChildRun(const std::function<bool()>& prepare, const std::function<bool()>& work)
{
    int ends[2];
    if (pipe(ends) != 0)
        return;
    const pid_t child = fork();
    if (child == 0) {
        const bool isPrepared = prepare();
        const double before = peakBytes();
        const double start = processorSeconds();
        const bool isDone = isPrepared && work();
        const double report[] = {processorSeconds() - start, peakBytes() - before};
        _exit(isDone && write(ends[1], report, sizeof report) == sizeof report ? 0 : 1);
    }
    close(ends[1]);
    double report[2];
    const bool isReported = child > 0 && read(ends[0], report, sizeof report) == sizeof report;
    close(ends[0]);
    int status = -1;
    if (child > 0)
        waitpid(child, &status, 0);
    succeeded = isReported && status == 0;
    if (succeeded) {
        seconds = report[0];
        bytes = report[1];
    }
}

void measureInChildren(benchmark::State& state, double items, const std::function<bool()>& prepare,
                       const std::function<bool()>& work)
{
    for (auto _ : state) {
        const ChildRun run(prepare, work);
        if (!run.succeeded)
            state.SkipWithError("the child failed");
        state.SetIterationTime(run.seconds);
        state.counters["items"] = items;
        state.counters["bytes_per_item"] = run.bytes / items;
    }
}
