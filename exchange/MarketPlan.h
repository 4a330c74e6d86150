#pragma once

#include "exchange/ValueCounts.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"

#include <cstddef>
#include <deque>
#include <memory>
#include <unordered_set>
#include <vector>

class Catalogue;

/// Values that an import brings for one series. As it reads, in the order of the lines; once `settle` is done by date,
/// one a day, and without those that the series has already.
template <class Owner>
struct SeriesValues {
    Owner* owner; // in the catalogue, or new in the plan
    Currency* currency;
    bool isNew; // the owner is
    std::vector<DatedValue> values;
};

/// What tables would bring into a catalogue: worked out for a preview, and done in a second step. Until then the
/// catalogue is as it was, and must stay so.
///
/// What is new stands here in the order in which the tables first mention it. It is the plan's own, and becomes the
/// catalogue's with `carryOut`.
class MarketPlan {
public:
    using Counts = ValueCounts;
    struct NewMarket {
        std::unique_ptr<Market> market;
        Currency* currency;
    };
    struct NewCompany {
        std::unique_ptr<Company> company;
        Market* market;
    };
    /// What came for one company or currency. Those are told of, too, that had all of it.
    template <class Owner>
    struct Tally {
        const Owner* owner;
        const Currency* currency;
        bool isNew;
        Counts counts;
    };
    using Owners = std::unordered_set<const Serializable*>;

    bool isEmpty() const { return quotes.empty() && rates.empty(); }

    /// Gives the reference the rate 1 where it needs it; to be called when all other values are there.
    ///
    /// It is worth 1 on every day for which any rate has come, where it has no value yet. Without rates one day is
    /// enough, the first of the quotes, since a single quote holds for ever; that is only done for a reference that is
    /// new or in which something is quoted. A reference with other rates of its own is left alone: its owner means
    /// something by them.
    /// @param ones the values of the reference among `rates`.
    void giveReferenceItsRates(std::vector<DatedValue>& ones);
    /// The latest day of all values; undefined without any.
    PackedDate lastDay() const;

    /// Sorts the values and counts them, and drops those of a day for which a later line has another, and those that
    /// change nothing.
    void settle();
    /// Drops what is new and has neither values nor something that has. To be called when `settle` is done.
    void dropUnused();

    /// Brings all of it into `catalogue`, for which the plan was made; a plan is carried out once. A day that has a
    /// value gets the new one, and all else stays as it is.
    /// @return the companies and currencies of which quotes or rates have changed.
    Owners carryOut(Catalogue& catalogue);

    std::vector<std::unique_ptr<Currency>> newCurrencies;
    std::vector<NewMarket> newMarkets;
    std::vector<NewCompany> newCompanies;
    std::deque<SeriesValues<Company>> quotes; // a deque, as whoever fills it keeps the places of its entries
    std::deque<SeriesValues<Currency>> rates;
    Currency* reference = nullptr; // of the catalogue from then on

    std::vector<Tally<Company>> quoteTallies; // once `settle` is done
    std::vector<Tally<Currency>> rateTallies;
    Counts quoteCounts;
    Counts rateCounts; // without those of the reference
    Counts referenceCounts;
    std::size_t refused = 0;  // lines
    std::size_t replaced = 0; // values given up for a later line of the same day
};
