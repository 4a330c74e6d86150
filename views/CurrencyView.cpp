#include "views/CurrencyView.h"

#include "views/Look.h"

CurrencyView::CurrencyView(BRect frame, const char* name, BWindow*) : PageView(frame, name)
{
    addButton(this, {8, 8, 108, 8 + look::kButtonHeight}, "btnLoadMarket", "Load", 'CBLd');
    addButton(this, {114, 8, 214, 8 + look::kButtonHeight}, "btnSaveMarket", "Save", 'CBSv');
}

void CurrencyView::AddCurrency(Currency*, bool) {}
void CurrencyView::setCurrencyRefName(const String&) {}
