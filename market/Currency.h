#pragma once

#include "foundation/Serializable.h"
#include "foundation/String.h"
#include "market/CurrencyQuote.h"
#include "market/Market.h"
#include "market/MarketLinks.h"
#include "market/QuoteSeries.h"

/// A money unit with its rates: a rate is the price of one unit in the reference currency, whose own rates are all 1.
///
/// Owns its rates and its markets; destroying it destroys them and unlinks its accounts.
class Currency final : public Serializable, public QuoteSeries<Currency, CurrencyQuote, CurrencyToQuotes> {
public:
    Currency();
    /// `reference` is the currency that the rates are expressed in; not owned, may be null.
    Currency(const String& name, const String& representation, Currency* reference);
    virtual ~Currency();

    /// Currencies have dated records only; these two do nothing and return -1.
    int wrt(FILE* file) const override;
    int rd(FILE* file) override;
    /// Writes the record of the currency with its markets and rates. @return 0; -1 when a write failed.
    int wrt(FILE* file, const Date& stamp) const;
    /// Adds the markets and rates of the next record. `*stamp` becomes the date in it; `stamp` may be null.
    /// @return 0; -1 when the file ends inside the record: what was read whole stays.
    int rd(FILE* file, Date* stamp);

    const String& getName() const { return name_; }
    void setName(const String& name) { name_ = name; }
    /// The short symbol shown beside amounts.
    const String& getRepresentation() const { return representation_; }
    void setRepresentation(const String& representation) { representation_ = representation; }

    int setReferenceCurrency(Currency* reference);
    /// The stored reference, null when there is none.
    Currency* storedReference() const { return reference_; }
    /// `*out` becomes the stored reference, or this currency when there is none. Always 0.
    int getReferenceCurrency(Currency** out);

    int addAccount(Account* account);
    int removeAccount(Account* account);
    unsigned getNbrAccounts() const { return accounts_.getNbr(); }
    Account** getAllAccounts(unsigned* n) const { return accounts_.getAll(n); }
    std::span<Account* const> accounts() const { return accounts_.all(); }

    int addMarket(Market* market) { return markets_.add(market); }
    int removeMarket(Market* market) { return markets_.remove(market); }
    unsigned getNbrMarkets() const { return markets_.getNbr(); }
    Market** getAllMarkets(unsigned* n) const { return markets_.getAll(n); }
    std::span<Market* const> markets() const { return markets_.all(); }

private:
    friend class AccountsToCurrency;
    friend class MarketsToCurrency;
    int readMarkets(FILE* file);

    String name_;
    String representation_;
    Currency* reference_ = nullptr; // not owned
    CurrencyToAccounts accounts_;
    CurrencyToMarkets markets_;
};
