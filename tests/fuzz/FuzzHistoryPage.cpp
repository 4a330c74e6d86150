// Any bytes as a history page: the parser neither crashes nor reads too far, its rows pass the filter, and a page
// that is cut gives the first of them, or all when the table's end has come.

#include "net/QuoteHistory.h"
#include "tests/fuzz/Require.h"

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <limits>
#include <string>

namespace {

/// The rows, checked.
std::vector<DatedPrice> rowsOf(const std::vector<char>& page, int* result)
{
    std::vector<DatedPrice> rows;
    *result = parseHistoryPage({page.data(), page.size()}, &rows);
    require(*result == 0 || *result == -1, "the result is 0 or -1");
    double last = 0;
    for (const auto& [date, price] : rows) {
        require(date.getMonth() != 0, "month 0 is left out");
        require(price >= 0 && price <= std::numeric_limits<float>::max(), "a price is finite and not negative");
        require(last == 0 || (price > last / 3 && price < last * 2), "a price is near the one before");
        last = price;
    }
    return rows;
}

bool areSame(const DatedPrice& a, const DatedPrice& b)
{
    return a.date == b.date && std::memcmp(&a.price, &b.price, sizeof a.price) == 0;
}

void check(const std::string& text)
{
    int result = 0, cutResult = 0;
    const std::vector<DatedPrice> all = rowsOf({text.begin(), text.end()}, &result);
    for (const std::size_t size : {text.size() / 2, text.size() - text.size() / 8}) {
        const std::string cut = text.substr(0, size);
        const std::vector<DatedPrice> first = rowsOf({cut.begin(), cut.end()}, &cutResult);
        require(first.size() <= all.size() && std::equal(first.begin(), first.end(), all.begin(), areSame),
                "a page that is cut gives the first rows");
        if (isHistoryCertain(cut))
            require(first.size() == all.size() && cutResult == result, "nothing follows the end of the table");
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const std::string page(reinterpret_cast<const char*>(data), size);
    check(page);
    check("(00s)</b>" + page);
    return 0;
}
