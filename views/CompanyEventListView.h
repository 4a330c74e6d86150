#pragma once

#include "market/CompanyEvent.h"
#include "views/DatedListView.h"

/// A note or a split.
class CompanyEventItem final : public ColumnItem {
public:
    explicit CompanyEventItem(CompanyEvent* event) : event_(event) {}

    CompanyEvent* object() const { return event_; }
    const void* key() const { return event_; }
    void release() { event_ = nullptr; }
    Cell cell(int column) const override;

private:
    CompanyEvent* event_;
};

/// The events of a company, by date; several can be selected.
class CompanyEventListView final : public DatedListView<CompanyEvent, CompanyEventItem> {
public:
    explicit CompanyEventListView(const char* name);
};
