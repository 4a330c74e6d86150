#include "tools/Reports.h"

#include "foundation/DateText.h"
#include "foundation/NumberText.h"
#include "foundation/PrintableText.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "portfolio/Account.h"
#include "portfolio/CashMove.h"
#include "portfolio/OperationKind.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "tools/TextTable.h"
#include "tools/Valuation.h"
#include "valuation/AccountState.h"
#include "valuation/ShareState.h"
#include "valuation/State.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <string>
#include <string_view>
#include <unordered_map>
#include <utility>
#include <vector>

namespace {

constexpr auto kRight = TextTable::Align::kRight;

std::string plain(const String& text)
{
    return printable(text.bytes());
}

/// An operation that a part of the report lists.
struct OperationLine {
    Date date;
    const char* type;
    std::string amount;
    std::string text;
};

void takeSales(const Share& share, std::vector<OperationLine>* lines)
{
    const Company* company = share.company();
    if (company == nullptr)
        return;
    for (const ShareOperation* sale : share.shareOperations()) {
        if (!sale->isAutomatic())
            continue;
        const std::string text = plain(company->getAbbreviation()) + " at " + amountText(sale->getQuote()) + ' ' +
                                 plain(company->getCurrencyRepresentation());
        lines->push_back({sale->getDate(), "sell", countText(sale->getQuantity()), text});
    }
}

void takeTransfers(const Account& account, std::vector<OperationLine>* lines)
{
    for (const Operation* operation : account.operations()) {
        const auto* transfer = dynamic_cast<const TransferAccountOperation*>(operation);
        if (transfer == nullptr || !transfer->isAutomatic() || transfer->recipient() == nullptr)
            continue;
        const std::string text = plain(account.getCurrencyRepresentation()) + " from " + plain(account.getName()) +
                                 " to " + plain(transfer->recipient()->getName());
        lines->push_back({transfer->getDate(), "transfer", amountText(transfer->getAmount()), text});
    }
}

/// Income and charges up to that day: they make the profit without a trade.
void takeMoves(const Account& account, const Date& day, std::vector<OperationLine>* lines)
{
    for (const Operation* operation : account.operations()) {
        const OperationKind kind = kindOf(*operation);
        if (operation->getDate() > day || (kind != OperationKind::kIncome && kind != OperationKind::kCharge))
            continue;
        const bool isIncome = kind == OperationKind::kIncome;
        const std::string text =
            plain(account.getCurrencyRepresentation()) + (isIncome ? " to " : " from ") + plain(account.getName());
        lines->push_back({operation->getDate(), isIncome ? "income" : "charge",
                          amountText(std::abs(cashMove(*operation, account))), text});
    }
}

/// By date, below a heading; empty without lines.
std::string listed(const char* heading, std::vector<OperationLine> lines)
{
    std::ranges::stable_sort(lines, {}, &OperationLine::date);
    TextTable table({{heading}, {""}, {"", kRight}, {""}});
    for (const OperationLine& line : lines)
        table.addRow({dateText(line.date), line.type, line.amount, line.text});
    return table.isEmpty() ? "" : '\n' + table.toString();
}

/// Writes each part as text. What cannot be told, because there is no reference currency or none of an amount's symbol,
/// is an empty cell; a part without rows is left out with its headings.
class Report {
public:
    explicit Report(const Valuation& valuation)
        : valuation_(valuation), reference_(valuation.catalogue().getReferenceCurrency())
    {
        if (reference_ != nullptr)
            referenceSymbol_ = plain(reference_->getRepresentation());
        for (const Currency* currency : valuation.catalogue().getCurrencies())
            bySymbol_.try_emplace(currency->getRepresentation().comparedBytes(), currency);
    }

    std::string make() const
    {
        std::string text = header() + totals() + accounts() + holdings() + gains() + moves() + automaticOperations();
        return valuation_.hasEvolution() ? text + evolution() : text;
    }

private:
    std::string header() const
    {
        const std::string day = "Portfolio on " + dateText(valuation_.state().getDate());
        if (reference_ == nullptr)
            return day + ", without totals: the market file has no reference currency\n";
        return day + ", in " + plain(reference_->getName()) + " (" + referenceSymbol_ + ")\n";
    }

    std::string totals() const
    {
        const Totals totals = valuation_.totals();
        TextTable table({{""}, {"", kRight}, {""}});
        if (totals.isKnown) {
            table.addRow({"Total Deposit", amountText(totals.totalDeposit), referenceSymbol_});
            table.addRow({"Total Value", amountText(totals.totalValue), referenceSymbol_});
            table.addRow({"Profit", amountText(totals.profit), referenceSymbol_});
            table.addRow({"Annual Revenu", amountText(totals.annualRevenue * 100.0), "%"});
            addReturn("Money-weighted return", valuation_.returns().moneyWeighted, &table);
            addReturn("Time-weighted return", valuation_.returns().timeWeighted, &table);
        }
        // The state gives a day after all others where there is no operation.
        const Date first = valuation_.state().getFirstOperationDate();
        table.addRow({"First operation", first == State::afterAllOperations() ? "none" : dateText(first), ""});
        return table.toString();
    }

    static void addReturn(const char* what, const AnnualReturn& annual, TextTable* table)
    {
        if (annual.isKnown())
            table->addRow({what, amountText(annual.rate * 100), "%"});
        else
            table->addRow({what, annual.reason(), ""});
    }

    /// An amount in the currency of that symbol, in the reference currency; empty when that has no answer.
    std::string inReference(double amount, const String& symbol) const
    {
        const auto currency = bySymbol_.find(symbol.comparedBytes());
        if (reference_ == nullptr || currency == bySymbol_.end())
            return {};
        const Date& day = valuation_.state().getDate();
        return amountText(amount * currency->second->getRealQuote(day) / reference_->getRealQuote(day));
    }

    std::string accounts() const
    {
        TextTable table({{"Account"}, {"Cash", kRight}, {""}, {valueHeading(), kRight}, {""}});
        for (const AccountState* state : valuation_.state().accountStates()) {
            const String& symbol = state->getCurrencyRepresentation();
            const Account* account = state->account();
            const bool isDefault = account != nullptr && account->isDefaultTransferAccount();
            table.addRow({plain(state->getAccountName()), amountText(state->getCash()), plain(symbol),
                          inReference(state->getCash(), symbol), isDefault ? "default transfer account" : ""});
        }
        return table.isEmpty() ? "" : '\n' + table.toString();
    }

    std::string holdings() const
    {
        TextTable table({{"Holding"},
                         {"Ticker"},
                         {"Market"},
                         {"Quantity", kRight},
                         {"Bought at", kRight},
                         {"Quote", kRight},
                         {""},
                         {"Gain", kRight},
                         {valueHeading(), kRight},
                         {"End date"}});
        for (const ShareState* state : valuation_.state().shareStates()) {
            const Share* share = state->share();
            const String& symbol = state->getCurrencyRepresentation();
            const bool isHeld = state->isHeld();
            const auto gain = state->gain();
            table.addRow({plain(state->getCompanyName()), plain(state->getCompanyAbbreviation()),
                          share != nullptr ? plain(share->getMarketName()) : "", countText(state->getQuantity()),
                          isHeld ? amountText(state->getBuyQuote()) : "", amountText(state->getQuote()), plain(symbol),
                          gain ? changeText(*gain) : "", isHeld ? inReference(state->worth(), symbol) : "",
                          isHeld ? dateText(state->getEndDate()) : ""});
        }
        return table.isEmpty() ? "" : '\n' + table.toString();
    }

    /// Of each holding a row in its currency and, where that is another one, a row in the reference currency.
    std::string gains() const
    {
        TextTable table({{"Gains, without costs"},
                         {"Bought", kRight},
                         {"Sold", kRight},
                         {"Costs", kRight},
                         {"Income", kRight},
                         {"Realised", kRight},
                         {"Unrealised", kRight},
                         {""}});
        auto figures = valuation_.figures().begin(); // of each, in the same order
        for (const ShareState* state : valuation_.state().shareStates()) {
            const HoldingFigures& holding = *figures++;
            if (holding.isEmpty())
                continue;
            const std::string symbol = plain(state->getCurrencyRepresentation());
            addGains(plain(state->getCompanyName()), holding.own, symbol, &table);
            if (holding.inReference && symbol != referenceSymbol_)
                addGains("", *holding.inReference, referenceSymbol_, &table);
        }
        return table.isEmpty() ? "" : '\n' + table.toString();
    }

    static void addGains(const std::string& name, const HoldingSums& sums, const std::string& symbol, TextTable* table)
    {
        table->addRow({name, amountText(sums.bought), amountText(sums.sold), amountText(sums.costs),
                       amountText(sums.income), amountText(sums.realisedGain),
                       sums.unrealisedGain ? amountText(*sums.unrealisedGain) : "", symbol});
    }

    std::string moves() const
    {
        std::vector<OperationLine> lines;
        for (const Account* account : valuation_.wallet().accounts())
            takeMoves(*account, valuation_.state().getDate(), &lines);
        return listed("Income and charges", std::move(lines));
    }

    /// What the search for automatic sales came to: the sales, and the transfers of their gains.
    std::string automaticOperations() const
    {
        std::vector<OperationLine> lines;
        for (const Share* share : valuation_.wallet().shares())
            takeSales(*share, &lines);
        for (const Account* account : valuation_.wallet().accounts())
            takeTransfers(*account, &lines);
        return listed("Automatic", std::move(lines));
    }

    std::string evolution() const
    {
        TextTable table({{"Day"}, {valueHeading(), kRight}});
        for (const EvolutionPoint& point : valuation_.evolution())
            table.addRow({dateText(point.date), amountText(point.totalValue)});
        return table.isEmpty() ? "" : '\n' + table.toString();
    }

    /// An empty heading stands above a column that has nothing in it.
    std::string valueHeading() const { return reference_ != nullptr ? "Value in " + referenceSymbol_ : std::string(); }

    const Valuation& valuation_;
    const Currency* reference_;
    std::string referenceSymbol_;
    std::unordered_map<std::string_view, const Currency*> bySymbol_; // the first of each symbol
};

} // namespace

void writeTableReport(const Valuation& valuation, FILE* out)
{
    const std::string text = Report(valuation).make();
    std::fwrite(text.data(), 1, text.size(), out);
}
