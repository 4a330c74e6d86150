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

void DateControl::setDate(const Date& date)
{
    SetText(dateText(date).c_str());
    mark();
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
