#include "market/CompanyQuote.h"

#include "market/Company.h"

CompanyQuote::CompanyQuote(Company* company, const Date& date, float value) : Quote(date, value)
{
    // A quote that the company has of that day is destroyed by this.
    setCompany(company);
}

CompanyQuote::~CompanyQuote()
{
    setCompany(nullptr);
}

/// Date or value has changed already. The company sorts its series before the next read, and fits the trend anew.
void CompanyQuote::notifyChange()
{
    if (Company* company = company_.partner())
        company->quoteChanged();
}

int CompanyQuote::setCompany(Company* company)
{
    return company_.set(this, company);
}
