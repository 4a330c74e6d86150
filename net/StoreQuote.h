#pragma once

#include "market/Company.h"

enum class StoreOutcome { kAdded, kChanged, kSame };

/// Makes `price` the company's quote of that day: adds a quote, or changes the value of the one that is there.
/// `*quote`, which the company owns, is the day's quote afterwards.
StoreOutcome storeQuote(Company* company, const Date& date, float price, CompanyQuote** quote);
