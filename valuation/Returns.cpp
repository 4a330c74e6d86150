#include "valuation/Returns.h"

#include "valuation/CashFlows.h"
#include "valuation/MoneyWeightedReturn.h"
#include "valuation/TimeWeightedReturn.h"

#include <algorithm>
#include <iterator>
#include <utility>

namespace {

using Points = std::span<const EvolutionPoint>;
using Flows = std::vector<CashFlow>;

/// A range of returns: from `first` on, with what was there already, and the flows behind that.
struct Range {
    Date first;
    double value;               // put in on the first day, at its end; 0 when the range begins with the operations
    Points::iterator point;     // the first of the days whose growth counts
    Flows::const_iterator flow; // the first that counts
};

AnnualReturn moneyWeightedReturn(const Range& range, Points points, const Flows& flows)
{
    const EvolutionPoint& last = points.back();
    std::vector<MoneyWeightedReturn::Payment> payments{{0, range.value}};
    for (auto flow = range.flow; flow != flows.end(); ++flow)
        payments.push_back({static_cast<double>(flow->date - range.first), flow->deposited - flow->withdrawn});
    payments.push_back({static_cast<double>(last.date - range.first), -static_cast<double>(last.totalValue)});
    return MoneyWeightedReturn(std::move(payments)).result();
}

AnnualReturn timeWeightedReturn(const Range& range, Points points, const Flows& flows)
{
    TimeWeightedReturn growth(range.value);
    auto flow = range.flow;
    for (auto point = range.point; point != points.end(); ++point) {
        CashFlow moved;
        if (flow != flows.end() && flow->date <= point->date)
            moved = *flow++;
        growth.addDay(point->totalValue, moved.deposited, moved.withdrawn);
    }
    return growth.result(points.back().date - range.first);
}

} // namespace

Returns::Returns(const Wallet& wallet, const Catalogue& catalogue, Points evolution, const Date& firstOperation,
                 const Date& from)
{
    if (evolution.empty())
        return;
    const Date& last = evolution.back().date;
    const bool isLater = from > firstOperation;
    Range range{isLater ? from : firstOperation, 0, evolution.begin(), {}};
    // From here on the range has days, unless one of the dates is of no calendar.
    if (!range.first.isValid() || !last.isValid() || range.first >= last)
        return;
    const Flows flows = cashFlows(wallet, catalogue, last);
    range.flow = flows.begin();
    const bool hasDays = evolution.front().date == firstOperation;
    if (isLater && hasDays) {
        range.point = std::ranges::upper_bound(evolution, from, {}, &EvolutionPoint::date);
        range.value = std::prev(range.point)->totalValue;
        range.flow = std::ranges::upper_bound(flows, from, {}, &CashFlow::date);
    }
    const AnnualReturn none(AnnualReturn::Kind::kTooManyDays);
    moneyWeighted = isLater && !hasDays ? none : moneyWeightedReturn(range, evolution, flows);
    timeWeighted = hasDays ? timeWeightedReturn(range, evolution, flows) : none;
}
