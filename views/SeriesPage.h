#pragma once

#include "market/Currency.h"
#include "views/PageView.h"
#include "views/QuoteBox.h"
#include "views/QuoteChart.h"

#include <algorithm>
#include <span>
#include <type_traits>
#include <utility>

/// What is selected in a list, each of which is an `Object`, as a new array that the caller deletes. `*n` becomes their
/// number.
template <class Object, class Listed>
Object** newArrayOf(const std::vector<Listed*>& selected, int* n)
{
    auto** array = new Object*[selected.size()];
    std::ranges::transform(selected, array, [](Listed* object) { return static_cast<Object*>(object); });
    *n = static_cast<int>(selected.size());
    return array;
}

/// What the pages of companies and of currencies have in common: the quotes of the series that is selected on the page,
/// in a list with fields, and in a chart. `Series` is `Company` or `Currency`.
///
/// The list may go on showing one series while another one, or none, is selected: it changes with `SetQuoteList`, the
/// chart with `UpdateQuotesChart`. Rows are taken out before their quotes are destroyed.
template <class Series>
class SeriesPage : public PageView {
public:
    using SeriesQuote = std::remove_pointer_t<decltype(std::declval<const Series&>().getQuote(0U))>;

    /// Null when none is selected, like the next one.
    virtual Series* selectedSeries() const = 0;
    SeriesQuote* GetSelectedQuote() const { return static_cast<SeriesQuote*>(quotes_->list().selected()); }
    /// @return a new array, by date; the caller deletes it.
    SeriesQuote** getAllSelectedQuotes(int* n) const
    {
        return newArrayOf<SeriesQuote>(quotes_->list().allSelected(), n);
    }

    /// Undefined while the field holds no date.
    Date getQuoteDate() const { return quotes_->getDate(); }
    void setQuoteDate(const Date& date) { quotes_->setDate(date); }
    float getQuoteValue() const { return quotes_->getValue(); }
    void setQuoteValue(float value) { quotes_->setValue(value); }
    void clearQuoteFields() { quotes_->clearFields(); }

    // What is told of a quote that is not shown has no effect on the list.
    void AddQuote(SeriesQuote* quote)
    {
        const Series* series = seriesOf(*quote);
        if (series != nullptr && isShown(series))
            quotes_->list().insert(quote);
        noteQuoteChange();
    }
    void ModifyQuote(SeriesQuote* quote)
    {
        quotes_->list().update(quote);
        noteQuoteChange();
    }
    void DeleteQuote(SeriesQuote* quote) { DeleteQuotes({&quote, 1}); }
    /// The same for many at once.
    void DeleteQuotes(std::span<SeriesQuote* const> quotes)
    {
        quotes_->list().removeAll({quotes.begin(), quotes.end()});
        noteQuoteChange();
    }

    /// Quotes of `series` have come or changed, many perhaps.
    void RefreshQuotes(Series* series)
    {
        if (isShown(series)) {
            quotes_->showQuotes(series);
            UpdateQuotesChart();
        }
        noteQuoteChange();
    }

    /// Shows the quotes of `series`, which stay as they are when they are shown already; null shows none, in the chart
    /// either.
    void SetQuoteList(Series* series)
    {
        quotes_->showQuotes(series);
        if (series == nullptr)
            UpdateQuotesChart();
    }
    /// Draws the quotes of the selected series anew.
    void UpdateQuotesChart()
    {
        if (const Series* series = selectedSeries())
            fillChart(*chart_, *series);
        else
            chart_->showNothing();
    }

    /// What is selected and in view in the list of quotes.
    ListPlaces quoteSelection() const { return quotes_->list().selection(); }
    void restoreQuoteSelection(const ListPlaces& places) { quotes_->list().restoreSelection(places); }

protected:
    using PageView::PageView;

    /// Both are to be called by the page's constructor.
    QuoteBox* addQuotes(BRect frame, const char* title, const QuoteBox::Codes& codes)
    {
        AddChild(quotes_ = new QuoteBox(frame, title, codes));
        return quotes_;
    }
    QuoteChart* addChart(BRect frame)
    {
        AddChild(chart_ = new QuoteChart(frame));
        chart_->setHint("The values of the row that is selected above will be drawn here, with their trend.");
        return chart_;
    }

    /// Whether it is this series, not null, whose quotes are in the list.
    bool isShown(const Series* series) const { return quotes_->isOf(series); }
    void redrawQuotes() { quotes_->list().InvalidateItems(); }
    virtual void fillChart(QuoteChart& chart, const Series& series) const = 0;
    /// A quote came, changed or goes.
    virtual void noteQuoteChange() {}

private:
    static const Company* seriesOf(const CompanyQuote& quote) { return quote.company(); }
    static const Currency* seriesOf(const CurrencyQuote& quote) { return quote.currency(); }

    QuoteBox* quotes_ = nullptr;
    QuoteChart* chart_ = nullptr;
};
