#include "app/EventEditor.h"

#include "app/PLWindow.h"
#include "market/NoteCompanyEvent.h"
#include "market/SplitCompanyEvent.h"
#include "views/CompanyView.h"

#include <memory>

namespace {

/// An event of the kind and with the content that the fields show; linked to `company`, which owns it.
CompanyEvent* makeEvent(const CompanyView& view, Company* company, const Date& date)
{
    if (view.getEventType() == NoteCompanyEvent::kType)
        return new NoteCompanyEvent(company, date, view.getCompanyEventTitle(), view.getCompanyEventText());
    return new SplitCompanyEvent(company, date, view.getCompanyEventNumerator(), view.getCompanyEventDivider());
}

/// Gives an event of the kind that the fields show their content. @return false for an event of the other kind.
bool takeFields(const CompanyView& view, CompanyEvent* event)
{
    if (event->getType() != view.getEventType())
        return false;
    if (auto* note = dynamic_cast<NoteCompanyEvent*>(event)) {
        note->setTitle(view.getCompanyEventTitle());
        note->setText(view.getCompanyEventText());
    } else if (auto* split = dynamic_cast<SplitCompanyEvent*>(event)) {
        split->setNumerator(view.getCompanyEventNumerator());
        split->setDivider(view.getCompanyEventDivider());
    }
    return true;
}

} // namespace

void EventEditor::add()
{
    Company* company = page_.GetSelectedCompany();
    if (company == nullptr)
        return window_.SetMessage("You must first select a company");
    const Date date = page_.getCompanyEventDate();
    if (date.isUndefined())
        return window_.SetMessage("Please specify a date.");
    page_.AddCompanyEvent(makeEvent(page_, company, date), true);
}

void EventEditor::update()
{
    if (page_.getCompanyEventDate().isUndefined())
        return window_.SetMessage("Please specify a date.");
    CompanyEvent* event = page_.GetSelectedCompanyEvent();
    if (event == nullptr)
        return window_.SetMessage("Please select a company event if you want to update.");
    // The kind is that of the menu, the date the event's own. Intended: a note can be made of a split, and the other
    // way round, on the day where it stands.
    if (takeFields(page_, event)) {
        page_.ModifyCompanyEvent(event);
        return;
    }
    // The company has both for a moment; the row goes before the event that it draws.
    CompanyEvent* replacement = makeEvent(page_, event->company(), event->getDate());
    page_.DeleteCompanyEvent(event);
    delete event;
    page_.AddCompanyEvent(replacement, true);
}

void EventEditor::remove()
{
    int n;
    const std::unique_ptr<CompanyEvent*[]> array(page_.GetAllSelectedCompanyEvents(&n));
    const std::span events(array.get(), static_cast<std::size_t>(n));
    page_.DeleteCompanyEvents(events); // the rows first: they look at the events' dates
    for (CompanyEvent* event : events)
        delete event;
}

void EventEditor::showSelected()
{
    const CompanyEvent* event = page_.GetSelectedCompanyEvent();
    if (const auto* note = dynamic_cast<const NoteCompanyEvent*>(event)) {
        page_.setCompanyEventDate(note->getDate());
        page_.setCompanyEventTitle(note->getTitle());
        page_.setCompanyEventText(note->getText());
        page_.SetEventType(NoteCompanyEvent::kType);
    } else if (const auto* split = dynamic_cast<const SplitCompanyEvent*>(event)) {
        page_.setCompanyEventDate(split->getDate());
        page_.setCompanyEventNumerator(split->getNumerator());
        page_.setCompanyEventDivider(split->getDivider());
        page_.SetEventType(SplitCompanyEvent::kType);
    } else {
        page_.setCompanyEventDate(Date());
        page_.setCompanyEventTitle(" ");
        page_.setCompanyEventText(" ");
        page_.setCompanyEventNumerator(1); // one share becomes two: the usual split
        page_.setCompanyEventDivider(2);
    }
}
