#include "valuation/CashFlows.h"

#include "market/Catalogue.h"
#include "market/Currency.h"
#include "portfolio/Account.h"
#include "portfolio/Wallet.h"
#include "valuation/CashMoves.h"

#include <algorithm>

namespace {

/// The first real day that is not before `date` in the order of dates.
Date realDay(const Date& date)
{
    if (date.isValid())
        return date;
    const short month = date.getMonth();
    if (month < 1)
        return {1, 1, date.getYear()};
    if (month > 12)
        return {1, 1, date.getYear() + 1};
    if (date.getDay() < 1)
        return {1, month, date.getYear()};
    return month < 12 ? Date(1, static_cast<short>(month + 1), date.getYear()) : Date(1, 1, date.getYear() + 1);
}

/// One flow for each deposit.
std::vector<CashFlow> flowsOf(const Wallet& wallet, const Currency& reference, const Date& end)
{
    std::vector<CashFlow> flows;
    for (const Account* account : wallet.accounts()) {
        const Currency* currency = account->currency();
        if (currency == nullptr)
            continue; // such an account is not replayed
        for (const Operation* operation : account->operations()) {
            const Date& date = operation->getDate();
            if (date > end)
                break;
            const double rate = operation->getType() == Operation::kDeposit ? reference.getRealQuote(date) : 0;
            if (rate == 0)
                continue;
            const double amount = depositInReference(*operation, *currency) / rate;
            flows.push_back({realDay(date), std::max(amount, 0.0), std::max(-amount, 0.0)});
        }
    }
    return flows;
}

} // namespace

std::vector<CashFlow> cashFlows(const Wallet& wallet, const Catalogue& catalogue, const Date& end)
{
    if (catalogue.getReferenceCurrency() == nullptr)
        return {};
    std::vector<CashFlow> flows = flowsOf(wallet, *catalogue.getReferenceCurrency(), end);
    std::ranges::stable_sort(flows, {}, &CashFlow::date);
    std::vector<CashFlow> days;
    for (const CashFlow& flow : flows) {
        if (days.empty() || days.back().date != flow.date)
            days.push_back({flow.date});
        days.back().deposited += flow.deposited;
        days.back().withdrawn += flow.withdrawn;
    }
    return days;
}
