#pragma once

#include "foundation/OneToManyAssociation.h"

class Market;
class Company;

/// The companies that a market lists.
class MarketToCompanies final : public OneToManyAssociation<MarketToCompanies, Market, Company> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& company) { return company.market_; }
};

/// The company's link to its market.
class CompaniesToMarket final : public ManyToOneAssociation<CompaniesToMarket, Company, Market> {
public:
    static auto& list(auto& market) { return market.companies_; }
};
