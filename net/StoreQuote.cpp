#include "net/StoreQuote.h"

StoreOutcome storeQuote(Company* company, const Date& date, float price, CompanyQuote** quote)
{
    if (company->getQuote(date, quote) != 0) {
        *quote = new CompanyQuote(company, date, price); // owned by the company
        return StoreOutcome::kAdded;
    }
    // Setting the same value again would count as a change, for which charts are drawn anew.
    if ((*quote)->getValue() == price)
        return StoreOutcome::kSame;
    (*quote)->setValue(price);
    return StoreOutcome::kChanged;
}
