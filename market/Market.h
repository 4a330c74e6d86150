#pragma once

#include "foundation/Serializable.h"
#include "foundation/String.h"
#include "market/Company.h"
#include "market/MarketLinks.h"

/// A stock exchange: trades in one currency and lists companies, which it owns.
class Market final : public Serializable {
public:
    Market();
    explicit Market(const String& name);
    virtual ~Market();

    /// The currency is not part of the record: it is the one whose record contains the market's.
    int wrt(FILE* file) const override;
    int rd(FILE* file) override;

    const String& getName() const { return name_; }
    void setName(const String& name) { name_ = name; }

    int getCurrency(Currency** out) const { return currency_.get(out); }
    /// The same; null when there is none.
    Currency* currency() const { return currency_.partner(); }
    int setCurrency(Currency* currency);
    /// The currency's short symbol; a String without text when the market has no currency.
    const String& getCurrencyRepresentation() const;

    int addCompany(Company* company) { return companies_.add(company); }
    int removeCompany(Company* company) { return companies_.remove(company); }
    unsigned getNbrCompanies() const { return companies_.getNbr(); }
    Company** getAllCompanies(unsigned* n) const { return companies_.getAll(n); }
    std::span<Company* const> companies() const { return companies_.all(); }
    /// `*out` becomes the first company with this ticker. @return 0; -1 and a null `*out` when there is none.
    int getCompany(const String& abbreviation, Company** out) const;

    /// Fetches the daily prices of the last three months of a company of this market, and stores them. Defined in net/,
    /// with the transfer.
    /// @return 0; -1 when this is not one of the markets that the server knows, "NASDAQ", "NYSE" and "AMEX", or when
    /// the page is not found or not whole. What stands before an error is stored.
    int setInternetLastThreeMonthsQuote(Company* company) const;

private:
    friend struct CompaniesToMarket;
    friend class CurrencyToMarkets;

    String name_;
    MarketToCompanies companies_;
    MarketsToCurrency currency_;
};
