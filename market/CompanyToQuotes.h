#pragma once

#include "foundation/OneToManyAssociation.h"

class Company;
class CompanyQuote;

/// A company's quotes, by date.
class CompanyToQuotes final : public OneToManyAssociation<Company, CompanyQuote> {
public:
    explicit CompanyToQuotes(Company* owner);

private:
    ManyToOneAssociation<CompanyQuote, Company>& backLink(CompanyQuote& e) const override;
};

/// The quote's link to its company.
class QuotesToCompany final : public ManyToOneAssociation<CompanyQuote, Company> {
public:
    using ManyToOneAssociation::ManyToOneAssociation;

private:
    int xAdd(Company* partner) override;
    int xRemove(Company* partner) override;
};
