#include "net/QuoteHistory.h"

#include "market/Company.h"
#include "market/Market.h"
#include "net/PageText.h"
#include "net/PageTransfer.h"
#include "net/QuoteServers.h"
#include "net/StoreQuote.h"

#include <algorithm>

namespace {

constexpr std::size_t kPageLimit = 6000; // characters

/// Takes the rows of the table one after the other, field by field.
class RowReader {
public:
    /// `text` begins behind the table's header.
    explicit RowReader(std::string_view text) : text_(text) { skipBlanks(); }

    enum class Outcome { kTaken, kSkipped, kTableEnds, kTextEnds, kError };
    Outcome readRow(DatedPrice* row);
    /// Goes to the row after the one that was read. @return false when there is none.
    bool goToNextRow();

private:
    Outcome readInteger(std::string_view ends, int* number);
    Outcome readPrice(std::size_t yearWidth, float* price);
    Outcome findEnd(std::size_t from, std::string_view ends);
    void skipBlanks() { place_ = firstNotOf(" \r\n\t/", place_); }
    std::string_view field() const { return text_.substr(place_, end_ - place_); }
    std::size_t firstNotOf(std::string_view blanks, std::size_t from) const
    {
        return std::min(text_.find_first_not_of(blanks, from), text_.size());
    }

    // At the beginning of a row `place_` is that of the month. When a field has ended a row early, it is where the next
    // row begins; when there is no end to be found, nobody reads on.
    std::string_view text_;
    std::size_t place_ = 0; // of the next field
    std::size_t end_ = 0;   // of the field that was read last
};

/// A row goes up to its price. One that a line feed interrupts is skipped: the next begins right behind that.
RowReader::Outcome RowReader::readRow(DatedPrice* row)
{
    // The only place where a text may end without being an error.
    if (place_ == text_.size())
        return Outcome::kTextEnds;
    // Each field is read only when those before it have been.
    int month = 0, day = 0, year = 0;
    Outcome outcome = readInteger("</ ", &month);
    if (outcome == Outcome::kTaken)
        outcome = readInteger("/", &day);
    const std::size_t yearPlace = place_;
    if (outcome == Outcome::kTaken)
        outcome = readInteger(" /\t", &year);
    if (outcome != Outcome::kTaken)
        return outcome;
    // Behind the year only blanks are passed over: a slash would be the price's own beginning.
    place_ = firstNotOf(" \t", end_);
    row->date = Date(static_cast<short>(day), static_cast<short>(month), year);
    return readPrice(place_ - yearPlace, &row->price);
}

/// Takes a number that one of `ends` follows, and goes behind that; '<', where it is one of them, ends the table.
RowReader::Outcome RowReader::readInteger(std::string_view ends, int* number)
{
    const Outcome outcome = findEnd(place_, ends);
    if (outcome != Outcome::kTaken)
        return outcome;
    if (text_[end_] == '<')
        return Outcome::kTableEnds;
    *number = static_cast<int>(leadingInteger(field()));
    place_ = end_ + 1;
    return outcome;
}

/// The end is searched from as far behind the start as the year was wide, with the blanks behind it, which lies in the
/// next column. Intended: only the number in front counts.
RowReader::Outcome RowReader::readPrice(std::size_t yearWidth, float* price)
{
    if (place_ == text_.size())
        return Outcome::kError;
    const Outcome outcome = findEnd(place_ + yearWidth, " /\t");
    if (outcome != Outcome::kTaken)
        return outcome;
    *price = static_cast<float>(leadingNumber(field()));
    place_ = firstNotOf(" \t", end_ + 1);
    return outcome;
}

/// Puts `end_` on the first of `ends`. A line feed before it skips the row, the end of the text is an error.
RowReader::Outcome RowReader::findEnd(std::size_t from, std::string_view ends)
{
    end_ = from;
    // `from` may lie behind the end of the text, where a price was looked for too far on.
    while (end_ < text_.size() && text_[end_] != '\n' && ends.find(text_[end_]) == ends.npos)
        ++end_;
    if (end_ >= text_.size())
        return Outcome::kError;
    if (text_[end_] != '\n')
        return Outcome::kTaken;
    place_ = end_ + 1;
    return Outcome::kSkipped;
}

bool RowReader::goToNextRow()
{
    place_ = text_.find('\n', place_);
    if (place_ == text_.npos)
        return false;
    skipBlanks();
    return place_ < text_.size();
}

/// Drops a price that is too far from the last one to be true.
class GlitchFilter {
public:
    bool accepts(float price)
    {
        constexpr double kDrop = 3, kRise = 2;
        // In double: the limits are exclusive, and a float would round them onto a price.
        const double previous = previous_;
        if (previous != 0 && !(price > previous / kDrop && price < previous * kRise))
            return false;
        previous_ = price;
        return true;
    }

private:
    float previous_ = 0; // the last one accepted
};

/// Appends the rows that count. @return what the last one read gave.
RowReader::Outcome readTable(std::string_view page, std::vector<DatedPrice>* rows)
{
    const std::string_view text = page.substr(0, page.find('\0'));
    const std::size_t table = endOfMarker(text, "(00s)</b>");
    if (table == text.npos)
        return RowReader::Outcome::kError;
    RowReader reader(text.substr(table));
    GlitchFilter filter;
    for (DatedPrice row{};;) {
        const RowReader::Outcome outcome = reader.readRow(&row);
        // It stands at the next row already, and `goToNextRow` would pass over that.
        if (outcome == RowReader::Outcome::kSkipped)
            continue;
        if (outcome != RowReader::Outcome::kTaken)
            return outcome;
        // The filter last: a price that does not count must not become the one that others are compared to.
        if (row.date.getMonth() != 0 && isPrice(row.price) && filter.accepts(row.price))
            rows->push_back(row);
        if (!reader.goToNextRow())
            return RowReader::Outcome::kError;
    }
}

} // namespace

int parseHistoryPage(std::string_view page, std::vector<DatedPrice>* rows)
{
    return readTable(page, rows) == RowReader::Outcome::kError ? -1 : 0;
}

bool isHistoryCertain(std::string_view beginning)
{
    std::vector<DatedPrice> rows;
    return readTable(beginning, &rows) == RowReader::Outcome::kTableEnds;
}

FetchEnd fetchQuoteHistory(const Market& market, Company* company, const StopCheck& stop)
{
    const String& name = market.getName();
    if (name != "NASDAQ" && name != "NYSE" && name != "AMEX")
        return FetchEnd::kNoHistory;
    Socket socket; // its destructor closes it, and only that
    if (const FetchEnd end = connectToQuotes(&socket, quoteServers().historyHost, stop); end != FetchEnd::kFetched)
        return end;
    String path(QuoteServers::kHistoryPath);
    path += company->getAbbreviation();
    path += QuoteServers::kHistoryPathEnd;
    ReceivedPage page(kPageLimit);
    if (const FetchEnd end = requestPage(&socket, path, isHistoryCertain, &page); end != FetchEnd::kFetched)
        return end;
    // The result is that of the whole text, as ever; but a price in a repetition, or one that runs into it, has not
    // been sent.
    std::vector<DatedPrice> rows, repeated;
    const int result = parseHistoryPage(page.text(), &repeated);
    parseHistoryPage(page.received(), &rows);
    CompanyQuote* quote;
    for (const auto& [date, price] : rows)
        storeQuote(company, date, price, &quote);
    return result == 0 ? FetchEnd::kFetched : FetchEnd::kNoPrice;
}

int Market::setInternetLastThreeMonthsQuote(Company* company) const
{
    return fetchQuoteHistory(*this, company, {}) == FetchEnd::kFetched ? 0 : -1;
}

int Company::setInternetLastThreeMonthsQuote()
{
    return market() != nullptr ? market()->setInternetLastThreeMonthsQuote(this) : -1;
}
