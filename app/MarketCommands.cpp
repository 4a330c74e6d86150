// Markets.

#include "app/PLWindow.h"
#include "app/StateHold.h"
#include "app/WindowLock.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "views/CompanyView.h"
#include "views/CurrencyView.h"

void PLWindow::AddMarket()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    const String name = companyView_->getMarketName();
    if (name.isUndefined()) {
        SetMessage("Please specify a market name.");
        return;
    }
    const String representation = companyView_->getMarketCurrencyRepresentation();
    if (representation.isUndefined()) {
        SetMessage("Please specify a currency representation.");
        return;
    }
    Currency* currency = getCurrencyByRepresentation(representation);
    if (currency == nullptr) {
        SetMessage("Unknown currency...");
        return;
    }
    auto* market = new Market(name);
    market->setCurrency(currency);
    AddMarket(market, true);
}

void PLWindow::AddMarket(Market* market, bool selected)
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    companyView_->AddMarket(market, selected);
    currencyView_->AddMarket(market);
    refreshWalletCatalogue();
}

void PLWindow::UpdateMarket()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    Market* market = companyView_->GetSelectedMarket();
    if (market == nullptr)
        return;
    market->setName(companyView_->getMarketName());
    companyView_->ModifyMarket(market);
    currencyView_->ModifyMarket(market);
}

void PLWindow::RemoveMarket(Market* market, bool ask)
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    if (ask && !confirm("This will delete all attached companies and share operations..."))
        return;
    const StateHold hold(*this);
    if (market == nullptr)
        market = companyView_->GetSelectedMarket();
    if (market != nullptr) {
        // The rows first: those of the market's companies go with it, all at once.
        companyView_->DeleteMarket(market);
        currencyView_->DeleteMarket(market);
        unsigned n;
        while (Company** companies = market->getAllCompanies(&n))
            RemoveCompany(companies[0], false);
        delete market;
    }
    UpdateState();
}

void PLWindow::RemoveAllMarkets()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    const StateHold hold(*this);
    companyView_->SetMarketList({});
    for (Market* market : catalogue_.getMarkets())
        RemoveMarket(market, false);
    UpdateState();
}

void PLWindow::MarketSelection()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    Market* market = companyView_->GetSelectedMarket();
    if (market != nullptr) {
        companyView_->setMarketName(market->getName());
        companyView_->setMarketCurrencyRepresentation(market->getCurrencyRepresentation());
    }
    companyView_->SetCompanyList(market);
}
