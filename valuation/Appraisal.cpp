#include "valuation/Appraisal.h"

#include "market/Catalogue.h"
#include "market/Currency.h"
#include "valuation/AccountState.h"
#include "valuation/CashMoves.h"
#include "valuation/ShareState.h"
#include "valuation/State.h"

namespace {

constexpr unsigned kUnknown = ~0U;

} // namespace

Appraisal::Appraisal(const Catalogue& catalogue) : reference_(catalogue.getReferenceCurrency())
{
    if (reference_ != nullptr)
        referenceWalk_.emplace(*reference_);
    for (const Currency* currency : catalogue.getCurrencies()) {
        if (currency->getRepresentation().hasText())
            bySymbol_.try_emplace(currency->getRepresentation().comparedBytes(), static_cast<unsigned>(rates_.size()));
        // Of currencies with one symbol the first is found, as by `getCurrencyByRepresentation`.
        rates_.push_back({Currency::Walk(*currency), 0, false});
    }
}

float Appraisal::totalValue(const State& state)
{
    if (!hasReference())
        return 0;
    // From here on `day_` and the values of the used rates belong to this state. A rate that comes into use later is
    // taken for the same day, in `findCurrency`.
    day_ = state.getDate();
    const double referenceRate = referenceWalk_->realQuote(day_);
    if (referenceRate == 0)
        return 0;
    for (const unsigned i : used_)
        rates_[i].value = rates_[i].walk.realQuote(day_);
    return sharesValue(state, referenceRate) + cashValue(state, referenceRate);
}

float Appraisal::sharesValue(const State& state, double referenceRate)
{
    const auto states = state.shareStates();
    // Lines of places that the last state had and this one has not are dropped; new ones are empty, and looked up.
    shares_.resize(states.size());
    float value = 0;
    for (std::size_t i = 0; i < states.size(); ++i) {
        const unsigned currency = currencyOf(shares_[i], states[i]->share(), *states[i]);
        if (currency == kUnknown)
            continue;
        const double quote = states[i]->getQuote();
        value = addRounded(value, quote * states[i]->getQuantity() * rates_[currency].value / referenceRate);
    }
    return value;
}

float Appraisal::cashValue(const State& state, double referenceRate)
{
    const auto states = state.accountStates();
    accounts_.resize(states.size());
    float value = 0;
    for (std::size_t i = 0; i < states.size(); ++i) {
        const unsigned currency = currencyOf(accounts_[i], states[i]->account(), *states[i]);
        if (currency == kUnknown)
            continue;
        const double cash = states[i]->getCash();
        value = addRounded(value, cash * rates_[currency].value / referenceRate);
    }
    return value;
}

/// The currency of a state's symbol; `item` is what it is the state of. The states of a wallet have the same items in
/// the same places, so the names are compared once for all of them.
template <class ItemState>
unsigned Appraisal::currencyOf(Line& line, const void* item, const ItemState& state)
{
    // Afterwards the line is that of `item`. A state without item has no address to know it by and is looked up each
    // time.
    if (line.item != item || item == nullptr)
        line = {item, findCurrency(state.getCurrencyRepresentation())};
    return line.currency;
}

unsigned Appraisal::findCurrency(const String& representation)
{
    const auto found = representation.hasText() ? bySymbol_.find(representation.comparedBytes()) : bySymbol_.end();
    if (found == bySymbol_.end())
        return kUnknown;
    // A currency is valued on each day from the first state on that anything in it is met in.
    Rate& rate = rates_[found->second];
    if (!rate.isUsed) {
        used_.push_back(found->second);
        rate.value = rate.walk.realQuote(day_);
        rate.isUsed = true;
    }
    return found->second;
}
