#pragma once

#include "foundation/Serializable.h"
#include "foundation/String.h"
#include "market/CompanyEvent.h"
#include "market/CompanyQuote.h"
#include "market/MarketLinks.h"
#include "market/QuoteSeries.h"

/// A listed company with its dated quotes, in the currency of its market, its notes and splits.
///
/// Owns its quotes and events, and the portfolio's holdings of it: destroying the company destroys them all.
class Company final : public Serializable, public QuoteSeries<Company, CompanyQuote, CompanyToQuotes> {
public:
    Company();
    Company(Market* market, const String& name, const String& abbreviation);
    virtual ~Company();

    int wrt(FILE* file) const override;
    int rd(FILE* file) override;

    const String& getName() const { return name_; }
    void setName(const String& name) { name_ = name; }
    /// The ticker.
    const String& getAbbreviation() const { return abbreviation_; }
    void setAbbreviation(const String& abbreviation) { abbreviation_ = abbreviation; }

    int getMarket(Market** out) const { return market_.get(out); }
    /// The same; null when there is none.
    Market* market() const { return market_.partner(); }
    int setMarket(Market* market);
    /// The short symbol of the market's currency; a String without text when market or currency is missing.
    const String& getCurrencyRepresentation() const;

    int addShare(Share* share);
    int removeShare(Share* share);
    unsigned getNbrShares() const { return shares_.getNbr(); }
    Share** getAllShares(unsigned* n) const { return shares_.getAll(n); }
    std::span<Share* const> shares() const { return shares_.all(); }
    int getShare(Share** out, unsigned i) const { return shares_.getAt(out, i); }

    int addEvent(CompanyEvent* event) { return events_.add(event); }
    int removeEvent(CompanyEvent* event) { return events_.remove(event); }
    unsigned getNbrEvents() const { return events_.getNbr(); }
    CompanyEvent** getAllEvents(unsigned* n) const { return events_.getAll(n); }
    std::span<CompanyEvent* const> events() const { return events_.all(); }
    /// File: count (i32), then of each event its type (u16) and its record, in the order of the list. `readEvents` adds
    /// what it reads. @return 0; -1 when a write failed or the file ended early.
    int writeEvents(FILE* file) const;
    int readEvents(FILE* file);

    // Defined in net/, with the transfers:

    /// Fetches today's price from a quote server; `path` is the request without the ticker. `*date` becomes today in
    /// any case, `*value` changes once the server is connected. Nothing is stored.
    /// @return 0; -1 when the server or the price is not found.
    int getInternetLastQuote(const String& host, const String& path, float* value, Date* date) const;
    /// Fetches and stores the quotes of the last three months, as the company's market can; -1 also without a market.
    int setInternetLastThreeMonthsQuote();

private:
    friend class CompanyEventsToCompany;
    friend class SharesToCompany;
    friend class MarketToCompanies;

    String name_;
    String abbreviation_;
    CompanyToShares shares_;
    CompanyToEvents events_;
    CompaniesToMarket market_;
};
