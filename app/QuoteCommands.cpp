// Quotes of the selected company, and those that are fetched.

#include "app/PLWindow.h"

void PLWindow::AddCompanyQuote() {}
void PLWindow::UpdateCompanyQuote() {}
void PLWindow::RemoveCompanyQuote() {}
void PLWindow::CompanyQuoteSelection() {}
void PLWindow::SplitQuotes() {}
void PLWindow::UpdateCompanyQuotesChart() {}
void PLWindow::SetThreeMonthsCompanyQuotes() {}
void PLWindow::UpdatePortoFolioQuotes() {}
