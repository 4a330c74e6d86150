#include "valuation/AutomaticSale.h"

#include "market/Company.h"
#include "portfolio/Account.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "portfolio/Wallet.h"

#include <algorithm>
#include <cmath>
#include <iterator>
#include <vector>

namespace {

// The period is a 16-bit number of days, so a longer way to the end date only comes from corrupt operations, whose end
// date can lie millions of years ahead: the search then gives up and sells at the end.
constexpr int kLongestSearch = 100000;

double limitAt(double begin, double end, int daysLeft, double period, double buyQuote)
{
    return (end - (end - begin) * daysLeft / period) * buyQuote;
}

Date dayAfter(const Date& start, int days)
{
    Date date = start;
    return date.moveBy(days);
}

/// Days from `start` to the first one that is not before `end`, kLongestSearch at most.
int daysBefore(const Date& end, const Date& start)
{
    int low = 0;
    if (!start.isValid()) { // on its way to a real date it may pass the end and come back: it has to be walked
        for (Date date = start; low < kLongestSearch && date < end; date + 1)
            ++low;
        return low;
    }
    int high = kLongestSearch;
    while (low < high) {
        const int middle = low + (high - low) / 2;
        if (dayAfter(start, middle) < end)
            low = middle + 1;
        else
            high = middle;
    }
    return low;
}

/// Whether a > b is possible on a day from one to another, given both on these two days. In between, each goes one way
/// only or is no number where it is none on both.
bool canExceed(double a0, double a1, double b0, double b1)
{
    if ((std::isnan(a0) && std::isnan(a1)) || (std::isnan(b0) && std::isnan(b1)))
        return false;
    const bool isUnknown = std::isnan(a0) || std::isnan(a1) || std::isnan(b0) || std::isnan(b1);
    return isUnknown || std::max(a0, a1) > std::min(b0, b1);
}

/// What is marked as automatic by hand has an account, which the next valuation takes it from.
bool isSimulated(const ShareOperation* operation)
{
    return operation->isAutomatic() && operation->account() == nullptr;
}

} // namespace

Date firstSimulatedSale(const Wallet& wallet)
{
    Date first;
    for (const Share* share : wallet.shares()) {
        // By date, so the first one of each holding is enough.
        const auto operations = share->shareOperations();
        const auto found = std::ranges::find_if(operations, isSimulated);
        if (found != operations.end() && (first.isUndefined() || (*found)->getDate() < first))
            first = (*found)->getDate();
    }
    return first;
}

void removeSimulatedSales(Wallet& wallet)
{
    for (const Share* share : wallet.shares()) {
        std::vector<ShareOperation*> simulated;
        std::ranges::copy_if(share->shareOperations(), std::back_inserter(simulated), isSimulated);
        for (ShareOperation* sale : simulated)
            delete sale;
    }
}

AutomaticSale::AutomaticSale(Share& share, Wallet& wallet, const Holding& holding)
    : share_(share), wallet_(wallet), holding_(holding)
{}

AutomaticSale::Day AutomaticSale::dayAt(const Date& stateDate, int number) const
{
    const Date date = dayAfter(stateDate, number);
    const int daysLeft = holding_.endDate.date() - date;
    const double period = wallet_.getInvestementPeriod();
    const double buyQuote = holding_.buyQuote;
    return {number, date.isValid(), share_.getPrevisionQuote(date),
            limitAt(wallet_.getBeginLoseSellRate(), wallet_.getEndLoseSellRate(), daysLeft, period, buyQuote),
            limitAt(wallet_.getBeginProfitSellRate(), wallet_.getEndProfitSellRate(), daysLeft, period, buyQuote)};
}

AutomaticSale::Outcome AutomaticSale::judge(const Day& day)
{
    if (day.lossLimit > day.prevision)
        return Outcome::kLoss;
    return day.profitLimit < day.prevision ? Outcome::kProfit : Outcome::kHold;
}

/// The first day from `first` to `last` on which the holding is sold, else `last`.
///
/// Trend and limits are straight lines, and rounding keeps their order. So most spans of days without a sale can be
/// told from their two ends: the search takes steps in proportion to the logarithm of the days, not to the days, whose
/// number comes from files. From an impossible state date on, the lines begin with the first real day.
AutomaticSale::Day AutomaticSale::firstSale(const Date& stateDate, const Day& first, const Day& last) const
{
    if (judge(first) != Outcome::kHold)
        return first;
    const bool canSell = first.isReal != last.isReal ||
                         canExceed(first.lossLimit, last.lossLimit, first.prevision, last.prevision) ||
                         canExceed(first.prevision, last.prevision, first.profitLimit, last.profitLimit);
    if (!canSell || last.number - first.number <= 1)
        return last;
    // The half with the earlier days is searched first. Where it ends without a sale, its last day is the first one of
    // the other half.
    const Day middle = dayAt(stateDate, first.number + (last.number - first.number) / 2);
    const Day sale = firstSale(stateDate, first, middle);
    return judge(sale) != Outcome::kHold ? sale : firstSale(stateDate, middle, last);
}

void AutomaticSale::make(const Date& stateDate, Account* sellingAccount)
{
    Outcome outcome = Outcome::kHold;
    Date date = holding_.endDate.date();
    // A holding whose end date has passed is sold on that date: then there is no day to search.
    if (const int days = daysBefore(date, stateDate); days > 0) {
        const Day day = firstSale(stateDate, dayAt(stateDate, 0), dayAt(stateDate, days - 1));
        outcome = judge(day);
        // Intended: at the end of the horizon the holding is sold whatever the trend, and no gain is transferred.
        if (outcome != Outcome::kHold)
            date = dayAfter(stateDate, day.number);
    }
    const float quote = share_.getPrevisionQuote(date);
    // Owned by the holding. Intended: without an account, so it is no part of any balance, is not written to the
    // portfolio file, and stays when the accounts' automatic operations are removed.
    new ShareOperation(date, &share_, false, holding_.quantity, quote, true, wallet_.getSellCost());
    if (outcome == Outcome::kProfit)
        transferGain(date, quote, sellingAccount);
}

void AutomaticSale::transferGain(const Date& date, float quote, Account* sellingAccount)
{
    if (sellingAccount == nullptr || share_.company() == nullptr)
        return;
    Account* recipient = wallet_.findDefaultTransferAccount(share_.company()->getCurrencyRepresentation());
    if (recipient == nullptr || recipient == sellingAccount)
        return;
    const double h = holding_.quantity;
    // What the sale brings and what the purchase cost, each with its proportional and its fixed cost.
    const double proceeds = quote * h * (1.0 - wallet_.getSellRateCost()) - wallet_.getSellCost();
    const double gain = proceeds - holding_.buyQuote * h * (1.0 + wallet_.getBuyRateCost()) - wallet_.getBuyCost();
    // A gain that the costs have used up is none to share.
    if (gain > 0) {
        const auto amount = static_cast<float>((1.0 - wallet_.getReinvestRate()) * gain);
        new TransferAccountOperation(date, sellingAccount, recipient, amount, true); // owned by the selling account
    }
}
