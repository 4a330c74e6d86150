#pragma once

#include "platform/TextControl.h"
#include "views/EventBox.h"
#include "views/MarketDataLists.h"
#include "views/SeriesPage.h"

#include <optional>
#include <vector>

/// The page of markets and companies, with the quotes and events of the selected company.
///
/// The companies are those of one market, quotes and events those of one company, which need not be selected any more.
/// So the page keeps whose rows it shows, and what is told of an object that is not shown has no effect. A row is taken
/// out by `Delete...` before its object is destroyed.
class CompanyView final : public SeriesPage<Company> {
public:
    CompanyView(BRect frame, const char* name, BWindow* window);

    // Markets.
    String getMarketName() const { return marketName_->Text(); }
    void setMarketName(const String& name) { showText(*marketName_, name); }
    /// The symbol as it was typed.
    String getMarketCurrencyRepresentation() const { return marketCurrency_->Text(); }
    void setMarketCurrencyRepresentation(const String& symbol) { showText(*marketCurrency_, symbol); }
    /// Null when none is selected, like all of these.
    Market* GetSelectedMarket() const { return markets_->selected(); }
    void AddMarket(Market* market, bool selected);
    void ModifyMarket(Market* market) { markets_->modify(market); }
    /// Empties the lists of what belongs to the market, too.
    void DeleteMarket(Market* market);
    /// Fills the market list; the company list becomes empty.
    void SetMarketList(const std::vector<Market*>& markets);

    // Companies of the selected market.
    String getCompanyName() const { return companyName_->Text(); }
    void setCompanyName(const String& name) { showText(*companyName_, name); }
    /// The ticker.
    String getCompanyAbbreviation() const { return abbreviation_->Text(); }
    void setCompanyAbbreviation(const String& abbreviation) { showText(*abbreviation_, abbreviation); }
    /// Both as fractions of the trend; shown as percentages.
    void setRelativeDailyChange(float change);
    void setDiffWithAverage(float difference);
    /// Puts into these two how much the trend line of `series` rises in a day, and how far the last quote stands above
    /// it, both in proportion to the line on the day of that quote. A trend of 0 is not guarded against: the fields
    /// then say that there is no number. `currency` is its symbol when it is a currency: the page says so.
    template <class Series>
    void showTrend(const Series& series, const String& currency = {})
    {
        nameTrend(currency);
        const Date last = series.getLastQuote();
        const double trend = series.getPrevisionQuote(last);
        setRelativeDailyChange(static_cast<float>(series.getPente() / trend));
        setDiffWithAverage(static_cast<float>((series.getRealQuote(last) - trend) / trend));
    }
    Company* GetSelectedCompany() const { return companies_->selected(); }
    Company* selectedSeries() const override { return GetSelectedCompany(); }
    void AddCompany(Company* company, bool selected);
    /// Its quotes may have changed, too.
    void ModifyCompany(Company* company);
    void DeleteCompany(Company* company);
    /// Shows the companies of `market`; null shows none.
    void SetCompanyList(Market* market);
    BListView* getCompanyListView() const { return companies_; }
    /// What quotes are multiplied by in a split, from its two fields; 0 while they hold none.
    double getSplitFactor() const;

    // Events of the selected company.
    /// 1 split, 2 note.
    short getEventType() const { return events_->getType(); }
    /// Shows the fields of that kind.
    void SetEventType(short type) { events_->setType(type); }
    Date getCompanyEventDate() const { return events_->getDate(); }
    void setCompanyEventDate(const Date& date) { events_->setDate(date); }
    String getCompanyEventTitle() const { return events_->getTitle(); }
    void setCompanyEventTitle(const String& title) { events_->setTitle(title); }
    String getCompanyEventText() const { return events_->getText(); }
    void setCompanyEventText(const String& text) { events_->setText(text); }
    short getCompanyEventNumerator() const { return events_->getNumerator(); }
    void setCompanyEventNumerator(short numerator) { events_->setNumerator(numerator); }
    short getCompanyEventDivider() const { return events_->getDivider(); }
    void setCompanyEventDivider(short divider) { events_->setDivider(divider); }
    CompanyEvent* GetSelectedCompanyEvent() const { return events_->list().selected(); }
    /// @return a new array, by date; the caller deletes it.
    CompanyEvent** GetAllSelectedCompanyEvents(int* n) const;
    void AddCompanyEvent(CompanyEvent* event, bool selected);
    void ModifyCompanyEvent(CompanyEvent* event);
    void DeleteCompanyEvent(CompanyEvent* event) { DeleteCompanyEvents({&event, 1}); }
    /// The same for many at once.
    void DeleteCompanyEvents(std::span<CompanyEvent* const> events);
    /// Shows the events of `company`; null shows none.
    void SetCompanyEventList(Company* company);

    /// What the lists show. `markets` are those of the catalogue, in its order.
    struct Places {
        ListPlaces markets;
        std::optional<std::size_t> shownMarket; // whose companies are listed
        ListPlaces companies;
        std::optional<std::size_t> shownCompany; // the selected one, whose quotes and events are listed
        ListPlaces quotes;
        ListPlaces events;
    };
    Places places(const std::vector<Market*>& markets) const;
    /// Brings back the rows and what was selected, in lists that show nothing; sends no message.
    void restore(const Places& places, const std::vector<Market*>& markets);

private:
    void makeMarkets(BRect frame);
    void makeCompanies(BRect frame);
    void nameTrend(const String& currency);
    void makeQuotes(BRect frame);
    void fillChart(QuoteChart& chart, const Company& company) const override;

    MarketListView* markets_ = nullptr;
    BTextControl* marketName_ = nullptr;
    BTextControl* marketCurrency_ = nullptr;
    BBox* companiesBox_ = nullptr;
    CompanyListView* companies_ = nullptr;
    BTextControl* abbreviation_ = nullptr;
    BTextControl* companyName_ = nullptr;
    BTextControl* relativeDailyChange_ = nullptr;
    BTextControl* diffWithAverage_ = nullptr;
    NumberControl* splitNumerator_ = nullptr;
    NumberControl* splitDenominator_ = nullptr;
    BCheckBox* withSafe_ = nullptr;
    EventBox* events_ = nullptr;

    // Whose rows the lists show; never looked into when they are not selected.
    const Market* shownMarket_ = nullptr;
    const Company* eventsOf_ = nullptr;

    std::span<CompanyEvent* const> leavingEvents_; // while the page takes out what is about to be destroyed
};
