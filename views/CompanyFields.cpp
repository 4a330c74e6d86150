// What the company page shows and gives back, list by list.

#include "views/CompanyView.h"

#include "foundation/NumberText.h"
#include "market/Company.h"
#include "market/Market.h"
#include "platform/CheckBox.h"
#include "platform/TextControl.h"
#include "views/CompanyEventListView.h"
#include "views/CompanyListView.h"
#include "views/EventBox.h"
#include "views/MarketListView.h"
#include "views/ModelText.h"
#include "views/NumberControl.h"
#include "views/QuoteBox.h"
#include "views/QuoteChart.h"
#include "views/QuoteListView.h"
#include "views/Selection.h"

// --- Markets.

String CompanyView::getMarketName() const
{
    return marketName_->Text();
}

void CompanyView::setMarketName(const String& name)
{
    showText(*marketName_, name);
}

String CompanyView::getMarketCurrencyRepresentation() const
{
    return marketCurrency_->Text();
}

void CompanyView::setMarketCurrencyRepresentation(const String& representation)
{
    showText(*marketCurrency_, representation);
}

Market* CompanyView::GetSelectedMarket() const
{
    return markets_->selected();
}

void CompanyView::AddMarket(Market* market, bool selected)
{
    markets_->add(market);
    if (selected)
        markets_->select(market);
}

void CompanyView::ModifyMarket(Market* market)
{
    markets_->modify(market);
}

void CompanyView::DeleteMarket(Market* market)
{
    markets_->remove(market);
    if (market == shownMarket_)
        SetCompanyList(nullptr);
}

void CompanyView::SetMarketList(const std::vector<Market*>& markets)
{
    markets_->setAll(markets);
    SetCompanyList(nullptr);
}

// --- Companies.

String CompanyView::getCompanyName() const
{
    return companyName_->Text();
}

void CompanyView::setCompanyName(const String& name)
{
    showText(*companyName_, name);
}

String CompanyView::getCompanyAbbreviation() const
{
    return abbreviation_->Text();
}

void CompanyView::setCompanyAbbreviation(const String& abbreviation)
{
    showText(*abbreviation_, abbreviation);
}

void CompanyView::setRelativeDailyChange(float change)
{
    relativeDailyChange_->SetText(finePercentText(change).c_str());
}

void CompanyView::setDiffWithAverage(float difference)
{
    diffWithAverage_->SetText(percentText(difference).c_str());
}

Company* CompanyView::GetSelectedCompany() const
{
    return companies_->selected();
}

void CompanyView::AddCompany(Company* company, bool selected)
{
    Market* market;
    markets_->InvalidateItems(); // they count their companies
    if (company->getMarket(&market) != 0 || market != shownMarket_)
        return;
    companies_->add(company);
    if (selected)
        companies_->select(company);
}

void CompanyView::ModifyCompany(Company* company)
{
    companies_->modify(company);
    if (!quotes_->isOf(company))
        return;
    SetQuoteList(company);
    UpdateQuotesChart();
}

void CompanyView::DeleteCompany(Company* company)
{
    companies_->remove(company);
    markets_->InvalidateItems();
    if (quotes_->isOf(company))
        SetQuoteList(nullptr);
    if (company == eventsOf_)
        SetCompanyEventList(nullptr);
}

void CompanyView::SetCompanyList(Market* market)
{
    if (market != shownMarket_)
        companies_->clear(); // what is selected in it is not to be found again
    shownMarket_ = market;
    unsigned n = 0;
    Company** companies = market != nullptr ? market->getAllCompanies(&n) : nullptr;
    companies_->setAll({companies, companies + n});
    const Company* selected = GetSelectedCompany();
    if (selected == nullptr || !quotes_->isOf(selected)) {
        SetQuoteList(nullptr);
        SetCompanyEventList(nullptr);
    }
}

BListView* CompanyView::getCompanyListView() const
{
    return companies_;
}

// --- Quotes.

Date CompanyView::getQuoteDate() const
{
    return quotes_->getDate();
}

void CompanyView::setQuoteDate(const Date& date)
{
    quotes_->setDate(date);
}

float CompanyView::getQuoteValue() const
{
    return quotes_->getValue();
}

void CompanyView::setQuoteValue(float value)
{
    quotes_->setValue(value);
}

double CompanyView::getSplitFactor() const
{
    const double denominator = splitDenominator_->getNumber();
    return denominator != 0 ? splitNumerator_->getNumber() / denominator : 0;
}

CompanyQuote* CompanyView::GetSelectedQuote() const
{
    return static_cast<CompanyQuote*>(quotes_->list().selected());
}

CompanyQuote** CompanyView::getAllSelectedQuotes(int* n) const
{
    return newArrayOf<CompanyQuote>(quotes_->list().allSelected(), n);
}

void CompanyView::AddQuote(CompanyQuote* quote)
{
    Company* company;
    if (quote->getCompany(&company) == 0 && quotes_->isOf(company))
        quotes_->list().insert(quote);
}

void CompanyView::ModifyQuote(CompanyQuote* quote)
{
    quotes_->list().update(quote);
}

void CompanyView::DeleteQuote(CompanyQuote* quote)
{
    DeleteQuotes(&quote, 1);
}

void CompanyView::DeleteQuotes(CompanyQuote* const* quotes, int n)
{
    quotes_->list().removeAll({quotes, quotes + n});
}

void CompanyView::SetQuoteList(Company* company)
{
    quotes_->showQuotes(company);
    if (company == nullptr)
        UpdateQuotesChart();
}

void CompanyView::UpdateQuotesChart()
{
    const Company* company = GetSelectedCompany();
    if (company == nullptr) {
        chart_->showNothing();
        return;
    }
    const String unit = company->getCurrencyRepresentation();
    chart_->showSeries(*company, textOf(company->getAbbreviation()), unit.isUndefined() ? "???" : textOf(unit),
                       withSafe_->Value() == B_CONTROL_ON);
}

// --- Events.

short CompanyView::getEventType() const
{
    return events_->getType();
}

void CompanyView::SetEventType(short type)
{
    events_->setType(type);
}

Date CompanyView::getCompanyEventDate() const
{
    return events_->getDate();
}

void CompanyView::setCompanyEventDate(const Date& date)
{
    events_->setDate(date);
}

String CompanyView::getCompanyEventTitle() const
{
    return events_->getTitle();
}

void CompanyView::setCompanyEventTitle(const String& title)
{
    events_->setTitle(title);
}

String CompanyView::getCompanyEventText() const
{
    return events_->getText();
}

void CompanyView::setCompanyEventText(const String& text)
{
    events_->setText(text);
}

short CompanyView::getCompanyEventNumerator() const
{
    return events_->getNumerator();
}

void CompanyView::setCompanyEventNumerator(short numerator)
{
    events_->setNumerator(numerator);
}

short CompanyView::getCompanyEventDivider() const
{
    return events_->getDivider();
}

void CompanyView::setCompanyEventDivider(short divider)
{
    events_->setDivider(divider);
}

CompanyEvent* CompanyView::GetSelectedCompanyEvent() const
{
    return events_->list().selected();
}

CompanyEvent** CompanyView::GetAllSelectedCompanyEvents(int* n) const
{
    return newArrayOf<CompanyEvent>(events_->list().allSelected(), n);
}

void CompanyView::AddCompanyEvent(CompanyEvent* event, bool selected)
{
    Company* company;
    if (event->getCompany(&company) != 0 || company != eventsOf_)
        return;
    events_->list().insert(event);
    if (selected)
        events_->list().select(event);
}

void CompanyView::ModifyCompanyEvent(CompanyEvent* event)
{
    events_->list().update(event);
}

void CompanyView::DeleteCompanyEvent(CompanyEvent* event)
{
    DeleteCompanyEvents(&event, 1);
}

void CompanyView::DeleteCompanyEvents(CompanyEvent* const* events, int n)
{
    events_->list().removeAll({events, events + n});
}

void CompanyView::SetCompanyEventList(Company* company)
{
    if (company != eventsOf_)
        events_->list().clear();
    eventsOf_ = company;
    unsigned n = 0;
    CompanyEvent** events = company != nullptr ? company->getAllEvents(&n) : nullptr;
    events_->list().showAll({events, events + n});
}
