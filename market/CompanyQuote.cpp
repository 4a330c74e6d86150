#include "market/CompanyQuote.h"

#include "market/Company.h"

CompanyQuote::CompanyQuote(Company* company, const Date& date, float value) : Quote(date, value)
{
    setCompany(company);
}

CompanyQuote::~CompanyQuote()
{
    setCompany(nullptr);
}

void CompanyQuote::notifyChange()
{
    if (Company* company = company_.partner())
        company->quoteChanged();
}

int CompanyQuote::setCompany(Company* company)
{
    return company_.set(this, company);
}
