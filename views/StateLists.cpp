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

#include <cmath>

namespace {

/// "12.3 %": in one decimal, as far as anybody asks.
std::string shareText(double fraction)
{
    const std::string text = changeText(fraction);
    return text.starts_with('+') ? text.substr(1) : text;
}

constexpr std::size_t kReferenceColumn = 7;
constexpr std::size_t kSumsInReference = 17; // and behind it

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

/// An amount out of the figures of a holding, in the currency of that symbol; a gain in colour.
Cell sumCell(const std::optional<double>& sum, bool isGain, const std::string& symbol)
{
    constexpr double kShown = 0.005; // less than that is shown as 0
    if (!sum)
        return {};
    const bool isPlain = !isGain || std::abs(*sum) < kShown;
    return {amountText(*sum), isPlain ? look::kText : *sum < 0 ? look::kLoss : look::kGain, sum, symbol};
}

template <auto kSum, bool kIsGain = false>
Cell ownSum(const Item& item)
{
    const HoldingFigures& figures = item.figures();
    if (figures.isEmpty())
        return {};
    return sumCell(figures.own.*kSum, kIsGain, textOf(item.object()->getCurrencyRepresentation()));
}

template <auto kSum, bool kIsGain = false>
Cell referenceSum(const Item& item)
{
    const HoldingFigures& figures = item.figures();
    if (figures.isEmpty() || !figures.inReference)
        return {};
    return sumCell((*figures.inReference).*kSum, kIsGain, item.reference());
}

} // namespace

const std::vector<ColumnOf<AccountState>> AccountStateItem::kColumns = {
    {{"Account", 172}, [](const AccountState& s) { return Cell{textOf(s.getAccountName())}; }},
    {{"Balance", 100, B_ALIGN_RIGHT}, balance},
    {{"Currency", 96}, currencyOf},
    {{"Default", 56, B_ALIGN_CENTER}, defaultMark},
};

// As far as the gain they fit into the page; to those behind it the list scrolls sideways.
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
    {{"End Date", 82, B_ALIGN_RIGHT, UnitPlace::kNone, true}, endDate}, // see `ShareStateItem::kEndDate`
    {{"Bought", 110, B_ALIGN_RIGHT, UnitPlace::kShown}, ownSum<&HoldingSums::bought>},
    {{"Sold", 110, B_ALIGN_RIGHT, UnitPlace::kShown}, ownSum<&HoldingSums::sold>},
    {{"Costs", 92, B_ALIGN_RIGHT, UnitPlace::kShown}, ownSum<&HoldingSums::costs>},
    {{"Income", 100, B_ALIGN_RIGHT, UnitPlace::kShown}, ownSum<&HoldingSums::income>},
    {{"Realised", 110, B_ALIGN_RIGHT, UnitPlace::kShown}, ownSum<&HoldingSums::realisedGain, true>},
    {{"Unrealised", 110, B_ALIGN_RIGHT, UnitPlace::kShown}, ownSum<&HoldingSums::unrealisedGain, true>},
    // From here on as `kSumsInReference` says.
    {{"Bought", 106, B_ALIGN_RIGHT, UnitPlace::kCopied}, referenceSum<&HoldingSums::bought>},
    {{"Sold", 92, B_ALIGN_RIGHT, UnitPlace::kCopied}, referenceSum<&HoldingSums::sold>},
    {{"Costs", 92, B_ALIGN_RIGHT, UnitPlace::kCopied}, referenceSum<&HoldingSums::costs>},
    {{"Income", 106, B_ALIGN_RIGHT, UnitPlace::kCopied}, referenceSum<&HoldingSums::income>},
    {{"Realised", 112, B_ALIGN_RIGHT, UnitPlace::kCopied}, referenceSum<&HoldingSums::realisedGain, true>},
    {{"Unrealised", 128, B_ALIGN_RIGHT, UnitPlace::kCopied}, referenceSum<&HoldingSums::unrealisedGain, true>},
};

void ShareStateItem::showIn(const std::string& symbol, double rate, double total)
{
    const Company* company = share_ != nullptr ? share_->company() : nullptr;
    const Market* market = company != nullptr ? company->market() : nullptr;
    const Currency* currency = market != nullptr ? market->currency() : nullptr;
    reference_ = symbol;
    // Where the row says no value in its own currency, there is none in another.
    if (rate == 0 || !basis_.isKnown || !basis_.hasRate || !state_->isHeld() || currency == nullptr)
        return;
    value_ = state_->worth() * currency->getRealQuote(state_->getDate()) / rate;
    if (total > 0)
        part_ = *value_ / total;
}

void ShareStateListView::addAllOf(const State& state, const Totals& totals, const std::vector<HoldingFigures>& figures)
{
    const auto shares = state.shareStates();
    const int32 first = CountRows();
    addAll({shares.begin(), shares.end()});
    for (std::size_t i = 0; i < figures.size(); ++i)
        static_cast<ShareStateItem*>(rowAt(first + static_cast<int32>(i)))->showFigures(figures[i]);
    if (totals.reference == nullptr)
        return;
    const std::string symbol = textOf(totals.reference->getRepresentation());
    setTitle(kReferenceColumn, "In " + symbol);
    for (std::size_t i = kSumsInReference; i < ShareStateItem::kColumns.size(); ++i)
        setTitle(i, ShareStateItem::kColumns[i].title + " in " + symbol);
    const double rate = totals.reference->getRealQuote(state.getDate());
    for (int32 i = first; i < CountRows(); ++i)
        static_cast<ShareStateItem*>(rowAt(i))->showIn(symbol, rate, totals.totalValue);
}
