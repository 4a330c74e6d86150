#include "net/LatestQuote.h"
#include "net/QuoteHistory.h"

#include <gtest/gtest.h>
#include <sstream>
#include <string>

namespace {

std::string shownRows(const std::vector<DatedPrice>& rows)
{
    std::ostringstream text;
    for (const auto& [date, price] : rows)
        text << date.toString().bytes() << '=' << price << ' ';
    return text.str();
}

/// "result: date=price date=price "
std::string parsed(std::string_view page)
{
    std::vector<DatedPrice> rows;
    const int result = parseHistoryPage(page, &rows);
    return std::to_string(result) + ": " + shownRows(rows);
}

TEST(HistoryPageTest, RowsAreReadInPageOrder)
{
    const struct {
        const char* rows;
        const char* expected;
        const char* why;
    } cases[] = {
        {"\n5/3/1999 45.5 46 44\n05/04/1999\t46\t47\t9\n</pre>", "0: 03/05/1999=45.5 04/05/1999=46 ", "blanks or tabs"},
        {" \r\n\t/5/3/1999 45 - - -\r\n  5/4/1999 46 - - -\n<", "0: 03/05/1999=45 04/05/1999=46 ", "blanks in front"},
        {"5/3/99 45 - - -\n<", "0: 03/05/99=45 ", "no century is added"},
        {"5/3/1999 45 - - -\n</pre>\n5/4/1999 46 - - -\n", "0: 03/05/1999=45 ", "the table ends at the first '<'"},
        // The filter.
        {"5/3/1999 10 - - -\n5/4/1999 25 - - -\n5/5/1999 12 - - -\n5/6/1999 3 - - -\n5/7/1999 11 - - -\n<",
         "0: 03/05/1999=10 05/05/1999=12 07/05/1999=11 ", "only plausible prices"},
        {"5/3/1999 12 - - -\n5/4/1999 24 - - -\n5/5/1999 4 - - -\n5/6/1999 23.5 - - -\n<",
         "0: 03/05/1999=12 06/05/1999=23.5 ", "the limits do not belong to it"},
        {"5/3/1999 nan - - -\n5/4/1999 -7 - - -\n5/5/1999 1e99 - - -\n5/6/1999 none - - -\n5/7/1999 0x10 - - -\n<",
         "0: 06/05/1999=0 07/05/1999=16 ", "only finite ones from 0 on, and no number is 0"},
        // The end of the text.
        {"5/3/1999 45 - - -\n", "-1: 03/05/1999=45 ", "behind a row that was read"},
        {"5/3/1999 45 - - -\n5/4/1999 46", "-1: 03/05/1999=45 ", "in a price"},
        {"5/3/1999 ", "-1: ", "before the price"},
        {"5", "-1: ", "in a month"},
        // Skipped rows.
        {"x\n5\n5/3\n5/3/\n5/3/1999\n5/4/1999 46 - - -\n<", "0: 04/05/1999=46 ", "a line feed in each field"},
        {"5/3/1999 45.51\n5/4/1999 46 - - -\n<", "0: 04/05/1999=46 ", "and right where the price may end"},
        {"no row\n 5/3/1999 45 - - -\n5/4/1999 46 - - -\n<", "0: 04/05/1999=46 ",
         "a blank behind a skipped row: month 0"},
        {"0/3/1999 45 - - -\n5/4/1999 99 - - -\n<", "0: 04/05/1999=99 ", "month 0 does not count for the filter"},
        // A price's end is searched from the width of the year on.
        {"5/3/1999 45\n5/4/1999 46 - - -\n5/5/1999 47 - - -\n<", "0: 03/05/1999=45 05/05/1999=47 ",
         "into the next row"},
        {"5/3/1999 \n7/4/1999 46 - - -\n<", "0: 03/05/1999=7 ", "no price: the next row's month"},
        {"5/3/\t4 - - -\n5/4/1999/4 - - -\n<", "0: 03/05/0=4 ", "no year; a slash behind it makes 0, which is dropped"},
    };
    for (const auto& c : cases)
        EXPECT_EQ(parsed("<pre><b>Date Volume (00s)</b>" + std::string(c.rows)), c.expected) << c.why;
    EXPECT_EQ(parsed("5/3/1999 45 - - -\n<"), "-1: ") << "no header";
    EXPECT_EQ(parsed("((00s)</b>5/3/1999 45 - - -\n<"), "-1: ") << "a match that breaks is not begun anew";
    EXPECT_EQ(parsed({"(00s)</b>5/3/1999 45 - - -\n\0<", 29}), "-1: 03/05/1999=45 ") << "the page ends at a zero";
}

TEST(LatestPageTest, APriceIsFiniteNotNegativeAndNotCut)
{
    const struct {
        const char* cell;
        float price; // -1 for none
        bool certain;
    } cases[] = {
        {"45</b></td>", 45, true},
        {"45</b></t", 45, true},
        {"45</b>", 45, false},
        {"45</b>\n", 45, false},
        {"45</b>7/8", -1, false},
        {"45</b>7/8<", 45.875F, true},
        {"45 </", 45, false},
        {"45 <", -1, false},
        {"45", -1, false},
        {"112 <sup>3</sup>/<sub>8", -1, false},
        {"112 <sup>3</sup>/<sub>8<", 112.375F, true},
        {"nan</b></td>", -1, true},
        {"-7</b></td>", -1, true},
        {"-0</b></td>", -1, true},
        {"1e99</b></td>", -1, true},
        {"1 <sup>inf</sup>/<sub>8</sub>", -1, true},
        {"none</b></td>", 0, true},
        {"", -1, false},
    };
    for (const auto& [cell, price, certain] : cases) {
        const std::string page = std::string("<td nowrap><b>") + cell;
        float cut = -1;
        EXPECT_EQ(parseLatestQuotePage(page, &cut), price < 0 ? -1 : 0) << cell;
        EXPECT_EQ(cut, price) << cell;
        EXPECT_EQ(isLatestQuoteCertain(page), certain) << cell;
    }
}

} // namespace
