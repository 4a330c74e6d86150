#include "valuation/HoldingFigures.h"

#include "market/Catalogue.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/Wallet.h"
#include "valuation/Dividends.h"
#include "valuation/Holding.h"
#include "valuation/ShareState.h"
#include "valuation/State.h"

#include <cmath>
#include <unordered_map>

namespace {

/// The rates of the currencies on the days up to that of a state. Thousands of trades ask for them, in no order, and so
/// each currency is gone through once.
class DailyRates {
public:
    explicit DailyRates(const State& state) : first_(state.getFirstOperationDate()), last_(state.getDate()) {}

    /// The rate on each day from the first operation on; empty where that is mistyped. It stays where it is.
    const std::vector<float>& of(const Currency& currency)
    {
        constexpr int kMostDays = 100000;
        const auto [found, isNew] = rates_.try_emplace(&currency);
        if (isNew && first_.isValid() && last_.isValid() && first_ <= last_ && last_ - first_ < kMostDays) {
            Currency::Walk walk(currency);
            for (Date day = first_; day <= last_; day + 1)
                found->second.push_back(walk.realQuote(day));
        }
        return found->second;
    }
    /// Where a day stands in these; beyond them all when it does not.
    std::size_t placeOf(const Date& day) const
    {
        return day.isValid() && day >= first_ ? static_cast<std::size_t>(day - first_) : kNowhere;
    }

private:
    static constexpr std::size_t kNowhere = ~std::size_t{0};

    Date first_;
    Date last_;
    std::unordered_map<const Currency*, std::vector<float>> rates_;
};

/// The value of one unit of a currency on a day.
class Measure {
public:
    /// In itself: 1.
    Measure() = default;
    /// In another currency; no number without a rate.
    Measure(DailyRates& rates, const Currency& unit, const Currency& measure)
        : rates_(&rates), unit_(&unit), measure_(&measure), unitRates_(&rates.of(unit)),
          measureRates_(&rates.of(measure))
    {}

    double on(const Date& day) const
    {
        if (rates_ == nullptr)
            return 1;
        const std::size_t place = rates_->placeOf(day);
        if (place < unitRates_->size()) // and so in the others, which are of the same days
            return static_cast<double>((*unitRates_)[place]) / (*measureRates_)[place];
        return static_cast<double>(unit_->getRealQuote(day)) / measure_->getRealQuote(day);
    }

private:
    const DailyRates* rates_ = nullptr;
    const Currency* unit_ = nullptr;
    const Currency* measure_ = nullptr;
    const std::vector<float>* unitRates_ = nullptr;
    const std::vector<float>* measureRates_ = nullptr;
};

/// A holding replayed in one currency.
class Replay {
public:
    Replay(const Share& share, const Wallet& wallet, const Measure& measure)
        : share_(share), wallet_(wallet), measure_(measure)
    {}

    /// Takes in the operations up to `day` that are still to come.
    void moveTo(const Date& day)
    {
        const auto operations = share_.shareOperations();
        for (; next_ < operations.size() && operations[next_]->getDate() <= day; ++next_)
            take(*operations[next_]);
    }
    /// The sums up to here, without income and what is not realised.
    HoldingSums sums() const
    {
        HoldingSums sums = sums_;
        sums.realisedGain = sums.sold - sums.bought + paidForRest();
        return sums;
    }
    double paidForRest() const { return average_ * holding_.quantity; }

private:
    void take(const ShareOperation& trade)
    {
        const double rate = measure_.on(trade.getDate()), quantity = trade.getQuantity();
        const double amount = rate * trade.getQuote() * quantity;
        sums_.costs += amount * (trade.isBuy() ? wallet_.getBuyRateCost() : wallet_.getSellRateCost()) +
                       rate * trade.getOperationCost();
        (trade.isBuy() ? sums_.bought : sums_.sold) += amount;
        if (!trade.isBuy()) {
            holding_.sell(trade);
            return;
        }
        // As `Holding` has it for the buy quote.
        const double total = quantity + holding_.quantity;
        if (total != 0)
            average_ = (amount + average_ * holding_.quantity) / total;
        holding_.buy(trade, wallet_.getInvestementPeriod());
    }

    const Share& share_;
    const Wallet& wallet_;
    Measure measure_;
    Holding holding_;
    double average_ = 0; // purchase price
    std::size_t next_ = 0;
    HoldingSums sums_;
};

HoldingSums difference(const HoldingSums& end, const HoldingSums& begin)
{
    return {end.bought - begin.bought,
            end.sold - begin.sold,
            end.costs - begin.costs,
            0,
            end.realisedGain - begin.realisedGain,
            {}};
}

/// The income within the range, each payment at the rates of its day.
double incomeOf(const std::vector<Dividends::Payment>& payments, const Date& from, const Date& to,
                const Currency& measure, DailyRates& rates)
{
    double sum = 0;
    for (const Dividends::Payment& payment : payments)
        if (payment.date > from && payment.date <= to) {
            const bool isSame = payment.currency == &measure;
            sum += payment.amount * (isSame ? 1 : Measure(rates, *payment.currency, measure).on(payment.date));
        }
    return sum;
}

HoldingSums sumsOf(const ShareState& state, const Date& from, const Measure& measure)
{
    const Date day = state.getDate();
    Replay replay(*state.share(), *state.state()->wallet(), measure);
    if (!from.isUndefined())
        replay.moveTo(from < day ? from : day);
    const HoldingSums begin = replay.sums();
    replay.moveTo(day);
    HoldingSums sums = difference(replay.sums(), begin);
    if (state.isHeld() && state.share()->company() != nullptr && state.share()->company()->getNbrQuotes() > 0)
        sums.unrealisedGain = state.worth() * measure.on(day) - replay.paidForRest();
    return sums;
}

bool isKnown(const HoldingSums& sums)
{
    return std::isfinite(sums.realisedGain) && std::isfinite(sums.income) &&
           std::isfinite(sums.unrealisedGain.value_or(0));
}

HoldingFigures figuresOf(const ShareState& state, const Catalogue& catalogue, const Dividends& dividends,
                         const Date& from, DailyRates& rates)
{
    if (state.share() == nullptr)
        return {};
    HoldingFigures figures{sumsOf(state, from, {}), {}};
    const Company* company = state.share()->company();
    const Currency* currency =
        company != nullptr && company->market() != nullptr ? company->market()->currency() : nullptr;
    if (currency == nullptr)
        return figures;
    const auto& payments = dividends.of(*company);
    figures.own.income = incomeOf(payments, from, state.getDate(), *currency, rates);
    const Currency* reference = catalogue.getReferenceCurrency();
    if (reference == nullptr || currency->getNbrQuotes() == 0)
        return figures;
    HoldingSums sums = sumsOf(state, from, Measure(rates, *currency, *reference));
    sums.income = incomeOf(payments, from, state.getDate(), *reference, rates);
    if (isKnown(sums))
        figures.inReference = sums;
    return figures;
}

} // namespace

std::vector<HoldingFigures> holdingFigures(const State& state, const Catalogue& catalogue, const Date& from)
{
    std::vector<HoldingFigures> figures;
    if (state.wallet() == nullptr)
        return figures;
    const Dividends dividends(*state.wallet(), catalogue);
    DailyRates rates(state);
    for (const ShareState* share : state.shareStates())
        figures.push_back(figuresOf(*share, catalogue, dividends, from, rates));
    return figures;
}
