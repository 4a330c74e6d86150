// Markets.

#include "app/PLWindow.h"

void PLWindow::AddMarket() {}
void PLWindow::AddMarket(Market*, bool) {}
void PLWindow::UpdateMarket() {}
void PLWindow::RemoveMarket(Market*, bool) {}
void PLWindow::RemoveAllMarkets() {}
void PLWindow::MarketSelection() {}
