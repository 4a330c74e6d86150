#pragma once

#include "foundation/Date.h"
#include "net/FetchEnd.h"
#include "net/Wait.h"

#include <string_view>
#include <vector>

class Company;
class Market;

struct DatedPrice {
    Date date;
    float price;
};

/// Reads the table of a history page, whose header ends with "(00s)</b>": a row a line, with the date as
/// month/day/year, the price, and further columns that are ignored. `*rows` gets the rows that count, in page order,
/// those before an error included.
///
/// A price counts when it lies between a third and twice the last one that counted, both exclusive; the first one, and
/// any after a 0, counts always. A row of month 0, which one that begins with a blank gives, is left out, and so is one
/// whose price is infinite, negative or "nan". Dates are taken as they stand, the year without a century.
/// @return 0 when the table ends with a '<', or the text with a line that is no row; -1 without the header, and when
/// the text ends elsewhere.
int parseHistoryPage(std::string_view page, std::vector<DatedPrice>* rows);

/// Whether the '<' that ends the table is in there: `parseHistoryPage` gives the same for every page that begins so.
bool isHistoryCertain(std::string_view beginning);

/// What `Market::setInternetLastThreeMonthsQuote` does, and how it ended. `stop` ends its waits.
FetchEnd fetchQuoteHistory(const Market& market, Company* company, const StopCheck& stop);
