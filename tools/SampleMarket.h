#pragma once

#include "foundation/Date.h"

#include <cstdint>
#include <vector>

class Catalogue;

bool isWeekday(const Date& day);

/// The 1305 weekdays of the five years that end with `last`, oldest first.
std::vector<Date> sampleDays(const Date& last);

/// Fills `catalogue`, which is empty, with a made-up world: four currencies with the euro as their reference, four
/// markets, and twenty companies that do not exist, with a quote, and a rate, on each of `days`, from `sampleDays`.
/// Quotes and rates depend on a day's place in `days` only.
void fillSampleMarket(Catalogue& catalogue, const std::vector<Date>& days);

struct SampleTicker {
    const char* name;
    float firstPrice;
    double volatility;  // of a day, a fraction
    std::uint64_t seed; // of the company's prices
};

/// Those of all companies of the made-up world.
std::vector<SampleTicker> sampleTickers();
