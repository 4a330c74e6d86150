#pragma once

#include "foundation/String.h"
#include "net/FetchEnd.h"
#include "net/Wait.h"
#include "platform/EscapeWatch.h"

#include <string>

class Company;
class CompanyView;
class PLWindow;

/// Brings quotes from the servers for one command, which blocks meanwhile. Escape ends the wait, and a server that was
/// silent is not asked again. What came and what did not, and why, is told in a notice.
class QuoteFetcher {
public:
    /// Both outlive this. The company that is selected on the page now is the one whose new quotes it is told of.
    QuoteFetcher(PLWindow& window, CompanyView& page);

    /// Fetches the company's price of today and stores it.
    /// @return false when there is no price to be had, or none was asked for any more; nothing has changed then.
    bool fetchLatest(Company& company);
    /// Fetches and stores the quotes of the last three months. @return false when that failed, be it in the middle.
    bool fetchHistory(Company& company);

    /// To be called when all that was wanted was asked for.
    void report();

private:
    static constexpr const char* kNotice = "quotes";

    /// @return whether it came.
    bool note(const Company& company, FetchEnd end);
    StopCheck stopCheck(const String& host);
    std::string reason() const;

    PLWindow& window_;
    CompanyView& page_;
    const Company* shown_; // only to be compared
    EscapeWatch escape_;
    String host_;                           // asked last
    FetchEnd trouble_ = FetchEnd::kFetched; // the last one that was none
    bool isOver_ = false;                   // it is of no use to go on
    unsigned asked_ = 0;
    unsigned came_ = 0;
    std::string missing_; // tickers
};
