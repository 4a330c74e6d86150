#include "market/NoteCompanyEvent.h"

NoteCompanyEvent::NoteCompanyEvent(Company* company, const Date& date, const String& title, const String& text)
    : CompanyEvent(company, date), title_(title), text_(text)
{}

int NoteCompanyEvent::wrt(FILE* file) const
{
    getDate().wrt(file);
    title_.wrt(file);
    return text_.wrt(file);
}

int NoteCompanyEvent::rd(FILE* file)
{
    // An event is read before it is linked: setting its date moves it in no list yet. A date that is cut short shows
    // when the title cannot be read.
    Date date;
    date.rd(file);
    setDate(date);
    return title_.rd(file) == 0 && text_.rd(file) == 0 ? 0 : -1;
}
