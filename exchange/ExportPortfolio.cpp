// The rows of the portfolio.

#include "exchange/ExportRows.h"
#include "exchange/TableText.h"
#include "market/Catalogue.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "portfolio/DepositAccountOperation.h"
#include "portfolio/OperationKind.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "portfolio/Wallet.h"
#include "valuation/AccountState.h"
#include "valuation/Evolution.h"
#include "valuation/ShareState.h"
#include "valuation/State.h"

#include <algorithm>
#include <cmath>

using namespace export_tables;

static_assert(std::size(kParameterNames) == Wallet::kParameterCount);

namespace {

/// The cells of an operation, by the headings of the table.
struct OperationCells {
    std::string date, type, account, toAccount, market, ticker, quantity, quote, amount, cost, rateCost, fromQuote,
        toQuote;

    std::vector<std::string> row() const
    {
        return {date,  type,   account, toAccount, market,    ticker, quantity,
                quote, amount, cost,    rateCost,  fromQuote, toQuote};
    }
};

/// As what a table has the operation. The cells of income and charges have no place for a zero with a sign, which a sum
/// may keep.
OperationKind kindInTable(const Operation& operation)
{
    const OperationKind kind = kindOf(operation);
    if (kind != OperationKind::kIncome && kind != OperationKind::kCharge)
        return kind;
    const auto& transfer = static_cast<const TransferAccountOperation&>(operation);
    const auto isSignedZero = [](float figure) { return figure == 0 && std::signbit(figure); };
    const bool isOdd =
        isSignedZero(transfer.getAmount()) || isSignedZero(transfer.getCost()) || isSignedZero(transfer.getRateCost());
    return isOdd ? OperationKind::kTransfer : kind;
}

void setTransfer(OperationCells* cells, const TransferAccountOperation& transfer, OperationKind kind)
{
    if (kind == OperationKind::kTransfer) {
        cells->amount = numberText(transfer.getAmount());
        cells->cost = numberText(transfer.getCost());
        cells->rateCost = numberText(transfer.getRateCost());
        cells->fromQuote = numberText(transfer.getFromCurrencyQuote());
        cells->toQuote = numberText(transfer.getToCurrencyQuote());
    } else {
        const bool isIncome = kind == OperationKind::kIncome;
        cells->amount = numberText(isIncome ? -transfer.getCost() : transfer.getAmount());
    }
}

} // namespace

/// An amount in the first currency of that symbol, in the reference currency; empty when that has no answer.
std::string ExportRows::value(double amount, const String& symbol, const State& state) const
{
    const Currency* reference = catalogue_.getReferenceCurrency();
    const Currency* currency = catalogue_.getCurrencyByRepresentation(symbol);
    const Date day = state.getDate();
    if (reference == nullptr || currency == nullptr || reference->getRealQuote(day) == 0)
        return {};
    return numberText(static_cast<float>(amount * currency->getRealQuote(day) / reference->getRealQuote(day)));
}

void ExportRows::addAccounts(CsvWriter& table, const State& state)
{
    for (const AccountState* cash : state.accountStates()) {
        const Account& account = *cash->account();
        const std::string& name = names_.of(account);
        add(table, {name, account.currency() != nullptr ? names_.of(*account.currency()) : "",
                    account.isDefaultTransferAccount() ? kYes : "", numberText(cash->getCash()),
                    value(cash->getCash(), account.getCurrencyRepresentation(), state),
                    TableNames::original(account.getName(), name)});
    }
}

void ExportRows::addHoldings(CsvWriter& table, std::span<const ShareState* const> holdings)
{
    for (const ShareState* holding : holdings)
        addHolding(table, *holding);
}

void ExportRows::addHolding(CsvWriter& table, const ShareState& holding)
{
    const Company* company = holding.share()->company();
    if (company == nullptr || company->market() == nullptr || company->market()->currency() == nullptr) {
        leftOut_.push_back("a holding of a company in no market is left out");
        return;
    }
    const Market& market = *company->market();
    const Date end = holding.getEndDate();
    add(table,
        {tableDate(holding.getDate()), names_.of(market), names_.of(*company), names_.of(*market.currency()),
         escaped(company->getName().bytes()), std::to_string(holding.getQuantity()), numberText(holding.getBuyQuote()),
         numberText(holding.getQuote()), value(holding.worth(), company->getCurrencyRepresentation(), *holding.state()),
         end.isUndefined() ? "" : tableDate(end)});
}

void ExportRows::addOperations(CsvWriter& table, const std::vector<const Operation*>& operations)
{
    for (const Operation* operation : operations)
        if (!operation->isAutomatic()) // what a valuation has made up is no news to anybody
            addOperation(table, *operation);
}

void ExportRows::addOperation(CsvWriter& table, const Operation& operation)
{
    const OperationKind kind = kindInTable(operation);
    OperationCells cells;
    cells.date = tableDate(operation.getDate());
    cells.type = nameOf(kind);
    cells.account = names_.of(*operation.account());
    if (kind == OperationKind::kDeposit) {
        const float amount = static_cast<const DepositAccountOperation&>(operation).getAmount();
        cells.amount = numberText(amount);
        if (amount < 0)
            cells.type = kWithdrawal;
    } else if (kind == OperationKind::kBuy || kind == OperationKind::kSell) {
        const auto& trade = static_cast<const ShareOperation&>(operation);
        const Company* company = trade.share() != nullptr ? trade.share()->company() : nullptr;
        if (company == nullptr || company->market() == nullptr) {
            leftOut_.push_back("the trade of " + cells.date + " on " + cells.account +
                               " has no company and is left out");
            return;
        }
        cells.market = names_.of(*company->market());
        cells.ticker = names_.of(*company);
        cells.quantity = std::to_string(trade.getQuantity());
        cells.quote = numberText(trade.getQuote());
        cells.cost = numberText(trade.getOperationCost());
    } else {
        const auto& transfer = static_cast<const TransferAccountOperation&>(operation);
        if (transfer.recipient() == nullptr) {
            leftOut_.push_back("the transfer of " + cells.date + " from " + cells.account +
                               " has lost its recipient and is left out");
            return;
        }
        if (kind == OperationKind::kTransfer)
            cells.toAccount = names_.of(*transfer.recipient());
        setTransfer(&cells, transfer, kind);
    }
    add(table, cells.row());
}

void ExportRows::addParameters(CsvWriter& table)
{
    for (int i = 0; i < Wallet::kParameterCount; ++i)
        add(table, {kParameterNames[i], numberText(wallet_->getParameter(static_cast<Wallet::Parameter>(i)))});
}

void ExportRows::addEvolution(CsvWriter& table, const std::vector<EvolutionPoint>& points)
{
    for (const EvolutionPoint& point : points)
        add(table, {tableDate(point.date), numberText(point.totalValue)});
}
