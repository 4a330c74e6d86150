#include "views/StateLists.h"

#include "foundation/DateText.h"
#include "foundation/NumberText.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "portfolio/Account.h"
#include "valuation/State.h"
#include "valuation/Totals.h"
#include "views/Look.h"
#include "views/ModelText.h"

namespace {

/// "12.3 %": in one decimal, as far as anybody asks.
std::string shareText(double fraction)
{
    const std::string text = changeText(fraction);
    return text.starts_with('+') ? text.substr(1) : text;
}

constexpr std::size_t kReferenceColumn = 7;

// Accounts. Name and currency are the account's as they are now, the balance is that of the valuation.

Cell balance(const AccountState& state)
{
    return {amountText(state.getCash()), state.getCash() < 0 ? look::kLoss : look::kText, state.getCash()};
}

Cell currencyOf(const AccountState& state)
{
    const Currency* currency = state.account() != nullptr ? state.account()->currency() : nullptr;
    // Such a balance counts as 0 in the totals.
    if (currency == nullptr)
        return {"no currency", look::kWarning};
    if (currency->getNbrQuotes() == 0)
        return {textOf(currency->getRepresentation()) + " (no rate)", look::kWarning};
    return {textOf(currency->getRepresentation())};
}

Cell defaultMark(const AccountState& state)
{
    return {state.account() != nullptr && state.account()->isDefaultTransferAccount() ? "\u2713" : ""};
}

// Holdings. What is sold stays in the list, faint and without amounts.

using Item = ShareStateItem;

Cell name(const ShareState& state, const String& text)
{
    return {textOf(text), state.isHeld() ? look::kText : look::kFaint};
}

Cell quantity(const Item& item)
{
    // More was sold than bought: a mistake among the operations.
    const int quantity = item.object()->getQuantity();
    return {countText(quantity), quantity < 0 ? look::kLoss : look::kText, quantity};
}

Cell quote(const Item& item)
{
    // Without a quote the holding counts as 0 in the totals.
    const float quote = item.object()->getQuote();
    return item.basis().isKnown ? Cell{amountText(quote), look::kText, quote} : Cell{"no quote", look::kWarning};
}

/// Empty where there is a quote of the day shown; otherwise the day of the one that counts, with "~" before the day
/// that an estimate starts from.
Cell quoteDay(const Item& item)
{
    const QuoteBasis& basis = item.basis();
    const Date day = item.object()->getDate();
    if (!basis.isKnown || basis.day == day)
        return {};
    return {(basis.isEstimate ? "~ " : "") + dateText(basis.day), basis.day > day ? look::kWarning : look::kFaint,
            dayOrder(basis.day)};
}

Cell ownValue(const Item& item)
{
    const ShareState& state = *item.object();
    if (!item.basis().isKnown || !state.isHeld())
        return {};
    if (!item.basis().hasRate)
        return {"no rate", look::kWarning}; // and so it counts as 0 in the totals
    return {amountText(state.worth()), look::kText, state.worth(), textOf(state.getCurrencyRepresentation())};
}

Cell referenceValue(const Item& item)
{
    return item.value() ? Cell{amountText(*item.value()), look::kText, item.value(), item.reference()} : Cell();
}

Cell partOfAll(const Item& item)
{
    return item.part() ? Cell{shareText(*item.part()), look::kText, item.part()} : Cell();
}

Cell gain(const Item& item)
{
    const auto gain = item.object()->gain();
    return gain ? Cell{changeText(*gain), *gain < 0 ? look::kLoss : look::kGain, gain} : Cell();
}

Cell buyQuote(const Item& item)
{
    const float quote = item.object()->getBuyQuote();
    return item.object()->isHeld() ? Cell{amountText(quote), look::kText, quote} : Cell();
}

Cell endDate(const Item& item)
{
    const Date end = item.object()->getEndDate();
    return item.object()->isHeld() ? Cell{dateText(end), look::kText, dayOrder(end)} : Cell();
}

} // namespace

const std::vector<ColumnOf<AccountState>> AccountStateItem::kColumns = {
    {{"Account", 172}, [](const AccountState& s) { return Cell{textOf(s.getAccountName())}; }},
    {{"Balance", 100, B_ALIGN_RIGHT}, balance},
    {{"Currency", 96}, currencyOf},
    {{"Default", 56, B_ALIGN_CENTER}, defaultMark},
};

// All of them fit into the page.
const std::vector<ColumnOf<ShareStateItem>> ShareStateItem::kColumns = {
    {{"Ticker", 50}, [](const Item& i) { return name(*i.object(), i.object()->getCompanyAbbreviation()); }},
    {{"Company", 106}, [](const Item& i) { return name(*i.object(), i.object()->getCompanyName()); }},
    {{"Quantity", 62, B_ALIGN_RIGHT}, quantity},
    {{"Buy Quote", 76, B_ALIGN_RIGHT}, buyQuote},
    {{"Quote", 62, B_ALIGN_RIGHT}, quote},
    {{"Quote of", 92, B_ALIGN_RIGHT}, quoteDay},
    {{"Value", 106, B_ALIGN_RIGHT, UnitPlace::kShown}, ownValue},
    {{"In ???", 76, B_ALIGN_RIGHT, UnitPlace::kCopied}, referenceValue},
    {{"Part", 50, B_ALIGN_RIGHT}, partOfAll},
    {{"Gain", 68, B_ALIGN_RIGHT}, gain},
    {{"End Date", 82, B_ALIGN_RIGHT, UnitPlace::kNone, true}, endDate}, // see `ShareStateItem::kEndDate`,
};

void ShareStateItem::showIn(const std::string& symbol, double rate, double total)
{
    const Company* company = share_ != nullptr ? share_->company() : nullptr;
    const Market* market = company != nullptr ? company->market() : nullptr;
    const Currency* currency = market != nullptr ? market->currency() : nullptr;
    // Where the row says no value in its own currency, there is none in another.
    if (rate == 0 || !basis_.isKnown || !basis_.hasRate || !state_->isHeld() || currency == nullptr)
        return;
    reference_ = symbol;
    value_ = state_->worth() * currency->getRealQuote(state_->getDate()) / rate;
    if (total > 0)
        part_ = *value_ / total;
}

void ShareStateListView::addAllOf(const State& state, const Totals& totals)
{
    const auto shares = state.shareStates();
    const int32 first = CountRows();
    addAll({shares.begin(), shares.end()});
    if (totals.reference == nullptr)
        return;
    const std::string symbol = textOf(totals.reference->getRepresentation());
    setTitle(kReferenceColumn, "In " + symbol);
    const double rate = totals.reference->getRealQuote(state.getDate());
    for (int32 i = first; i < CountRows(); ++i)
        static_cast<ShareStateItem*>(rowAt(i))->showIn(symbol, rate, totals.totalValue);
}
