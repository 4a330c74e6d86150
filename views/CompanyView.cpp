#include "views/CompanyView.h"

#include "views/Look.h"

CompanyView::CompanyView(BRect frame, const char* name, BWindow*) : PageView(frame, name)
{
    addButton(this, {8, 8, 108, 8 + look::kButtonHeight}, "btnLoadMarket", "Load", 'CBLd');
    addButton(this, {114, 8, 214, 8 + look::kButtonHeight}, "btnSaveMarket", "Save", 'CBSv');
}

void CompanyView::SetMarketList(const std::vector<Market*>&) {}
