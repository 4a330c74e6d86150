// What loading and valuing cost, for believable amounts of data. Whatever works on files is measured in a child process
// of its own.

#include "market/Company.h"
#include "tests/bench/AppBench.h"
#include "tests/bench/ChildRun.h"
#include "tests/bench/FigureReporter.h"
#include "tests/bench/GeneratedFiles.h"
#include "tests/bench/Portfolio.h"
#include "valuation/Evolution.h"
#include "valuation/State.h"

#include <cstring>
#include <memory>

namespace {

using Files = GeneratedFiles::Files;

std::unique_ptr<GeneratedFiles> folder; // of this run

constexpr DataSize kLarge{1000, 20, 500, 20, 50000};

/// A portfolio with the same number of operations, spread over more or fewer years.
constexpr DataSize small(int years)
{
    return {200, years, 200, 10, 5000};
}

double daysOf(const DataSize& size)
{
    return size.years * 365.25;
}
double quotesOf(const DataSize& size)
{
    return daysOf(size) * (5.0 / 7 * size.companies + GeneratedFiles::kCurrencies);
}
/// One of each holding and each day.
double shareStatesOf(const DataSize& size)
{
    return daysOf(size) * size.holdings;
}

// The steps that are measured, and those that lead up to them. All return true on success.

bool doNothing(Portfolio&, const Files&)
{
    return true;
}

/// The least that a load can do: reads the file whole, adds up a value for every quote that it has room for, and
/// forgets it. Where exactly the values stand makes no difference to the time.
bool walkMarket(Portfolio&, const Files& files)
{
    const std::size_t size = std::filesystem::file_size(files.market);
    const std::unique_ptr<unsigned char[]> bytes(new unsigned char[size]); // not set to zero
    FILE* file = std::fopen(files.market.c_str(), "rb");
    const bool isRead = std::fread(bytes.get(), 1, size, file) == size;
    std::fclose(file);
    double sum = 0;
    for (std::size_t at = 0; at + Quote::kFileSize <= size; at += Quote::kFileSize) {
        float value;
        std::memcpy(&value, bytes.get() + at, sizeof value);
        sum += value;
    }
    benchmark::DoNotOptimize(sum);
    return isRead;
}

bool loadMarket(Portfolio& portfolio, const Files& files)
{
    return portfolio.loadMarket(files.market);
}

bool load(Portfolio& portfolio, const Files& files)
{
    return portfolio.loadMarket(files.market) && portfolio.loadWallet(files.wallet);
}

bool evolve(Portfolio& portfolio, const Files&)
{
    EvolutionOutcome outcome;
    refreshStates(portfolio.wallet, Portfolio::lastDay(), false, &outcome);
    return outcome == EvolutionOutcome::Built;
}

bool loadAndEvolve(Portfolio& portfolio, const Files& files)
{
    return load(portfolio, files) && evolve(portfolio, files);
}

bool removeStates(Portfolio& portfolio, const Files&)
{
    portfolio.wallet.removeAllStates();
    return true;
}

bool makeChart(Portfolio& portfolio, const Files& files)
{
    return loadAndEvolve(portfolio, files) &&
           evolutionPoints(portfolio.wallet, portfolio.catalogue).size() == portfolio.wallet.getNbrStates();
}

constexpr int kReplays = 40;

/// Replays days spread over the years of the evolution.
bool replay(Portfolio& portfolio, const Files&)
{
    for (int i = 0; i < kReplays; ++i) {
        Date day = Portfolio::lastDay();
        day.moveBy(static_cast<std::int64_t>(-i * daysOf(small(20)) / kReplays));
        const State state(&portfolio.wallet, day, false);
        benchmark::DoNotOptimize(state.getTotalDeposit());
    }
    return true;
}

using Step = bool (*)(Portfolio&, const Files&);

void BM_Files(benchmark::State& state, const DataSize& size, double items, Step prepare, Step work)
{
    const Files files = folder->files(size);
    Portfolio portfolio; // each child fills its own copy
    measureInChildren(
        state, items, [&] { return prepare(portfolio, files); }, [&] { return work(portfolio, files); });
}

#define PELORIN_BENCHMARK(name, ...)                                                                                   \
    BENCHMARK_CAPTURE(BM_Files, name, __VA_ARGS__)->UseManualTime()->Unit(benchmark::kMillisecond)

PELORIN_BENCHMARK(walk_market, kLarge, quotesOf(kLarge), doNothing, walkMarket);
PELORIN_BENCHMARK(load_market, kLarge, quotesOf(kLarge), doNothing, loadMarket);
PELORIN_BENCHMARK(evolve_10_years, small(10), shareStatesOf(small(10)), load, evolve);
PELORIN_BENCHMARK(evolve_20_years, small(20), shareStatesOf(small(20)), load, evolve);
PELORIN_BENCHMARK(evolve_40_years, small(40), shareStatesOf(small(40)), load, evolve);
PELORIN_BENCHMARK(replay, small(20), kReplays* small(20).holdings, load, replay);
PELORIN_BENCHMARK(remove_10_years, small(10), shareStatesOf(small(10)), loadAndEvolve, removeStates);
PELORIN_BENCHMARK(remove_20_years, small(20), shareStatesOf(small(20)), loadAndEvolve, removeStates);
PELORIN_BENCHMARK(remove_40_years, small(40), shareStatesOf(small(40)), loadAndEvolve, removeStates);
PELORIN_BENCHMARK(chart_small, small(20), 1, doNothing, makeChart);
PELORIN_BENCHMARK(chart_large, kLarge, 1, doNothing, makeChart);

/// From the front, so that every removal leaves a gap in the list.
void BM_RemoveQuotes(benchmark::State& state)
{
    for (auto _ : state) {
        state.PauseTiming();
        Company company;
        std::vector<std::unique_ptr<CompanyQuote>> quotes;
        Date day(1, 1, 1900);
        for (std::int64_t i = 0; i < state.range(); ++i, day + 1)
            quotes.push_back(std::make_unique<CompanyQuote>(&company, day, 1));
        state.ResumeTiming();
        for (const auto& quote : quotes)
            company.removeQuote(quote.get());
        state.PauseTiming();
        quotes.clear();
        state.ResumeTiming();
    }
    state.counters["items"] = static_cast<double>(state.range());
}
BENCHMARK(BM_RemoveQuotes)->Arg(10000)->Arg(40000);

} // namespace

int main(int argc, char** argv)
{
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv))
        return 2;
    folder = std::make_unique<GeneratedFiles>();
    registerAppBenchmarks(*folder, {kLarge, quotesOf(kLarge)}, {small(20), shareStatesOf(small(20))});
    FigureReporter reporter;
    benchmark::RunSpecifiedBenchmarks(&reporter);
    folder.reset();
    return 0;
}
