#include "report/HoldingTables.h"

#include "foundation/DateText.h"
#include "foundation/NumberText.h"
#include "market/Catalogue.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "portfolio/Share.h"
#include "report/ReportCells.h"
#include "valuation/State.h"
#include "valuation/WalletFigures.h"
#include "views/Look.h"
#include "views/ModelText.h"
#include "views/StateLists.h"

namespace {

constexpr auto kRight = B_ALIGN_RIGHT;
constexpr std::size_t kRest = 6;        // the column of the unrealised gains
constexpr std::size_t kInReference = 3; // the value in the reference currency, from behind
constexpr const char* kEstimate = "~ ";
constexpr const char* kEstimateNote =
    "~ marks an estimate: the straight line from the first quote, or rate, to the last, made longer.";

std::string companyText(const ShareState& state)
{
    const std::string ticker = textOf(state.getCompanyAbbreviation()), name = textOf(state.getCompanyName());
    return name.empty() ? ticker : name + " (" + ticker + ')';
}

/// The sums of several holdings.
struct GainSum {
    HoldingSums sums;
    bool isWhole = true; ///< nothing is missing in it

    void add(const std::optional<HoldingSums>& part)
    {
        if (!part) {
            isWhole = false;
            return;
        }
        sums.bought += part->bought;
        sums.sold += part->sold;
        sums.costs += part->costs;
        sums.income += part->income;
        sums.realisedGain += part->realisedGain;
        if (part->unrealisedGain)
            sums.unrealisedGain = sums.unrealisedGain.value_or(0) + *part->unrealisedGain;
    }
};

PaperRow gainRow(const std::string& name, const HoldingSums& sums, const std::string& symbol, bool hasRest)
{
    PaperRow row{{textCell(name), amountOrNothing(sums.bought), amountOrNothing(sums.sold), amountOrNothing(sums.costs),
                  amountOrNothing(sums.income), amountOrNothing(sums.realisedGain)}};
    if (hasRest)
        row.cells.push_back(sums.unrealisedGain ? amountCell(*sums.unrealisedGain) : PaperCell());
    row.cells.push_back(textCell(symbol));
    return row;
}

std::vector<PaperColumn> gainColumns(bool hasRest)
{
    std::vector<PaperColumn> columns{{"Holding"},       {"Bought", kRight}, {"Sold", kRight},
                                     {"Costs", kRight}, {"Income", kRight}, {"Realised gain", kRight}};
    if (hasRest)
        columns.push_back({"Unrealised gain", kRight});
    columns.push_back({""}); // currency
    return columns;
}

std::string gainNote(const std::string& reference)
{
    const std::string note =
        "Gains are without the costs, which stand beside them. What is sold counts at the average purchase price.";
    return reference.empty() ? note : note + " In " + reference + " each operation counts at the rate of its day.";
}

bool isEstimate(const ShareState& state, const HoldingFigures& sums)
{
    return sums.own.unrealisedGain && state.quoteBasis().isEstimate;
}

void mark(PaperCell& cell, bool isEstimated)
{
    if (isEstimated && !cell.text.empty())
        cell.text.insert(0, kEstimate);
}

/// That of the holding's market; null without one.
const Currency* currencyOf(const ShareState& state)
{
    const Company* company = state.share() != nullptr ? state.share()->company() : nullptr;
    const Market* market = company != nullptr ? company->market() : nullptr;
    return market != nullptr ? market->currency() : nullptr;
}

} // namespace

HoldingTables::HoldingTables(const WalletFigures& figures) : figures_(figures)
{
    if (const Currency* reference = figures.catalogue().getReferenceCurrency())
        reference_ = textOf(reference->getRepresentation());
}

/// A single rate holds for ever, and is none.
bool HoldingTables::isRateEstimate(const Currency* currency) const
{
    if (currency == nullptr || currency == figures_.catalogue().getReferenceCurrency() || currency->getNbrQuotes() < 2)
        return false;
    return currency->getLastQuoteUpTo(figures_.day()).isUndefined() || currency->getLastQuote() < figures_.day();
}

PaperTable HoldingTables::accounts() const
{
    PaperTable table{"Accounts", {{"Account"}, {"Balance", kRight}, {"Currency"}}, {}};
    if (!reference_.empty())
        table.columns.push_back({"In " + reference_, kRight});
    double sum = 0;
    bool isWhole = true, hasEstimate = false;
    for (AccountState* state : figures_.state().accountStates()) {
        const AccountStateItem item(state);
        table.rows.push_back({{cellOf(item, "Account"), cellOf(item, "Balance"), cellOf(item, "Currency")}});
        const Currency* currency = state->account()->currency();
        const auto value = currency != nullptr
                               ? inReference(state->getCash(), *currency, figures_.catalogue(), figures_.day())
                               : std::nullopt;
        isWhole = isWhole && value;
        sum += value.value_or(0);
        if (!reference_.empty())
            table.rows.back().cells.push_back(value ? amountCell(*value) : PaperCell());
        mark(table.rows.back().cells.back(), value && isRateEstimate(currency));
        hasEstimate = hasEstimate || (value && isRateEstimate(currency));
    }
    if (!reference_.empty() && isWhole && table.rows.size() > 1) {
        table.rows.push_back({{textCell("Together"), {}, {}, amountCell(sum)}, true});
        mark(table.rows.back().cells.back(), hasEstimate);
    }
    if (hasEstimate)
        table.note = kEstimateNote;
    return table;
}

PaperTable HoldingTables::holdings() const
{
    const Totals totals = figures_.totals();
    PaperTable table{"Holdings",
                     {{"Company"},
                      {"Ticker"},
                      {"Quantity", kRight},
                      {"Buy Quote", kRight},
                      {"Quote", kRight},
                      {"Quote of", kRight},
                      {"Value", kRight}},
                     {}};
    if (!reference_.empty())
        table.columns.insert(table.columns.end(), {{"In " + reference_, kRight}, {"Part", kRight}});
    table.columns.push_back({"Gain", kRight});
    const double rate = totals.isKnown ? totals.reference->getRealQuote(figures_.day()) : 0;
    double sum = 0;
    bool isOlder = false, hasEstimate = false, isWhole = true;
    for (ShareState* state : figures_.state().shareStates()) {
        if (!state->isHeld())
            continue;
        ShareStateItem item(state);
        item.showIn(reference_, rate, totals.totalValue);
        sum += item.value().value_or(0);
        isWhole = isWhole && item.value();
        const bool isAtEstimate = item.basis().isEstimate || isRateEstimate(currencyOf(*state));
        isOlder = isOlder || (item.basis().isKnown && item.basis().day != figures_.day());
        hasEstimate = hasEstimate || isAtEstimate;
        PaperRow row;
        for (const PaperColumn& column : table.columns)
            row.cells.push_back(column.title.starts_with("In ") ? cellOf(item, "In ???") : cellOf(item, column.title));
        if (!reference_.empty())
            mark(row.cells[row.cells.size() - kInReference], item.value() && isAtEstimate);
        table.rows.push_back(row);
    }
    if (!reference_.empty() && isWhole && table.rows.size() > 1) {
        PaperRow together{std::vector<PaperCell>(table.columns.size()), true};
        together.cells.front() = textCell("Together");
        PaperCell& whole = together.cells[together.cells.size() - kInReference];
        whole = amountCell(sum);
        mark(whole, hasEstimate);
        table.rows.push_back(together);
    }
    if (isOlder)
        table.note =
            "Quote of: the day of the quote that counts, where there is none of " + dateText(figures_.day()) + ".";
    if (hasEstimate)
        table.note += (isOlder ? " " : "") + std::string(kEstimateNote);
    return table;
}

PaperTable HoldingTables::gains(const std::string& title, const std::vector<HoldingFigures>& sums, bool hasRest) const
{
    PaperTable table{title, gainColumns(hasRest), {}};
    GainSum together;
    std::size_t holdings = 0;
    bool hasEstimate = false;
    auto own = sums.begin();
    for (const ShareState* state : figures_.state().shareStates()) {
        const HoldingFigures& figures = *own++;
        const bool isEmpty =
            hasRest ? figures.isEmpty() : figures.own.bought == 0 && figures.own.sold == 0 && figures.own.income == 0;
        if (isEmpty)
            continue;
        addGains(*state, figures, hasRest, &table);
        together.add(figures.inReference);
        ++holdings;
        hasEstimate = hasEstimate || isEstimate(*state, figures) ||
                      (figures.own.unrealisedGain && isRateEstimate(currencyOf(*state)));
    }
    if (holdings > 1 && together.isWhole) {
        table.rows.push_back(gainRow("Together", together.sums, reference_, hasRest));
        table.rows.back().isSum = true;
        if (hasRest)
            mark(table.rows.back().cells[kRest], hasEstimate);
    }
    if (holdings > 0)
        table.note = gainNote(reference_);
    return table;
}

void HoldingTables::addGains(const ShareState& state, const HoldingFigures& sums, bool hasRest, PaperTable* table) const
{
    const std::string symbol = textOf(state.getCurrencyRepresentation());
    std::vector<PaperRow> rows{gainRow(companyText(state), sums.own, symbol, hasRest)};
    if (sums.inReference && symbol != reference_) {
        rows.push_back(gainRow("", *sums.inReference, reference_, hasRest));
        rows.back().goesOn = true;
        for (PaperCell& cell : rows.back().cells)
            if (cell.color == look::kText)
                cell.color = look::kFaint;
    }
    for (PaperRow& row : rows) {
        // The second row, if there is one, is in the reference currency.
        const bool isAtRate = &row != &rows.front() && isRateEstimate(currencyOf(state));
        if (hasRest)
            mark(row.cells[kRest], isEstimate(state, sums) || isAtRate);
        table->rows.push_back(std::move(row));
    }
}
