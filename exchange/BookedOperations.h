#pragma once

#include "exchange/PlannedOperation.h"

#include <cstdint>
#include <map>
#include <tuple>

class Company;
class Operation;
class Wallet;

/// The operations that a portfolio has, each to be found once: day, account, recipient, kind, and of a trade company
/// and quantity, of anything else the amount. Simulated ones do not count.
class BookedOperations {
public:
    explicit BookedOperations(const Wallet& wallet);

    /// Whether there is one like `operation` that has not been taken yet; it is taken then.
    bool take(const PlannedOperation& operation) { return take(keyOf(operation)); }
    bool take(const Operation& operation) { return take(keyOf(operation)); }

private:
    using Key = std::tuple<Date, const Account*, const Account*, OperationKind, const Company*, std::uint32_t>;

    bool take(const Key& key);
    static Key keyOf(const Operation& operation);
    static Key keyOf(const PlannedOperation& operation);

    std::map<Key, unsigned> left_; // how many of each
};
