#pragma once

#include "foundation/Date.h"
#include "market/Currency.h"

#include <optional>
#include <string_view>
#include <unordered_map>
#include <vector>

class Catalogue;
class State;

/// The worth of states in the catalogue's reference currency.
///
/// Amounts in a currency count at its rate of the state's day, divided by the reference currency's own rate of that
/// day; currencies are found by symbol. Sums are rounded to float after every addition. An appraisal remembers which
/// currency each holding is in, so it serves for many states of a wallet while catalogue and wallet stay as they are.
class Appraisal {
public:
    explicit Appraisal(const Catalogue& catalogue);

    /// False without a reference currency: nothing has a value then.
    bool hasReference() const { return reference_ != nullptr; }

    /// Value of holdings and cash; 0 without a reference currency, and when its rate is 0.
    float totalValue(const State& state);

private:
    /// A currency with its rate on the day of the state at hand, when it is one that anything is in.
    struct Rate {
        Currency::Walk walk;
        double value;
        bool isUsed;
    };
    /// What stood at a place of the states met so far, and the index of its currency in `rates_`, or kUnknown.
    struct Line {
        const void* item = nullptr;
        unsigned currency = 0;
    };

    float sharesValue(const State& state, double referenceRate);
    float cashValue(const State& state, double referenceRate);
    template <class ItemState>
    unsigned currencyOf(Line& line, const void* item, const ItemState& state);
    unsigned findCurrency(const String& representation);

    Currency* reference_;
    std::optional<Currency::Walk> referenceWalk_;             // unless there is no reference currency
    Date day_;                                                // of the state at hand
    std::vector<Rate> rates_;                                 // of the catalogue's currencies
    std::unordered_map<std::string_view, unsigned> bySymbol_; // indices into `rates_`
    std::vector<unsigned> used_;                              // likewise
    std::vector<Line> shares_;                                // by place in the state
    std::vector<Line> accounts_;
};
