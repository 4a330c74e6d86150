// Events of the selected company.

#include "app/PLWindow.h"
#include "app/WindowLock.h"
#include "market/Company.h"
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

void PLWindow::ChangeCompanyEventType(short type)
{
    const WindowLock lock(*this);
    if (lock.isHeld())
        companyView_->SetEventType(type);
}

void PLWindow::AddCompanyEvent()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    Company* company = companyView_->GetSelectedCompany();
    if (company == nullptr) {
        SetMessage("You must first select a company");
        return;
    }
    const Date date = companyView_->getCompanyEventDate();
    if (date.isUndefined()) {
        SetMessage("Please specify a date.");
        return;
    }
    companyView_->AddCompanyEvent(makeEvent(*companyView_, company, date), true);
}

void PLWindow::UpdateCompanyEvent()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    if (companyView_->getCompanyEventDate().isUndefined()) {
        SetMessage("Please specify a date.");
        return;
    }
    CompanyEvent* event = companyView_->GetSelectedCompanyEvent();
    if (event == nullptr) {
        SetMessage("Please select a company event if you want to update.");
        return;
    }
    // The kind is that of the menu, the date the event's own. Intended: a note can be made of a split, and the other
    // way round, on the day where it stands.
    if (takeFields(*companyView_, event)) {
        companyView_->ModifyCompanyEvent(event);
        return;
    }
    Company* company = nullptr;
    event->getCompany(&company);
    CompanyEvent* replacement = makeEvent(*companyView_, company, event->getDate());
    companyView_->DeleteCompanyEvent(event);
    delete event;
    companyView_->AddCompanyEvent(replacement, true);
}

void PLWindow::RemoveCompanyEvent()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    int n;
    const std::unique_ptr<CompanyEvent*[]> events(companyView_->GetAllSelectedCompanyEvents(&n));
    companyView_->DeleteCompanyEvents(events.get(), n);
    for (int i = 0; i < n; ++i)
        delete events[static_cast<std::size_t>(i)];
}

void PLWindow::CompanyEventSelection()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    const CompanyEvent* event = companyView_->GetSelectedCompanyEvent();
    if (const auto* note = dynamic_cast<const NoteCompanyEvent*>(event)) {
        companyView_->setCompanyEventDate(note->getDate());
        companyView_->setCompanyEventTitle(note->getTitle());
        companyView_->setCompanyEventText(note->getText());
        companyView_->SetEventType(NoteCompanyEvent::kType);
    } else if (const auto* split = dynamic_cast<const SplitCompanyEvent*>(event)) {
        companyView_->setCompanyEventDate(split->getDate());
        companyView_->setCompanyEventNumerator(split->getNumerator());
        companyView_->setCompanyEventDivider(split->getDivider());
        companyView_->SetEventType(SplitCompanyEvent::kType);
    } else {
        companyView_->setCompanyEventDate(Date());
        companyView_->setCompanyEventTitle(" ");
        companyView_->setCompanyEventText(" ");
        companyView_->setCompanyEventNumerator(1); // one share becomes two: the usual split
        companyView_->setCompanyEventDivider(2);
    }
}
