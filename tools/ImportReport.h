#pragma once

#include "exchange/MarketPlan.h"

#include <string>

/// What is to be told of a plan that is not carried out yet: figures for standard output, names beside them.
struct ImportReport {
    explicit ImportReport(const MarketPlan& plan);

    /// Throws when standard output takes nothing.
    void print() const;

    std::string names;
    std::string figures;
};
