#pragma once

#include "foundation/String.h"
#include "views/PageView.h"

class Currency;

/// The page of currencies and their rates.
class CurrencyView final : public PageView {
public:
    CurrencyView(BRect frame, const char* name, BWindow* window);

    void AddCurrency(Currency* currency, bool selected);
    /// Shows the name of the reference currency.
    void setCurrencyRefName(const String& name);
};
