#include "tools/SampleQuotes.h"

#include "market/Catalogue.h"
#include "market/Company.h"
#include "market/Market.h"
#include "storage/AtomicFile.h"
#include "tools/Noise.h"
#include "tools/SampleMarket.h"

#include <charconv>
#include <cmath>
#include <cstdio>
#include <stdexcept>
#include <string>

namespace {

constexpr int kDays = 100;

/// Null when the market file's owner has removed it.
const Company* findCompany(const Catalogue& catalogue, const String& ticker)
{
    for (const Market* market : catalogue.getMarkets()) {
        Company* company;
        if (market->getCompany(ticker, &company) == 0)
            return company;
    }
    return nullptr;
}

/// A day's price after `former`, in cents: another one, and above 0.
float nextPrice(float former, const SampleTicker& ticker, const Date& day)
{
    constexpr double kCents = 100;
    const int number = day - Date(1, 1, 2000);
    Noise noise(ticker.seed << 32 ^ static_cast<std::uint32_t>(number));
    const double move = noise.next() * ticker.volatility;
    const double price = std::round(static_cast<double>(former) * (1 + move) * kCents) / kCents;
    if (price <= 0 || static_cast<float>(price) == former)
        return static_cast<float>(static_cast<double>(former) + 1 / kCents);
    return static_cast<float>(price);
}

std::string rowOf(const Date& day, float price)
{
    char date[32], digits[64]; // as long as any float without an exponent
    std::snprintf(date, sizeof date, "%04d-%02d-%02d,", day.getYear(), day.getMonth(), day.getDay());
    char* const end = std::to_chars(digits, digits + sizeof digits, price, std::chars_format::fixed).ptr;
    return date + std::string(digits, end) + '\n';
}

std::string tableOf(const Company& company, const SampleTicker& ticker, const Date& last)
{
    std::string table = "Date,Close\n";
    Date day = last;
    day.moveBy(-kDays);
    float price = company.getRealQuote(day);
    if (!(price > 0))
        price = ticker.firstPrice;
    while (day < last) {
        day = day.getNext();
        if (day != last && !isWeekday(day))
            continue;
        CompanyQuote* quote = nullptr;
        const bool isKnown = day != last && company.getQuote(day, &quote) == 0 && quote->getValue() > 0;
        price = isKnown ? quote->getValue() : nextPrice(price, ticker, day);
        table += rowOf(day, price);
    }
    return table;
}

} // namespace

void writeSampleQuotes(const std::filesystem::path& folder, const Catalogue& catalogue, const Date& last)
{
    std::error_code error;
    std::filesystem::create_directories(folder, error);
    if (error)
        throw std::runtime_error(folder.string() + ": cannot be made: " + error.message());
    for (const SampleTicker& ticker : sampleTickers()) {
        const Company* company = findCompany(catalogue, ticker.name);
        if (company == nullptr)
            continue;
        const std::string table = tableOf(*company, ticker, last);
        AtomicFile file(folder / (std::string(ticker.name) + ".csv"), AtomicFile::Existing::kReplace);
        if (std::fwrite(table.data(), 1, table.size(), file.stream()) != table.size())
            file.fail("cannot be written");
        file.commit();
    }
}
