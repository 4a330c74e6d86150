#include "tools/tour/GuideTour.h"

#include "app/ReportAssistant.h"
#include "tools/tour/TourHand.h"

namespace {

enum Page { kCompany, kCurrency, kPortoFolio, kOperations, kParameters };

// Parts of the window that tell what a step is about.
const BRect kPage(0, 0, 800, 776);
const BRect kCurrencyLists(0, 0, 800, 500);
const BRect kQuotesAndChart(0, 262, 800, 776);
const BRect kFirstOperations(0, 0, 800, 200);
const BRect kOperationFields(0, 616, 800, 776);

using DatedValues = std::vector<std::pair<const char*, const char*>>;

void addQuotes(TourHand& hand, const DatedValues& quotes)
{
    for (const auto& [date, value] : quotes) {
        hand.type({{"txtQuoteDate", date}, {"txtQuoteValue", value}});
        hand.press("btnAddQuote");
    }
}

void addCurrency(TourHand& hand, const char* name, const char* symbol, const DatedValues& rates)
{
    hand.turnTo(kCurrency);
    hand.type({{"txtCurrencyName", name}, {"txtCurrencyRepresentation", symbol}});
    hand.press("btnAddCurrency");
    addQuotes(hand, rates);
}

void addMarket(TourHand& hand, const char* name, const char* currency)
{
    hand.turnTo(kCompany);
    hand.type({{"txtMarketName", name}, {"txtMarketCurrencyRepresentation", currency}});
    hand.press("btnAddMarket");
}

/// On the company page, in the market that was added last.
void addCompany(TourHand& hand, const char* ticker, const char* name, const DatedValues& quotes)
{
    hand.type({{"txtAbbreviation", ticker}, {"txtName", name}});
    hand.press("btnAddCompany");
    addQuotes(hand, quotes);
}

void addAccount(TourHand& hand, const char* name, const char* currency, bool isDefault)
{
    hand.turnTo(kPortoFolio);
    hand.type({{"txtAccountName", name}, {"txtAccountCurrency", currency}});
    hand.tick("cbxDefaultTransferAccount", isDefault);
    hand.press("btnAddAccount");
}

void valueOn(TourHand& hand, const char* date)
{
    hand.turnTo(kPortoFolio);
    hand.type({{"txtDate", date}});
}

void makeFirstPortfolio(TourHand& hand)
{
    addCurrency(hand, "Euro", "EUR", {{"2/1/2026", "1"}});
    hand.picture("guide-currency", kCurrencyLists);
    addMarket(hand, "Paris", "EUR");
    addCompany(hand, "ALP", "Alpine Water", {{"2/1/2026", "40"}, {"31/3/2026", "43"}, {"30/6/2026", "46"}});
    hand.picture("guide-company", kPage);
    addAccount(hand, "Main", "EUR", true);
    hand.turnTo(kOperations);
    hand.choose("baseAccount", "Main");
    hand.type({{"txtDate", "5/1/2026"}, {"txtAmount", "5000"}});
    hand.press("btnAddOperation");
    hand.choose("operationType", "Buy");
    hand.type({{"txtMarketName", "Paris"}, {"txtCompanyAbbreviation", "ALP"}, {"txtQuantity", "100"}});
    hand.picture("guide-buy", kOperationFields);
    hand.press("btnAddOperation");
    valueOn(hand, "30/6/2026");
    hand.tick("cbxComputeEvolution", true);
    hand.picture("guide-value", kPage);
    hand.tick("cbxComputeEvolution", false);
    valueOn(hand, "31/7/2026");
    hand.picture("guide-estimate", {0, 0, 800, 400});
}

void addDollars(TourHand& hand)
{
    addCurrency(hand, "Dollar", "USD", {{"2/1/2026", "0.85"}, {"30/6/2026", "0.90"}});
    addMarket(hand, "New York", "USD");
    addCompany(hand, "BLU", "Blue Rail", {{"2/1/2026", "20"}, {"30/6/2026", "25"}});
    addAccount(hand, "Dollars", "USD", true);
    hand.turnTo(kOperations);
    hand.choose("operationType", "Transfer");
    hand.choose("transferAccount", "Dollars");
    hand.type({{"txtDate", "15/1/2026"}, {"txtAmount", "500"}});
    hand.picture("guide-transfer", kOperationFields);
    hand.press("btnAddOperation");
    hand.choose("operationType", "Buy");
    hand.choose("baseAccount", "Dollars");
    hand.type({{"txtDate", "16/1/2026"}, {"txtMarketName", "New York"}, {"txtCompanyAbbreviation", "BLU"}});
    hand.type({{"txtQuantity", "10"}, {"txtShareCost", "5"}});
    hand.press("btnAddOperation");
    valueOn(hand, "30/6/2026");
    hand.picture("guide-two-currencies", {0, 0, 800, 420});
}

/// The panel gives a statement.
void showImport(TourHand& hand)
{
    hand.turnTo(kOperations);
    hand.pressInFront("btnImportTable");
    hand.chooseInFront("importAccount", "Main");
    hand.pictureInFront("guide-import");
    hand.pressInFront("btnCancel");
    hand.turnTo(kPortoFolio);
}

void showExport(TourHand& hand)
{
    hand.pressInFront("btnExport");
    hand.picture("guide-export", {0, 0, 800, 300});
    hand.closeMenu();
}

void showReport(TourHand& hand)
{
    hand.command(ReportAssistant::kAsked);
    hand.pictureInFront("guide-report");
    hand.pressInFront("btnCloseReport");
}

/// Simulates the sale of a holding with profit. The portfolio is of no use afterwards.
void showPrevisions(TourHand& hand)
{
    hand.select("lstAccounts", 0);
    hand.tick("cbxDefaultTransferAccount", false);
    hand.press("btnUpdateQuote"); // the accounts' button has this name, too
    addAccount(hand, "Savings", "EUR", true);
    hand.turnTo(kParameters);
    hand.type({{"txtEndProfitSellRate", "105"}});
    valueOn(hand, "31/1/2026");
    hand.turnTo(kOperations);
    hand.tick("cbxPrevision", true);
    hand.picture("guide-previsions", kFirstOperations);
    hand.pressInFront("btnNotice1"); // Take Back
}

void split(TourHand& hand)
{
    hand.turnTo(kCompany);
    hand.select("lstMarkets", 0);
    hand.select("lstCompanies", 0);
    hand.type({{"txtQuoteDate", "1/7/2026"}, {"txtQuoteValue", "23"}});
    hand.press("btnAddQuote");
    hand.type({{"txtCompanyEventDate", "1/7/2026"}});
    hand.press("btnAddCompanyEvent");
    hand.picture("guide-split-before", kQuotesAndChart);
    hand.press("btnApplySplit");
    hand.pictureInFront("guide-split");
    hand.pressInFront("btnApply");
    hand.picture("guide-split-after", kQuotesAndChart);
    hand.dismissNotice();
}

void showMistakes(TourHand& hand)
{
    hand.turnTo(kOperations);
    hand.choose("operationType", "Sell");
    hand.type({{"txtDate", "31/2/2026"}, {"txtQuantity", "ten"}});
    hand.picture("guide-mistakes", kOperationFields);
}

/// All quotes of a company at once, by mistake.
void removeQuotes(TourHand& hand)
{
    hand.turnTo(kCompany);
    hand.select("lstQuotes", 0, 3);
    hand.press("btnRemoveQuote");
    hand.picture("guide-removed", {0, 0, 800, 540});
}

} // namespace

void tourSafety(TourHand& hand)
{
    hand.turnTo(kPortoFolio);
    hand.press("btnLoadPortoFolio"); // without its market file
    hand.picture("guide-not-loaded", {0, 0, 800, 800});
    hand.turnTo(kCompany);
    hand.press("btnLoadMarket");
    hand.turnTo(kPortoFolio);
    hand.press("btnLoadPortoFolio");
    hand.press("btnReinitPortoFolio");
    hand.picture("guide-reinit", {0, 0, 800, 140});
}

void leaveUnsaved(TourHand& hand)
{
    addCurrency(hand, "Euro", "EUR", {});
}

void tourRescue(TourHand& hand)
{
    hand.picture("guide-rescue", {0, 740, 800, 800});
}

void tourGuide(TourHand& hand)
{
    hand.picture("guide-first", {0, 0, 800, 800});
    makeFirstPortfolio(hand);
    addDollars(hand);
    showImport(hand);
    showExport(hand);
    showReport(hand);
    showPrevisions(hand);
    split(hand);
    showMistakes(hand);
    removeQuotes(hand);
}
