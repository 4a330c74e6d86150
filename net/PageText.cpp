#include "net/PageText.h"

#include <clocale>
#include <cmath>
#include <cstdlib>
#include <string>

std::size_t endOfMarker(std::string_view page, std::string_view marker)
{
    std::size_t matched = 0;
    for (std::size_t i = 0; i < page.size(); ++i) {
        matched = page[i] == marker[matched] ? matched + 1 : 0;
        if (matched == marker.size())
            return i + 1;
    }
    return std::string_view::npos;
}

double leadingNumber(std::string_view text)
{
    // The program's own locale may have a comma for the mark, and cannot be changed for a moment: other threads would
    // see that. This one is made once, and kept.
    static const locale_t plain = newlocale(LC_ALL_MASK, "C", nullptr);
    return strtod_l(std::string(text).c_str(), nullptr, plain);
}

long leadingInteger(std::string_view text)
{
    constexpr int kDecimal = 10;
    return std::strtol(std::string(text).c_str(), nullptr, kDecimal);
}

bool isPrice(float number)
{
    return std::isfinite(number) && !std::signbit(number);
}
