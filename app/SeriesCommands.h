#pragma once

#include "app/PLWindow.h"
#include "app/WindowLock.h"
#include "foundation/Date.h"
#include "views/CompanyView.h"

#include <cstddef>
#include <memory>
#include <type_traits>
#include <utility>

/// The commands on the quotes of the selected company and of the selected currency. `Page` is the page of either: their
/// methods for quotes have the same names.
namespace series_commands {

/// The class of the quotes on `Page`.
template <class Page>
using QuoteOf = std::remove_pointer_t<decltype(std::declval<const Page&>().GetSelectedQuote())>;

/// What the commands that change quotes end with.
template <class Page>
void showChange(PLWindow& window, Page& page)
{
    page.UpdateQuotesChart();
    window.UpdateState();
}

/// `series` is what is selected; `unselected` the message for null.
template <class Page, class Series>
void addQuote(PLWindow& window, Page& page, Series* series, const char* unselected)
{
    const WindowLock lock(window);
    if (!lock.isHeld())
        return;
    const Date date = page.getQuoteDate();
    if (date.isUndefined()) {
        window.SetMessage("Please specify a date.");
        return;
    }
    if (series == nullptr) {
        window.SetMessage(unselected);
        return;
    }
    const float value = page.getQuoteValue();
    QuoteOf<Page>* quote;
    if (series->getQuote(date, &quote) == 0) {
        quote->setValue(value);
        page.ModifyQuote(quote);
    } else {
        page.AddQuote(new QuoteOf<Page>(series, date, value));
    }
    showChange(window, page);
}

/// Gives the selected quote the day and the value of the page's fields.
template <class Page>
void updateQuote(PLWindow& window, Page& page)
{
    const WindowLock lock(window);
    if (!lock.isHeld())
        return;
    if (QuoteOf<Page>* quote = page.GetSelectedQuote()) {
        const Date date = page.getQuoteDate();
        if (date.isUndefined()) {
            window.SetMessage("Please specify a date.");
            return;
        }
        // Another quote may have that day; both stay.
        quote->setDate(date);
        quote->setValue(page.getQuoteValue());
        page.ModifyQuote(quote);
    } else {
        window.SetMessage("You must first select a quote");
    }
    showChange(window, page);
}

/// Destroys all selected quotes.
template <class Page>
void removeQuotes(PLWindow& window, Page& page)
{
    const WindowLock lock(window);
    if (!lock.isHeld())
        return;
    int n;
    const std::unique_ptr<QuoteOf<Page>*[]> quotes(page.getAllSelectedQuotes(&n));
    page.DeleteQuotes(quotes.get(), n);
    for (int i = 0; i < n; ++i)
        delete quotes[static_cast<std::size_t>(i)];
    showChange(window, page);
}

/// Puts the selected quote into the page's fields.
template <class Page>
void showSelectedQuote(PLWindow& window, Page& page)
{
    const WindowLock lock(window);
    if (!lock.isHeld())
        return;
    if (const QuoteOf<Page>* quote = page.GetSelectedQuote()) {
        page.setQuoteDate(quote->getDate());
        page.setQuoteValue(quote->getValue());
    }
    page.UpdateQuotesChart();
}

/// Puts into the company page's two fields how much the trend line of `series` rises in a day, and how far the last
/// quote stands above it, both in proportion to the line on the day of that quote. A trend of 0 is not guarded against:
/// the fields then say that there is no number.
template <class Series>
void showTrend(CompanyView& page, const Series& series)
{
    const Date last = series.getLastQuote();
    const double trend = series.getPrevisionQuote(last);
    page.setRelativeDailyChange(static_cast<float>(series.getPente() / trend));
    page.setDiffWithAverage(static_cast<float>((series.getRealQuote(last) - trend) / trend));
}

} // namespace series_commands
