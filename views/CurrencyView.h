#pragma once

#include "platform/TextControl.h"
#include "views/MarketDataLists.h"
#include "views/SeriesPage.h"

#include <optional>

/// The page of currencies, with the markets and rates of the selected currency.
///
/// Markets and rates are those of one currency, which need not be selected any more. So the page keeps whose rows it
/// shows, and what is told of an object that is not shown has no effect. A row is taken out by `Delete...` before its
/// object is destroyed.
class CurrencyView final : public SeriesPage<Currency> {
public:
    CurrencyView(BRect frame, const char* name, BWindow* window);

    String getCurrencyName() const { return name_->Text(); }
    void setCurrencyName(const String& name) { showText(*name_, name); }
    /// The symbol.
    String getCurrencyRepresentation() const { return representation_->Text(); }
    void setCurrencyRepresentation(const String& representation) { showText(*representation_, representation); }
    /// Shows the name of the reference currency. Its rates and those of the others may have changed with it.
    void setCurrencyRefName(const String& name);
    /// Null when none is selected.
    Currency* GetSelectedCurrency() const { return currencies_->selected(); }
    Currency* selectedSeries() const override { return GetSelectedCurrency(); }
    void AddCurrency(Currency* currency, bool selected);
    void ModifyCurrency(Currency* currency);
    /// Takes the row out, the last one moves into its place.
    void DeleteCurrency(Currency* currency);

    // Markets of the selected currency.
    /// Null shows none.
    void SetMarketList(Currency* currency);
    void AddMarket(Market* market);
    void ModifyMarket(Market* market) { markets_->modify(market); }
    void DeleteMarket(Market* market) { markets_->remove(market); }

    /// What the lists show.
    struct Places {
        ListPlaces currencies;
        std::optional<std::size_t> shownCurrency; // the selected one, whose markets and rates are listed
        ListPlaces markets;
        ListPlaces quotes;
    };
    /// `currencies` are those of the catalogue, in its order.
    Places places(const std::vector<Currency*>& currencies) const;
    /// Fills the lists, which show nothing, and brings back what was selected; sends no message.
    void restore(const Places& places, const std::vector<Currency*>& currencies);
    /// Shows no currency any more.
    void DeleteAllCurrencies();

private:
    void makeCurrencies(BRect frame);
    void makeMarkets(BRect frame);
    void fillChart(QuoteChart& chart, const Currency& currency) const override;
    void noteQuoteChange() override { currencies_->InvalidateItems(); } // they show their latest rate

    CurrencyListView* currencies_ = nullptr;
    BTextControl* name_ = nullptr;
    BTextControl* representation_ = nullptr;
    BTextControl* referenceName_ = nullptr;
    MarketListView* markets_ = nullptr;

    const Currency* marketsOf_ = nullptr; // whose markets are listed; never looked into
};
