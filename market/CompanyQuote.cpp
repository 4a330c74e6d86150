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

CompanyToQuotes::CompanyToQuotes(Company* owner) : OneToManyAssociation(owner, true, sortQuotesByDate) {}

ManyToOneAssociation<CompanyQuote, Company>& CompanyToQuotes::backLink(CompanyQuote& e) const
{
    return e.company_;
}

// Through the owner's own operations, so that a quote of the same day is replaced and the trend follows.

int QuotesToCompany::xAdd(Company* partner)
{
    return partner->addQuote(owner());
}

int QuotesToCompany::xRemove(Company* partner)
{
    return partner->removeQuote(owner());
}
