#include "app/QuoteEditor.h"

#include "app/PLWindow.h"

#include "views/ModelText.h"

#include <memory>

namespace {

std::string nameOf(const Company& company)
{
    const Market* market = company.market();
    return (market != nullptr ? textOf(market->getName()) : "") + '\n' + textOf(company.getAbbreviation());
}

std::string nameOf(const Currency& currency)
{
    return textOf(currency.getName());
}

} // namespace

template <class Series>
void QuoteEditor<Series>::showChange()
{
    page_.UpdateQuotesChart();
    window_.UpdateState();
}

template <class Series>
void QuoteEditor<Series>::add()
{
    const Date date = page_.getQuoteDate();
    if (date.isUndefined())
        return window_.SetMessage("Please specify a date.");
    Series* series = page_.selectedSeries();
    if (series == nullptr)
        return window_.SetMessage(unselected_);
    // Before and after, this command leaves one quote on the day: it never makes a second one.
    const float value = page_.getQuoteValue();
    SeriesQuote* quote;
    if (series->getQuote(date, &quote) == 0) {
        quote->setValue(value);
        page_.ModifyQuote(quote);
    } else {
        page_.AddQuote(new SeriesQuote(series, date, value)); // the series owns it
    }
    showChange();
}

template <class Series>
void QuoteEditor<Series>::update()
{
    if (SeriesQuote* quote = page_.GetSelectedQuote()) {
        const Date date = page_.getQuoteDate();
        if (date.isUndefined())
            return window_.SetMessage("Please specify a date.");
        // Another quote may have that day; both stay. The row moves to where the new day belongs.
        quote->setDate(date);
        quote->setValue(page_.getQuoteValue());
        page_.ModifyQuote(quote);
    } else {
        window_.SetMessage("You must first select a quote");
    }
    showChange();
}

template <class Series>
void QuoteEditor<Series>::remove()
{
    int n;
    const std::unique_ptr<SeriesQuote*[]> array(page_.getAllSelectedQuotes(&n));
    const std::span quotes(array.get(), static_cast<std::size_t>(n));
    page_.DeleteQuotes(quotes); // the rows first: they look at the quotes' dates
    for (SeriesQuote* quote : quotes)
        delete quote;
    showChange();
}

template <class Series>
void QuoteEditor<Series>::showSelected()
{
    if (const SeriesQuote* quote = page_.GetSelectedQuote()) {
        page_.setQuoteDate(quote->getDate());
        page_.setQuoteValue(quote->getValue());
    }
    page_.UpdateQuotesChart();
}

template <class Series>
void QuoteEditor<Series>::followSeries()
{
    const Series* series = page_.selectedSeries();
    if (series == nullptr) {
        series_ = nullptr; // it may be gone, and the next one come to its address
        return;
    }
    const std::string name = nameOf(*series);
    if (!name_.empty() && series != series_ && name != name_)
        page_.clearQuoteFields();
    series_ = series;
    name_ = name;
}

template class QuoteEditor<Company>;
template class QuoteEditor<Currency>;
