// Currencies, and the catalogue as a whole.

#include "app/Holds.h"
#include "views/CompanyView.h"
#include "views/CurrencyView.h"

#include <memory>

void PLWindow::AddCurrency()
{
    const String name = currencyView_->getCurrencyName();
    const String representation = currencyView_->getCurrencyRepresentation();
    if (name.isUndefined() || representation.isUndefined())
        return SetMessage("Please specify a currency name and representation.");
    auto* currency = new Currency(name, representation, getReferenceCurrency());
    if (getReferenceCurrency() == nullptr) { // whoever comes first is what all others are priced in
        setReferenceCurrency(currency);
        currencyView_->setCurrencyRefName(name);
    }
    AddCurrency(currency, true);
}

void PLWindow::AddCurrency(Currency* currency, bool selected)
{
    // Catalogue and page both put it last, so that the rows keep to the order of the catalogue.
    catalogue_.addCurrency(currency);
    currencyView_->AddCurrency(currency, selected);
    refreshWalletCatalogue();
}

void PLWindow::UpdateCurrency()
{
    Currency* currency = currencyView_->GetSelectedCurrency();
    if (currency == nullptr)
        return;
    currency->setName(currencyView_->getCurrencyName());
    currency->setRepresentation(currencyView_->getCurrencyRepresentation());
    currency->setReferenceCurrency(getReferenceCurrency());
    currencyView_->ModifyCurrency(currency);
    if (currency == getReferenceCurrency())
        currencyView_->setCurrencyRefName(currency->getName());
    UpdateState();
}

void PLWindow::RemoveCurrency()
{
    if (catalogue_.getNbrCurrencies() == 1)
        return SetMessage("You may not remove the last currency...");
    if (!confirm("This will delete all attached markets, companies and accounts..."))
        return;
    const StateHold hold(*this);
    if (Currency* currency = currencyView_->GetSelectedCurrency()) {
        // First the catalogue lets go of it, so that nothing finds it any more, and another currency is the reference;
        // then its rows go, and at the end of the block itself, with its rates.
        const std::unique_ptr<Currency> removed(currency);
        const bool wasReference = currency == getReferenceCurrency();
        catalogue_.removeCurrency(currency);
        if (wasReference) {
            currencyView_->setCurrencyRefName(getReferenceCurrency()->getName());
            CurrencySelection();
        }
        // The accounts stay, without a currency, though the question names them. Intended: its wording is kept.
        removeMarkets(*currency);
        currencyView_->DeleteCurrency(currency);
    }
    UpdateState();
}

void PLWindow::RemoveAllCurrencies()
{
    const StateHold hold(*this);
    companyView_->SetMarketList({}); // at once
    for (Currency* currency : catalogue_.getCurrencies()) {
        removeMarkets(*currency);
        currencyView_->DeleteCurrency(currency);
    }
    catalogue_.clear(); // no row is left that stands for one of them
    currencyView_->setCurrencyRefName(String());
    UpdateState();
}

void PLWindow::CurrencySelection()
{
    Currency* currency = currencyView_->GetSelectedCurrency();
    currencyView_->SetMarketList(currency);
    currencyView_->SetQuoteList(currency);
    currencyQuotes_->followSeries();
    if (currency == nullptr)
        return;
    currencyView_->setCurrencyName(currency->getName());
    currencyView_->setCurrencyRepresentation(currency->getRepresentation());
    // On the company page, until that is refreshed. Intended, as is that the chart is not drawn here: it
    // shows the rates of the currency that is named in it until a rate is selected.
    companyView_->showTrend(*currency, currency->getRepresentation());
}

void PLWindow::SetCurrencyRef()
{
    Currency* currency = currencyView_->GetSelectedCurrency();
    if (currency == nullptr)
        return SetMessage("Please select a currency.");
    if (currency == getReferenceCurrency())
        return;
    SetCurrencyRef(currency);
    UpdateState();
}

void PLWindow::SetCurrencyRef(Currency* newReference)
{
    if (newReference == getReferenceCurrency())
        return;
    // Before and after, all rates are given in the reference currency: with it they all change.
    catalogue_.rebaseOn(newReference);
    currencyView_->setCurrencyRefName(newReference->getName());
    CurrencySelection();
}

void PLWindow::removeMarkets(const Currency& currency)
{
    while (!currency.markets().empty())
        RemoveMarket(currency.markets().front(), false);
}

void PLWindow::showCatalogue(unsigned firstNew)
{
    // The rows stand in the order of the catalogue, which has put the new currencies behind the others.
    const auto& currencies = catalogue_.getCurrencies();
    for (unsigned i = firstNew; i < currencies.size(); ++i)
        currencyView_->AddCurrency(currencies[i], false);
    if (getReferenceCurrency() != nullptr)
        currencyView_->setCurrencyRefName(getReferenceCurrency()->getName());
    CurrencySelection();
    companyView_->SetMarketList(catalogue_.getMarkets());
    showWallet();
}
