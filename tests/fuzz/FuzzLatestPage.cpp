// Any bytes as a latest-quote page: the parser neither crashes nor reads too far, cuts as the C library's functions do,
// which it replaces, and takes a price for certain only when nothing that follows changes it.

#include "net/LatestQuote.h"
#include "tests/fuzz/Require.h"

#include <cmath>
#include <cstdint>
#include <cstring>
#include <limits>
#include <string>
#include <vector>

namespace {

const std::string kMarker = "<td nowrap><b>";

float numberOf(const char* token)
{
    return static_cast<float>(std::strtod(token, nullptr));
}

/// The price in front of `cell`, which is cut to pieces and has three tokens at least.
void cutWithTheLibrary(std::string cell, float* price)
{
    constexpr const char* kDelimiters = " <sup>/b";
    const char* whole = std::strtok(cell.data(), kDelimiters);
    const char* numerator = std::strtok(nullptr, kDelimiters);
    const char* denominator = std::strtok(nullptr, kDelimiters);
    *price = numberOf(whole);
    if (*numerator != 't' && numberOf(denominator) != 0)
        *price += numberOf(numerator) / numberOf(denominator);
}

void checkBeginnings(const std::string& page)
{
    for (std::size_t size = page.size() / 2; size < page.size(); size += 1 + page.size() / 16) {
        const std::string beginning = page.substr(0, size);
        if (!isLatestQuoteCertain(beginning))
            continue;
        float first = 0, all = 0;
        require(parseLatestQuotePage(beginning, &first) == parseLatestQuotePage(page, &all) &&
                    std::memcmp(&first, &all, sizeof all) == 0,
                "a certain price is that of the whole page");
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const std::vector<char> exact(data, data + size); // nothing stands behind it
    float price = 0;
    const std::string_view page(exact.data(), size);
    if (parseLatestQuotePage(page, &price) == 0)
        require(page.find(kMarker) != page.npos, "a price stands behind the marker");
    require(!std::signbit(price) && price <= std::numeric_limits<float>::max(), "a price is finite and not negative");

    // With three tokens behind it, whatever it has has its end.
    const std::string cell = std::string(page.substr(0, page.find('\0'))) + "</td></td></td>";
    checkBeginnings(kMarker + cell);
    float expected = price = 0;
    const int result = parseLatestQuotePage(kMarker + cell, &price);
    cutWithTheLibrary(cell, &expected);
    const bool isPrice = !std::signbit(expected) && expected <= std::numeric_limits<float>::max();
    require(result == (isPrice ? 0 : -1), "a marked cell has a price unless that is none");
    require(!isPrice || std::memcmp(&price, &expected, sizeof price) == 0,
            "the price is that of the library's functions");
    return 0;
}
