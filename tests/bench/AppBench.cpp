#include "tests/bench/AppBench.h"

#include "app/PLWindow.h"
#include "foundation/Today.h"
#include "platform/Application.h"
#include "platform/CheckBox.h"
#include "platform/Entry.h"
#include "platform/Message.h"
#include "platform/Screenshot.h"
#include "platform/TabView.h"
#include "portfolio/Wallet.h"
#include "tests/bench/ChildRun.h"
#include "tests/bench/Portfolio.h"

#include <cstdlib>

namespace {

using Files = GeneratedFiles::Files;

constexpr int kPages = 5;
constexpr int kSwitches = 20 * kPages;

/// The window, with what is needed around it. It ends with its process.
struct Desktop {
    BApplication application{"application/x-vnd.Pelorin-bench"};
    PLWindow* window = nullptr;
    BTabView* tabs = nullptr;

    bool open(const Files& files)
    {
        setToday(Portfolio::lastDay());
        window = new PLWindow({50, 50, 850, 850}, DataFolder(files.market.parent_path().string()));
        window->Show();
        handle_pending_messages();
        tabs = dynamic_cast<BTabView*>(window->FindView("TabView"));
        return tabs != nullptr;
    }

    /// What an open panel's answer does.
    void load(int32 tab, const std::filesystem::path& path)
    {
        tabs->Select(tab);
        const entry_ref ref{path.parent_path().string(), path.filename().string()};
        BMessage answer(B_REFS_RECEIVED);
        answer.AddRef("refs", &ref);
        window->PostMessage(&answer);
        handle_pending_messages();
    }

    bool loadMarket(const Files& files)
    {
        load(0, files.market);
        return window->catalogue().getNbrCurrencies() > 0;
    }

    bool loadBoth(const Files& files)
    {
        loadMarket(files);
        load(2, files.wallet);
        return window->getWallet()->getNbrAccounts() > 0;
    }

    bool evolve()
    {
        dynamic_cast<BCheckBox*>(window->FindView("cbxComputeEvolution"))->SetValue(B_CONTROL_ON);
        window->PostMessage('WCCe');
        handle_pending_messages();
        return window->getWallet()->getNbrStates() > 1;
    }

    bool switchPages()
    {
        for (int i = 0; i < kSwitches; ++i) {
            tabs->Select(i % kPages);
            handle_pending_messages();
        }
        return true;
    }
};

using Step = bool (*)(Desktop&, const Files&);

void measure(benchmark::State& state, const Files& files, Step prepare, Step work, double items)
{
    setenv("QT_QPA_PLATFORM", "offscreen", 0);
    Desktop* desktop = nullptr; // made in each child, and ends with it
    const auto begin = [&] {
        desktop = new Desktop;
        return prepare(*desktop, files);
    };
    measureInChildren(state, items, begin, [&] { return work(*desktop, files); });
}

} // namespace

void registerAppBenchmarks(GeneratedFiles& files, const Load& market, const Load& portfolio)
{
    const Step nothing = [](Desktop&, const Files&) { return true; };
    const Step open = [](Desktop& d, const Files& f) { return d.open(f); };
    const Step openAndLoad = [](Desktop& d, const Files& f) { return d.open(f) && d.loadBoth(f); };
    const struct {
        const char* name;
        Load load;
        Step prepare;
        Step work;
    } benchmarks[] = {
        {"open", {portfolio.size, 1}, nothing, open},
        {"switch_page", {portfolio.size, 1}, openAndLoad, [](Desktop& d, const Files&) { return d.switchPages(); }},
        {"load_market", market, open, [](Desktop& d, const Files& f) { return d.loadMarket(f); }},
        {"evolve_20_years", portfolio, openAndLoad, [](Desktop& d, const Files&) { return d.evolve(); }},
    };
    for (const auto& b : benchmarks) {
        const auto run = [&files, load = b.load, prepare = b.prepare, work = b.work](benchmark::State& state) {
            measure(state, files.files(load.size), prepare, work, load.items);
        };
        benchmark::RegisterBenchmark((std::string("BM_Window/") + b.name).c_str(), run)
            ->UseManualTime()
            ->Unit(benchmark::kMillisecond);
    }
}
