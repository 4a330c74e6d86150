#pragma once

#include "foundation/OneToManyAssociation.h"

class Company;
class Share;

/// The portfolio's holdings of a company. Holdings live a floor higher: the members are defined beside `Share`.
class CompanyToShares final : public OneToManyAssociation<CompanyToShares, Company, Share> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    /// Destroys every holding.
    void deleteAll();
    static auto& link(auto& share) { return share.company_; }
};

/// The holding's link to its company.
class SharesToCompany final : public ManyToOneAssociation<SharesToCompany, Share, Company> {
public:
    static auto& list(auto& company) { return company.shares_; }
};
