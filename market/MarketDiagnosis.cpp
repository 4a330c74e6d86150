#include "market/MarketDiagnosis.h"

#include "foundation/Date.h"
#include "foundation/FieldIO.h"
#include "market/Company.h"

#include <cerrno>
#include <cstring>

namespace {

/// Whether a whole date of the calendar comes next. Files have one where a currency or a portfolio begins.
bool isAtDate(FILE* file)
{
    Date date;
    date.rd(file);
    return !reachedEnd(file) && date.isValid();
}

void skipQuotes(FILE* file)
{
    unsigned char record[Date::kFileSize + sizeof(float)];
    for (auto missing = static_cast<unsigned>(freadint(file)); missing > 0 && !reachedEnd(file); --missing)
        freadbytes(file, record, sizeof record);
}

// Each of these goes over a record and gives the place where the file ends in it, as it is told; empty when the record
// is whole.

std::string endInMarket(FILE* file, const std::string& self, NameText shown)
{
    String name;
    if (name.rd(file) != 0)
        return self;
    const std::string market = "the market " + shown(name.bytes());
    const auto count = static_cast<unsigned>(freadint(file));
    for (unsigned i = 0; i < count && !reachedEnd(file); ++i)
        if (Company().rd(file) != 0)
            return "company " + std::to_string(i + 1) + " of " + market;
    return reachedEnd(file) ? market : "";
}

std::string endInCurrency(FILE* file, const std::string& self, NameText shown)
{
    Date stamp;
    stamp.rd(file);
    String name;
    String symbol;
    if (name.rd(file) != 0 || symbol.rd(file) != 0)
        return self;
    const std::string currency = "the currency " + shown(name.bytes());
    const auto count = static_cast<unsigned>(freadint(file));
    for (unsigned i = 0; i < count && !reachedEnd(file); ++i) {
        const std::string market = "market " + std::to_string(i + 1) + " of " + currency;
        if (const std::string end = endInMarket(file, market, shown); !end.empty())
            return end;
    }
    if (reachedEnd(file))
        return currency;
    skipQuotes(file);
    return reachedEnd(file) ? "the rates of " + currency : "";
}

std::string endInFile(FILE* file, NameText shown)
{
    String reference;
    if (reference.rd(file) != 0)
        return "its head";
    const auto count = static_cast<unsigned>(freadint(file));
    for (unsigned i = 0; i < count && !reachedEnd(file); ++i)
        if (const std::string end = endInCurrency(file, "currency " + std::to_string(i + 1), shown); !end.empty())
            return end;
    return reachedEnd(file) ? "its head" : "";
}

} // namespace

bool looksLikeMarketFile(FILE* file)
{
    std::rewind(file);
    String reference;
    if (reference.rd(file) != 0)
        return false;
    const int count = freadint(file);
    if (count != 0)
        return isAtDate(file);
    return !reachedEnd(file) && std::fgetc(file) == EOF; // no currencies, and nothing else
}

std::string faultOfMarketFile(FILE* file, NameText shown)
{
    std::rewind(file);
    // A portfolio begins with a date. In a market file the same bytes are the length of a text, and no month.
    if (isAtDate(file))
        return "this is a portfolio file";
    std::rewind(file);
    const std::string place = endInFile(file, shown);
    return place.empty() ? "it has the reference currency over and over" : faultAtEnd(file, place);
}

std::string faultAtEnd(FILE* file, const std::string& place)
{
    if (std::ferror(file) != 0)
        return std::string("it cannot be read: ") + std::strerror(errno);
    std::rewind(file);
    return std::fgetc(file) == EOF ? "the file is empty" : "the file ends in the middle of " + place;
}
