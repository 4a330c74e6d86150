#pragma once

#include "chart/ChartFlag.h"

#include <span>
#include <vector>

class Company;
class CompanyEvent;

/// What the chart of a company's quotes marks: the purchases and sales of it in the portfolio, and its events but those
/// that are `leaving`. Says what has happened: "Bought 100 at 40.00", "Split 1 to 2", "Dividend: 25 EUR".
std::vector<ChartFlag> companyFlags(const Company& company, std::span<CompanyEvent* const> leaving);

/// How purchases, sales and events look, and what they are called in the key.
ChartFlagStyles companyFlagStyles();
