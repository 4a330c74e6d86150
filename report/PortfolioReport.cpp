#include "report/PortfolioReport.h"

#include "foundation/DateText.h"
#include "foundation/NumberText.h"
#include "market/Catalogue.h"
#include "market/Currency.h"
#include "report/HoldingTables.h"
#include "report/ReportCells.h"
#include "report/YearTables.h"
#include "valuation/QuoteCoverage.h"
#include "valuation/State.h"
#include "valuation/WalletFigures.h"
#include "views/EvolutionChart.h"
#include "views/Look.h"
#include "views/ModelText.h"

#include <algorithm>

namespace {

std::string returnText(const AnnualReturn& annual, const std::string& mark)
{
    return annual.isKnown() ? mark + percentText(annual.rate) : annual.reason();
}

bool hasOperations(const State& state)
{
    return state.getFirstOperationDate() <= state.getDate();
}

} // namespace

std::vector<int> PortfolioReport::years() const
{
    return YearTables::years(figures_);
}

std::unique_ptr<PaperDocument> PortfolioReport::make(std::optional<int> year, PaperSize size) const
{
    const std::string day = "Portfolio on " + dateText(figures_.day());
    auto paper = std::make_unique<PaperDocument>(size, name_, day);
    const Currency* reference = figures_.catalogue().getReferenceCurrency();
    paper->addTitle(name_, reference == nullptr ? day
                                                : day + ", in " + textOf(reference->getName()) + " (" +
                                                      textOf(reference->getRepresentation()) + ')');
    addTotals(*paper);
    addChart(*paper);
    const HoldingTables tables(figures_);
    paper->addTable(tables.accounts());
    paper->addTable(tables.holdings());
    const std::string since = isLater() ? "after " + dateText(figures_.from()) : "since the first operation";
    PaperTable gains = tables.gains("Gains " + since, figures_.holdings(), true);
    if (isLater())
        gains.note += " What is not realised is the whole gain since the purchase.";
    paper->addTable(gains);
    addYear(*paper, year);
    return paper;
}

bool PortfolioReport::isLater() const
{
    return !figures_.from().isUndefined() && figures_.from() > figures_.state().getFirstOperationDate();
}

std::string PortfolioReport::estimates() const
{
    const State& state = figures_.state();
    const Date& day = figures_.day();
    const QuoteCoverage quotes = quoteCoverage(state), rates = rateCoverage(state, figures_.catalogue());
    std::string text = estimateText(quotes, rates, day);
    // Where quotes are missing the text is of these alone.
    if (const std::string ofRates = coverageText(rates, "rates", day);
        !ofRates.empty() && !coverageText(quotes, "quotes", day).empty())
        text += "; " + ofRates;
    return text;
}

void PortfolioReport::addTotals(PaperDocument& paper) const
{
    const Totals totals = figures_.totals();
    const State& state = figures_.state();
    const std::string first = hasOperations(state) ? dateText(state.getFirstOperationDate()) : "none";
    if (!totals.isKnown) {
        paper.addFacts({{"First operation", {first}}});
        return paper.addText("Without totals, returns and chart: the market data has no reference currency.");
    }
    const std::string unit = ' ' + textOf(totals.reference->getRepresentation());
    const std::string mark = hasEstimates() ? "~ " : "";
    const auto amount = [&](double value, const std::string& sign) {
        PaperCell cell = amountCell(value);
        return PaperCell{sign + cell.text + unit, cell.color};
    };
    const Returns& returns = figures_.returns();
    std::vector<PaperFact> facts{{"Total value", amount(totals.totalValue, mark)},
                                 {"Total deposit", amount(totals.totalDeposit, "")},
                                 {"Profit", amount(totals.profit, mark)},
                                 {"First operation", {first}}};
    const std::string since = isLater() ? " since " + dateText(figures_.from()) : "";
    if (hasOperations(state))
        facts.insert(facts.end(), {{"Money-weighted return" + since, {returnText(returns.moneyWeighted, mark)}},
                                   {"Time-weighted return" + since, {returnText(returns.timeWeighted, mark)}},
                                   {"Annual revenue (simple)", {mark + percentText(totals.annualRevenue)}}});
    paper.addFacts(facts);
    if (std::string text = estimates(); !text.empty())
        paper.addText("~ " + text + '.');
}

void PortfolioReport::addChart(PaperDocument& paper) const
{
    if (figures_.outcome() == EvolutionOutcome::kBadFirstDay)
        paper.addText("Without a chart: the first operation, of " + dateText(figures_.state().getFirstOperationDate()) +
                      ", is of no day of the calendar.");
    if (figures_.outcome() == EvolutionOutcome::kTooLong)
        paper.addText("Without a chart: there are too many days since the first operation.");
    if (figures_.evolution().size() < 2)
        return;
    const Currency* reference = figures_.catalogue().getReferenceCurrency();
    auto chart = std::make_unique<EvolutionChart>(BRect(0, 0, 700, 230), EvolutionChart::Medium::kPaper);
    chart->showPoints(figures_.evolution(), textOf(reference->getRepresentation()));
    paper.addPicture("Value from day to day", std::move(chart));
}

void PortfolioReport::addYear(PaperDocument& paper, std::optional<int> year) const
{
    const YearTables tables(figures_, year);
    const std::string title = year ? "Year " + std::to_string(*year) : "All operations";
    if (tables.isEmpty())
        return paper.addText(year ? "No operations in " + std::to_string(*year) + " up to the day of this report."
                                  : "No operations up to the day of this report.");
    const std::string from = year ? "From " + dateText(Date(1, 1, *year)) + " to " : "Up to ";
    paper.addPart(title, from + dateText(tables.last()));
    paper.addTable(tables.sums());
    if (year)
        paper.addTable(HoldingTables(figures_).gains("Gains of " + std::to_string(*year),
                                                     figures_.holdingsWithin(tables.before(), tables.last()), false));
    paper.addTable(tables.operations());
}
