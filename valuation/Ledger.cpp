#include "valuation/Ledger.h"

#include "valuation/CashMoves.h"

#include <algorithm>

std::size_t Ledger::addSegment()
{
    segments_.push_back({moves_.size()});
    return segments_.size() - 1;
}

void Ledger::advance(std::size_t segment)
{
    ++segments_[segment].happened;
    stale_ = std::min(stale_, segment);
}

float Ledger::balance()
{
    if (stale_ != kNone) {
        takeIn(segments_[stale_]); // what it has summed still holds: nothing before it has changed
        for (std::size_t i = stale_ + 1; i < segments_.size(); ++i) {
            segments_[i].summed = 0;
            segments_[i].sum = segments_[i - 1].sum;
            takeIn(segments_[i]);
        }
        stale_ = kNone;
    }
    return segments_.empty() ? 0 : segments_.back().sum;
}

void Ledger::takeIn(Segment& segment)
{
    float sum = segment.sum;
    const double* moves = moves_.data() + segment.begin;
    for (std::size_t i = segment.summed; i < segment.happened; ++i)
        sum = addRounded(sum, moves[i]);
    segment.sum = sum;
    segment.summed = segment.happened;
}
