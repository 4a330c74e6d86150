#include "views/StateLists.h"

#include "foundation/DateText.h"
#include "foundation/NumberText.h"
#include "market/Currency.h"
#include "portfolio/Account.h"
#include "views/Look.h"
#include "views/ModelText.h"

namespace {

// Accounts. Name and currency are the account's as they are now, the balance is that of the valuation.

Cell balance(const AccountState& state)
{
    return {amountText(state.getCash()), state.getCash() < 0 ? look::kLoss : look::kText};
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
    return {countText(quantity), quantity < 0 ? look::kLoss : look::kText};
}

Cell quote(const Item& item)
{
    // Without a quote the holding counts as 0 in the totals.
    return item.basis().isKnown ? Cell{amountText(item.object()->getQuote())} : Cell{"no quote", look::kWarning};
}

/// Empty where there is a quote of the day shown; otherwise the day of the one that counts, with "~" before the day
/// that an estimate starts from.
Cell quoteDay(const Item& item)
{
    const QuoteBasis& basis = item.basis();
    const Date day = item.object()->getDate();
    if (!basis.isKnown || basis.day == day)
        return {};
    return {(basis.isEstimate ? "~ " : "") + dateText(basis.day), basis.day > day ? look::kWarning : look::kFaint};
}

Cell value(const Item& item)
{
    const ShareState& state = *item.object();
    if (!item.basis().isKnown || !state.isHeld())
        return {};
    if (!item.basis().hasRate)
        return {"no rate", look::kWarning}; // and so it counts as 0 in the totals
    return {amountText(state.worth()) + ' ' + textOf(state.getCurrencyRepresentation())};
}

Cell gain(const Item& item)
{
    const auto gain = item.object()->gain();
    return gain ? Cell{changeText(*gain), *gain < 0 ? look::kLoss : look::kGain} : Cell();
}

/// `text` of a holding that there is still something of.
Cell whileHeld(const Item& item, const std::string& text)
{
    return {item.object()->isHeld() ? text : ""};
}

} // namespace

const std::vector<ColumnOf<AccountState>> AccountStateItem::kColumns = {
    {{"Account", 172}, [](const AccountState& s) { return Cell{textOf(s.getAccountName())}; }},
    {{"Balance", 100, B_ALIGN_RIGHT}, balance},
    {{"Currency", 96}, currencyOf},
    {{"Default", 56, B_ALIGN_CENTER}, defaultMark},
};

const std::vector<ColumnOf<ShareStateItem>> ShareStateItem::kColumns = {
    {{"Ticker", 56}, [](const Item& i) { return name(*i.object(), i.object()->getCompanyAbbreviation()); }},
    {{"Company", 136}, [](const Item& i) { return name(*i.object(), i.object()->getCompanyName()); }},
    {{"Quantity", 60, B_ALIGN_RIGHT}, quantity},
    {{"Buy Quote", 72, B_ALIGN_RIGHT},
     [](const Item& i) { return whileHeld(i, amountText(i.object()->getBuyQuote())); }},
    {{"Quote", 64, B_ALIGN_RIGHT}, quote},
    {{"Quote of", 100, B_ALIGN_RIGHT}, quoteDay},
    {{"Value", 110, B_ALIGN_RIGHT}, value},
    {{"Gain", 66, B_ALIGN_RIGHT}, gain},
    {{"End Date", 82, B_ALIGN_RIGHT}, [](const Item& i) { return whileHeld(i, dateText(i.object()->getEndDate())); }},
};
