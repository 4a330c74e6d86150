#include "app/LatestQuoteFetch.h"

#include "net/QuoteServers.h"
#include "net/StoreQuote.h"
#include "views/CompanyView.h"

int fetchLatestQuote(Company* company, CompanyView* view)
{
    float price = 0;
    Date date;
    if (company->getInternetLastQuote(quoteServers().latestHost, QuoteServers::kLatestPath, &price, &date) != 0)
        return -1;
    CompanyQuote* quote = nullptr;
    const StoreOutcome outcome = storeQuote(company, date, price, &quote);
    if (view != nullptr && outcome == StoreOutcome::kAdded)
        view->AddQuote(quote);
    if (view != nullptr && outcome == StoreOutcome::kChanged)
        view->ModifyQuote(quote);
    return 0;
}
