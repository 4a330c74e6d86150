#pragma once

#include "foundation/OneToManyAssociation.h"
#include "market/Quote.h"

class Company;
class CompanyQuote;

/// A company's quotes, by date.
class CompanyToQuotes final : public OneToManyAssociation<CompanyToQuotes, Company, CompanyQuote, true> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& quote) { return quote.company_; }
    static int compare(const void* a, const void* b) { return sortQuotesByDate(a, b); }
};

/// The quote's link to its company.
class QuotesToCompany final : public ManyToOneAssociation<QuotesToCompany, CompanyQuote, Company, true> {
public:
    // By way of the series, where a quote of the same day is replaced and the trend follows.
    static int enter(auto& company, CompanyQuote* quote) { return company.addQuote(quote); }
    static int leave(auto& company, CompanyQuote* quote) { return company.removeQuote(quote); }
};
