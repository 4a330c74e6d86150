// Quotes of the selected company, and those that are fetched.

#include "app/LatestQuoteFetch.h"
#include "app/PLWindow.h"
#include "app/SeriesCommands.h"
#include "app/WindowLock.h"
#include "market/Company.h"
#include "portfolio/Share.h"
#include "portfolio/Wallet.h"
#include "views/CompanyView.h"

#include <memory>

void PLWindow::AddCompanyQuote()
{
    series_commands::addQuote(*this, *companyView_, companyView_->GetSelectedCompany(),
                              "You must first select a company");
}

void PLWindow::UpdateCompanyQuote()
{
    series_commands::updateQuote(*this, *companyView_);
}

void PLWindow::RemoveCompanyQuote()
{
    series_commands::removeQuotes(*this, *companyView_);
}

void PLWindow::CompanyQuoteSelection()
{
    series_commands::showSelectedQuote(*this, *companyView_);
}

void PLWindow::SplitQuotes()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    const double factor = companyView_->getSplitFactor();
    if (factor == 0) {
        SetMessage("Please specify a factor (ex: 1:2)");
        return;
    }
    // Only the selected quotes: a person selects those before the day of the split.
    int n;
    const std::unique_ptr<CompanyQuote*[]> quotes(companyView_->getAllSelectedQuotes(&n));
    for (int i = 0; i < n; ++i) {
        CompanyQuote* quote = quotes[static_cast<std::size_t>(i)];
        quote->setValue(static_cast<float>(quote->getValue() * factor));
        companyView_->ModifyQuote(quote);
    }
    if (n == 0)
        return;
    UpdateCompanyQuotesChart();
    UpdateState();
}

void PLWindow::UpdateCompanyQuotesChart()
{
    const WindowLock lock(*this);
    if (lock.isHeld())
        companyView_->UpdateQuotesChart();
}

void PLWindow::SetThreeMonthsCompanyQuotes()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    Company* company = companyView_->GetSelectedCompany();
    if (company == nullptr)
        return;
    SetMessage("Getting the last three months of quotes on the Internet (only for NASDAQ and NYSE)");
    if (company->setInternetLastThreeMonthsQuote() != 0) {
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
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    SetMessage("Getting the latest quote on the Internet... Please stand by.");
    const Company* shown = companyView_->GetSelectedCompany();
    unsigned n;
    Share** shares = wallet_->getAllShares(&n);
    for (unsigned i = 0; i < n; ++i) {
        Company* company;
        if (shares[i]->getCompany(&company) != 0)
            continue;
        // A company that several holdings are of is fetched for each of them.
        if (fetchLatestQuote(company, company == shown ? companyView_ : nullptr) != 0)
            SetMessage("Error Getting the latest quote on the Internet for a company");
    }
    // The portfolio is not valued anew here. Intended: the next command that does so takes the quotes into account.
    SetMessage("All portofolio quotes are up-to-date.");
}
