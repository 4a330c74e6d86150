// Any bytes as a market data file: the reader neither crashes nor hangs, what it made answers every question, and what
// is written of it reads back to the same bytes.

#include "market/CompanyEvent.h"
#include "market/MarketDiagnosis.h"
#include "tests/fuzz/Require.h"
#include "tests/support/Bytes.h"
#include "tests/support/SmallPortfolio.h"

#include <climits>
#include <cstdint>
#include <cstring>

namespace {

bool areSameBits(float a, float b)
{
    return std::memcmp(&a, &b, sizeof a) == 0;
}

template <class Series>
void askOnDay(const Series& series, const Date& day)
{
    (void)series.getRealQuote(day);
    (void)series.getPrevisionQuote(day);
}

template <class Series>
void askSeries(const Series& series)
{
    const Date oddDays[] = {Date(),       {31, 12, 1998},  {29, 2, 2000},     {31, 2, 1999},
                            {-7, 13, -5}, {1, 1, INT_MIN}, {31, 12, INT_MAX}, {SHRT_MAX, SHRT_MAX, INT_MAX}};
    Date former;
    for (const Date& day : oddDays)
        askOnDay(series, day);
    const auto quotes = all(series, &Series::getAllQuotes);
    for (const auto* quote : quotes) {
        Date day = quote->getDate();
        require(quote == quotes.front() || former < day, "quotes are in date order, one a day");
        former = day;
        require(areSameBits(series.getRealQuote(day), quote->getValue()), "the value of a quoted day is its quote");
        askOnDay(series, day.moveBy(1));
    }
    (void)series.getPente();
    (void)series.getHighestQuote();
    (void)series.getLowestQuote();
    require(quotes.empty() || series.getFirstQuote() <= series.getLastQuote(), "the first quote is not after the last");
}

void askMarket(const Market& market)
{
    for (const Company* company : all(market, &Market::getAllCompanies)) {
        askSeries(*company);
        const String ticker = company->getAbbreviation();
        Company* found = nullptr;
        market.getCompany(ticker, &found);
        require(found == nullptr || found->getAbbreviation() == ticker, "a company is found by its ticker");
        for (CompanyEvent* event : all(*company, &Company::getAllEvents))
            event->setDate(event->getDate().getNext());
    }
}

void askEverything(const Catalogue& catalogue)
{
    for (const Currency* currency : catalogue.getCurrencies())
        askSeries(*currency);
    for (const Market* market : catalogue.getMarkets())
        askMarket(*market);
}

std::string fileOf(const Catalogue& catalogue)
{
    return written([&](FILE* file) { require(catalogue.wrt(file, Date(3, 5, 1999)) == 0, "a catalogue is written"); });
}

void checkRereading(const Catalogue& catalogue)
{
    // A second currency with the reference's symbol makes the reader rebase all rates, every time anew.
    unsigned candidates = 0;
    for (const Currency* currency : catalogue.getCurrencies())
        if (catalogue.getReferenceCurrency() != nullptr &&
            currency->getRepresentation() == catalogue.getReferenceCurrency()->getRepresentation())
            ++candidates;
    const std::string bytes = fileOf(catalogue);
    Catalogue again;
    const int result = again.rd(BytesFile(bytes));
    require(candidates > 1 || result == 0, "a written catalogue is read whole");
    require(candidates > 1 || fileOf(again) == bytes, "writing, reading and writing gives the same bytes");
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    Catalogue catalogue;
    const BytesFile file(std::string(reinterpret_cast<const char*>(data), size));
    catalogue.rd(file);
    faultOfMarketFile(file, [](std::string_view name) { return std::string(name); });
    checkRereading(catalogue);
    askEverything(catalogue);
    if (catalogue.getNbrCurrencies() > 0) {
        catalogue.rebaseOn(catalogue.getCurrencies().back());
        askEverything(catalogue);
    }
    return 0;
}
