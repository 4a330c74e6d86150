#include "views/DateControl.h"

#include "foundation/DateText.h"
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

void DateControl::setDate(const Date& date)
{
    SetText(dateText(date).c_str());
    mark();
}

Date DateControl::getDate() const
{
    return readDate(Text());
}

void DateControl::TextModified()
{
    mark();
}

void DateControl::KeyDown(const char* bytes, int32)
{
    Date date = getDate();
    if (date.isUndefined()) {
        if (*Text() == '\0')
            enter(today());
        return;
    }
    switch (*bytes) {
    case B_UP_ARROW:
        enter(date.moveBy(1));
        break;
    case B_DOWN_ARROW:
        enter(date.moveBy(-1));
        break;
    case B_PAGE_UP:
        enter(monthsFrom(date, 1));
        break;
    case B_PAGE_DOWN:
        enter(monthsFrom(date, -1));
        break;
    default:
        break;
    }
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
