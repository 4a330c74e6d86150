#include "market/CompanyEvent.h"

#include "market/Company.h"

CompanyEvent::CompanyEvent(Company* company, const Date& date) : date_(date)
{
    setCompany(company);
}

/// The company lists the event until here, and does not afterwards.
CompanyEvent::~CompanyEvent()
{
    setCompany(nullptr);
}

int CompanyEvent::setDate(const Date& date)
{
    // The company's list must not hold an event whose date changes: it leaves and comes back.
    Company* company = company_.partner();
    if (company != nullptr && setCompany(nullptr) != 0)
        return -1;
    // It is in no list now, so that the date can change.
    date_ = date;
    return company == nullptr || setCompany(company) == 0 ? 0 : -1;
}

int CompanyEvent::setCompany(Company* company)
{
    return company_.set(this, company);
}
