#include "views/CompanyEventListView.h"

#include "foundation/DateText.h"
#include "market/NoteCompanyEvent.h"
#include "market/SplitCompanyEvent.h"
#include "views/ModelText.h"

namespace {

enum Column { kDate, kKind, kContent };

std::string contentOf(const CompanyEvent& event)
{
    if (const auto* note = dynamic_cast<const NoteCompanyEvent*>(&event))
        return textOf(note->getTitle());
    // There are two kinds of events.
    const auto& split = static_cast<const SplitCompanyEvent&>(event);
    return std::to_string(split.getNumerator()) + " : " + std::to_string(split.getDivider());
}

} // namespace

Cell CompanyEventItem::cell(int column) const
{
    switch (column) {
    case kDate:
        return {dateText(object_->getDate())};
    case kKind:
        return {object_->getType() == NoteCompanyEvent::kType ? "Note" : "Split"};
    case kContent:
        return {contentOf(*object_)};
    default:
        return {};
    }
}

CompanyEventListView::CompanyEventListView(const char* name)
    : DatedListView({}, name, B_MULTIPLE_SELECTION_LIST, {{"Date", 82}, {"Kind", 46}, {"Content", 194}})
{}
