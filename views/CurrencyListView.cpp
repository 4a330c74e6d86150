#include "views/CurrencyListView.h"

#include "foundation/DateText.h"
#include "foundation/NumberText.h"
#include "views/Look.h"
#include "views/ModelText.h"

namespace {

enum Column { kName, kSymbol, kRate, kRateDay };

} // namespace

Cell CurrencyItem::cell(int column) const
{
    const unsigned rates = object_->getNbrQuotes();
    switch (column) {
    case kName:
        return {textOf(object_->getName())};
    case kSymbol:
        return {textOf(object_->getRepresentation())};
    case kRate:
        // What is held in a currency without a rate has no value.
        return rates > 0 ? Cell{exactText(object_->getQuote(rates - 1)->getValue())} : Cell{"no rate", look::kWarning};
    case kRateDay:
        return {dateText(object_->getLastQuote()), look::kFaint};
    default:
        return {};
    }
}

CurrencyListView::CurrencyListView(const char* name)
    : ObjectListView(
          {}, name, B_SINGLE_SELECTION_LIST,
          {{"Currency", 150}, {"Symbol", 62}, {"Latest Rate", 96, B_ALIGN_RIGHT}, {"Rate of", 82, B_ALIGN_RIGHT}})
{}
