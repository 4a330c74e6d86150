#pragma once

#include "foundation/Date.h"

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
