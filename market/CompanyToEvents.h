#pragma once

#include "foundation/OneToManyAssociation.h"

class Company;
class CompanyEvent;

/// A company's notes and splits.
class CompanyToEvents final : public OneToManyAssociation<CompanyToEvents, Company, CompanyEvent> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& event) { return event.company_; }
};

/// The event's link to its company.
class CompanyEventsToCompany final : public ManyToOneAssociation<CompanyEventsToCompany, CompanyEvent, Company> {
public:
    static auto& list(auto& company) { return company.events_; }
};
