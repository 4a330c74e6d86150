#include "valuation/Ledger.h"

#include "valuation/CashMoves.h"

#include <algorithm>

Ledger::Rank Ledger::addMove(double amount)
{
    // Its rank is the highest so far. No sum changes, since the move has not happened.
    amounts_.push_back(amount);
    return static_cast<Rank>(amounts_.size() - 1);
}

void Ledger::happen(Rank rank)
{
    // `happened_` is in ascending order of ranks, before and after.
    const auto place = std::lower_bound(happened_.begin(), happened_.end(), rank);
    // The sums before `place` stay right. Those from there on lack this move, or stand one place too early.
    stale_ = std::min(stale_, static_cast<std::size_t>(place - happened_.begin()));
    happened_.insert(place, rank);
}

float Ledger::balance()
{
    if (stale_ != kNone) {
        // Before `stale_` each sum covers the moves up to its own. From there on they are taken again, in order of
        // rank, each from the one before it.
        sums_.resize(happened_.size());
        float sum = stale_ > 0 ? sums_[stale_ - 1] : 0;
        for (std::size_t i = stale_; i < happened_.size(); ++i) {
            const double amount = amounts_[happened_[i]];
            const auto single = static_cast<float>(amount);
            // Two floats add up to the same float in float and in double, but in float it takes a third of the time,
            // and every addition has to wait for the one before.
            if (single == amount)
                sum += single;
            else
                sum = addRounded(sum, amount);
            sums_[i] = sum;
        }
        // Every sum is right again.
        stale_ = kNone;
    }
    return sums_.empty() ? 0 : sums_.back();
}
