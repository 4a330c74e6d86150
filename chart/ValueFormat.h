#pragma once

#include "chart/ChartScale.h"

#include <string>

/// How values are written: with 0 to 3 decimals wherever that tells them apart, else with more, or as powers of ten.
struct ValueFormat {
    int decimals;
    bool isScientific; // the decimals are then those of the factor before the power of ten

    /// For numbers up to `magnitude` in size that differ by at least `step`, which is above 0.
    static ValueFormat forStep(double step, double magnitude);
    /// For single values out of `range`: more decimals the smaller they are, as prices are quoted.
    static ValueFormat forValues(const ChartRange& range);

    std::string operator()(double value) const;
};
