#include "exchange/OperationReader.h"

#include "exchange/TextForms.h"
#include "foundation/FoldedText.h"
#include "market/Catalogue.h"
#include "market/Company.h"
#include "market/Currency.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace {

/// As the files keep it. Throws for what they cannot keep.
float single(double value)
{
    constexpr double kLargest = std::numeric_limits<float>::max();
    const auto kept = static_cast<float>(std::abs(value) <= kLargest ? value : 0);
    if (value != 0 && kept == 0)
        throw UnusableRow(std::abs(value) > 1 ? "has a number that is too large" : "has a number that is too small");
    return kept;
}

/// Whether the amounts may differ by nothing but their rounding to cents.
bool areEqualToACent(double a, double b)
{
    constexpr double kCent = 0.011;
    return std::abs(a - b) <= kCent;
}

std::string symbolOf(const Currency* currency)
{
    return currency != nullptr ? shown(currency->getRepresentation().comparedBytes()) : "no currency";
}

} // namespace

OperationReader::OperationReader(const StatementTable& table, const StatementProfile& profile, const Accounts& accounts,
                                 const Catalogue& catalogue)
    : table_(table), profile_(profile), accounts_(accounts), companies_(catalogue)
{
    for (const Currency* currency : catalogue.getCurrencies()) {
        currencies_.try_emplace(foldedText(currency->getRepresentation().comparedBytes()), currency);
        currencies_.try_emplace(foldedText(currency->getName().comparedBytes()), currency);
    }
}

PlannedOperation OperationReader::read(const Row& row) const
{
    if (row.fields.empty())
        throw UnusableRow("has a quote that is not closed at the end of its field");
    PlannedOperation operation;
    operation.line = row.line;
    operation.date = table_.date(row);
    const StatementType type = typeOf(row);
    operation.account = &accountNamed(table_.cell(row, StatementColumn::kAccount));
    checkCurrency(table_.cell(row, StatementColumn::kCurrency), *operation.account);
    if (type == StatementType::kTransfer) {
        readTransfer(row, &operation);
    } else if (type == StatementType::kBuy || type == StatementType::kSell) {
        operation.kind = type == StatementType::kBuy ? OperationKind::kBuy : OperationKind::kSell;
        readTrade(row, &operation);
    } else {
        readCash(row, type, &operation);
    }
    return operation;
}

StatementType OperationReader::typeOf(const Row& row) const
{
    const std::string word(table_.cell(row, StatementColumn::kType));
    if (word.empty())
        throw UnusableRow("has no type");
    if (const auto type = profile_.typeOf(word))
        return *type;
    throw UntoldRow("the type " + shown(word) + " is not known", UntoldRow::About::kType);
}

const PlannedAccount& OperationReader::accountNamed(std::string_view name) const
{
    if (name.empty())
        name = profile_.account();
    if (name.empty())
        throw UntoldRow("names no account", UntoldRow::About::kAccount);
    const auto found = accounts_.find(name);
    if (found == accounts_.end())
        throw UntoldRow("there is no account " + shown(name), UntoldRow::About::kNewAccount);
    if (found->second.currency == nullptr)
        throw UnusableRow("the account " + shown(name) + " has no currency");
    return found->second;
}

void OperationReader::readCash(const Row& row, StatementType type, PlannedOperation* operation) const
{
    const double amount = neededAmount(row, *operation->account);
    const double size = std::abs(amount);
    if (type == StatementType::kDeposit || type == StatementType::kWithdrawal) {
        operation->kind = OperationKind::kDeposit;
        operation->amount = single(type == StatementType::kDeposit ? amount : 0 - size);
        return;
    }
    if (amount == 0)
        throw UnusableRow("has an amount of 0");
    // Interest and dividends that were taken back are charges.
    const bool isIncome = type == StatementType::kIncome && amount > 0;
    operation->kind = isIncome ? OperationKind::kIncome : OperationKind::kCharge;
    operation->amount = single(size);
}

void OperationReader::readTransfer(const Row& row, PlannedOperation* operation) const
{
    const std::string_view to = table_.cell(row, StatementColumn::kToAccount);
    if (to.empty())
        throw UnusableRow("names no account to transfer to");
    const PlannedAccount& from = *operation->account;
    operation->kind = OperationKind::kTransfer;
    operation->recipient = &accountNamed(to);
    // Within an account it would be a charge or nothing, and be taken for one once it is booked.
    if (operation->recipient == &from)
        throw UnusableRow("is a transfer to the account that it comes from");
    operation->amount = single(std::abs(neededAmount(row, from)));
    operation->cost = single(sizeOf(row, StatementColumn::kCost));
    operation->rateCost = single(sizeOf(row, StatementColumn::kRateCost));
    const bool isExchanged = from.currency != operation->recipient->currency;
    operation->fromQuote = exchangeQuote(row, StatementColumn::kFromQuote, from, isExchanged);
    operation->toQuote = exchangeQuote(row, StatementColumn::kToQuote, *operation->recipient, isExchanged);
}

/// The rate of the account's currency: what the line says, or else the market file on that day.
float OperationReader::exchangeQuote(const Row& row, StatementColumn column, const PlannedAccount& account,
                                     bool isExchanged) const
{
    double quote = 1;
    if (const auto figure = table_.figure(row, column))
        quote = figure->value;
    else if (isExchanged && account.currency->getNbrQuotes() == 0)
        throw UnusableRow("the market file has no rate of " + symbolOf(account.currency) + ", and the line has none");
    else if (isExchanged)
        quote = account.currency->getRealQuote(table_.date(row));
    if (!(quote > 0))
        throw UnusableRow("the rate of " + symbolOf(account.currency) + " is not above 0");
    return single(quote);
}

void OperationReader::readTrade(const Row& row, PlannedOperation* operation) const
{
    const PlannedAccount& account = *operation->account;
    operation->company =
        companies_.find(table_.cell(row, StatementColumn::kMarket), table_.cell(row, StatementColumn::kTicker),
                        table_.cell(row, StatementColumn::kName), account.currency);
    // By the symbols, as the window compares them.
    if (account.currency->getRepresentation() != operation->company->getCurrencyRepresentation())
        throw UnusableRow("the account " + shown(account.name) + " is in " + symbolOf(account.currency) +
                          ", the company in " + symbolOf(operation->company->market()->currency()));
    operation->quantity = quantityOf(row);
    const double cost = sizeOf(row, StatementColumn::kCost);
    const double costs = operation->kind == OperationKind::kBuy ? cost : -cost; // what they add to the amount
    operation->cost = single(cost);
    const auto quote = money(row, StatementColumn::kQuote, account);
    const auto amount = amountOf(row, account);
    if (quote && *quote < 0)
        throw UnusableRow("has a quote below 0");
    // A quote of 0 beside an amount was only filled in, unless the shares were for free.
    if (quote && (*quote != 0 || amount.value_or(0) == 0)) {
        operation->quote = single(*quote);
        if (amount && !areEqualToACent(std::abs(*amount), std::abs(*quote * operation->quantity + costs)))
            operation->otherAmount = std::abs(*amount);
        return;
    }
    if (!amount)
        throw UnusableRow("has neither a quote nor an amount");
    const double total = std::abs(*amount) - costs;
    if (!(total > 0))
        throw UnusableRow("has an amount that its cost uses up, so that nothing is left for the shares");
    operation->quote = single(total / operation->quantity);
}

int OperationReader::quantityOf(const Row& row) const
{
    const double quantity = sizeOf(row, StatementColumn::kQuantity);
    if (quantity == 0)
        throw UnusableRow("has no number of shares");
    if (quantity != std::floor(quantity))
        throw UnusableRow(shown(table_.cell(row, StatementColumn::kQuantity)) + " is no whole number of shares");
    if (quantity > std::numeric_limits<int>::max())
        throw UnusableRow("has a number of shares that is too large");
    return static_cast<int>(quantity);
}

double OperationReader::neededAmount(const Row& row, const PlannedAccount& account) const
{
    if (const auto amount = amountOf(row, account))
        return *amount;
    throw UnusableRow("has no amount");
}

std::optional<double> OperationReader::amountOf(const Row& row, const PlannedAccount& account) const
{
    if (const auto amount = money(row, StatementColumn::kAmount, account))
        return amount;
    const auto debit = money(row, StatementColumn::kDebit, account);
    const auto credit = money(row, StatementColumn::kCredit, account);
    if (!debit && !credit)
        return std::nullopt;
    // The column says which way it went; some banks write the minus besides.
    return std::abs(credit.value_or(0)) - std::abs(debit.value_or(0));
}

std::optional<double> OperationReader::money(const Row& row, StatementColumn column,
                                             const PlannedAccount& account) const
{
    const auto figure = table_.figure(row, column);
    if (!figure)
        return std::nullopt;
    checkCurrency(figure->unit, account);
    return figure->value;
}

double OperationReader::sizeOf(const Row& row, StatementColumn column) const
{
    const auto figure = table_.figure(row, column);
    return figure ? std::abs(figure->value) : 0;
}

/// Money of another currency than the account's is refused, as far as `text` names one. The file need not have it: a
/// line in francs is none in euros, whether or not anybody keeps their rate.
void OperationReader::checkCurrency(std::string_view text, const PlannedAccount& account) const
{
    const std::string_view own = account.currency->getRepresentation().comparedBytes();
    if (text.empty() || text == own || text == account.currency->getName().comparedBytes())
        return;
    bool isOther = false;
    const auto found = text != "GBp" ? currencies_.find(foldedText(text)) : currencies_.end(); // pence, not pounds
    if (found != currencies_.end()) {
        isOther = found->second->getRepresentation() != account.currency->getRepresentation();
    } else if (currencyCodesOf(own) == own) {
        // An account may be in what no code stands for; then nothing is known of it.
        const std::vector<std::string_view> codes = splitAtBlanks(currencyCodesOf(text));
        isOther = !codes.empty() && std::ranges::find(codes, own) == codes.end();
    }
    if (isOther)
        throw UnusableRow("is in " + shown(text) + ", but the account " + shown(account.name) + " is in " +
                          symbolOf(account.currency));
}
