// Currencies and their rates.

#include "app/PLWindow.h"

void PLWindow::AddCurrency() {}
void PLWindow::AddCurrency(Currency*, bool) {}
void PLWindow::UpdateCurrency() {}
void PLWindow::RemoveCurrency() {}
void PLWindow::RemoveAllCurrencies() {}
void PLWindow::CurrencySelection() {}
void PLWindow::SetCurrencyRef() {}
void PLWindow::SetCurrencyRef(Currency*) {}
void PLWindow::AddCurrencyQuote() {}
void PLWindow::UpdateCurrencyQuote() {}
void PLWindow::RemoveCurrencyQuote() {}
void PLWindow::CurrencyQuoteSelection() {}
void PLWindow::UpdateCurrencyQuotesChart() {}
