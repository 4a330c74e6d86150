#include "views/ShareStateListView.h"

#include "foundation/DateText.h"
#include "foundation/NumberText.h"
#include "views/Look.h"
#include "views/ModelText.h"

namespace {

enum Column { kTicker, kCompany, kQuantity, kBuyQuote, kQuote, kQuoteDay, kValue, kGain, kEndDate };

std::string withCurrency(const ShareState& state, double amount)
{
    return amountText(amount) + ' ' + textOf(state.getCurrencyRepresentation());
}

} // namespace

Cell ShareStateItem::cell(int column) const
{
    const bool isHeld = state_->isHeld();
    switch (column) {
    case kTicker:
        return {textOf(state_->getCompanyAbbreviation()), isHeld ? look::kText : look::kFaint};
    case kCompany:
        return {textOf(state_->getCompanyName()), isHeld ? look::kText : look::kFaint};
    case kQuantity:
        return {countText(state_->getQuantity()), state_->getQuantity() < 0 ? look::kLoss : look::kText};
    case kBuyQuote:
        return {isHeld ? amountText(state_->getBuyQuote()) : ""};
    case kQuote:
        // Without a quote the holding counts as 0 in the totals.
        return basis_.isKnown ? Cell{amountText(state_->getQuote())} : Cell{"no quote", look::kWarning};
    case kQuoteDay:
        return quoteDay();
    case kValue:
        if (basis_.isKnown && isHeld && !basis_.hasRate)
            return {"no rate", look::kWarning}; // and so it counts as 0 in the totals
        return {basis_.isKnown && isHeld ? withCurrency(*state_, state_->worth()) : ""};
    case kGain:
        return gain();
    case kEndDate:
        return {isHeld ? dateText(state_->getEndDate()) : ""};
    default:
        return {};
    }
}

/// Empty where there is a quote of the day shown; otherwise the day of the one that counts, with "~" before the day
/// that an estimate starts from.
Cell ShareStateItem::quoteDay() const
{
    const Date day = state_->getDate();
    if (!basis_.isKnown || basis_.day == day)
        return {};
    return {(basis_.isEstimate ? "~ " : "") + dateText(basis_.day), basis_.day > day ? look::kWarning : look::kFaint};
}

Cell ShareStateItem::gain() const
{
    const auto gain = state_->gain();
    return gain ? Cell{changeText(*gain), *gain < 0 ? look::kLoss : look::kGain} : Cell();
}

ShareStateListView::ShareStateListView(const char* name)
    : ObjectListView({}, name, B_SINGLE_SELECTION_LIST,
                     {{"Ticker", 56},
                      {"Company", 136},
                      {"Quantity", 60, B_ALIGN_RIGHT},
                      {"Buy Quote", 72, B_ALIGN_RIGHT},
                      {"Quote", 64, B_ALIGN_RIGHT},
                      {"Quote of", 100, B_ALIGN_RIGHT},
                      {"Value", 110, B_ALIGN_RIGHT},
                      {"Gain", 66, B_ALIGN_RIGHT},
                      {"End Date", 82, B_ALIGN_RIGHT}})
{}
