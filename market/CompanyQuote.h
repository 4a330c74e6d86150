#pragma once

#include "foundation/Pooled.h"
#include "market/MarketLinks.h"
#include "market/Quote.h"

/// One dated price of a company's share, in the currency of the company's market.
///
/// A quote belongs to at most one company; deleting the company deletes its quotes.
class CompanyQuote final : public Quote, public Pooled<CompanyQuote> {
public:
    CompanyQuote() = default;
    /// Links the quote into `company`'s series; it replaces a quote of the same day.
    CompanyQuote(Company* company, const Date& date, float value);
    ~CompanyQuote() override;

    /// @return 0; -1 and a null `*out` when the quote has no company.
    int getCompany(Company** out) const { return company_.get(out); }
    /// The same; null when there is none.
    Company* company() const { return company_.partner(); }
    int setCompany(Company* company);

protected:
    void notifyChange() override;

private:
    friend class CompanyToQuotes;
    QuotesToCompany company_;
};
