// Any bytes as a latest-quote page: the parser neither crashes nor reads too far, and cuts as the C library's functions
// do, which it replaces.

#include "net/LatestQuote.h"
#include "tests/fuzz/Require.h"

#include <cstdint>
#include <cstring>
#include <string>
#include <vector>

namespace {

const std::string kMarker = "<td nowrap><b>";

float numberOf(const char* token)
{
    return token != nullptr ? static_cast<float>(std::strtod(token, nullptr)) : 0;
}

/// The price in front of `cell`, which is cut to pieces; -1 and no price without a token.
int cutWithTheLibrary(std::string cell, float* price)
{
    constexpr const char* kDelimiters = " <sup>/b";
    const char* whole = std::strtok(cell.data(), kDelimiters);
    const char* numerator = std::strtok(nullptr, kDelimiters);
    const char* denominator = std::strtok(nullptr, kDelimiters);
    if (whole == nullptr)
        return -1;
    *price = numberOf(whole);
    if (numerator != nullptr && *numerator != 't' && numberOf(denominator) != 0)
        *price += numberOf(numerator) / numberOf(denominator);
    return 0;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const std::vector<char> exact(data, data + size); // nothing stands behind it
    float price = 0;
    const std::string_view page(exact.data(), size);
    if (parseLatestQuotePage(page, &price) == 0)
        require(page.find(kMarker) != page.npos, "a price stands behind the marker");

    const std::string cell(page.substr(0, page.find('\0')));
    float expected = price = 0;
    const int result = parseLatestQuotePage(kMarker + cell, &price);
    require(result == cutWithTheLibrary(cell, &expected), "a marked cell has a price unless it has no token");
    require(std::memcmp(&price, &expected, sizeof price) == 0, "the price is that of the library's functions");
    return 0;
}
