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
    Outcome readMonth(int* month);
    Outcome readDay(int* day);
    Outcome readYear(int* year);
    Outcome readPrice(float* price);
    Outcome findEnd(std::size_t from, std::string_view ends);
    void skipBlanks() { place_ = firstNotOf(" \r\n\t/", place_); }
    std::string_view field() const { return text_.substr(place_, end_ - place_); }
    int integer() const { return static_cast<int>(leadingInteger(field())); }
    std::size_t firstNotOf(std::string_view blanks, std::size_t from) const
    {
        return std::min(text_.find_first_not_of(blanks, from), text_.size());
    }

    std::string_view text_;
    std::size_t place_ = 0;     // of the next field
    std::size_t end_ = 0;       // of the field that was read last
    std::size_t yearWidth_ = 0; // with the blanks behind the year
};

/// A row goes up to its price. One that a line feed interrupts is skipped: the next begins right behind that.
RowReader::Outcome RowReader::readRow(DatedPrice* row)
{
    if (place_ == text_.size())
        return Outcome::kTextEnds;
    int month = 0, day = 0, year = 0;
    Outcome outcome = readMonth(&month);
    if (outcome == Outcome::kTaken)
        outcome = readDay(&day);
    if (outcome == Outcome::kTaken)
        outcome = readYear(&year);
    if (outcome == Outcome::kTaken)
        outcome = readPrice(&row->price);
    if (outcome == Outcome::kTaken)
        row->date = Date(static_cast<short>(day), static_cast<short>(month), year);
    return outcome;
}

RowReader::Outcome RowReader::readMonth(int* month)
{
    const Outcome outcome = findEnd(place_, "</ ");
    if (outcome != Outcome::kTaken)
        return outcome;
    if (text_[end_] == '<')
        return Outcome::kTableEnds;
    *month = integer();
    place_ = end_ + 1;
    return outcome;
}

RowReader::Outcome RowReader::readDay(int* day)
{
    const Outcome outcome = findEnd(place_, "/");
    if (outcome != Outcome::kTaken)
        return outcome;
    *day = integer();
    place_ = end_ + 1;
    return outcome;
}

RowReader::Outcome RowReader::readYear(int* year)
{
    const Outcome outcome = findEnd(place_, " /\t");
    if (outcome != Outcome::kTaken)
        return outcome;
    *year = integer();
    const std::size_t price = firstNotOf(" \t", end_);
    yearWidth_ = price - place_;
    place_ = price;
    return outcome;
}

/// The end is searched from as far behind the start as the year was wide, which lies in the next column. Intended: only
/// the number in front counts.
RowReader::Outcome RowReader::readPrice(float* price)
{
    if (place_ == text_.size())
        return Outcome::kError;
    const Outcome outcome = findEnd(place_ + yearWidth_, " /\t");
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
        if (outcome == RowReader::Outcome::kSkipped)
            continue;
        if (outcome != RowReader::Outcome::kTaken)
            return outcome;
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
