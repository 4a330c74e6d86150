#include "market/CompanyEvent.h"

#include "market/Company.h"

CompanyEvent::CompanyEvent(Company* company, const Date& date) : date_(date)
{
    setCompany(company);
}

CompanyEvent::~CompanyEvent()
{
    setCompany(nullptr);
}

int CompanyEvent::setDate(const Date& date)
{
    Company* company = company_.partner();
    if (company != nullptr && setCompany(nullptr) != 0)
        return -1;
    date_ = date;
    return company == nullptr || setCompany(company) == 0 ? 0 : -1;
}

int CompanyEvent::setCompany(Company* company)
{
    return company_.set(this, company);
}
