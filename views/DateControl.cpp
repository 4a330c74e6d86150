#include "views/DateControl.h"

#include "views/DateText.h"

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

void DateControl::mark()
{
    const bool isWrong = *Text() != '\0' && getDate().isUndefined();
    MarkAsInvalid(isWrong ? "This is no date: day/month/year, such as 31/12/2024" : nullptr);
}
