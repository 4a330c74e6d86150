#include "views/CompanyEventListView.h"

#include "market/NoteCompanyEvent.h"
#include "market/SplitCompanyEvent.h"
#include "views/DateText.h"
#include "views/ModelText.h"

namespace {

enum Column { kDate, kKind, kContent };

std::string contentOf(const CompanyEvent& event)
{
    if (const auto* note = dynamic_cast<const NoteCompanyEvent*>(&event))
        return textOf(note->getTitle());
    const auto& split = static_cast<const SplitCompanyEvent&>(event);
    return std::to_string(split.getNumerator()) + " : " + std::to_string(split.getDivider());
}

} // namespace

Cell CompanyEventItem::cell(int column) const
{
    switch (column) {
    case kDate:
        return {dateText(event_->getDate())};
    case kKind:
        return {event_->getType() == NoteCompanyEvent::kType ? "Note" : "Split"};
    case kContent:
        return {contentOf(*event_)};
    default:
        return {};
    }
}

CompanyEventListView::CompanyEventListView(const char* name)
    : DatedListView({}, name, B_MULTIPLE_SELECTION_LIST, {{"Date", 82}, {"Kind", 46}, {"Content", 194}})
{}
