// Any bytes as a history page: the parser neither crashes nor reads too far, its rows pass the filter, and a page that
// is cut gives the first of them.

#include "net/QuoteHistory.h"
#include "tests/fuzz/Require.h"

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <string>

namespace {

/// The rows, checked.
std::vector<DatedPrice> rowsOf(const std::vector<char>& page)
{
    std::vector<DatedPrice> rows;
    const int result = parseHistoryPage({page.data(), page.size()}, &rows);
    require(result == 0 || result == -1, "the result is 0 or -1");
    double last = 0;
    for (const auto& [date, price] : rows) {
        require(date.getMonth() != 0, "month 0 is left out");
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
    const std::vector<DatedPrice> all = rowsOf({text.begin(), text.end()});
    for (const std::size_t size : {text.size() / 2, text.size() - text.size() / 8}) {
        const std::vector<DatedPrice> first = rowsOf({text.begin(), text.begin() + static_cast<std::ptrdiff_t>(size)});
        require(first.size() <= all.size() && std::equal(first.begin(), first.end(), all.begin(), areSame),
                "a page that is cut gives the first rows");
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
