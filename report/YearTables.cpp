#include "report/YearTables.h"

#include "foundation/NumberText.h"
#include "market/Catalogue.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "portfolio/CashMove.h"
#include "portfolio/OperationKind.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "portfolio/Wallet.h"
#include "report/ReportCells.h"
#include "valuation/WalletFigures.h"
#include "views/ModelText.h"
#include "views/OperationListView.h"

#include <algorithm>
#include <cmath>
#include <functional>
#include <set>

namespace {

constexpr auto kRight = B_ALIGN_RIGHT;

/// What went into an account and out of it from outside, none below zero.
struct AccountSums {
    double deposited = 0, withdrawn = 0, income = 0, charges = 0;

    void add(OperationKind kind, double move)
    {
        if (kind == OperationKind::kDeposit)
            (move < 0 ? withdrawn : deposited) += std::abs(move);
        else if (kind == OperationKind::kIncome)
            income += move;
        else if (kind == OperationKind::kCharge)
            charges -= move;
    }
    bool isEmpty() const { return deposited == 0 && withdrawn == 0 && income == 0 && charges == 0; }
    PaperRow row(const std::string& name, const std::string& symbol) const
    {
        return {{textCell(name), amountOrNothing(deposited), amountOrNothing(withdrawn), amountOrNothing(income),
                 amountOrNothing(charges), textCell(symbol)}};
    }
};

/// A deposit of less than 0 is called what it is.
PaperCell typeOf(const OperationItem& item, double move)
{
    const bool isWithdrawal = kindOf(*item.object()) == OperationKind::kDeposit && move < 0;
    return isWithdrawal ? textCell("Withdrawal") : cellOf(item, "Type");
}

/// All that a trade or a transfer has cost, in the currency of its account.
double costOf(const Operation& operation, double move)
{
    const auto* trade = dynamic_cast<const ShareOperation*>(&operation);
    if (trade != nullptr && trade->share() != nullptr) {
        const double traded = static_cast<double>(trade->getQuote()) * trade->getQuantity();
        return trade->isBuy() ? -move - traded : traded - move;
    }
    if (kindOf(operation) == OperationKind::kTransfer)
        return static_cast<const TransferAccountOperation&>(operation).getTotalCost();
    return 0;
}

} // namespace

YearTables::YearTables(const WalletFigures& figures, std::optional<int> year)
    : figures_(figures), year_(year), dividends_(figures.wallet(), figures.catalogue())
{
    last_ = figures.day();
    if (year) {
        before_ = Date(31, 12, *year - 1);
        last_ = std::min(last_, Date(31, 12, *year));
    }
    for (const Operation* operation : operationsByDate(figures.wallet()))
        if (operation->getDate() > before_ && operation->getDate() <= last_)
            operations_.push_back(operation);
}

std::vector<int> YearTables::years(const WalletFigures& figures)
{
    std::set<int, std::greater<>> years;
    for (const Account* account : figures.wallet().accounts())
        for (const Operation* operation : account->operations())
            if (!operation->getDate().isUndefined() && operation->getDate() <= figures.day())
                years.insert(operation->getDate().getYear());
    return {years.begin(), years.end()};
}

PaperTable YearTables::sums() const
{
    PaperTable table{
        "Deposits, income and charges",
        {{"Account"}, {"Deposited", kRight}, {"Withdrawn", kRight}, {"Income", kRight}, {"Charges", kRight}, {""}},
        {}};
    const Catalogue& catalogue = figures_.catalogue();
    const Currency* reference = catalogue.getReferenceCurrency();
    AccountSums together;
    bool isWhole = reference != nullptr, isForeign = false;
    for (const Account* account : figures_.wallet().accounts()) {
        AccountSums sums;
        for (const Operation* operation : account->operations()) {
            if (operation->getDate() <= before_ || operation->getDate() > last_ || account->currency() == nullptr)
                continue;
            const double move = cashMove(*operation, *account);
            const OperationKind kind = kindOf(*operation);
            const auto value = inReference(move, *account->currency(), catalogue, operation->getDate());
            sums.add(kind, move);
            together.add(kind, value.value_or(0));
            isWhole = isWhole && value;
        }
        if (sums.isEmpty())
            continue;
        isForeign = isForeign || account->currency() != reference;
        table.rows.push_back(sums.row(textOf(account->getName()), textOf(account->getCurrencyRepresentation())));
    }
    if (!isWhole || (table.rows.size() < 2 && !isForeign) || table.rows.empty())
        return table;
    table.rows.push_back(together.row("Together", textOf(reference->getRepresentation())));
    table.rows.back().isSum = true;
    if (isForeign)
        table.note = "Together: each amount at the rate of its day.";
    return table;
}

PaperTable YearTables::operations() const
{
    PaperTable table{year_ ? "Operations of " + std::to_string(*year_) : "All operations",
                     {{"Date"},
                      {"Type"},
                      {"Account"},
                      {"What"},
                      {"Quantity", kRight},
                      {"Quote", kRight},
                      {"Costs", kRight},
                      {"Effect", kRight},
                      {""}},
                     {}};
    for (const Operation* operation : operations_)
        addOperation(*operation, &table);
    return table;
}

void YearTables::addOperation(const Operation& operation, PaperTable* table) const
{
    // The list changes what a row shows, never the operation.
    OperationItem item(const_cast<Operation*>(&operation));
    const bool isTrade = dynamic_cast<const ShareOperation*>(&operation) != nullptr;
    const Account& account = *operation.account();
    const double move = cashMove(operation, account);
    const auto symbolOf = [](const Account& of) { return textCell(textOf(of.getCurrencyRepresentation())); };
    const Company* payer = dividends_.payerOf(operation);
    const PaperCell what = payer != nullptr
                               ? textCell(textOf(payer->getAbbreviation()) + "  " + textOf(payer->getName()))
                               : cellOf(item, "What");
    table->rows.push_back({{cellOf(item, "Date"), typeOf(item, move), textCell(textOf(account.getName())), what,
                            cellOf(item, "Quantity"), isTrade ? cellOf(item, "Quote/Amount") : PaperCell(),
                            amountOrNothing(costOf(operation, move)), amountCell(move), symbolOf(account)}});
    const auto* transfer = dynamic_cast<const TransferAccountOperation*>(&operation);
    if (transfer == nullptr || transfer->recipient() == nullptr || transfer->recipient() == &account)
        return;
    const Account& recipient = *transfer->recipient();
    item.showEffectOn(&recipient, std::nullopt);
    table->rows.push_back({{{},
                            {},
                            textCell(textOf(recipient.getName())),
                            cellOf(item, "What"),
                            {},
                            {},
                            {},
                            amountCell(cashMove(operation, recipient)),
                            symbolOf(recipient)},
                           false,
                           true});
}
