// The transactions of a journal. JournalPrices.cpp has the prices.

#include "exchange/Journal.h"

#include "exchange/JournalText.h"
#include "exchange/TableText.h"
#include "exchange/UniqueNames.h"
#include "foundation/DateText.h"
#include "foundation/PrintableText.h"
#include "market/Catalogue.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "portfolio/CashMove.h"
#include "portfolio/DepositAccountOperation.h"
#include "portfolio/OperationKind.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "portfolio/Wallet.h"
#include "valuation/AccountState.h"
#include "valuation/ShareState.h"
#include "valuation/State.h"
#include "valuation/Totals.h"

#include <algorithm>
#include <cmath>
#include <stdexcept>
#include <unordered_set>

namespace {

constexpr const char* kDeposits = "Equity:Deposits";
constexpr const char* kExchange = "Equity:Exchange";
constexpr const char* kRounding = "Equity:Rounding";
constexpr const char* kTotalRounding = "Assets:Rounding";
constexpr const char* kIncome = "Income:Received";
constexpr const char* kCharges = "Expenses:Charges";
constexpr const char* kFees = "Expenses:Fees";

constexpr const char* kTheRest = ""; // no amount: what the other postings leave

/// The companies of the holdings, or all where the wallet is empty.
std::vector<const Company*> companiesOf(const Catalogue& catalogue, const Wallet& wallet)
{
    std::vector<const Company*> companies;
    std::unordered_set<const Company*> taken;
    for (const Share* share : wallet.shares())
        if (share->company() != nullptr && taken.insert(share->company()).second)
            companies.push_back(share->company());
    if (wallet.getNbrShares() + wallet.getNbrAccounts() == 0)
        for (const Market* market : catalogue.getMarkets())
            companies.insert(companies.end(), market->companies().begin(), market->companies().end());
    return companies;
}

/// The manual operations that the replay counts, up to `day`, by date. Trades are those of the holdings.
std::vector<const Operation*> operationsOf(const Wallet& wallet, const Date& day)
{
    std::vector<const Operation*> operations;
    const auto take = [&](const Operation* operation) {
        if (!operation->isAutomatic() && operation->getDate() <= day)
            operations.push_back(operation);
    };
    for (const Account* account : wallet.accounts())
        for (const Operation* operation : account->operations())
            if (operation->getType() == Operation::kDeposit || operation->getType() == Operation::kTransfer)
                take(operation);
    for (const Share* share : wallet.shares())
        for (const ShareOperation* trade : share->shareOperations())
            take(trade);
    std::ranges::stable_sort(operations, {}, &Operation::getDate);
    return operations;
}

/// What a person calls the operation in a message.
std::string described(const Operation& operation)
{
    const std::string day = operation.getDate().toString().getCharacterArray();
    const Account* account = operation.account();
    const std::string place = account != nullptr ? " on " + printable(account->getName().bytes()) : std::string();
    return std::string("the ") + nameOf(kindOf(operation)) + " of " + day + place;
}

std::string nameText(const String& name)
{
    return cleanName(name.bytes());
}

/// What the total of the state has beyond the values of its holdings and accounts, in the reference currency.
double totalRounding(const Catalogue& catalogue, const State& state)
{
    const Totals totals(state, catalogue);
    const double referenceRate = totals.isKnown ? totals.reference->getRealQuote(state.getDate()) : 0;
    if (referenceRate == 0)
        return 0;
    double sum = 0;
    const auto add = [&](double amount, const String& symbol) {
        if (const Currency* currency = catalogue.getCurrencyByRepresentation(symbol))
            sum += amount * currency->getRealQuote(state.getDate()) / referenceRate;
    };
    for (const ShareState* holding : state.shareStates())
        add(holding->worth(), holding->getCurrencyRepresentation());
    for (const AccountState* account : state.accountStates())
        add(account->getCash(), account->getCurrencyRepresentation());
    return totals.totalValue - sum;
}

bool areOfOneSymbol(const Currency& a, const Currency& b)
{
    return &a == &b || a.getRepresentation() == b.getRepresentation();
}

} // namespace

Journal::Journal(const Catalogue& catalogue, const Wallet& wallet, const State& state, const JournalForm& form)
    : catalogue_(catalogue), wallet_(wallet), state_(state), form_(form), day_(state.getDate()),
      companies_(companiesOf(catalogue, wallet)), names_(catalogue, wallet, companies_, form)
{
    if (!isWithin(day_))
        throw std::runtime_error(dateText(day_) + ": no journal of this kind has such a day");
    for (const Account* account : wallet.accounts())
        cash_.emplace(account, 0);
    for (const Operation* operation : operationsOf(wallet, day_))
        addOperation(*operation);
    addRoundings();
    addPrices();
}

bool Journal::isWithin(const Date& date) const
{
    return date.isValid() && date.getYear() >= form_.firstYear() && date.getYear() <= form_.lastYear();
}

void Journal::addOperation(const Operation& operation)
{
    if (!isWithin(operation.getDate()))
        throw std::runtime_error(described(operation) + " has a day that no journal of this kind can have");
    Transaction transaction{operation.getDate(), nameOf(kindOf(operation)), {}};
    if (operation.getType() == Operation::kTransfer)
        addTransfer(static_cast<const TransferAccountOperation&>(operation), &transaction);
    else if (operation.getType() != Operation::kDeposit)
        addTrade(static_cast<const ShareOperation&>(operation), &transaction);
    else {
        const Units amount = unitsOf(ownCashMove(operation), operation);
        if (amount < 0)
            transaction.text = "Withdrawal";
        move(*operation.account(), amount, &transaction);
        post(&transaction, kDeposits, kTheRest);
    }
    if (!transaction.postings.empty())
        transactions_.push_back(std::move(transaction));
}

void Journal::addTransfer(const TransferAccountOperation& transfer, Transaction* transaction)
{
    const Account& from = *transfer.account();
    const Account* to = transfer.recipient();
    if (to == &from) {
        const OperationKind kind = kindOf(transfer);
        move(from, unitsOf(cashMove(transfer, from), transfer), transaction);
        post(transaction,
             kind == OperationKind::kIncome   ? kIncome
             : kind == OperationKind::kCharge ? kCharges
                                              : kFees,
             kTheRest);
        return;
    }
    const Units sent = -unitsOf(ownCashMove(transfer), transfer);
    const Units received = to != nullptr ? unitsOf(receivedCash(transfer), transfer) : 0;
    move(from, -sent, transaction);
    if (to != nullptr) {
        transaction->text += " to " + nameText(to->getName());
        move(*to, received, transaction);
    }
    if (to == nullptr || to->currency() == nullptr || from.currency() == nullptr) {
        post(transaction, kExchange, kTheRest); // one of them has no cash that counts
        return;
    }
    if (areOfOneSymbol(*from.currency(), *to->currency())) {
        if (sent != received)
            post(transaction, kFees, kTheRest);
        return;
    }
    // What the exchange keeps is in the sender's currency, and so is what it is given.
    const std::string& given = names_.ofCurrency(from.getCurrencyRepresentation());
    const Units fee = unitsOf(transfer.getTotalCost(), transfer);
    if (fee != 0)
        post(transaction, kFees, amount(fee, given));
    post(transaction, kExchange, amount(sent - fee, given));
    post(transaction, kExchange, amount(-received, names_.ofCurrency(to->getCurrencyRepresentation())));
}

void Journal::addTrade(const ShareOperation& trade, Transaction* transaction)
{
    const Company* company = trade.share()->company();
    const Account* account = cash_.contains(trade.account()) ? trade.account() : nullptr;
    const Units cash = account != nullptr ? unitsOf(cashMove(trade, *account), trade) : 0;
    const Currency* currency =
        company != nullptr && company->market() != nullptr ? company->market()->currency() : nullptr;
    const bool isPriced = currency != nullptr && account != nullptr && account->currency() != nullptr &&
                          areOfOneSymbol(*currency, *account->currency()) && std::isfinite(trade.getQuote()) &&
                          trade.getQuote() > 0;
    if (company != nullptr) {
        const std::string& shares = form_.inAmount(names_.of(*company));
        const long long quantity = trade.isBuy() ? trade.getQuantity() : -static_cast<long long>(trade.getQuantity());
        transaction->text += ' ' + std::to_string(trade.getQuantity()) + ' ' + nameText(company->getName());
        std::string held = std::to_string(quantity) + ' ' + shares;
        if (isPriced)
            held += " @ " + journalNumber(trade.getQuote()) + ' ' +
                    form_.inAmount(names_.ofCurrency(currency->getRepresentation()));
        post(transaction, names_.holdingOf(*company), held);
        if (!isPriced)
            post(transaction, kExchange, std::to_string(-quantity) + ' ' + shares);
    }
    if (account == nullptr || account->currency() == nullptr)
        return;
    move(*account, cash, transaction);
    post(transaction, isPriced ? kFees : kExchange,
         isPriced ? kTheRest : amount(-cash, names_.ofCurrency(account->getCurrencyRepresentation())));
}

/// What the accounts have on the day beyond the moves of the transactions, and the total beyond its parts: a replay
/// rounds every sum to a float.
void Journal::addRoundings()
{
    Transaction transaction{day_, "Rounding of the sums in Pelorin", {}};
    for (const AccountState* state : state_.accountStates()) {
        const Account& account = *state->account();
        if (account.currency() == nullptr)
            continue;
        if (!std::isfinite(state->getCash()))
            throw std::runtime_error("the cash of " + printable(account.getName().bytes()) + " is no number");
        addRounding(names_.of(account), state->getCash() - static_cast<double>(cash_.at(&account)) / kUnitsInOne,
                    account.getCurrencyRepresentation(), &transaction);
    }
    // Beyond a hundred thousand a float has hardly a cent, and the sum of many holdings may lack two.
    const Currency* reference = catalogue_.getReferenceCurrency();
    if (const double lost = totalRounding(catalogue_, state_); reference != nullptr && std::isfinite(lost))
        addRounding(kTotalRounding, lost, reference->getRepresentation(), &transaction);
    if (!transaction.postings.empty())
        transactions_.push_back(std::move(transaction));
}

void Journal::addRounding(const std::string& account, double difference, const String& symbol, Transaction* transaction)
{
    constexpr int kDecimals = 8;
    const std::string digits = fixedText(difference, kDecimals);
    if (digits == fixedText(0, kDecimals))
        return;
    const std::string& commodity = form_.inAmount(names_.ofCurrency(symbol));
    post(transaction, account, digits + ' ' + commodity);
    post(transaction, kRounding, fixedText(-difference, kDecimals) + ' ' + commodity);
}

Journal::Units Journal::unitsOf(double amount, const Operation& operation) const
{
    // Beyond this a double has no cents.
    constexpr double kMost = 1e13;
    if (!(std::abs(amount) <= kMost))
        throw std::runtime_error(described(operation) + " moves an amount that is too large for a journal");
    return std::llround(amount * kUnitsInOne);
}

void Journal::move(const Account& account, Units units, Transaction* transaction)
{
    if (account.currency() == nullptr)
        return; // such an account is not replayed
    if (Units& cash = cash_[&account]; __builtin_add_overflow(cash, units, &cash))
        throw std::runtime_error("the account " + names_.of(account) + " has too much cash for a journal");
    post(transaction, names_.of(account), amount(units, names_.ofCurrency(account.getCurrencyRepresentation())));
}

std::string Journal::amount(Units units, const std::string& commodity) const
{
    return moneyText(units) + ' ' + form_.inAmount(commodity);
}

void Journal::post(Transaction* transaction, const std::string& account, const std::string& amount)
{
    opened_.try_emplace(account, transaction->date);
    transaction->postings += "    " + account + (amount.empty() ? "" : "  ") + amount + '\n';
}

void Journal::write(FILE* file) const
{
    const auto put = [file](const std::string& text) { std::fwrite(text.data(), 1, text.size(), file); };
    const Currency* reference = catalogue_.getReferenceCurrency();
    put(form_.head() + '\n' +
        form_.preamble(reference != nullptr ? names_.ofCurrency(reference->getRepresentation()) : "") + '\n');
    for (const Currency* currency : currencies_)
        put(form_.commodity(names_.ofCurrency(currency->getRepresentation()), true, nameText(currency->getName())));
    for (const Company* company : companies_)
        put(form_.commodity(names_.of(*company), false,
                            nameText(company->getName()) +
                                (company->market() != nullptr ? ", " + nameText(company->market()->getName()) : "")));
    put("\n");
    for (const auto& [account, day] : opened_)
        put(form_.openAccount(tableDate(day), account));
    for (const Transaction& transaction : transactions_)
        put('\n' + form_.transaction(tableDate(transaction.date), transaction.text) + transaction.postings);
    // Behind the transactions: of a day that has both, the price counts, and not what a trade has paid.
    put('\n' + priceText_);
}
