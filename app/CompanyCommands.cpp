// Companies.

#include "app/LatestQuoteFetch.h"
#include "app/PLWindow.h"
#include "app/SeriesCommands.h"
#include "app/StateHold.h"
#include "app/WindowLock.h"
#include "market/Company.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "views/CompanyView.h"
#include "views/OperationView.h"

namespace {

/// Calls `apply` for every operation of every holding of the company.
template <class Apply>
void forEachOperation(const Company& company, const Apply& apply)
{
    unsigned nShares;
    Share** shares = company.getAllShares(&nShares);
    for (unsigned i = 0; i < nShares; ++i) {
        unsigned n;
        ShareOperation** operations = shares[i]->getAllShareOperations(&n);
        for (unsigned k = 0; k < n; ++k)
            apply(operations[k]);
    }
}

} // namespace

void PLWindow::AddCompany()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    Market* market = companyView_->GetSelectedMarket();
    if (market == nullptr) {
        SetMessage("Please first create a market.");
        return;
    }
    const String abbreviation = companyView_->getCompanyAbbreviation();
    if (abbreviation.isUndefined()) {
        SetMessage("Please specify an abbreviation for your company");
        return;
    }
    AddCompany(new Company(market, companyView_->getCompanyName(), abbreviation), true);
}

void PLWindow::AddCompany(Company* company, bool selected)
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    companyView_->AddCompany(company, selected);
}

void PLWindow::UpdateCompany()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    if (Company* company = companyView_->GetSelectedCompany()) {
        SetMessage("Getting the latest quote on the Internet... Please stand by.");
        const bool isFetched = fetchLatestQuote(company, companyView_) == 0;
        SetMessage(isFetched ? "Successful update to the latest quote on the Internet"
                             : "Error Getting the latest quote on the Internet");
        // After the fetch, which asks for the ticker as it was. Intended: one button renames and brings up to date.
        company->setName(companyView_->getCompanyName());
        company->setAbbreviation(companyView_->getCompanyAbbreviation());
        companyView_->ModifyCompany(company);
        forEachOperation(*company, [this](ShareOperation* o) { operationView_->UpdateShareOperation(o); });
    }
    UpdateState();
}

void PLWindow::RemoveCompany(Company* company, bool ask)
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    if (ask && !confirm("This will delete all attached share operations..."))
        return;
    const StateHold hold(*this);
    if (company == nullptr)
        company = companyView_->GetSelectedCompany();
    if (company != nullptr) {
        forEachOperation(*company, [this](ShareOperation* o) { operationView_->RemoveShareOperation(o); });
        companyView_->DeleteCompany(company);
        delete company;
    }
    UpdateState();
}

void PLWindow::CompanySelection()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    Company* company = companyView_->GetSelectedCompany();
    companyView_->SetQuoteList(company);
    companyView_->SetCompanyEventList(company);
    if (company == nullptr)
        return;
    companyView_->setCompanyName(company->getName());
    companyView_->setCompanyAbbreviation(company->getAbbreviation());
    series_commands::showTrend(*companyView_, *company);
    UpdateCompanyQuotesChart();
}
