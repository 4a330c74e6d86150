#pragma once

#include "platform/Box.h"
#include "views/DateControl.h"
#include "views/MarketDataLists.h"
#include "views/NumberControl.h"

/// A list of quotes with the fields and buttons to add, change and remove them.
///
/// The rows are those of one series, by date. Its address is kept to tell it from others, and never looked into.
class QuoteBox final : public BBox {
public:
    /// What is sent by the list, by the fields, and by the buttons.
    struct Codes {
        uint32 selection;
        uint32 date;
        uint32 value;
        uint32 add;
        uint32 update;
        uint32 remove;
    };

    QuoteBox(BRect frame, const char* title, const Codes& codes);

    QuoteListView& list() const { return *list_; }
    /// Shows the quotes of a `QuoteSeries`, which stay as they are when they are shown already; null shows none.
    template <class Series>
    void showQuotes(const Series* series)
    {
        const bool isOther = !isOf(series);
        if (isOther)
            list_->clear(); // before the address changes: what was selected is not to be found again
        series_ = series;
        std::vector<Quote*> quotes;
        if (series != nullptr)
            quotes.assign(series->quotes().begin(), series->quotes().end());
        list_->showAll(std::move(quotes));
        if (isOther)
            list_->ScrollTo(list_->CountItems() - 1); // the latest quote
    }
    /// Whether it is this series whose quotes are shown.
    bool isOf(const void* series) const { return series == series_; }

    /// Undefined while the text is no date.
    Date getDate() const { return date_->getDate(); }
    void setDate(const Date& date) { date_->setDate(date); }
    void clearFields()
    {
        date_->setDate(Date());
        value_->SetText("");
        value_->MarkAsInvalid(nullptr);
    }
    float getValue() const { return value_->getNumber(); }
    void setValue(float value) { value_->setNumber(value); }

    /// What is left free for more controls, in the box's coordinates.
    BRect freeArea() const { return freeArea_; }

private:
    QuoteListView* list_;
    const void* series_ = nullptr; // whose quotes are shown; never looked into
    DateControl* date_;
    NumberControl* value_;
    BRect freeArea_;
};
