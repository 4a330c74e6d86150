#pragma once

#include "market/Company.h"
#include "views/ObjectListView.h"

/// A company's ticker and name.
class CompanyItem final : public ObjectItem<Company> {
public:
    using ObjectItem::ObjectItem;
    Cell cell(int column) const override;
};

/// The companies of a market, in its order.
class CompanyListView final : public ObjectListView<Company, CompanyItem> {
public:
    explicit CompanyListView(const char* name);
};
