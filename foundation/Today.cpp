#include "foundation/Today.h"

#include <ctime>

namespace {

Date chosenDay; // undefined: the clock tells

} // namespace

Date today()
{
    if (!chosenDay.isUndefined())
        return chosenDay;
    const std::time_t now = std::time(nullptr);
    std::tm local{};
    localtime_r(&now, &local);
    return {static_cast<short>(local.tm_mday), static_cast<short>(local.tm_mon + 1), local.tm_year + 1900};
}

void setToday(const Date& day)
{
    chosenDay = day;
}
