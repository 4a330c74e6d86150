#include "views/ShareStateListView.h"

#include "foundation/NumberText.h"
#include "market/Company.h"
#include "portfolio/Share.h"
#include "views/DateText.h"
#include "views/Look.h"

namespace {

enum Column { kTicker, kCompany, kQuantity, kBuyQuote, kQuote, kQuoteDay, kValue, kGain, kEndDate };

const Company* companyOf(const Share* share)
{
    Company* company = nullptr;
    if (share != nullptr)
        share->getCompany(&company);
    return company;
}

std::string withCurrency(const ShareState& state, double amount)
{
    return amountText(amount) + ' ' + std::string(state.getCurrencyRepresentation().bytes());
}

} // namespace

ShareStateItem::ShareStateItem(ShareState* state) : state_(state), share_(state->listed()) {}

Cell ShareStateItem::cell(int column) const
{
    const Company* company = companyOf(share_);
    const bool hasQuote = company != nullptr && company->getNbrQuotes() > 0;
    switch (column) {
    case kTicker:
        return {std::string(state_->getCompanyAbbreviation().bytes()), isHeld() ? look::kText : look::kFaint};
    case kCompany:
        return {std::string(state_->getCompanyName().bytes()), isHeld() ? look::kText : look::kFaint};
    case kQuantity:
        return {countText(state_->getQuantity()), state_->getQuantity() < 0 ? look::kLoss : look::kText};
    case kBuyQuote:
        return {isHeld() ? amountText(state_->getBuyQuote()) : ""};
    case kQuote:
        // Without a quote the holding counts as 0 in the totals.
        return hasQuote ? Cell{amountText(state_->getQuote())} : Cell{"no quote", look::kWarning};
    case kQuoteDay:
        return quoteDay();
    case kValue:
        return {hasQuote && isHeld() ? withCurrency(*state_, 1.0 * state_->getQuantity() * state_->getQuote()) : ""};
    case kGain:
        return gain();
    case kEndDate:
        return {isHeld() ? dateText(state_->getEndDate()) : ""};
    default:
        return {};
    }
}

/// The day of the quote where that is not the day shown, which then is the last one there was or, after the last one of
/// all, an estimate; before the first one an estimate as well.
Cell ShareStateItem::quoteDay() const
{
    const Company* company = companyOf(share_);
    const Date day = state_->getDate();
    if (company == nullptr || company->getNbrQuotes() == 0)
        return {};
    if (day < company->getFirstQuote())
        return {"< " + dateText(company->getFirstQuote()), look::kWarning};
    CompanyQuote* quote = nullptr;
    if (company->getQuote(day, &quote) == 0)
        return {};
    return {dateText(company->getLastQuoteUpTo(day)), look::kFaint};
}

Cell ShareStateItem::gain() const
{
    const Company* company = companyOf(share_);
    if (company == nullptr || company->getNbrQuotes() == 0 || state_->getBuyQuote() == 0 || !isHeld())
        return {};
    const double gain = static_cast<double>(state_->getQuote()) / state_->getBuyQuote() - 1;
    return {changeText(gain), gain < 0 ? look::kLoss : look::kGain};
}

ShareStateListView::ShareStateListView(const char* name)
    : ObjectListView({}, name, B_SINGLE_SELECTION_LIST,
                     {{"Ticker", 56},
                      {"Company", 150},
                      {"Quantity", 60, B_ALIGN_RIGHT},
                      {"Buy Quote", 72, B_ALIGN_RIGHT},
                      {"Quote", 64, B_ALIGN_RIGHT},
                      {"Quote of", 86, B_ALIGN_RIGHT},
                      {"Value", 110, B_ALIGN_RIGHT},
                      {"Gain", 66, B_ALIGN_RIGHT},
                      {"End Date", 82, B_ALIGN_RIGHT}})
{}
