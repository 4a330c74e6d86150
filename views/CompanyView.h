#pragma once

#include "views/PageView.h"

#include <vector>

class BListView;
class Company;
class Market;

/// The page of markets and companies.
class CompanyView final : public PageView {
public:
    CompanyView(BRect frame, const char* name, BWindow* window);

    /// Fills the market list; the company list becomes empty.
    void SetMarketList(const std::vector<Market*>& markets);
    Company* GetSelectedCompany() const { return nullptr; }
    BListView* getCompanyListView() const { return nullptr; }
};
