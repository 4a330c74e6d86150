#pragma once

#include "foundation/Date.h"

#include <string>

class Catalogue;
class State;

/// How far the figures of a state rest on quotes of its very day, and not on older ones or on estimates.
struct QuoteCoverage {
    unsigned needed = 0;  // quotes that the figures rest on
    unsigned older = 0;   // of these, from a day before
    unsigned unknown = 0; // of these, there is none up to the day: an estimate from later ones, or nothing at all
    Date lastFullDay;     // the last one up to the state's day with all quotes; undefined when there is none
};

/// The quotes of the holdings of `state` that are held.
QuoteCoverage quoteCoverage(const State& state);
/// The rates of the currencies that its holdings and accounts are in, other than the reference currency.
QuoteCoverage rateCoverage(const State& state, const Catalogue& catalogue);
/// "11 of 12 quotes are older than 21/11/2026", for the `what` "quotes" and that day; empty when none is.
std::string coverageText(const QuoteCoverage& coverage, const char* what, const Date& day);
/// "estimated: 11 of 12 quotes are older than 21/11/2026, the last day with all quotes is 20/11/2026"; the same of the
/// rates where no quote is missing, and empty where none of these is, either.
std::string estimateText(const QuoteCoverage& quotes, const QuoteCoverage& rates, const Date& day);
