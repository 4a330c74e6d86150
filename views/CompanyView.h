#pragma once

#include "foundation/Date.h"
#include "foundation/String.h"
#include "views/PageView.h"

#include <vector>

class BListView;
class Company;
class CompanyEvent;
class CompanyListView;
class CompanyQuote;
class EventBox;
class Market;
class MarketListView;
class QuoteBox;
class QuoteChart;

/// The page of markets and companies, with the quotes and events of the selected company.
///
/// A row is taken out by `Delete...` before its object is destroyed. What is told of an object that is not shown has
/// no effect.
class CompanyView final : public PageView {
public:
    CompanyView(BRect frame, const char* name, BWindow* window);

    // Markets.
    String getMarketName() const;
    void setMarketName(const String& name);
    /// The symbol as it was typed.
    String getMarketCurrencyRepresentation() const;
    void setMarketCurrencyRepresentation(const String& representation);
    /// Null when none is selected, like all of these.
    Market* GetSelectedMarket() const;
    void AddMarket(Market* market, bool selected);
    void ModifyMarket(Market* market);
    /// Empties the lists of what belongs to the market, too.
    void DeleteMarket(Market* market);
    /// Fills the market list; the company list becomes empty.
    void SetMarketList(const std::vector<Market*>& markets);

    // Companies of the selected market.
    String getCompanyName() const;
    void setCompanyName(const String& name);
    /// The ticker.
    String getCompanyAbbreviation() const;
    void setCompanyAbbreviation(const String& abbreviation);
    /// Both as fractions of the trend; shown as percentages.
    void setRelativeDailyChange(float change);
    void setDiffWithAverage(float difference);
    Company* GetSelectedCompany() const;
    void AddCompany(Company* company, bool selected);
    /// Its quotes may have changed, too.
    void ModifyCompany(Company* company);
    void DeleteCompany(Company* company);
    /// Shows the companies of `market`; null shows none.
    void SetCompanyList(Market* market);
    BListView* getCompanyListView() const;

    // Quotes of the selected company.
    Date getQuoteDate() const;
    void setQuoteDate(const Date& date);
    float getQuoteValue() const;
    void setQuoteValue(float value);
    /// What quotes are multiplied by in a split, from its two fields; 0 while they hold none.
    double getSplitFactor() const;
    CompanyQuote* GetSelectedQuote() const;
    /// @return a new array, by date; the caller deletes it.
    CompanyQuote** getAllSelectedQuotes(int* n) const;
    void AddQuote(CompanyQuote* quote);
    void ModifyQuote(CompanyQuote* quote);
    void DeleteQuote(CompanyQuote* quote);
    /// The same for many at once.
    void DeleteQuotes(CompanyQuote* const* quotes, int n);
    /// Shows the quotes of `company`, which stay as they are when they are shown already; null shows none.
    void SetQuoteList(Company* company);
    /// Draws the quotes of the selected company anew.
    void UpdateQuotesChart();

    // Events of the selected company.
    /// 1 split, 2 note.
    short getEventType() const;
    /// Shows the fields of that kind.
    void SetEventType(short type);
    Date getCompanyEventDate() const;
    void setCompanyEventDate(const Date& date);
    String getCompanyEventTitle() const;
    void setCompanyEventTitle(const String& title);
    String getCompanyEventText() const;
    void setCompanyEventText(const String& text);
    short getCompanyEventNumerator() const;
    void setCompanyEventNumerator(short numerator);
    short getCompanyEventDivider() const;
    void setCompanyEventDivider(short divider);
    CompanyEvent* GetSelectedCompanyEvent() const;
    /// @return a new array, by date; the caller deletes it.
    CompanyEvent** GetAllSelectedCompanyEvents(int* n) const;
    void AddCompanyEvent(CompanyEvent* event, bool selected);
    void ModifyCompanyEvent(CompanyEvent* event);
    void DeleteCompanyEvent(CompanyEvent* event);
    /// The same for many at once.
    void DeleteCompanyEvents(CompanyEvent* const* events, int n);
    /// Shows the events of `company`; null shows none.
    void SetCompanyEventList(Company* company);

private:
    void makeMarkets(BRect frame);
    void makeCompanies(BRect frame);
    void makeQuotes(BRect frame);

    MarketListView* markets_ = nullptr;
    BTextControl* marketName_ = nullptr;
    BTextControl* marketCurrency_ = nullptr;
    CompanyListView* companies_ = nullptr;
    BTextControl* abbreviation_ = nullptr;
    BTextControl* companyName_ = nullptr;
    BTextControl* relativeDailyChange_ = nullptr;
    BTextControl* diffWithAverage_ = nullptr;
    QuoteBox* quotes_ = nullptr;
    NumberControl* splitNumerator_ = nullptr;
    NumberControl* splitDenominator_ = nullptr;
    BCheckBox* withSafe_ = nullptr;
    EventBox* events_ = nullptr;
    QuoteChart* chart_ = nullptr;

    // Whose rows the lists show; never looked into when they are not selected.
    const Market* shownMarket_ = nullptr;
    const Company* eventsOf_ = nullptr;
};
