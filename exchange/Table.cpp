#include "exchange/Table.h"

#include "exchange/StatementText.h"
#include "foundation/DateText.h"
#include "foundation/PrintableText.h"

#include <algorithm>
#include <charconv>
#include <limits>

namespace {

std::string_view trimmed(std::string_view text)
{
    constexpr std::string_view kBlanks = " \t";
    const std::size_t first = text.find_first_not_of(kBlanks);
    return first == text.npos ? std::string_view() : text.substr(first, text.find_last_not_of(kBlanks) - first + 1);
}

bool isCalled(std::string_view heading, std::string_view name)
{
    return name.ends_with('*') ? heading.starts_with(name.substr(0, name.size() - 1)) : heading == name;
}

/// 0 when `text` is no decimal number, with a point, or beyond the range of double.
double numberOf(std::string_view text)
{
    double number;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    return error == std::errc() && end == text.data() + text.size() ? number : 0;
}

const char* describe(Column column)
{
    constexpr const char* kDescriptions[] = {"date", "ticker", "price or rate", "market", "currency", "name"};
    return kDescriptions[static_cast<std::size_t>(column)];
}

} // namespace

std::string shown(std::string_view text)
{
    return '"' + printable(text) + '"';
}

// The reader is always one record ahead: `more_` says whether `reader_.fields()` is a row that nobody has taken yet.
// The constructor reads the first record to see whether it is a header, `forEach` takes the rows from there on.
Table::Table(const std::string& path, const TableForm& form) : path_(path), reader_(path), more_(next())
{
    const bool header = takeHeader(form);
    // What looked like headings by accident is forgotten again: the columns are where the plain form has them.
    if (!header) {
        places_.fill(kNowhere);
        valueHeading_.clear();
        mostFields_ = form.plain.size();
        for (std::size_t i = 0; i < mostFields_; ++i)
            place(form.plain[i]) = i;
    } else if (form.mayBeWide)
        takeWideColumns(form);
    // The columns of a wide table stand for all that a plain one must have behind the date.
    for (std::size_t i = 0; i < form.required && wide_.empty(); ++i)
        if (!has(form.plain[i]))
            throw std::runtime_error(path + ": the header line names no column for the " + describe(form.plain[i]));
    // The header line is no row: the first one is behind it. Without a header the record read is a row.
    if (header) {
        headings_ = reader_.fields();
        more_ = next();
    }
}

/// Goes to the next record. @return false at the end of the file.
bool Table::next()
{
    if (!reader_.next())
        return false;
    reader_.decode();
    return true;
}

/// Finds the columns by the headings in the first record. @return whether it is a header line: it names a column of
/// dates, or any two, since a ticker may look like a heading.
bool Table::takeHeader(const TableForm& form)
{
    places_.fill(kNowhere);
    // From here on `places_` has no column but those that the loops find.
    std::vector<std::string> present;
    for (const std::string& field : reader_.fields())
        present.push_back(headingOf(field));
    std::size_t found = 0;
    for (const auto& [column, names] : form.headings)
        for (const std::string_view name : names) {
            const auto isOfName = [name](const std::string& heading) { return isCalled(heading, name); };
            const auto at = std::find_if(present.begin(), present.end(), isOfName);
            if (at == present.end())
                continue;
            // The names are in order of preference, so the first that is there settles the column.
            place(column) = static_cast<std::size_t>(at - present.begin());
            if (column == Column::kValue)
                valueHeading_ = *at;
            ++found;
            break;
        }
    return found > 1 || has(Column::kDate);
}

/// Takes the table for a wide one if it has dates and nothing else that a plain one must have.
void Table::takeWideColumns(const TableForm& form)
{
    const auto isThere = [this](Column column) { return has(column); };
    if (!has(Column::kDate) || std::any_of(form.plain.begin() + 1, form.plain.end(), isThere))
        return;
    // Afterwards `wide_` has all columns with a heading but those that say something of the whole row.
    const auto& fields = reader_.fields();
    for (std::size_t i = 0; i < fields.size(); ++i)
        if (const std::string_view name = trimmed(fields[i]);
            !name.empty() && std::ranges::find(places_, i) == places_.end())
            wide_.push_back({i, std::string(name)});
}

std::string Table::heading(Column column) const
{
    const std::size_t i = place(column);
    return i < headings_.size() ? std::string(trimmed(headings_[i])) : std::string();
}

std::string Table::headingOf(std::string_view text)
{
    std::string heading;
    for (const char c : text)
        if (std::string_view(" \t_-.").find(c) == std::string_view::npos)
            heading += c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
    return heading;
}

std::size_t Table::forEach(const std::function<void()>& take, const TableWatch& watch)
{
    constexpr std::size_t kRowsOfAStep = 4096;
    std::size_t refused = 0;
    // A row that throws leaves the table as it was: the next one is read as if this one had never been there. Other
    // errors are the file's, and end the reading.
    for (std::size_t row = 0; more_; more_ = next(), ++row) {
        if (row % kRowsOfAStep == 0 && watch.progress)
            watch.progress(path_, reader_.progress());
        try {
            checkFit();
            take();
        } catch (const UnusableRow& reason) {
            ++refused;
            if (watch.refused)
                watch.refused(path_, reader_.line(), reason.what());
        }
    }
    return refused;
}

void Table::checkFit() const
{
    // The reader gives no fields for a line that it could not cut; an empty line never comes here.
    if (reader_.fields().empty())
        throw UnusableRow("has text behind a closing quote");
    for (std::size_t i = mostFields_; i < reader_.fields().size(); ++i)
        if (!reader_.fields()[i].empty())
            throw UnusableRow("has too many fields for a table without a header line");
}

std::string_view Table::field(std::size_t i) const
{
    return i < reader_.fields().size() ? trimmed(reader_.fields()[i]) : std::string_view();
}

std::string_view Table::cell(const WideColumn& column) const
{
    const std::string_view text = field(column.index);
    return text == "N/A" || text == "NA" || text == "-" ? std::string_view() : text;
}

Date Table::date()
{
    const std::string_view text = cell(Column::kDate);
    std::optional<Date> date = parseDate(text);
    const auto written = WrittenDate::read(text);
    const bool isOpen = written && !written->isOrderKnown;
    // Of all other forms those that can be read in one way only: with points the day comes first.
    if (!date && written && (!isOpen || text.find('.') == text.find_first_not_of("0123456789")))
        date = written->date(false);
    constexpr int kMonths = 12;
    hasDayFirst_ = hasDayFirst_ || (isOpen && written->first > kMonths);
    // The lines before it, which fit both orders, have been read wrongly.
    if (isOpen && !hasDayFirst_ && written->date(false).isUndefined() && !written->date(true).isUndefined())
        throw std::runtime_error(path_ + ", line " + std::to_string(reader_.line()) + ": " + shown(text) +
                                 " has the month first; the dates have to be as YYYY-MM-DD or DD/MM/YYYY");
    if (!date || date->isUndefined())
        throw UnusableRow(shown(text) + " is no date as YYYY-MM-DD or DD/MM/YYYY");
    return *date;
}

float Table::value(std::string_view cell, bool inverted)
{
    std::string text(cell);
    const std::size_t place = text.find_first_of(".,");
    const char mark = place != text.npos ? text[place] : decimalMark_;
    const bool isAllowed =
        mark == decimalMark_ || (decimalMark_ == '\0' && (mark == '.' || reader_.separator() != ','));
    // The mark is judged above, so the number can be read with a point from here on.
    std::replace(text.begin(), text.end(), ',', '.');
    const double number = isAllowed ? numberOf(text) : 0;
    const double value = inverted && number != 0 ? 1 / number : number;
    if (value > 0 && value <= static_cast<double>(std::numeric_limits<float>::max()) && static_cast<float>(value) > 0) {
        // Settled by the first number that has a mark; a whole number leaves it open.
        decimalMark_ = mark;
        return static_cast<float>(value);
    }
    // The mark stays as it was: a number that is refused settles nothing.
    const char expected = decimalMark_ == '\0' ? '.' : decimalMark_;
    throw UnusableRow(shown(cell) + " is no positive number with decimal '" + expected + "'");
}
