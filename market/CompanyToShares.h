#pragma once

#include "foundation/OneToManyAssociation.h"

class Company;
class Share;

/// The portfolio's holdings of a company. Holdings live a floor higher: the members are defined beside `Share`.
class CompanyToShares final : public OneToManyAssociation<Company, Share> {
public:
    explicit CompanyToShares(Company* owner) : OneToManyAssociation(owner) {}

    /// Destroys every holding.
    void deleteAll();

private:
    ManyToOneAssociation<Share, Company>& backLink(Share& e) const override;
};

/// The holding's link to its company.
class SharesToCompany final : public ManyToOneAssociation<Share, Company> {
public:
    using ManyToOneAssociation::ManyToOneAssociation;

private:
    int xAdd(Company* partner) override;
    int xRemove(Company* partner) override;
};
