#include "tools/Today.h"

#include <ctime>

Date today()
{
    const std::time_t now = std::time(nullptr);
    std::tm local{};
    localtime_r(&now, &local);
    return {static_cast<short>(local.tm_mday), static_cast<short>(local.tm_mon + 1), local.tm_year + 1900};
}
