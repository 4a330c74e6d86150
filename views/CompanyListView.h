#pragma once

#include "market/Company.h"
#include "views/ObjectListView.h"

/// A company's ticker and name.
class CompanyItem final : public ColumnItem {
public:
    explicit CompanyItem(Company* company) : company_(company) {}

    Company* object() const { return company_; }
    const void* key() const { return company_; }
    Cell cell(int column) const override;

private:
    Company* company_;
};

/// The companies of a market, in its order.
class CompanyListView final : public ObjectListView<Company, CompanyItem> {
public:
    explicit CompanyListView(const char* name);
};
