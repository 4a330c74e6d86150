#include "app/QuoteFetcher.h"

#include "app/PLWindow.h"
#include "net/LatestQuote.h"
#include "net/QuoteHistory.h"
#include "net/QuoteServers.h"
#include "net/StoreQuote.h"
#include "views/ModelText.h"

QuoteFetcher::QuoteFetcher(PLWindow& window, CompanyView& page)
    : window_(window), page_(page), shown_(page.GetSelectedCompany())
{
    window_.dropNotice(kNotice); // of the command before
}

bool QuoteFetcher::fetchLatest(Company& company)
{
    if (isOver_ || escape_.IsPressed())
        return note(company, isOver_ ? trouble_ : FetchEnd::kStopped);
    float price = 0;
    Date date;
    host_ = quoteServers().latestHost;
    const FetchEnd end = fetchLatestQuote(company, host_, QuoteServers::kLatestPath, stopCheck(host_), &price, &date);
    if (!note(company, end))
        return false;
    CompanyQuote* quote = nullptr;
    const StoreOutcome outcome = storeQuote(&company, date, price, &quote);
    if (&company == shown_ && outcome == StoreOutcome::kAdded)
        page_.AddQuote(quote);
    if (&company == shown_ && outcome == StoreOutcome::kChanged)
        page_.ModifyQuote(quote);
    return true;
}

bool QuoteFetcher::fetchHistory(Company& company)
{
    host_ = quoteServers().historyHost;
    const Market* market = company.market();
    return note(company,
                market != nullptr ? fetchQuoteHistory(*market, &company, stopCheck(host_)) : FetchEnd::kNoHistory);
}

bool QuoteFetcher::note(const Company& company, FetchEnd end)
{
    ++asked_;
    if (end == FetchEnd::kFetched) {
        ++came_;
        return true;
    }
    trouble_ = end;
    isOver_ = isOver_ || end == FetchEnd::kSilent || end == FetchEnd::kStopped;
    missing_ += (missing_.empty() ? "" : ", ") + textOf(company.getAbbreviation());
    return false;
}

/// Tells of Escape as soon as there is a wait that it could end.
StopCheck QuoteFetcher::stopCheck(const String& host)
{
    return [this, host, isTold = false]() mutable {
        if (!isTold)
            window_.showNotice({kNotice, "Waiting for " + textOf(host) + ".  Escape ends this", {}, true});
        isTold = true;
        return escape_.IsPressed();
    };
}

std::string QuoteFetcher::reason() const
{
    const std::string host = textOf(host_);
    switch (trouble_) {
    case FetchEnd::kNoHistory:
        return "only companies of NASDAQ, NYSE and AMEX have a history";
    case FetchEnd::kNoHost:
        return "there is no server " + host;
    case FetchEnd::kRefused:
        return "the server " + host + " takes no connections";
    case FetchEnd::kSilent:
        return "the server " + host + " did not answer" + (asked_ > 1 ? ", and not asked again" : "");
    case FetchEnd::kStopped:
        return "Escape has ended it";
    case FetchEnd::kClosed:
        return "the server " + host + " closed without an answer";
    default:
        return "the server " + host + " has no price";
    }
}

void QuoteFetcher::report()
{
    if (asked_ == 0 || (asked_ == 1 && came_ == 1)) {
        window_.dropNotice(kNotice); // that it waits
        return;
    }
    const std::string came = std::to_string(came_) + " of " + std::to_string(asked_) + " quotes came";
    if (came_ == asked_)
        window_.showNotice({kNotice, came, {}, true});
    else if (asked_ == 1)
        window_.showNotice({kNotice, "No quotes for " + missing_ + ": " + reason(), {}});
    else // the tickers last: there may be many
        window_.showNotice({kNotice, came + ": " + reason() + "; none for " + missing_, {}});
}
