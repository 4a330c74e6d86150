#pragma once

#include "foundation/OneToManyAssociation.h"

class Company;
class CompanyEvent;

/// A company's notes and splits.
class CompanyToEvents final : public OneToManyAssociation<Company, CompanyEvent> {
public:
    explicit CompanyToEvents(Company* owner) : OneToManyAssociation(owner) {}

private:
    ManyToOneAssociation<CompanyEvent, Company>& backLink(CompanyEvent& e) const override;
};

/// The event's link to its company.
class CompanyEventsToCompany final : public ManyToOneAssociation<CompanyEvent, Company> {
public:
    using ManyToOneAssociation::ManyToOneAssociation;

private:
    int xAdd(Company* partner) override;
    int xRemove(Company* partner) override;
};
