#pragma once

#include "foundation/OneToManyAssociation.h"

class Market;
class Company;

/// The companies that a market lists.
class MarketToCompanies final : public OneToManyAssociation<Market, Company> {
public:
    explicit MarketToCompanies(Market* owner) : OneToManyAssociation(owner) {}

private:
    ManyToOneAssociation<Company, Market>& backLink(Company& e) const override;
};

/// The company's link to its market.
class CompaniesToMarket final : public ManyToOneAssociation<Company, Market> {
public:
    using ManyToOneAssociation::ManyToOneAssociation;

private:
    int xAdd(Market* partner) override;
    int xRemove(Market* partner) override;
};
