#include "exchange/OperationPlan.h"

#include "exchange/BookedOperations.h"
#include "exchange/Table.h"
#include "market/Catalogue.h"
#include "market/Currency.h"
#include "portfolio/DepositAccountOperation.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "portfolio/Wallet.h"

#include <algorithm>
#include <stdexcept>
#include <unordered_map>

namespace {

/// Makes operations in a wallet, and the holdings that they are the first of.
class Booker {
public:
    explicit Booker(Wallet& wallet) : wallet_(wallet)
    {
        // Of several holdings of a company the first one is meant, as a file is read.
        for (Share* share : wallet.shares())
            shares_.try_emplace(share->company(), share);
    }

    void book(const PlannedOperation& operation)
    {
        if (operation.isTrade())
            return bookTrade(operation);
        Account* account = operation.account->account;
        // Its account owns each of them.
        if (operation.kind == OperationKind::kDeposit)
            new DepositAccountOperation(operation.date, account, operation.amount, false);
        else
            bookTransfer(operation, account);
    }

private:
    void bookTransfer(const PlannedOperation& operation, Account* account)
    {
        const bool isIncome = operation.kind == OperationKind::kIncome;
        const bool isCharge = operation.kind == OperationKind::kCharge;
        Account* recipient = isIncome || isCharge ? account : operation.recipient->account;
        auto* transfer =
            new TransferAccountOperation(operation.date, account, recipient, isIncome ? 0 : operation.amount, false);
        transfer->setCost(isIncome ? -operation.amount : operation.cost);
        transfer->setRateCost(isCharge ? 1 : operation.rateCost);
        transfer->setFromCurrencyQuote(operation.fromQuote);
        transfer->setToCurrencyQuote(operation.toQuote);
    }

    void bookTrade(const PlannedOperation& operation)
    {
        Share*& share = shares_[operation.company];
        if (share == nullptr)
            share = new Share(&wallet_, operation.company); // the wallet owns it
        const bool isBuy = operation.kind == OperationKind::kBuy;
        auto* trade = new ShareOperation(operation.date, share, isBuy, operation.quantity, operation.quote, false,
                                         operation.cost);
        trade->setAccount(operation.account->account);
    }

    Wallet& wallet_;
    std::unordered_map<const Company*, Share*> shares_;
};

} // namespace

OperationPlan::OperationPlan(const StatementTable& table, const StatementProfile& profile,
                             const std::vector<NewAccount>& newAccounts, const Wallet& wallet,
                             const Catalogue& catalogue)
    : isNewestFirst_(table.isNewestFirst())
{
    // Of equal names the first one is meant, as everywhere.
    for (Account* account : wallet.accounts()) {
        const std::string name(account->getName().comparedBytes());
        accounts_.try_emplace(name, PlannedAccount{name, account, account->currency()});
    }
    for (const NewAccount& account : newAccounts)
        addNewAccount(account, catalogue);
    // The operations refer to the accounts, of which there will be no more.
    const OperationReader reader(table, profile, accounts_, catalogue);
    BookedOperations before(wallet);
    for (const StatementTable::Row& row : table.rows())
        try {
            const PlannedOperation operation = reader.read(row);
            (before.take(operation) ? booked_ : operations_).push_back(operation);
        } catch (const UntoldRow& reason) {
            refused_.push_back({row.line, reason.what(), reason.about});
        } catch (const UnusableRow& reason) {
            refused_.push_back({row.line, reason.what(), std::nullopt});
        }
}

void OperationPlan::addNewAccount(const NewAccount& account, const Catalogue& catalogue)
{
    Currency* currency = catalogue.getCurrencyByRepresentation(account.symbol.c_str());
    if (currency == nullptr)
        throw std::runtime_error("the market file has no currency " + shown(account.symbol) + " for the account " +
                                 shown(account.name));
    const auto [place, isNew] = accounts_.try_emplace(account.name, PlannedAccount{account.name, nullptr, currency});
    if (isNew)
        newAccounts_.push_back(&place->second);
    else if (place->second.currency == nullptr ||
             place->second.currency->getRepresentation() != currency->getRepresentation())
        throw std::runtime_error("there is an account " + shown(account.name) + " already, which is not in " +
                                 shown(account.symbol));
}

void OperationPlan::book(Wallet& wallet)
{
    for (const PlannedAccount* account : newAccounts_) {
        PlannedAccount& made = accounts_.find(account->name)->second;
        made.account = new Account(made.name.c_str()); // the wallet's from here on
        made.account->setWallet(&wallet);
        made.account->setCurrency(made.currency);
    }
    // Operations of one day stay in the order in which they are added.
    Booker booker(wallet);
    if (isNewestFirst_)
        std::for_each(operations_.rbegin(), operations_.rend(), [&](const auto& each) { booker.book(each); });
    else
        std::ranges::for_each(operations_, [&](const auto& each) { booker.book(each); });
}
