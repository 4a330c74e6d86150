#include "valuation/DailyStates.h"

#include "market/Company.h"
#include "market/Currency.h"
#include "portfolio/Account.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "portfolio/Wallet.h"
#include "valuation/AccountState.h"
#include "valuation/CashMoves.h"
#include "valuation/ShareState.h"
#include "valuation/State.h"

#include <algorithm>

DailyStates::DailyStates(Wallet& wallet, const Date& first, const Date& end)
    : wallet_(wallet), firstOperationDate_(State::afterAllOperations())
{
    wallet.removeAutomaticOperations();
    // `days_` is in ascending order without a gap, so that a day's index is its distance from the first.
    for (Date day = first; day < end; day + 1)
        days_.push_back(day);
    events_.resize(days_.size());

    accounts_.assign(wallet.accounts().begin(), wallet.accounts().end());
    cash_.resize(accounts_.size()); // the events point into it: it must not grow later
    // The order in which a state moves cash: every account's own moves, then holding by holding, then what is
    // automatic.
    for (std::size_t i = 0; i < accounts_.size(); ++i) {
        accountIndex_.emplace(accounts_[i], i);
        takeOwnMoves(i);
        takeReceivedTransfers(i, false);
    }
    // From here on every own and received move has its rank. The trades get theirs behind them, holding by holding.
    lines_.reserve(wallet.getNbrShares());
    for (Share* share : wallet.shares())
        takeShare(*share);
    for (std::size_t i = 0; i < accounts_.size(); ++i)
        takeReceivedTransfers(i, true);
}

/// The first day on which an operation of that date counts; the number of days when it never does.
std::size_t DailyStates::dayOf(const Date& date) const
{
    if (days_.empty() || date <= days_.front())
        return 0;
    // Days have no gaps: the distance is the index. A date before `end` lies within them.
    if (date.isValid())
        return std::min(static_cast<std::size_t>(date - days_.front().date()), days_.size());
    // A date that no calendar has is at no distance, but it has its place in the order of dates.
    return static_cast<std::size_t>(std::lower_bound(days_.begin(), days_.end(), PackedDate(date)) - days_.begin());
}

void DailyStates::takeMove(const Operation& operation, Ledger& ledger, double amount)
{
    const std::size_t day = dayOf(operation.getDate());
    // It never happens in this evolution, so it needs no rank.
    if (day == days_.size())
        return;
    // The ranks of a ledger rise from call to call: the order of the calls is the order of its sum.
    events_[day].push_back({&ledger, ledger.addMove(amount)});
}

void DailyStates::takeOwnMoves(std::size_t account)
{
    // Of an account without currency the own moves do not count, as in a replay.
    const Currency* currency = accounts_[account]->currency();
    if (currency == nullptr)
        return;
    for (const Operation* operation : accounts_[account]->operations()) {
        firstOperationDate_ = std::min(firstOperationDate_, operation->getDate());
        const short type = operation->getType();
        if (type == Operation::kDeposit)
            takeMove(*operation, deposits_, depositInReference(*operation, *currency));
        if (type == Operation::kDeposit || type == Operation::kTransfer)
            takeMove(*operation, cash_[account], ownCashMove(*operation));
    }
}

void DailyStates::takeReceivedTransfers(std::size_t account, bool automatic)
{
    if (accounts_[account]->currency() == nullptr)
        return;
    for (const TransferAccountOperation* transfer : accounts_[account]->transferOperations()) {
        firstOperationDate_ = std::min(firstOperationDate_, transfer->getDate());
        if (transfer->isAutomatic() == automatic)
            takeMove(*transfer, cash_[account], receivedCash(*transfer));
    }
}

void DailyStates::takeShare(Share& share)
{
    // The operations are sorted by date, so `line.operations` is in the order of days, too.
    Line& line = lines_.emplace_back();
    line.share = &share;
    for (const ShareOperation* operation : share.shareOperations()) {
        firstOperationDate_ = std::min(firstOperationDate_, operation->getDate());
        line.operations.emplace_back(dayOf(operation->getDate()), operation);
        const auto found = accountIndex_.find(operation->account());
        if (found == accountIndex_.end()) // none, or one of another wallet: it moves no cash here
            continue;
        const float amount =
            operation->isBuy() ? -purchaseCost(*operation, wallet_) : saleProceeds(*operation, wallet_);
        takeMove(*operation, cash_[found->second], amount);
    }
    line.operations.emplace_back(kNever, nullptr);
    line.nextDay = line.operations.front().first;
    // The walk begins before the first quote and is only asked for later and later days.
    if (share.company() != nullptr)
        line.walk.emplace(*share.company());
    share.reserveShareStates(share.getNbrShareStates() + static_cast<unsigned>(days_.size()));
}

void DailyStates::build()
{
    for (std::size_t day = 0; day < days_.size(); day += kDaysAtOnce)
        buildDays(day, std::min(day + kDaysAtOnce, days_.size()));
}

/// Builds the states of the days from `begin` up to `end`; all earlier ones have been built.
void DailyStates::buildDays(std::size_t begin, std::size_t end)
{
    State* states[kDaysAtOnce];
    for (std::size_t day = begin; day < end; ++day)
        states[day - begin] = newState(day);
    // Behind the accounts the holdings, as the replay makes them, and each state has its own in the wallet's order.
    for (Line& line : lines_)
        for (std::size_t day = begin; day < end; ++day) {
            if (line.nextDay <= day)
                replay(line, day);
            const float quote = line.walk ? line.walk->realQuote(days_[day]) : 0;
            new ShareState(*line.share, states[day - begin]->shareStates_, line.holding, quote);
        }
}

/// The state of that day, owned by the wallet, with its accounts and without its holdings.
State* DailyStates::newState(std::size_t day)
{
    // The ledgers hold what has happened up to the day before. After this loop they hold this day's moves, too, and a
    // balance is summed again only where one has changed.
    for (const Event& event : events_[day])
        event.ledger->happen(event.rank);

    auto* state = new State(&wallet_, days_[day].date());
    state->setFirstOperationDate(firstOperationDate_);
    state->setTotalDeposit(deposits_.balance());
    state->accountStates_.reserve(static_cast<unsigned>(accounts_.size()));
    for (std::size_t i = 0; i < accounts_.size(); ++i)
        new AccountState(accounts_[i], state, cash_[i].balance());
    state->shareStates_.reserve(static_cast<unsigned>(lines_.size()));
    return state;
}

/// Before: the holding has taken in the operations up to `replayed`. After: all those that count by this day.
void DailyStates::replay(Line& line, std::size_t day)
{
    Holding holding = *line.holding;
    for (; line.nextDay <= day; line.nextDay = line.operations[line.replayed].first) {
        const ShareOperation& operation = *line.operations[line.replayed++].second;
        if (operation.isBuy())
            holding.buy(operation, wallet_.getInvestementPeriod());
        else
            holding.sell(operation);
    }
    line.holding = SharedHolding(holding);
}
