#include "tests/bench/FigureReporter.h"

#include <algorithm>
#include <cstdio>
#include <ostream>
#include <string_view>

namespace {

/// With `lower`, the cost of an item of `upper` in terms of that of an item of `lower`, in memory where the unit is
/// that of two memories; otherwise as the unit says.
struct Figure {
    const char* what;
    const char* upper;
    const char* lower;
    const char* unit;
    const char* aim;
};

constexpr Figure kFigures[] = {
    {"Load of a market file / walk of its bytes", "BM_Files/load_market", "BM_Files/walk_market", "", "< 20"},
    {"Memory of a loaded quote", "BM_Files/load_market", nullptr, "B", "< 120"},
    {"Evolution of 20 years", "BM_Files/evolve_20_years", nullptr, "ms", "< 1000"},
    {"Evolution, cost of a day, 10 / 20 years", "BM_Files/evolve_10_years", "BM_Files/evolve_20_years", "", "about 1"},
    {"Evolution, cost of a day, 40 / 20 years", "BM_Files/evolve_40_years", "BM_Files/evolve_20_years", "", "about 1"},
    {"Evolution of 20 years, with the values of its days", "BM_Evolved/points_20_years", nullptr, "ms", ""},
    {"The same with both returns / without them", "BM_Evolved/returns_20_years", "BM_Evolved/points_20_years", "",
     "< 1.1"},
    {"A second valuation / the first", "BM_Files/evolve_again", "BM_Files/evolve_20_years", "", "< 0.7"},
    {"Full replay of a day / a day of the evolution", "BM_Files/replay", "BM_Files/evolve_20_years", "", ""},
    {"Memory of an evolution, per holding and day", "BM_Files/evolve_20_years", nullptr, "B", "< 250"},
    {"Removal of states, cost of a day, 10 / 20 years", "BM_Files/remove_10_years", "BM_Files/remove_20_years", "",
     "about 1"},
    {"Removal of states, cost of a day, 40 / 20 years", "BM_Files/remove_40_years", "BM_Files/remove_20_years", "",
     "about 1"},
    {"Files to chart, small portfolio", "BM_Files/chart_small", nullptr, "ms", "< 80"},
    {"Files to chart, large portfolio", "BM_Files/chart_large", nullptr, "ms", "< 640"},
    {"Start until the window is painted", "BM_Start/pelorin", nullptr, "ms", ""},
    {"The same / that of a bare window of its size", "BM_Start/pelorin", "BM_Start/bare", "", "< 2.2"},
    {"Memory at rest", "BM_Start/pelorin", nullptr, "MB", ""},
    {"Memory at rest / that of the bare window", "BM_Start/pelorin", "BM_Start/bare", "B/B", ""},
    {"The window opens, until it is painted", "BM_Window/open", nullptr, "ms", ""},
    {"100 pages come up", "BM_Window/switch_page", nullptr, "ms", ""},
    {"Load of a market file in the window / without", "BM_Window/load_market", "BM_Files/load_market", "", "about 1"},
    {"Valuation of the large portfolio in the window", "BM_Window/value", nullptr, "ms", ""},
    {"Evolution of 20 years in the window / without", "BM_Window/evolve_20_years", "BM_Files/evolve_20_years", "", ""},
    {"50,000 operations sorted by a text", "BM_Window/sort_by_text", nullptr, "ms", "< 100"},
    {"The same by a number", "BM_Window/sort_by_number", nullptr, "ms", "< 100"},
    {"The same filtered, the first letter", "BM_Window/filter_first", nullptr, "ms", "< 100"},
    {"The next letter, in sorted ones", "BM_Window/filter_further", nullptr, "ms", "< 100"},
    {"Drawing of a line, 100,000 / 5,000 points", "BM_DrawLine/100000", "BM_DrawLine/5000", "", "< 3"},
    {"A zoom step in 20 years / drawing all of them", "BM_ZoomStep", "BM_DrawLine/7305", "", "< 1.5"},
    {"A read-out in 20 years / drawing all of them", "BM_ReadOut", "BM_DrawLine/7305", "", "< 0.5"},
    {"Filling and clearing a line, a point, 4 n / n", "BM_FillLine/80000", "BM_FillLine/20000", "", "about 1"},
    {"First letter of a completion, 5,000 companies", "BM_FirstCompletion/5000", nullptr, "ms", "< 20"},
    {"Completion of five more texts, together", "BM_Completion/5000", nullptr, "ms", "< 20"},
};

double medianOf(std::vector<double> values)
{
    std::sort(values.begin(), values.end());
    return values[values.size() / 2];
}

} // namespace

void FigureReporter::ReportRuns(const std::vector<Run>& runs)
{
    ConsoleReporter::ReportRuns(runs);
    for (const Run& run : runs) {
        if (run.error_occurred || run.run_type != Run::RT_Iteration)
            continue;
        const auto counter = [&run](const char* name, double otherwise) {
            const auto found = run.counters.find(name);
            return found != run.counters.end() ? found->second.value : otherwise;
        };
        const std::string arguments = run.run_name.args;
        Result& result = results_[run.run_name.function_name + (arguments.empty() ? "" : "/" + arguments)];
        const bool isManual = !run.run_name.time_type.empty(); // set by the benchmark, as processor time, too
        const double seconds = isManual ? run.real_accumulated_time : run.cpu_accumulated_time;
        result.seconds.push_back(seconds / static_cast<double>(run.iterations));
        result.items = counter("items", 1);
        result.bytesPerItem = counter("bytes_per_item", 0);
    }
}

void FigureReporter::Finalize()
{
    GetOutputStream() << std::endl;
    for (const Figure& figure : kFigures) {
        const auto upper = results_.find(figure.upper);
        const auto lower = results_.find(figure.lower != nullptr ? figure.lower : figure.upper);
        if (upper == results_.end() || lower == results_.end())
            continue; // filtered out
        const Result& result = upper->second;
        double value = medianOf(result.seconds);
        const std::string_view unit = figure.unit;
        if (unit == "B/B")
            value = result.bytesPerItem / lower->second.bytesPerItem;
        else if (figure.lower != nullptr)
            value = value / result.items / (medianOf(lower->second.seconds) / lower->second.items);
        else
            value = unit == "B" ? result.bytesPerItem : unit == "MB" ? result.bytesPerItem / 1e6 : value * 1000;
        std::printf("%-50s %8.3g %-2s  %s %s\n", figure.what, value, unit == "B/B" ? "" : figure.unit,
                    *figure.aim != '\0' ? "aim:" : "", figure.aim);
    }
}
