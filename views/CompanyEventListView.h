#pragma once

#include "market/CompanyEvent.h"
#include "views/DatedListView.h"

/// A note or a split.
class CompanyEventItem final : public ObjectItem<CompanyEvent> {
public:
    using ObjectItem::ObjectItem;
    Cell cell(int column) const override;
};

/// The events of a company, by date; several can be selected.
class CompanyEventListView final : public DatedListView<CompanyEvent, CompanyEventItem> {
public:
    explicit CompanyEventListView(const char* name);
};
