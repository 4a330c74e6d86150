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
    for (Date day = first; day < end; day + 1)
        days_.push_back(day);
    events_.resize(days_.size());

    unsigned nAccounts;
    Account** accounts = wallet.getAllAccounts(&nAccounts);
    accounts_.assign(accounts, accounts + nAccounts);
    cash_.resize(nAccounts); // the events point into it: it must not grow later
    // The order in which a state moves cash: every account's own moves, then holding by holding, then what is
    // automatic.
    for (std::size_t i = 0; i < nAccounts; ++i) {
        accountIndex_.emplace(accounts_[i], i);
        takeOwnMoves(i);
        takeReceivedTransfers(i, false);
    }
    unsigned nShares;
    Share** shares = wallet.getAllShares(&nShares);
    lines_.reserve(nShares);
    for (unsigned i = 0; i < nShares; ++i)
        takeShare(*shares[i]);
    for (std::size_t i = 0; i < nAccounts; ++i)
        takeReceivedTransfers(i, true);
}

/// The first day on which an operation of that date counts; the number of days when it never does.
std::size_t DailyStates::dayOf(const Date& date) const
{
    if (days_.empty() || date <= days_.front())
        return 0;
    if (date.isValid())
        return std::min(static_cast<std::size_t>(date - days_.front().date()), days_.size());
    return static_cast<std::size_t>(std::lower_bound(days_.begin(), days_.end(), PackedDate(date)) - days_.begin());
}

void DailyStates::takeMove(const Operation& operation, Ledger& ledger, double amount)
{
    const std::size_t day = dayOf(operation.getDate());
    if (day == days_.size())
        return;
    events_[day].push_back({&ledger, ledger.addMove(amount)});
}

void DailyStates::takeOwnMoves(std::size_t account)
{
    Currency* currency;
    if (accounts_[account]->getCurrency(&currency) != 0)
        return;
    unsigned n;
    Operation** operations = accounts_[account]->getAllOperations(&n);
    for (unsigned i = 0; i < n; ++i) {
        const Operation& operation = *operations[i];
        firstOperationDate_ = std::min(firstOperationDate_, operation.getDate());
        const short type = operation.getType();
        if (type == Operation::kDeposit)
            takeMove(operation, deposits_, depositInReference(operation, *currency));
        if (type == Operation::kDeposit || type == Operation::kTransfer)
            takeMove(operation, cash_[account], ownCashMove(operation));
    }
}

void DailyStates::takeReceivedTransfers(std::size_t account, bool automatic)
{
    Currency* currency;
    if (accounts_[account]->getCurrency(&currency) != 0)
        return;
    unsigned n;
    TransferAccountOperation** transfers = accounts_[account]->getAllTransferOperations(&n);
    for (unsigned i = 0; i < n; ++i) {
        firstOperationDate_ = std::min(firstOperationDate_, transfers[i]->getDate());
        if (transfers[i]->isAutomatic() == automatic)
            takeMove(*transfers[i], cash_[account], receivedCash(*transfers[i]));
    }
}

void DailyStates::takeShare(Share& share)
{
    Line& line = lines_.emplace_back();
    line.share = &share;
    unsigned n;
    ShareOperation** operations = share.getAllShareOperations(&n);
    for (unsigned i = 0; i < n; ++i) {
        const ShareOperation& operation = *operations[i];
        firstOperationDate_ = std::min(firstOperationDate_, operation.getDate());
        line.operations.emplace_back(dayOf(operation.getDate()), &operation);
        Account* account;
        operation.getAccount(&account);
        const auto found = accountIndex_.find(account);
        if (found == accountIndex_.end()) // none, or one of another wallet: it moves no cash here
            continue;
        const float amount = operation.isBuy() ? -purchaseCost(operation, wallet_) : saleProceeds(operation, wallet_);
        takeMove(operation, cash_[found->second], amount);
    }
    if (Company * company; share.getCompany(&company) == 0)
        line.walk.emplace(*company);
    share.reserveShareStates(share.getNbrShareStates() + static_cast<unsigned>(days_.size()));
}

/// The company's real quote of that day and those behind it.
void DailyStates::takeQuotesFrom(std::size_t day)
{
    const std::size_t count = std::min(kDaysAhead, days_.size() - day);
    for (Line& line : lines_)
        if (line.walk)
            for (std::size_t i = 0; i < count; ++i)
                line.quotes[i] = line.walk->realQuote(days_[day + i]);
}

void DailyStates::build()
{
    for (std::size_t day = 0; day < days_.size(); ++day)
        buildDay(day);
}

void DailyStates::buildDay(std::size_t day)
{
    if (day % kDaysAhead == 0)
        takeQuotesFrom(day);
    for (const Event& event : events_[day])
        event.ledger->happen(event.rank);

    auto* state = new State(&wallet_, days_[day].date()); // owned by the wallet, and the others by it
    state->setFirstOperationDate(firstOperationDate_);
    state->setTotalDeposit(deposits_.balance());
    state->accountStates_.reserve(static_cast<unsigned>(accounts_.size()));
    for (std::size_t i = 0; i < accounts_.size(); ++i)
        new AccountState(accounts_[i], state, cash_[i].balance());
    state->shareStates_.reserve(static_cast<unsigned>(lines_.size()));
    for (Line& line : lines_) {
        for (; line.replayed < line.operations.size() && line.operations[line.replayed].first <= day; ++line.replayed) {
            const ShareOperation& operation = *line.operations[line.replayed].second;
            if (operation.isBuy())
                line.holding.buy(operation, wallet_.getInvestementPeriod());
            else
                line.holding.sell(operation);
        }
        new ShareState(*line.share, *state, line.holding, line.quotes[day % kDaysAhead]);
    }
}
