#pragma once

#include "foundation/Date.h"

#include <span>
#include <vector>

class Catalogue;
class Company;

bool isWeekday(const Date& day);

/// The 1305 weekdays of the five years that end with `last`, oldest first.
std::vector<Date> sampleDays(const Date& last);

/// Fills `catalogue`, which is empty, with a made-up world: four currencies with the euro as their reference, four
/// markets, and twenty companies that do not exist, with a quote, and a rate, on each of `days`, from `sampleDays`.
/// Quotes and rates depend on a day's place in `days` only.
void fillSampleMarket(Catalogue& catalogue, const std::vector<Date>& days);

struct SampleCompany {
    const char* name;
    const char* ticker;
    const char* market;
    double price;      // on the first day
    double growth;     // of a year, a fraction, beside what the world does
    double volatility; // of a day, a fraction
    double beta;       // how much it follows the world
};

/// Those of the made-up world.
std::span<const SampleCompany> sampleCompanies();

/// The first company with this ticker, whatever its market; null when the catalogue has none.
Company* findCompany(const Catalogue& catalogue, const String& ticker);
