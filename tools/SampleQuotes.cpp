#include "tools/SampleQuotes.h"

#include "market/Catalogue.h"
#include "market/Company.h"
#include "sample/Noise.h"
#include "sample/SampleMarket.h"
#include "storage/AtomicFile.h"
#include "tools/QuotePages.h"

#include <cmath>
#include <cstdio>
#include <stdexcept>
#include <string>

namespace {

constexpr int kDays = 100;

/// A day's price after `former`, in cents: another one, and above 0.
float nextPrice(float former, double volatility, std::uint64_t seed, const Date& day)
{
    constexpr double kCents = 100;
    // The move depends on the day and the company only, and not on how many moves were made before: tables that are
    // written later move likewise on the same days.
    const int number = day - Date(1, 1, 2000);
    Noise noise(seed << 32 ^ static_cast<std::uint32_t>(number));
    const double move = noise.next() * volatility;
    const double price = std::round(static_cast<double>(former) * (1 + move) * kCents) / kCents;
    // A price that stands still would be no news, and one of 0 no price.
    if (price <= 0 || static_cast<float>(price) == former)
        return static_cast<float>(static_cast<double>(former) + 1 / kCents);
    return static_cast<float>(price);
}

std::string rowOf(const Date& day, float price)
{
    char date[32];
    std::snprintf(date, sizeof date, "%04d-%02d-%02d,", day.getYear(), day.getMonth(), day.getDay());
    return date + shortestText(price, std::chars_format::fixed) + '\n';
}

/// `seed` is that of the company's prices.
std::string tableOf(const Company& company, const SampleCompany& plan, std::uint64_t seed, const Date& last)
{
    std::string table = "Date,Close\n";
    Date day = last;
    day.moveBy(-kDays);
    // The walk begins with the price before the first day. A company without quotes begins where the sample began; so
    // does one whose line has run below 0.
    float price = company.getRealQuote(day);
    if (!(price > 0))
        price = static_cast<float>(plan.price);
    while (day < last) {
        day = day.getNext();
        if (day != last && !isWeekday(day))
            continue;
        CompanyQuote* quote = nullptr;
        const bool isKnown = day != last && company.getQuote(day, &quote) == 0 && quote->getValue() > 0;
        price = isKnown ? quote->getValue() : nextPrice(price, plan.volatility, seed, day);
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
    std::uint64_t seed = 0;
    for (const SampleCompany& plan : sampleCompanies()) {
        // Also for a company that is not there, so that the others keep theirs.
        ++seed;
        const Company* company = findCompany(catalogue, plan.ticker);
        if (company == nullptr)
            continue; // the market file's owner has removed it
        const std::string table = tableOf(*company, plan, seed, last);
        AtomicFile file(folder / (std::string(plan.ticker) + ".csv"), AtomicFile::Existing::kReplace);
        if (std::fwrite(table.data(), 1, table.size(), file.stream()) != table.size())
            file.fail("cannot be written");
        file.commit();
    }
}
