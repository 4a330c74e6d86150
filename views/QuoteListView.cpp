#include "views/QuoteListView.h"

#include "foundation/NumberText.h"
#include "views/DateText.h"

Cell QuoteItem::cell(int column) const
{
    return {column == 0 ? dateText(quote_->getDate()) : exactText(quote_->getValue())};
}

QuoteListView::QuoteListView(const char* name)
    : DatedListView({}, name, B_MULTIPLE_SELECTION_LIST, {{"Date", 82}, {"Value", 96, B_ALIGN_RIGHT}})
{}
