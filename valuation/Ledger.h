#pragma once

#include <cstddef>
#include <cstdint>
#include <limits>
#include <vector>

/// A sum of moves, rounded to float after every addition, as more and more of the moves happen.
///
/// The moves are added up in a fixed order that is not the order in which they happen. Because each rounding depends on
/// the sum so far, a move that happens makes everything behind it be added up again; what stands before it is
/// remembered.
class Ledger {
public:
    /// The place of a move in the order of addition.
    using Rank = std::uint32_t;

    /// Adds a move behind the others. It has not happened yet.
    Rank addMove(double amount);
    void happen(Rank rank);
    /// The sum of the moves that have happened.
    float balance();

private:
    static constexpr std::size_t kNone = std::numeric_limits<std::size_t>::max();

    std::vector<double> amounts_; // of all moves, by rank
    // The moves that have happened, in order:
    std::vector<Rank> happened_;
    std::vector<float> sums_;   // up to and including each; right before `stale_`
    std::size_t stale_ = kNone; // from here on the sums have to be taken again
};
