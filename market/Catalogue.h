#pragma once

#include "foundation/Date.h"
#include "foundation/String.h"

#include <cstdio>
#include <memory>
#include <vector>

class Currency;
class Market;

/// The market data as a whole: the currencies in order of addition, and through them the markets and companies; one
/// currency is the reference that all rates are expressed in.
///
/// Owns the currencies.
class Catalogue {
public:
    Catalogue();
    ~Catalogue();
    Catalogue(const Catalogue&) = delete;
    Catalogue& operator=(const Catalogue&) = delete;

    /// Adds the currencies of a market data file behind those that are here. A currency with the symbol of the file's
    /// reference becomes the reference, by `rebaseOn`.
    /// @return 0; -1 when the file ends early, or has over 100 currencies of that symbol: what was read whole stays.
    int rd(FILE* file);
    /// `stamp` is the date at the head of every currency record. @return 0; -1 when a write failed.
    int wrt(FILE* file, const Date& stamp) const;

    /// Takes ownership of `currency`.
    void addCurrency(Currency* currency);
    /// Takes `currency` out and gives it back to the caller; the last currency moves into its place. When it was the
    /// reference, the currency then first becomes that, by `rebaseOn`. No other currency goes on storing it as its own
    /// reference.
    void removeCurrency(Currency* currency);
    /// Destroys the last currency; nothing else changes, and no rate is divided. When it was the reference, there is
    /// none until the next `setReferenceCurrency`.
    void dropLastCurrency();
    /// Destroys all currencies; there is no reference any more.
    void clear();
    unsigned getNbrCurrencies() const;
    /// The list itself, in order of addition; valid until the next change.
    const std::vector<Currency*>& getCurrencies() const { return currencies_; }
    /// The first currency with this symbol, null when there is none.
    Currency* getCurrencyByRepresentation(const String& representation) const;

    /// Every market of the first currency, then of the second, and so on.
    std::vector<Market*> getMarkets() const;

    /// Null until there is one.
    Currency* getReferenceCurrency() const { return reference_; }
    void setReferenceCurrency(Currency* reference) { reference_ = reference; }
    /// Makes `newReference` the reference currency. When there was another one, every rate of the other currencies is
    /// divided by the new reference's rate of that day, and its own rates become 1.
    void rebaseOn(Currency* newReference);

private:
    std::vector<Currency*> currencies_; // owned
    Currency* reference_ = nullptr;     // one of them
};
