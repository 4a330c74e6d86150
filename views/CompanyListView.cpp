#include "views/CompanyListView.h"

Cell CompanyItem::cell(int column) const
{
    return {std::string((column == 0 ? company_->getAbbreviation() : company_->getName()).bytes())};
}

CompanyListView::CompanyListView(const char* name)
    : ObjectListView({}, name, B_SINGLE_SELECTION_LIST, {{"Ticker", 66}, {"Company", 176}})
{}
