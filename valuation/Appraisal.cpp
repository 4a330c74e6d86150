#include "valuation/Appraisal.h"

#include "market/Catalogue.h"
#include "market/Currency.h"
#include "valuation/AccountState.h"
#include "valuation/CashMoves.h"
#include "valuation/ShareState.h"
#include "valuation/State.h"

#include <algorithm>

namespace {

constexpr unsigned kUnknown = ~0U;

} // namespace

Appraisal::Appraisal(const Catalogue& catalogue) : catalogue_(catalogue), reference_(catalogue.getReferenceCurrency())
{}

float Appraisal::totalValue(const State& state)
{
    if (!hasReference())
        return 0;
    const double referenceRate = reference_->getRealQuote(state.getDate());
    if (referenceRate == 0)
        return 0;
    rates_.clear();
    for (const Currency* currency : catalogue_.getCurrencies())
        rates_.push_back(currency->getRealQuote(state.getDate()));
    return sharesValue(state, referenceRate) + cashValue(state, referenceRate);
}

float Appraisal::sharesValue(const State& state, double referenceRate)
{
    unsigned n;
    ShareState** states = state.getAllShareStates(&n);
    shares_.resize(n);
    float value = 0;
    for (unsigned i = 0; i < n; ++i) {
        const unsigned currency = currencyOf(shares_, i, states[i]);
        if (currency == kUnknown)
            continue;
        const double quote = states[i]->getQuote();
        value = addRounded(value, quote * states[i]->getQuantity() * rates_[currency] / referenceRate);
    }
    return value;
}

float Appraisal::cashValue(const State& state, double referenceRate)
{
    unsigned n;
    AccountState** states = state.getAllAccountStates(&n);
    accounts_.resize(n);
    float value = 0;
    for (unsigned i = 0; i < n; ++i) {
        const unsigned currency = currencyOf(accounts_, i, states[i]);
        if (currency == kUnknown)
            continue;
        const double cash = states[i]->getCash();
        value = addRounded(value, cash * rates_[currency] / referenceRate);
    }
    return value;
}

/// The currency of an item's symbol. The states of a wallet have the same items in the same places, so the names are
/// compared once for all of them.
template <class Item>
unsigned Appraisal::currencyOf(std::vector<Line>& lines, unsigned place, const Item* item) const
{
    const void* listed = item->listed();
    if (lines[place].item != listed || listed == nullptr)
        lines[place] = {listed, findCurrency(item->getCurrencyRepresentation())};
    return lines[place].currency;
}

unsigned Appraisal::findCurrency(const String& representation) const
{
    const auto& currencies = catalogue_.getCurrencies();
    const auto isMeant = [&](const Currency* currency) { return currency->getRepresentation() == representation; };
    const auto found = std::find_if(currencies.begin(), currencies.end(), isMeant);
    return found != currencies.end() ? static_cast<unsigned>(found - currencies.begin()) : kUnknown;
}
