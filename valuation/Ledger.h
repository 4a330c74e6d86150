#pragma once

#include <cstddef>
#include <limits>
#include <vector>

/// A sum of moves, rounded to float after every addition, that can be taken again as more and more of them happen.
///
/// The moves stand in segments, in the order in which they are added up; within a segment they happen one after the
/// other. When one happens, everything behind it has to be added up again, because each rounding depends on the sum so
/// far; what stands before it is remembered.
class Ledger {
public:
    /// Starts a new segment behind the others. @return its number.
    std::size_t addSegment();
    /// Adds a move to the last segment; it has not happened yet.
    void addMove(double amount) { moves_.push_back(amount); }
    std::size_t getNbrSegments() const { return segments_.size(); }

    /// The next move of the segment happens.
    void advance(std::size_t segment);
    /// The sum of all moves that have happened.
    float balance();

private:
    struct Segment {
        std::size_t begin;        // its first move
        std::size_t happened = 0; // number of its moves that count
        std::size_t summed = 0;   // number of those that are in `sum`
        float sum = 0;            // of everything up to the last summed move of this segment
    };

    static constexpr std::size_t kNone = std::numeric_limits<std::size_t>::max();

    void takeIn(Segment& segment);

    std::vector<double> moves_;
    std::vector<Segment> segments_;
    std::size_t stale_ = kNone; // the first segment with a move that is not summed
};
