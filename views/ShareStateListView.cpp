#include "views/ShareStateListView.h"

#include "foundation/NumberText.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"
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

bool hasRate(const Company& company)
{
    Market* market = nullptr;
    Currency* currency = nullptr;
    return company.getMarket(&market) == 0 && market->getCurrency(&currency) == 0 && currency->getNbrQuotes() > 0;
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
        if (hasQuote && isHeld() && !hasRate(*company))
            return {"no rate", look::kWarning}; // and so it counts as 0 in the totals
        return {hasQuote && isHeld() ? withCurrency(*state_, 1.0 * state_->getQuantity() * state_->getQuote()) : ""};
    case kGain:
        return gain();
    case kEndDate:
        return {isHeld() ? dateText(state_->getEndDate()) : ""};
    default:
        return {};
    }
}

/// Empty where there is a quote of the day shown; otherwise the day of the one that counts, with "~" before the day
/// that an estimate starts from: outside the series the quote is on a straight line.
Cell ShareStateItem::quoteDay() const
{
    const Company* company = companyOf(share_);
    if (company == nullptr || company->getNbrQuotes() == 0)
        return {};
    const Date day = state_->getDate();
    const Date quoted = company->getLastQuoteUpTo(day);
    if (quoted == day)
        return {};
    const bool isEstimate = company->getNbrQuotes() > 1 && (quoted.isUndefined() || day > company->getLastQuote());
    const std::string text = dateText(quoted.isUndefined() ? company->getFirstQuote() : quoted);
    return {(isEstimate ? "~ " : "") + text, quoted.isUndefined() ? look::kWarning : look::kFaint};
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
                      {"Company", 136},
                      {"Quantity", 60, B_ALIGN_RIGHT},
                      {"Buy Quote", 72, B_ALIGN_RIGHT},
                      {"Quote", 64, B_ALIGN_RIGHT},
                      {"Quote of", 100, B_ALIGN_RIGHT},
                      {"Value", 110, B_ALIGN_RIGHT},
                      {"Gain", 66, B_ALIGN_RIGHT},
                      {"End Date", 82, B_ALIGN_RIGHT}})
{}
