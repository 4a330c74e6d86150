#include "views/CompanyListView.h"

#include "views/ModelText.h"

Cell CompanyItem::cell(int column) const
{
    return {textOf(column == 0 ? object_->getAbbreviation() : object_->getName())};
}

CompanyListView::CompanyListView(const char* name)
    : ObjectListView({}, name, B_SINGLE_SELECTION_LIST, {{"Ticker", 66}, {"Company", 176}})
{}
