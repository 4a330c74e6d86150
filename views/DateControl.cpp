#include "views/DateControl.h"

#include "foundation/Today.h"

#include <algorithm>

namespace {

/// The same day of another month, or its last one where it has no such day.
Date monthsFrom(const Date& date, int months)
{
    const int month = 12 * date.getYear() + date.getMonth() - 1 + months;
    // The first of the month is a day that every month has; the day follows once the length is known.
    Date result(1, static_cast<short>(month % 12 + 1), month / 12);
    result.setDay(std::min(date.getDay(), result.getMonthLength()));
    return result;
}

} // namespace

DateControl::DateControl(BRect frame, const char* name, const char* label, const char* text, BMessage* message)
    : BTextControl(frame, name, label, text, message), shown_(text)
{
    SetCalendar(
        [this] {
            const Date date = getDate();
            return CalendarDay{date.getDay(), date.getMonth(), date.getYear()};
        },
        [this](const CalendarDay& day) {
            enter(Date(static_cast<short>(day.day), static_cast<short>(day.month), day.year));
        });
}

void DateControl::setDate(const Date& date)
{
    shown_ = dateText(date);
    SetText(shown_.c_str());
    mark();
}

Date DateControl::getDate() const
{
    // A date of the first century that was put in is shown with its two digits, and stays what it is.
    return Text() == shown_ ? readDate(shown_) : readShortDate(Text(), today());
}

void DateControl::TextFinished()
{
    const Date date = getDate();
    if (!date.isUndefined() && Text() != shown_)
        setDate(date);
}

void DateControl::KeyDown(const char* bytes, int32)
{
    Date date = getDate();
    // A text that is no date stays as it is: nobody wants it replaced by a key that slipped.
    if (date.isUndefined()) {
        if (*Text() == '\0')
            enter(today());
        return;
    }
    constexpr struct {
        char key;
        int days;
        int months;
    } kMoves[] = {{B_UP_ARROW, 1, 0}, {B_DOWN_ARROW, -1, 0}, {B_PAGE_UP, 0, 1}, {B_PAGE_DOWN, 0, -1}};
    // All other keys are for the text, and have gone there.
    for (const auto& move : kMoves)
        if (move.key == *bytes)
            return enter(move.months != 0 ? monthsFrom(date, move.months) : date.moveBy(move.days));
}

void DateControl::enter(const Date& date)
{
    if (readDate(dateText(date)).isUndefined())
        return; // beyond the first or the last year

    // As after typing: the colour is right, offers know of it, and the window is told last.
    setDate(date);
    TextModified();
    Invoke();
}

void DateControl::mark()
{
    const bool isWrong = *Text() != '\0' && getDate().isUndefined();
    MarkAsInvalid(isWrong ? "This is no date: day/month/year, such as 31/12/2024" : nullptr);
}
