#pragma once

#include "foundation/String.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

class Catalogue;

/// The quotes of a series as their records. Images share the records of a series that has not changed between them.
struct SeriesImage {
    std::shared_ptr<const std::string> records;
    /// Of a series that has these very quotes. Only a saving: who finds it in a series need not compare the quotes.
    mutable std::uint64_t revision = 0;
};

/// A company with its quotes and events, without what the portfolio has of it.
struct CompanyImage {
    String name;
    String abbreviation;
    SeriesImage quotes;
    std::string events; // as in the file
};

struct MarketImage {
    String name;
    std::vector<std::shared_ptr<const CompanyImage>> companies;
};

struct CurrencyImage {
    String name;
    String representation;
    std::optional<std::size_t> reference; // the place of the one it stores
    SeriesImage quotes;
    std::vector<std::shared_ptr<const MarketImage>> markets;
};

/// The market data at one moment: what a file of it says, and what that leaves out, the order of the lists and which
/// currency is stored as whose reference.
///
/// An image never changes. Those of different moments share what is the same at the same place, so one more costs the
/// memory of what has changed. Links between objects are kept as places in the lists, since names may be ambiguous.
struct CatalogueImage {
    std::optional<std::size_t> reference;
    std::vector<std::shared_ptr<const CurrencyImage>> currencies;

    /// @return `former` itself when that is what the catalogue looks like; `former` may be null.
    static std::shared_ptr<const CatalogueImage> of(const Catalogue& catalogue,
                                                    const std::shared_ptr<const CatalogueImage>& former);
    /// Makes `catalogue` look like this. Objects stay where something stands at their place; the others are destroyed
    /// or made. Nobody refers to holdings or rows of it: the portfolio goes before and comes behind.
    void restore(Catalogue& catalogue) const;
    /// Bytes that are in this one and not in `other`, which comes next to it in time.
    std::size_t bytesBeside(const CatalogueImage& other) const;
};
