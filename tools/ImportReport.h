#pragma once

#include "exchange/MarketFile.h"

#include <string>

/// What is to be told of a plan that is not carried out yet: figures for standard output, names beside them.
struct ImportReport {
    explicit ImportReport(const MarketPlan& plan);

    /// Throws when standard output takes nothing.
    void print() const;

    std::string names;
    std::string figures;
};

/// Carries out a plan that was made for the file, and saves it as a save of the window does. Throws std::runtime_error
/// with the reason when it could not be saved; then it is as it was.
/// @param latestDay of the values. A file that bears a later one keeps that.
void bringInto(MarketFile& file, MarketPlan& plan, const Date& latestDay);
