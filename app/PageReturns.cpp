#include "app/PageReturns.h"

#include "app/Holds.h"
#include "valuation/Returns.h"
#include "valuation/State.h"
#include "valuation/Totals.h"
#include "views/WalletView.h"

#include <algorithm>

PageReturns::PageReturns(PLWindow& window, WalletView& page) : window_(window), page_(page)
{
    // A range comes from the chart, not by way of a command, so the lock is taken here.
    page.setRangeHook([this] {
        const WindowLock lock(window_);
        if (lock.isHeld())
            showRange();
    });
}

void PageReturns::show(const State& state, std::vector<EvolutionPoint> days)
{
    days_ = std::move(days);
    firstOperation_ = state.getFirstOperationDate();
    hasDays_ = page_.isComputeEvolution();
    if (const Totals totals(state, window_.catalogue()); days_.empty() && totals.isKnown)
        days_.push_back({state.getDate(), totals.totalValue, totals.totalDeposit});
    showRange();
}

void PageReturns::showRange()
{
    if (days_.empty())
        return;
    // Without the values of all days there is no other range than that of all.
    const auto [from, to] = days_.size() > 1 ? page_.daysInView() : std::pair<Date, Date>();
    std::span<const EvolutionPoint> days = days_;
    if (!to.isUndefined() && to < days.back().date)
        days = {days.begin(), std::ranges::upper_bound(days, to, {}, &EvolutionPoint::date)};
    const Returns returns(*window_.getWallet(), window_.catalogue(), days, firstOperation_, from);
    page_.showReturns(returns, std::max(from, firstOperation_), days.back().date, hasDays_);
}
