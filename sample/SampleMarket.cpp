#include "sample/SampleMarket.h"

#include "market/Catalogue.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "market/NoteCompanyEvent.h"
#include "market/SplitCompanyEvent.h"
#include "sample/Noise.h"

#include <algorithm>
#include <cmath>
#include <iterator>

namespace {

// The sample is a small story: each random walk has a seed of its own, so that a change to one company leaves the
// prices of all others as they are. Days are places in the list of weekdays, so that the story moves with its last day.
constexpr int kWeeks = 261; // of five years
constexpr double kDaysInYear = 261;

constexpr struct CurrencyPlan {
    const char* name;
    const char* symbol;
    double rate;       // in euros, on the first day
    double volatility; // of a day, a fraction
} kCurrencies[] = {
    {"Euro", "EUR", 1, 0},
    {"US Dollar", "USD", 0.9120, 0.0042},
    {"Pound Sterling", "GBP", 1.1640, 0.0035},
    {"Swiss Franc", "CHF", 1.0310, 0.0026},
};

constexpr struct MarketPlan {
    const char* name;
    const char* symbol; // of its currency
} kMarkets[] = {{"NYSE", "USD"}, {"NASDAQ", "USD"}, {"Paris", "EUR"}, {"London", "GBP"}};

constexpr SampleCompany kCompanies[] = {
    {"Harrowmere Rail", "HWMR", "NYSE", 62.40, 0.07, 0.011, 0.9},
    {"Tannehurst Paper Mills", "TNHP", "NYSE", 28.15, -0.04, 0.015, 0.8},
    {"Ardenmoor Energy", "AMOE", "NYSE", 47.80, 0.02, 0.017, 0.7},
    {"Prairieholt Grain", "PRHG", "NYSE", 83.60, 0.05, 0.010, 0.5},
    {"Ostrander Insurance", "OSDR", "NYSE", 118.25, 0.06, 0.009, 0.8},
    {"Caddisfield Pharma", "CDFP", "NYSE", 35.70, 0.12, 0.016, 0.6},
    {"Quillon Systems", "QLLN", "NASDAQ", 71.30, 0.03, 0.018, 1.3},
    {"Zephrine Robotics", "ZPHR", "NASDAQ", 22.90, 0.22, 0.025, 1.5},
    {"Luxorine Optics", "LXRO", "NASDAQ", 54.10, 0.04, 0.021, 1.2},
    {"Nordwick Semiconductor", "NDWK", "NASDAQ", 91.75, 0.04, 0.021, 1.6},
    {"Sorvane Networks", "SRVN", "NASDAQ", 16.45, -0.08, 0.020, 1.1},
    {"Verreries de Montbrac", "VMBC", "Paris", 44.20, 0.05, 0.012, 0.8},
    {"Brasseries du Vieux Quai", "BVQY", "Paris", 67.50, 0.04, 0.009, 0.5},
    {"Énergies d'Armorel", "EARM", "Paris", 12.86, 0.09, 0.015, 0.7},
    {"Chantiers Lorvane", "CHLV", "Paris", 31.95, -0.10, 0.018, 1.1},
    {"Maison Delaubray", "MDLB", "Paris", 203.40, 0.11, 0.013, 1.0},
    {"Whitcombe & Sons", "WTCB", "London", 8.94, 0.06, 0.013, 0.8},
    {"Thornebury Water", "THBW", "London", 14.62, 0.03, 0.008, 0.4},
    {"Kestrel Moor Brewing", "KMBR", "London", 21.35, -0.02, 0.012, 0.6},
    {"Marlstone Mining", "MRLM", "London", 33.10, 0.08, 0.022, 1.2},
};

constexpr struct SplitPlan {
    const char* ticker;
    std::size_t day; // the first one on which the new shares are traded
    short newShares; // for each old one
} kSplits[] = {{"ZPHR", 702, 3}, {"NDWK", 958, 2}};

constexpr struct NotePlan {
    const char* ticker;
    std::size_t day;
    const char* title;
    const char* text;
} kNotes[] = {
    {"QLLN", 61, "Coverage", "Sells to hospitals only; little debt. Worth watching."},
    {"CHLV", 133, "Order book", "Two ferries cancelled. Management expects a weak second half."},
    {"MDLB", 248, "Annual report", "Margins up again, Asia now a third of sales. Dividend 3.20."},
    {"LXRO", 371, "Recall", "Headsets recalled; provision of 140 million."},
    {"AMOE", 455, "Buy back", "Up to 5% of the shares within a year."},
    {"ZPHR", 702, "Split 3 for 1", "Quotes and operations before this day are converted to new shares."},
    {"EARM", 815, "Offshore park", "Second field connected six weeks early."},
    {"NDWK", 958, "Split 2 for 1", "Quotes and operations before this day are converted to new shares."},
    {"THBW", 1040, "Tariffs", "Regulator allows 4.1% for the coming period."},
    {"PRHG", 1168, "Harvest", "Drought in the south, volumes down by a tenth."},
    {"MRLM", 1243, "New licence", "Permit for the northern pit granted at last."},
};

double rounded(double value, double unitsOfOne)
{
    return std::floor(value * unitsOfOne + 0.5) / unitsOfOne;
}

/// What all companies have in common on a day: a steady rise, but for one slump and its recovery.
double worldDrift(std::size_t day)
{
    // Days of the sample. The recovery makes up for the slump and a little more.
    constexpr std::size_t kSlump = 430;
    constexpr std::size_t kTurn = 475;
    constexpr std::size_t kRecovered = 610;
    if (day >= kSlump && day < kTurn)
        return -0.0048;
    return day >= kTurn && day < kRecovered ? 0.0019 : 0.0001;
}

std::vector<double> worldReturns(std::size_t days)
{
    constexpr double kVolatility = 0.007;
    Noise noise(20);
    std::vector<double> returns;
    for (std::size_t i = 0; i < days; ++i)
        returns.push_back(worldDrift(i) + kVolatility * noise.next());
    return returns;
}

void addRates(Currency* currency, const CurrencyPlan& plan, std::uint64_t seed, const std::vector<Date>& days)
{
    constexpr double kPull = 0.004; // back to the first day's rate
    constexpr double kRateUnits = 10000;
    Noise noise(seed);
    double rate = plan.rate;
    for (const Date& day : days) {
        new CurrencyQuote(currency, day, static_cast<float>(rounded(rate, kRateUnits)));
        // The walk itself is not rounded, or small moves would be lost. The pull keeps a rate near to what people know.
        rate += kPull * (plan.rate - rate) + plan.volatility * rate * noise.next();
    }
}

const SplitPlan* findSplit(const String& ticker)
{
    const auto isOf = [&ticker](const SplitPlan& split) { return ticker == split.ticker; };
    const auto* found = std::find_if(std::begin(kSplits), std::end(kSplits), isOf);
    return found != std::end(kSplits) ? found : nullptr;
}

void addQuotes(Company* company, const SampleCompany& plan, std::uint64_t seed, const std::vector<Date>& days,
               const std::vector<double>& world)
{
    constexpr double kCents = 100;
    const SplitPlan* split = findSplit(plan.ticker);
    Noise noise(seed);
    double price = plan.price;
    for (std::size_t i = 0; i < days.size(); ++i) {
        // The price was formed in whole cents for an old share; whoever keeps the quotes has divided it at the split.
        const double parts = split != nullptr && i < split->day ? split->newShares : 1;
        new CompanyQuote(company, days[i], static_cast<float>(rounded(price * parts, kCents) / parts));
        price *= 1 + plan.growth / kDaysInYear + plan.beta * world[i] + plan.volatility * noise.next();
    }
    if (split != nullptr)
        new SplitCompanyEvent(company, days[split->day], 1, split->newShares);
}

void addNotes(Company* company, const std::vector<Date>& days)
{
    for (const NotePlan& note : kNotes)
        if (company->getAbbreviation() == note.ticker)
            new NoteCompanyEvent(company, days[note.day], note.title, note.text);
}

/// Null when there is no market of that name.
Market* findMarket(const Catalogue& catalogue, const String& name)
{
    for (Market* market : catalogue.getMarkets())
        if (market->getName() == name)
            return market;
    return nullptr;
}

} // namespace

bool isWeekday(const Date& day)
{
    const Date someMonday(1, 1, 2001);
    return ((day - someMonday) % 7 + 7) % 7 < 5;
}

std::vector<Date> sampleDays(const Date& last)
{
    Date day = last;
    day.moveBy(1 - 7 * kWeeks);
    std::vector<Date> days;
    for (; day <= last; day = day.getNext())
        if (isWeekday(day))
            days.push_back(day);
    return days;
}

void fillSampleMarket(Catalogue& catalogue, const std::vector<Date>& days)
{
    // Counts through currencies and companies alike. So a new currency would change all prices, and with them what the
    // sample's trades come to; a new company goes to the end of its table.
    std::uint64_t seed = 1000;
    for (const CurrencyPlan& plan : kCurrencies) {
        Currency* reference = catalogue.getReferenceCurrency();
        auto* currency = new Currency(plan.name, plan.symbol, reference);
        catalogue.addCurrency(currency);
        // Of the first one: it is its own reference, and those behind it are made with it.
        if (reference == nullptr)
            catalogue.setReferenceCurrency(currency);
        addRates(currency, plan, ++seed, days);
    }
    for (const MarketPlan& plan : kMarkets) {
        auto* market = new Market(plan.name);
        market->setCurrency(catalogue.getCurrencyByRepresentation(plan.symbol));
    }
    // All companies see the same world, each as far as its beta goes.
    const std::vector<double> world = worldReturns(days.size());
    for (const SampleCompany& plan : kCompanies) {
        auto* company = new Company(findMarket(catalogue, plan.market), plan.name, plan.ticker);
        addQuotes(company, plan, ++seed, days, world);
        addNotes(company, days);
    }
}

std::span<const SampleCompany> sampleCompanies()
{
    return kCompanies;
}

Company* findCompany(const Catalogue& catalogue, const String& ticker)
{
    Company* company = nullptr;
    for (const Market* market : catalogue.getMarkets())
        if (market->getCompany(ticker, &company) == 0)
            break;
    return company;
}
