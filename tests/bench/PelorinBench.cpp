// What starting, loading, valuing and drawing cost, for believable amounts of data. Whatever works on files is measured
// in a child process of its own. It needs no screen, only the platform's offscreen mode.

#include "app/PLWindow.h"
#include "chart/GraphLine.h"
#include "chart/GraphPoint.h"
#include "chart/GraphView.h"
#include "foundation/Today.h"
#include "history/CatalogueImage.h"
#include "history/WalletImage.h"
#include "market/Market.h"
#include "market/NameIndex.h"
#include "market/Quote.h"
#include "platform/Application.h"
#include "platform/CheckBox.h"
#include "platform/Entry.h"
#include "platform/Message.h"
#include "platform/Screenshot.h"
#include "platform/TabView.h"
#include "tests/bench/ChildRun.h"
#include "tests/bench/FigureReporter.h"
#include "tests/bench/GeneratedFiles.h"
#include "valuation/Evolution.h"
#include "valuation/Returns.h"
#include "valuation/State.h"
#include "views/OperationListView.h"

#include <cmath>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <string>
#include <vector>

namespace {

using Files = GeneratedFiles::Files;

std::unique_ptr<GeneratedFiles> folder; // of this run

constexpr DataSize kLarge{1000, 20, 500, 20, 50000};
constexpr DataSize kLong{4, 58, 4, 4, 100}; // companies with 15,000 quotes

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

template <class Subject>
bool doNothing(Subject&, const Files&)
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

template <class Read>
bool isRead(const std::filesystem::path& path, Read read)
{
    FILE* file = std::fopen(path.c_str(), "rb");
    const int result = read(file);
    std::fclose(file);
    return result == 0;
}

bool loadMarket(Portfolio& portfolio, const Files& files)
{
    return isRead(files.market, [&](FILE* file) { return portfolio.catalogue.rd(file); });
}

bool load(Portfolio& portfolio, const Files& files)
{
    if (!loadMarket(portfolio, files))
        return false;
    portfolio.wallet.setCatalogue(portfolio.catalogue);
    return isRead(files.wallet, [&](FILE* file) { return portfolio.wallet.rd(file, nullptr); });
}

bool evolve(Portfolio& portfolio, const Files&)
{
    EvolutionOutcome outcome;
    refreshStates(portfolio.wallet, Portfolio::lastDay(), false, &outcome);
    return outcome == EvolutionOutcome::kBuilt;
}

bool loadAndEvolve(Portfolio& portfolio, const Files& files)
{
    return load(portfolio, files) && evolve(portfolio, files);
}

/// A portfolio with the daily values that its chart shows.
struct Evolved : Portfolio {
    std::vector<EvolutionPoint> points;
};

bool loadEvolved(Evolved& subject, const Files& files)
{
    return load(subject, files);
}

bool evolveToPoints(Evolved& subject, const Files& files)
{
    const bool isEvolved = evolve(subject, files);
    subject.points = evolutionByDate(subject.wallet, subject.catalogue);
    return isEvolved && !subject.points.empty();
}

bool evolveWithReturns(Evolved& subject, const Files& files)
{
    if (!evolveToPoints(subject, files))
        return false;
    const Returns returns(subject.wallet, subject.catalogue, subject.points, subject.points.front().date, {});
    // The first operations buy more than there is, so that a time-weighted return is not known: it costs the same.
    return returns.moneyWeighted.isKnown() && returns.timeWeighted.kind != AnnualReturn::Kind::kNoDay;
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

/// A portfolio with its images, as an undo keeps them.
struct Remembered : Portfolio {
    std::shared_ptr<const CatalogueImage> image;
    std::shared_ptr<const CatalogueImage> changed;
};

bool note(Remembered& subject, const Files&)
{
    subject.changed = CatalogueImage::of(subject.catalogue, subject.image);
    const auto wallet = WalletImage::of(subject.wallet, subject.catalogue, [](const Operation&) { return false; });
    return wallet.operations.size() > 0;
}

bool loadAndNote(Remembered& subject, const Files& files)
{
    if (!load(subject, files))
        return false;
    subject.image = CatalogueImage::of(subject.catalogue, nullptr);
    return true;
}

/// A quote of one company.
bool changeQuote(Remembered& subject, const Files& files)
{
    Company& company = *subject.catalogue.getMarkets()[0]->companies()[0];
    company.getQuote(company.getNbrQuotes() / 2)->setValue(1);
    return note(subject, files) && subject.changed != subject.image;
}

bool removeMarkets(Remembered& subject, const Files& files)
{
    for (Market* market : subject.catalogue.getMarkets())
        delete market;
    return note(subject, files) || subject.changed != subject.image;
}

bool loadAndRemove(Remembered& subject, const Files& files)
{
    return loadAndNote(subject, files) && removeMarkets(subject, files);
}

bool undo(Remembered& subject, const Files&)
{
    subject.image->restore(subject.catalogue);
    return !subject.catalogue.getMarkets().empty();
}

/// The window, with what is needed around it.
struct Desktop {
    BApplication application{"application/x-vnd.Pelorin-bench"};
    PLWindow* window = nullptr;
    BTabView* tabs = nullptr;
};

bool openWindow(Desktop& desktop, const Files& files)
{
    setToday(Portfolio::lastDay());
    desktop.window = new PLWindow({50, 50, 850, 850}, DataFolder(files.market.parent_path().string()));
    desktop.window->Show();
    handle_pending_messages();
    desktop.tabs = dynamic_cast<BTabView*>(desktop.window->FindView("TabView"));
    return desktop.tabs != nullptr;
}

/// What an open panel's answer does.
void answerWith(const std::filesystem::path& path, Desktop& desktop, int32 tab)
{
    desktop.tabs->Select(tab);
    const entry_ref ref{path.parent_path().string(), path.filename().string()};
    BMessage answer(B_REFS_RECEIVED);
    answer.AddRef("refs", &ref);
    desktop.window->PostMessage(&answer);
    handle_pending_messages();
}

bool loadMarket(Desktop& desktop, const Files& files)
{
    answerWith(files.market, desktop, 0);
    return desktop.window->catalogue().getNbrCurrencies() > 0;
}

bool load(Desktop& desktop, const Files& files)
{
    if (!openWindow(desktop, files) || !loadMarket(desktop, files))
        return false;
    answerWith(files.wallet, desktop, 2);
    return desktop.window->getWallet()->getNbrAccounts() > 0;
}

/// Values the portfolio once more, as each command about it does.
bool value(Desktop& desktop, const Files&)
{
    desktop.window->PostMessage('WTDa');
    handle_pending_messages();
    return desktop.window->getState() != nullptr;
}

bool evolve(Desktop& desktop, const Files&)
{
    dynamic_cast<BCheckBox*>(desktop.window->FindView("cbxComputeEvolution"))->SetValue(B_CONTROL_ON);
    desktop.window->PostMessage('WCCe');
    handle_pending_messages();
    return desktop.window->getWallet()->getNbrStates() > 1;
}

OperationListView& operationsOf(Desktop& desktop)
{
    return dynamic_cast<OperationListView&>(*desktop.window->FindView("lstOperations"));
}

bool loadAndShowOperations(Desktop& desktop, const Files& files)
{
    const bool isLoaded = load(desktop, files);
    desktop.tabs->Select(3);
    handle_pending_messages();
    return isLoaded && operationsOf(desktop).CountItems() == kLarge.operations;
}

template <std::size_t kColumn>
bool sortOperations(Desktop& desktop, const Files&)
{
    operationsOf(desktop).sortBy(kColumn);
    handle_pending_messages();
    return operationsOf(desktop).sortedBy() == kColumn;
}

/// For the first time, and so in rows that no filter has looked into.
bool filterOperations(Desktop& desktop, const Files&)
{
    operationsOf(desktop).setFilter("buy 2");
    handle_pending_messages();
    return operationsOf(desktop).CountItems() < kLarge.operations;
}

bool loadSortAndFilter(Desktop& desktop, const Files& files)
{
    return loadAndShowOperations(desktop, files) && sortOperations<3>(desktop, files) &&
           filterOperations(desktop, files);
}

/// The next letter that is typed.
bool filterFurther(Desktop& desktop, const Files&)
{
    const int32 former = operationsOf(desktop).CountItems();
    operationsOf(desktop).setFilter("buy 31");
    handle_pending_messages();
    return operationsOf(desktop).CountItems() < former;
}

bool switchPages(Desktop& desktop, const Files&)
{
    constexpr int kPages = 5, kSwitches = 20 * kPages;
    for (int i = 0; i < kSwitches; ++i) {
        desktop.tabs->Select(i % kPages);
        handle_pending_messages();
    }
    return true;
}

template <class Subject>
void measure(benchmark::State& state, const DataSize& size, double items, bool (*prepare)(Subject&, const Files&),
             bool (*work)(Subject&, const Files&))
{
    const Files files = folder->files(size);
    Subject* subject = nullptr; // made in each child, and ends with it
    const auto begin = [&] {
        subject = new Subject;
        return prepare(*subject, files);
    };
    measureInChildren(state, items, begin, [&] { return work(*subject, files); });
}

constexpr auto BM_Files = measure<Portfolio>;
constexpr auto BM_Evolved = measure<Evolved>;
constexpr auto BM_Undo = measure<Remembered>;
constexpr auto BM_Window = measure<Desktop>;

#define PELORIN_BENCHMARK(subject, name, ...)                                                                          \
    BENCHMARK_CAPTURE(subject, name, __VA_ARGS__)->UseManualTime()->Unit(benchmark::kMillisecond)

PELORIN_BENCHMARK(BM_Files, walk_market, kLarge, quotesOf(kLarge), doNothing, walkMarket);
PELORIN_BENCHMARK(BM_Files, load_market, kLarge, quotesOf(kLarge), doNothing, loadMarket);
PELORIN_BENCHMARK(BM_Files, evolve_10_years, small(10), shareStatesOf(small(10)), load, evolve);
PELORIN_BENCHMARK(BM_Files, evolve_20_years, small(20), shareStatesOf(small(20)), load, evolve);
PELORIN_BENCHMARK(BM_Files, evolve_40_years, small(40), shareStatesOf(small(40)), load, evolve);
PELORIN_BENCHMARK(BM_Files, evolve_again, small(20), shareStatesOf(small(20)), loadAndEvolve, evolve);
PELORIN_BENCHMARK(BM_Files, replay, small(20), kReplays* small(20).holdings, load, replay);
PELORIN_BENCHMARK(BM_Files, remove_10_years, small(10), shareStatesOf(small(10)), loadAndEvolve, removeStates);
PELORIN_BENCHMARK(BM_Files, remove_20_years, small(20), shareStatesOf(small(20)), loadAndEvolve, removeStates);
PELORIN_BENCHMARK(BM_Files, remove_40_years, small(40), shareStatesOf(small(40)), loadAndEvolve, removeStates);
PELORIN_BENCHMARK(BM_Files, chart_small, small(20), 1, doNothing, makeChart);
PELORIN_BENCHMARK(BM_Files, chart_large, kLarge, 1, doNothing, makeChart);
PELORIN_BENCHMARK(BM_Evolved, points_20_years, small(20), 1, loadEvolved, evolveToPoints);
PELORIN_BENCHMARK(BM_Evolved, returns_20_years, small(20), 1, loadEvolved, evolveWithReturns);
PELORIN_BENCHMARK(BM_Undo, note_nothing, kLarge, 1, loadAndNote, note);
PELORIN_BENCHMARK(BM_Undo, note_a_quote_of_15000, kLong, 1, loadAndNote, changeQuote);
PELORIN_BENCHMARK(BM_Undo, remove_markets, kLarge, quotesOf(kLarge), loadAndNote, removeMarkets);
PELORIN_BENCHMARK(BM_Undo, bring_them_back, kLarge, quotesOf(kLarge), loadAndRemove, undo);
PELORIN_BENCHMARK(BM_Window, open, small(20), 1, doNothing, openWindow);
PELORIN_BENCHMARK(BM_Window, switch_page, small(20), 1, load, switchPages);
PELORIN_BENCHMARK(BM_Window, load_market, kLarge, quotesOf(kLarge), openWindow, loadMarket);
PELORIN_BENCHMARK(BM_Window, sort_by_text, kLarge, kLarge.operations, loadAndShowOperations, sortOperations<3>);
PELORIN_BENCHMARK(BM_Window, sort_by_number, kLarge, kLarge.operations, loadAndShowOperations, sortOperations<7>);
PELORIN_BENCHMARK(BM_Window, filter_first, kLarge, kLarge.operations, loadAndShowOperations, filterOperations);
PELORIN_BENCHMARK(BM_Window, filter_further, kLarge, kLarge.operations, loadSortAndFilter, filterFurther);
PELORIN_BENCHMARK(BM_Window, value, kLarge, 1, load, value);
PELORIN_BENCHMARK(BM_Window, evolve_20_years, small(20), shareStatesOf(small(20)), load, evolve);

/// A price a day that wanders up and down.
void fill(GraphLine& line, std::int64_t count)
{
    Date day(1, 1, 1700);
    for (std::int64_t i = 0; i < count; ++i, day + 1) {
        const auto t = static_cast<double>(i);
        auto* point = new GraphPoint(0, static_cast<float>(std::sin(t * 1e-3) + 0.1 * std::sin(t * 0.7)));
        point->setDateBased(true);
        point->setDateX(day);
        line.addGraphPoint(point);
    }
}

/// A chart on the screen, with a line of so many days.
class ShownLine {
public:
    explicit ShownLine(std::int64_t days) : application_("application/x-vnd.Pelorin-bench")
    {
        window_ = new BWindow(BRect(0, 0, 780, 360), "chart", B_TITLED_WINDOW, 0); // belongs to itself
        chart_ = new GraphView(window_->Bounds(), "chart");
        window_->AddChild(chart_);
        line_.setDateBased(true);
        fill(line_, days);
        chart_->setXDateBased(true);
        chart_->addGraphElement(&line_);
        window_->Show();
        handle_pending_messages();
    }
    ~ShownLine() { window_->Quit(); }
    GraphView& chart() { return *chart_; }

private:
    BApplication application_;
    BWindow* window_;
    GraphView* chart_;
    GraphLine line_;
};

void BM_DrawLine(benchmark::State& state)
{
    ShownLine shown(state.range());
    for (auto _ : state) {
        shown.chart().Invalidate();
        shown.chart().Sync();
    }
    if (shown.chart().scale() == nullptr)
        state.SkipWithError("nothing was drawn");
}
constexpr int kDaysOf20Years = 7305;
BENCHMARK(BM_DrawLine)->Arg(5000)->Arg(kDaysOf20Years)->Arg(100000)->Unit(benchmark::kMillisecond);

/// Notches of the wheel, in and out again by turns, up to a few weeks.
void BM_ZoomStep(benchmark::State& state)
{
    constexpr int kNotches = 25;
    ShownLine shown(kDaysOf20Years);
    int notch = 0;
    for (auto _ : state) {
        shown.chart().WheelTurned({390, 180}, 0, notch++ / kNotches % 2 == 0 ? -1 : 1);
        shown.chart().Sync();
        if (notch == kNotches && shown.chart().shownRange().length() > 60)
            state.SkipWithError("nothing was zoomed");
    }
}
BENCHMARK(BM_ZoomStep)->Unit(benchmark::kMillisecond);

/// Movements of the pointer, each with its read-out.
void BM_ReadOut(benchmark::State& state)
{
    ShownLine shown(kDaysOf20Years);
    int x = 0;
    for (auto _ : state) {
        shown.chart().MouseMoved({static_cast<float>(x++ % 780), 180}, true);
        shown.chart().Sync();
    }
    if (!shown.chart().readOut())
        state.SkipWithError("nothing was read out");
}
BENCHMARK(BM_ReadOut)->Unit(benchmark::kMillisecond);

void BM_FillLine(benchmark::State& state)
{
    for (auto _ : state) {
        GraphLine line;
        fill(line, state.range());
        benchmark::DoNotOptimize(line.getMaxDateX());
        line.clearAll();
    }
    state.counters["items"] = static_cast<double>(state.range());
}
BENCHMARK(BM_FillLine)->Arg(20000)->Arg(80000)->Unit(benchmark::kMillisecond);

/// So many companies, of which each tenth has "water" in its name.
std::vector<NamedEntry> companies(int count)
{
    constexpr const char* kWords[] = {"Alpine", "Métallurgie", "Bank", "Energy", "Systèmes",
                                      "Foods",  "Håndverk",    "Rail", "Water",  "Électricité"};
    std::vector<NamedEntry> entries;
    for (int i = 0; i < count; ++i)
        entries.push_back({"T" + std::to_string(i * 7919 % count),
                           std::string(kWords[i / 10 % 10]) + ' ' + kWords[i % 10],
                           "Market " + std::to_string(i % 20)});
    return entries;
}

/// The first letter typed after a change of the catalogue: the names are gathered anew.
void BM_FirstCompletion(benchmark::State& state)
{
    const auto entries = companies(static_cast<int>(state.range(0)));
    for (auto _ : state)
        benchmark::DoNotOptimize(NameIndex(entries).find("w", 50));
}
BENCHMARK(BM_FirstCompletion)->Arg(5000)->Unit(benchmark::kMillisecond);

/// Each further letter; the last text fits nothing, and so is looked for everywhere.
void BM_Completion(benchmark::State& state)
{
    const NameIndex index(companies(static_cast<int>(state.range(0))));
    for (auto _ : state) {
        for (const char* typed : {"t", "t1", "water", "électricité w", "nobody"})
            benchmark::DoNotOptimize(index.find(typed, 50));
    }
    state.SetItemsProcessed(5 * state.iterations());
}
BENCHMARK(BM_Completion)->Arg(5000)->Unit(benchmark::kMillisecond);

struct Start {
    double seconds = 0;
    double bytes = 0;
};

Start start(benchmark::State& state, const std::string& window)
{
    Start start;
    FILE* probe = popen((PELORIN_START_PROBE " " + window).c_str(), "r");
    if (probe == nullptr || std::fscanf(probe, "%lf %lf", &start.seconds, &start.bytes) != 2 || pclose(probe) != 0)
        state.SkipWithError("no window came up");
    return start;
}

/// A start from nothing, libraries and all, until the window is painted: the median of twenty, since what else a
/// machine does lengthens some. In between comes another window, which this one is compared with: a machine is quicker
/// with what it has just done.
void BM_Start(benchmark::State& state, const char* window, const char* other)
{
    constexpr std::size_t kStarts = 20;
    for (auto _ : state) {
        std::vector<double> seconds;
        while (seconds.size() < kStarts) {
            start(state, other);
            const Start measured = start(state, window);
            seconds.push_back(measured.seconds);
            state.counters["bytes_per_item"] = measured.bytes;
        }
        std::ranges::nth_element(seconds, seconds.begin() + kStarts / 2);
        state.SetIterationTime(seconds[kStarts / 2]);
    }
}
BENCHMARK_CAPTURE(BM_Start, pelorin, "pelorin", "bare")->UseManualTime()->Unit(benchmark::kMillisecond)->Iterations(1);
BENCHMARK_CAPTURE(BM_Start, bare, "bare", "pelorin")->UseManualTime()->Unit(benchmark::kMillisecond)->Iterations(1);

} // namespace

int main(int argc, char** argv)
{
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv))
        return 2;
    setenv("QT_QPA_PLATFORM", "offscreen:configfile=" PELORIN_SCREEN, 0); // with room for the whole window
    folder = std::make_unique<GeneratedFiles>();
    FigureReporter reporter;
    benchmark::RunSpecifiedBenchmarks(&reporter);
    folder.reset();
    return 0;
}
