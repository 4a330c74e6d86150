#include "valuation/SharedHolding.h"

SharedHolding::SharedHolding(const Holding& holding) : place_(static_cast<std::uint32_t>(entries_.size()))
{
    if (free_.empty()) {
        entries_.push_back({holding, 1});
        return;
    }
    place_ = free_.back();
    free_.pop_back();
    entry() = {holding, 1};
}

void SharedHolding::forgetAll()
{
    entries_.clear();
    free_.clear();
}
