#include "views/MarketListView.h"

#include "foundation/NumberText.h"
#include "views/ModelText.h"

namespace {

enum Column { kName, kCurrency, kCompanies };

} // namespace

Cell MarketItem::cell(int column) const
{
    switch (column) {
    case kName:
        return {textOf(object_->getName())};
    case kCurrency:
        return {textOf(object_->getCurrencyRepresentation())};
    case kCompanies:
        return {countText(static_cast<int>(object_->getNbrCompanies()))};
    default:
        return {};
    }
}

MarketListView::MarketListView(const char* name, float nameWidth)
    : ObjectListView({}, name, B_SINGLE_SELECTION_LIST,
                     {{"Market", nameWidth}, {"Currency", 66}, {"Companies", 78, B_ALIGN_RIGHT}})
{}
