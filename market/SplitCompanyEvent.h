#pragma once

#include "market/CompanyEvent.h"

/// A share split on a day, as a numerator and a divider. Stored and shown as it is; no quote, valuation or chart is
/// adjusted by it.
class SplitCompanyEvent final : public CompanyEvent {
public:
    static constexpr short kType = 1;

    SplitCompanyEvent() = default;
    SplitCompanyEvent(Company* company, const Date& date, short numerator, short divider);

    /// File: date, numerator (u16), divider (u16). `rd` returns -1 when the file ends inside the record.
    int wrt(FILE* file) const override;
    int rd(FILE* file) override;
    short getType() const override { return kType; }

    short getNumerator() const { return numerator_; }
    void setNumerator(short numerator) { numerator_ = numerator; }
    short getDivider() const { return divider_; }
    void setDivider(short divider) { divider_ = divider; }

private:
    short numerator_ = 0;
    short divider_ = 0;
};
