#include "valuation/SplitPlan.h"

#include "foundation/DateText.h"
#include "market/Company.h"
#include "market/NoteCompanyEvent.h"
#include "market/SplitCompanyEvent.h"
#include "portfolio/Account.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/Wallet.h"
#include "valuation/CashMoves.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace {

constexpr std::int64_t kMostShares = std::numeric_limits<int>::max();

/// The smallest whole number from `a` / `b` on; `b` is above zero.
std::int64_t dividedUp(std::int64_t a, std::int64_t b)
{
    return a / b + (a % b > 0 ? 1 : 0); // of a negative number the division drops the fraction upwards
}

/// Whether `value` came out of a computation from `former` without leaving what a float can hold.
bool survives(float former, float value)
{
    return !std::isfinite(former) || (std::isfinite(value) && (value != 0 || former == 0));
}

const NoteCompanyEvent* findNote(const Company& company, const Date& day)
{
    for (const CompanyEvent* event : company.events()) {
        const auto* note = dynamic_cast<const NoteCompanyEvent*>(event);
        if (note != nullptr && note->getDate() == day && note->getTitle() == SplitPlan::kAppliedTitle)
            return note;
    }
    return nullptr;
}

} // namespace

SplitPlan::SplitPlan(const SplitCompanyEvent& event, bool splitsQuotes)
    : company_(event.company()), day_(event.getDate()), from_(event.getNumerator()), to_(event.getDivider()),
      splitsQuotes_(splitsQuotes)
{
    plan();
}

void SplitPlan::plan()
{
    if (company_ == nullptr || !day_.isValid())
        return refuse("The split has no day.");
    if (from_ <= 0 || to_ <= 0)
        return refuse("A split needs two numbers above 0, such as 1 to 2.");
    if (from_ == to_)
        return refuse("A split of " + ratio() + " changes nothing.");
    appliedNote_ = findNote(*company_, day_);
    planQuotes();
    for (Share* share : company_->shares())
        planHolding(share);
    // The value of a fraction needs a price, which may have to come from the trades.
    findPrice();
    for (Holding& holding : holdings_)
        settle(holding);
}

void SplitPlan::refuse(const std::string& problem)
{
    if (problem_.empty())
        problem_ = problem; // the first one counts
}

void SplitPlan::planQuotes()
{
    const auto all = company_->quotes();
    revision_ = company_->revision();
    const auto next = std::ranges::partition_point(all, [this](const CompanyQuote* q) { return q->getDate() < day_; });
    quotes_ = static_cast<unsigned>(next - all.begin());
    if (next != all.end()) {
        nextQuoteDay_ = (*next)->getDate();
        nextQuote_ = (*next)->getValue();
    }
    if (quotes_ == 0)
        return;
    firstQuoteDay_ = all.front()->getDate();
    lastQuoteDay_ = all[quotes_ - 1]->getDate();
    lastQuote_ = all[quotes_ - 1]->getValue();
    for (const CompanyQuote* quote : all.first(splitsQuotes_ ? quotes_ : 0))
        if (!survives(quote->getValue(), static_cast<float>(quote->getValue() * factor())))
            return refuse("The quote of " + dateText(quote->getDate()) + " would be no number any more.");
}

bool SplitPlan::looksSplit() const
{
    if (quotes_ == 0 || nextQuoteDay_.isUndefined() || !(lastQuote_ > 0) || !(nextQuote_ > 0))
        return false;
    const double step = std::log(static_cast<double>(nextQuote_) / lastQuote_);
    return std::abs(step) < std::abs(step - std::log(factor()));
}

void SplitPlan::planHolding(Share* share)
{
    Holding holding{share};
    for (ShareOperation* operation : share->shareOperations()) {
        if (operation->isAutomatic())
            hasSimulatedSales_ = true;
        else if (operation->getDate() < day_ && !planTrade(holding, operation))
            return;
    }
    if (!holding.trades.empty())
        holdings_.push_back(std::move(holding));
}

/// @return false when it cannot be split.
bool SplitPlan::planTrade(Holding& holding, ShareOperation* operation)
{
    const std::int64_t former = operation->getQuantity();
    const std::int64_t before = dividedUp(holding.former * to_, from_);
    holding.former += operation->isBuy() ? former : -former;
    const std::int64_t after = dividedUp(holding.former * to_, from_);
    const std::int64_t quantity = operation->isBuy() ? after - before : before - after;
    Trade trade{operation, 0, operation->getQuote(), operation->getOperationCost(), holding.former, after};
    const double amount = static_cast<double>(former) * trade.quote;
    if (quantity != 0) {
        trade.quote = static_cast<float>(amount / static_cast<double>(quantity));
    } else {
        const double rate = operation->getOperationRateCost();
        trade.cost += static_cast<float>(operation->isBuy() ? amount * (1 + rate) : -amount * (1 - rate));
        trade.quote = static_cast<float>(trade.quote * factor());
    }
    // A holding is counted in 32 bits, and so is what it is before: nothing above has overflowed 64.
    const bool fits =
        std::max(std::abs(holding.former), std::max(std::abs(after), std::abs(quantity))) <= kMostShares &&
        survives(operation->getQuote(), trade.quote) &&
        (std::isfinite(trade.cost) || !std::isfinite(operation->getOperationCost()));
    if (!fits)
        refuse("The " + std::string(operation->isBuy() ? "purchase" : "sale") + " of " +
               dateText(operation->getDate()) + " would be too large.");
    trade.quantity = static_cast<int>(quantity);
    holding.trades.push_back(trade);
    if (operation->account() != nullptr)
        holding.account = operation->account();
    return fits;
}

unsigned SplitPlan::trades() const
{
    std::size_t n = 0;
    for (const Holding& holding : holdings_)
        n += holding.trades.size();
    return static_cast<unsigned>(n);
}

void SplitPlan::findPrice()
{
    if (quotes_ > 0 && splitsQuotes_) {
        priceDay_ = lastQuoteDay_;
        priceBefore_ = lastQuote_;
        priceAfter_ = static_cast<float>(lastQuote_ * factor());
        return;
    }
    if (quotes_ > 0 || !nextQuoteDay_.isUndefined()) {
        // Split already, or from after the split.
        priceDay_ = quotes_ > 0 ? lastQuoteDay_ : nextQuoteDay_;
        priceAfter_ = quotes_ > 0 ? lastQuote_ : nextQuote_;
        priceBefore_ = static_cast<float>(priceAfter_ / factor());
        return;
    }
    for (const Holding& holding : holdings_) {
        const ShareOperation& last = *holding.trades.back().operation;
        if (!priceDay_.isUndefined() && last.getDate() < priceDay_)
            continue;
        priceDay_ = last.getDate();
        priceBefore_ = last.getQuote();
        priceAfter_ = static_cast<float>(priceBefore_ * factor());
    }
}

void SplitPlan::settle(Holding& holding)
{
    const std::int64_t upper = holding.trades.back().holding;
    // Rounded up, less one share when there was a fraction: the whole shares below it.
    const std::int64_t missing = upper * from_ - holding.former * to_; // to the upper number, times `from`
    holding.fraction = missing > 0 ? from_ - missing : 0;
    holding.whole = upper - (holding.fraction > 0 ? 1 : 0);
    if (holding.fraction > 0) {
        if (holding.account == nullptr)
            refuse("The fraction of a share cannot be settled: its purchases have no account.");
        const double value = static_cast<double>(priceAfter_) * static_cast<double>(holding.fraction) / from_;
        const Wallet* wallet = holding.share->wallet();
        const double kept = 1.0 - (wallet != nullptr ? wallet->getSellRateCost() : 0);
        // A rate of 100 % leaves nothing to arrive, whatever the quote.
        holding.saleQuote = static_cast<float>(kept > 0 ? value / kept : value);
        holding.paidOut = static_cast<float>(holding.saleQuote * kept);
    }
    holding.valueBefore = static_cast<double>(holding.former) * priceBefore_;
    holding.valueAfter = static_cast<double>(holding.whole) * priceAfter_ + holding.paidOut;
    if (!std::isfinite(holding.saleQuote) || !std::isfinite(priceAfter_) || !std::isfinite(priceBefore_))
        refuse("The price of " + dateText(priceDay_) + " would be no number any more.");
}

NoteCompanyEvent* SplitPlan::apply() const
{
    if (splitsQuotes_)
        for (CompanyQuote* quote : company_->quotes().first(quotes_))
            quote->setValue(static_cast<float>(quote->getValue() * factor()));
    for (Share* share : company_->shares())
        share->removeAutomaticShareOperations();
    for (const Holding& holding : holdings_) {
        for (const Trade& trade : holding.trades) {
            trade.operation->setQuantity(trade.quantity);
            trade.operation->setQuote(trade.quote);
            trade.operation->setOperationCost(trade.cost);
        }
        if (holding.fraction > 0) {
            auto* sale = new ShareOperation(day_, holding.share, false, 1, holding.saleQuote, false, 0);
            sale->setAccount(holding.account); // from here on the account and the holding list it
        }
    }
    // For a second portfolio the note is there already.
    const String text = ratio().c_str();
    if (appliedNote_ != nullptr && appliedNote_->getText() == text)
        return nullptr;
    return new NoteCompanyEvent(company_, day_, kAppliedTitle, text);
}
