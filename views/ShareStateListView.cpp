#include "views/ShareStateListView.h"

#include "foundation/NumberText.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "portfolio/Share.h"
#include "views/DateText.h"
#include "views/Look.h"
#include "views/ModelText.h"

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
    return amountText(amount) + ' ' + textOf(state.getCurrencyRepresentation());
}

} // namespace

ShareStateItem::ShareStateItem(ShareState* state) : state_(state), share_(state->share())
{
    const Company* company = companyOf(share_);
    if (company == nullptr || company->getNbrQuotes() == 0)
        return;
    hasQuote_ = true;
    hasRate_ = hasRate(*company);
    const Date day = state->getDate();
    const Date quoted = company->getLastQuoteUpTo(day);
    quoteDay_ = quoted.isUndefined() ? company->getFirstQuote() : quoted;
    isEstimate_ = company->getNbrQuotes() > 1 && (quoted.isUndefined() || day > company->getLastQuote());
}

Cell ShareStateItem::cell(int column) const
{
    switch (column) {
    case kTicker:
        return {textOf(state_->getCompanyAbbreviation()), isHeld() ? look::kText : look::kFaint};
    case kCompany:
        return {textOf(state_->getCompanyName()), isHeld() ? look::kText : look::kFaint};
    case kQuantity:
        return {countText(state_->getQuantity()), state_->getQuantity() < 0 ? look::kLoss : look::kText};
    case kBuyQuote:
        return {isHeld() ? amountText(state_->getBuyQuote()) : ""};
    case kQuote:
        // Without a quote the holding counts as 0 in the totals.
        return hasQuote_ ? Cell{amountText(state_->getQuote())} : Cell{"no quote", look::kWarning};
    case kQuoteDay:
        return quoteDay();
    case kValue:
        if (hasQuote_ && isHeld() && !hasRate_)
            return {"no rate", look::kWarning}; // and so it counts as 0 in the totals
        return {hasQuote_ && isHeld() ? withCurrency(*state_, 1.0 * state_->getQuantity() * state_->getQuote()) : ""};
    case kGain:
        return gain();
    case kEndDate:
        return {isHeld() ? dateText(state_->getEndDate()) : ""};
    default:
        return {};
    }
}

/// Empty where there is a quote of the day shown; otherwise the day of the one that counts, with "~" before the day
/// that an estimate starts from.
Cell ShareStateItem::quoteDay() const
{
    const Date day = state_->getDate();
    if (!hasQuote_ || quoteDay_ == day)
        return {};
    return {(isEstimate_ ? "~ " : "") + dateText(quoteDay_), quoteDay_ > day ? look::kWarning : look::kFaint};
}

Cell ShareStateItem::gain() const
{
    if (!hasQuote_ || state_->getBuyQuote() == 0 || !isHeld())
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
