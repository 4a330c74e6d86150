// What drawing costs. It needs no screen, only the platform's offscreen mode.

#include "chart/GraphLine.h"
#include "chart/GraphPoint.h"
#include "chart/GraphView.h"
#include "platform/Application.h"
#include "platform/Screenshot.h"
#include "platform/Window.h"

#include <benchmark/benchmark.h>

#include <cmath>
#include <cstdlib>

namespace {

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

void BM_DrawLine(benchmark::State& state)
{
    setenv("QT_QPA_PLATFORM", "offscreen", 0);
    BApplication application("application/x-vnd.Pelorin-bench");
    auto* window = new BWindow(BRect(0, 0, 780, 360), "chart", B_TITLED_WINDOW, 0); // belongs to itself
    auto* chart = new GraphView(window->Bounds(), "chart");
    window->AddChild(chart);
    GraphLine line;
    line.setDateBased(true);
    fill(line, state.range());
    chart->setXDateBased(true);
    chart->addGraphElement(&line);
    window->Show();
    handle_pending_messages();
    for (auto _ : state) {
        chart->Invalidate();
        chart->Sync();
    }
    if (chart->scale() == nullptr)
        state.SkipWithError("nothing was drawn");
    window->Quit();
}
BENCHMARK(BM_DrawLine)->Arg(5000)->Arg(100000)->Unit(benchmark::kMillisecond);

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

} // namespace
