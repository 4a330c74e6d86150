// Markets, their companies, and the quotes that are fetched for these.

#include "app/Holds.h"
#include "app/QuoteFetcher.h"
#include "portfolio/Wallet.h"
#include "views/CompanyView.h"
#include "views/CurrencyView.h"
#include "views/OperationView.h"

#include <memory>

void PLWindow::AddMarket()
{
    const String name = companyView_->getMarketName();
    if (name.isUndefined())
        return SetMessage("Please specify a market name.");
    const String representation = companyView_->getMarketCurrencyRepresentation();
    if (representation.isUndefined())
        return SetMessage("Please specify a currency representation.");
    Currency* currency = getCurrencyByRepresentation(representation);
    if (currency == nullptr)
        return SetMessage("Unknown currency...");
    auto* market = new Market(name);
    market->setCurrency(currency); // which owns it from here on
    AddMarket(market, true);
}

void PLWindow::AddMarket(Market* market, bool selected)
{
    companyView_->AddMarket(market, selected);
    currencyView_->AddMarket(market);
    refreshWalletCatalogue();
}

void PLWindow::UpdateMarket()
{
    Market* market = companyView_->GetSelectedMarket();
    if (market == nullptr)
        return;
    market->setName(companyView_->getMarketName());
    companyView_->ModifyMarket(market);
    currencyView_->ModifyMarket(market);
}

void PLWindow::RemoveMarket(Market* market, bool ask)
{
    if (ask && !confirm("This will delete all attached companies and share operations..."))
        return;
    const StateHold hold(*this);
    if (market == nullptr)
        market = companyView_->GetSelectedMarket();
    if (market != nullptr) {
        // The rows first: those of the market's companies go with it, all at once. Then the companies, one by one,
        // until the market stands alone and no operation is left that is about one of them.
        companyView_->DeleteMarket(market);
        currencyView_->DeleteMarket(market);
        while (!market->companies().empty())
            RemoveCompany(market->companies().front(), false);
        delete market;
    }
    UpdateState();
}

void PLWindow::RemoveAllMarkets()
{
    const StateHold hold(*this);
    companyView_->SetMarketList({}); // all rows at once, not each with its market
    for (Market* market : catalogue_.getMarkets())
        RemoveMarket(market, false);
    UpdateState();
}

void PLWindow::MarketSelection()
{
    // Without a selection the company list becomes empty, while the fields keep what they hold.
    Market* market = companyView_->GetSelectedMarket();
    if (market != nullptr)
        showFields(*market);
    companyView_->SetCompanyList(market);
}

void PLWindow::showFields(const Market& market)
{
    companyView_->setMarketName(market.getName());
    companyView_->setMarketCurrencyRepresentation(market.getCurrencyRepresentation());
}

void PLWindow::AddCompany()
{
    Market* market = companyView_->GetSelectedMarket();
    if (market == nullptr)
        return SetMessage("Please first create a market.");
    const String abbreviation = companyView_->getCompanyAbbreviation();
    if (abbreviation.isUndefined())
        return SetMessage("Please specify an abbreviation for your company");
    AddCompany(new Company(market, companyView_->getCompanyName(), abbreviation), true); // the market owns it
}

void PLWindow::AddCompany(Company* company, bool selected)
{
    companyView_->AddCompany(company, selected);
}

void PLWindow::UpdateCompany()
{
    if (Company* company = companyView_->GetSelectedCompany()) {
        SetMessage("Getting the latest quote on the Internet... Please stand by.");
        QuoteFetcher fetcher(*this, *companyView_);
        const bool isFetched = fetcher.fetchLatest(*company);
        fetcher.report();
        SetMessage(isFetched ? "Successful update to the latest quote on the Internet"
                             : "Error Getting the latest quote on the Internet");
        // After the fetch, which asks for the ticker as it was. Intended: one button renames and brings up to date.
        company->setName(companyView_->getCompanyName());
        company->setAbbreviation(companyView_->getCompanyAbbreviation());
        // All rows that show the name or the ticker are drawn again.
        companyView_->ModifyCompany(company);
        for (const Share* share : company->shares())
            for (ShareOperation* operation : share->shareOperations())
                operationView_->UpdateShareOperation(operation);
    }
    UpdateState();
}

void PLWindow::RemoveCompany(Company* company, bool ask)
{
    if (ask && !confirm("This will delete all attached share operations..."))
        return;
    const StateHold hold(*this);
    if (company == nullptr)
        company = companyView_->GetSelectedCompany();
    if (company != nullptr) {
        // The company takes its holdings along, and they their operations: all rows of these go first.
        for (const Share* share : company->shares())
            for (ShareOperation* operation : share->shareOperations())
                operationView_->RemoveShareOperation(operation);
        companyView_->DeleteCompany(company);
        delete company;
    }
    UpdateState();
}

void PLWindow::CompanySelection()
{
    // The lists and the chart follow the selection, also to nothing; the fields keep what they hold then.
    Company* company = companyView_->GetSelectedCompany();
    companyView_->SetQuoteList(company);
    companyView_->SetCompanyEventList(company);
    companyQuotes_->followSeries();
    if (company == nullptr)
        return;
    companyView_->setCompanyName(company->getName());
    companyView_->setCompanyAbbreviation(company->getAbbreviation());
    companyView_->showTrend(*company);
    UpdateCompanyQuotesChart();
}

void PLWindow::SplitQuotes()
{
    const double factor = companyView_->getSplitFactor();
    if (factor == 0)
        return SetMessage("Please specify a factor (ex: 1:2)");
    // Only the selected quotes: a person selects those before the day of the split.
    int n;
    const std::unique_ptr<CompanyQuote*[]> quotes(companyView_->getAllSelectedQuotes(&n));
    for (CompanyQuote* quote : std::span(quotes.get(), static_cast<std::size_t>(n))) {
        quote->setValue(static_cast<float>(quote->getValue() * factor));
        companyView_->ModifyQuote(quote);
    }
    if (n == 0)
        return;
    UpdateCompanyQuotesChart();
    UpdateState();
}

void PLWindow::SetThreeMonthsCompanyQuotes()
{
    Company* company = companyView_->GetSelectedCompany();
    if (company == nullptr)
        return;
    SetMessage("Getting the last three months of quotes on the Internet (only for NASDAQ and NYSE)");
    QuoteFetcher fetcher(*this, *companyView_);
    const bool isFetched = fetcher.fetchHistory(*company);
    fetcher.report();
    if (!isFetched) {
        // Quotes may have been stored all the same. Intended: they show at the next refresh.
        SetMessage("Error getting the last three months of quotes");
        return;
    }
    companyView_->ModifyCompany(company);
    UpdateState();
    SetMessage("Last three months added...");
}

void PLWindow::UpdatePortoFolioQuotes()
{
    SetMessage("Getting the latest quote on the Internet... Please stand by.");
    QuoteFetcher fetcher(*this, *companyView_);
    for (const Share* share : wallet_->shares()) {
        // A company that several holdings are of is fetched for each of them.
        Company* company = share->company();
        if (company != nullptr && !fetcher.fetchLatest(*company))
            SetMessage("Error Getting the latest quote on the Internet for a company");
    }
    // The portfolio is not valued anew here. Intended: the next command that does so takes the quotes into account.
    SetMessage("All portofolio quotes are up-to-date."); // Intended: also when some are not, which the notice tells.
    fetcher.report();
}
