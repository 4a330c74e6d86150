#pragma once

#include "views/SeriesPage.h"

#include <string>

class PLWindow;

/// The commands on the quotes of the series that is selected on a page: of a company, or of a currency.
///
/// Those that change quotes leave a chart that shows the quotes that there are now, and a portfolio valued by them.
/// What a check refuses has changed nothing.
template <class Series>
class QuoteEditor {
public:
    /// `unselected` is what the status line says when no series is selected. Window and page outlive this.
    QuoteEditor(PLWindow& window, SeriesPage<Series>& page, const char* unselected)
        : window_(window), page_(page), unselected_(unselected)
    {}

    /// A quote that stands on that day already takes the value.
    void add();
    /// Gives the selected quote the day and the value of the page's fields.
    void update();
    /// Destroys all selected quotes.
    void remove();
    /// Puts the selected quote into the page's fields.
    void showSelected();
    /// A series was selected, or the same one shown again: what the fields hold of another one is not its.
    void followSeries();

private:
    using SeriesQuote = typename SeriesPage<Series>::SeriesQuote;

    void showChange();

    PLWindow& window_;
    SeriesPage<Series>& page_;
    const char* unselected_;
    // What the fields were for last. An undo makes the series anew, and a person may rename it: only one that differs
    // in both is another one.
    const Series* series_ = nullptr; // null while none is selected; never looked into
    std::string name_;               // empty before the first
};
