#include "exchange/StatementTable.h"

#include "exchange/CsvReader.h"
#include "exchange/Table.h"
#include "exchange/TextForms.h"

#include <algorithm>
#include <iterator>
#include <stdexcept>

namespace {

constexpr std::size_t kMostColumns = 1000; // no statement has so many
constexpr std::size_t kMostRows = 1'000'000;

/// A field as UTF-8, taken by itself.
std::string readable(const std::string& bytes)
{
    return isUtf8(bytes) ? bytes : fromWindows1252(bytes);
}

/// The heading, and what is left of it without a currency behind: "(EUR)", "in EUR", "EUR".
std::array<std::string, 2> keysOf(const std::string& heading)
{
    std::string_view text = withoutBlanks(std::string_view(heading).substr(0, heading.find_first_of("([")));
    const std::size_t last = text.rfind(' ') + 1; // 0 for a single word
    const auto isCapital = [](char c) { return c >= 'A' && c <= 'Z'; };
    constexpr std::size_t kCode = 3;
    if (last > 0 && text.size() - last == kCode && std::ranges::all_of(text.substr(last), isCapital)) {
        text = withoutBlanks(text.substr(0, last));
        for (const std::string_view word : {" in", " en"})
            if (text.ends_with(word))
                text.remove_suffix(word.size());
    }
    return {wordKey(heading), wordKey(text)};
}

std::string textOf(const std::vector<std::string>& fields)
{
    std::string text;
    for (const std::string& field : fields)
        if (!withoutBlanks(field).empty())
            text += (text.empty() ? "" : " ") + field;
    return text;
}

std::string lineText(const StatementTable::Row& row)
{
    return "line " + std::to_string(row.line);
}

} // namespace

StatementTable::StatementTable(const std::string& path, const StatementProfile& profile)
{
    const char separator = findSeparator(path, profile);
    readAll(path, separator);
    decode();
    passOverEnd(path, profile);
    // From here on `rows_` are the lines that are meant to be read, and nothing is added to them.
    settleDates(path, profile);
    settleDecimalMarks(separator);
}

/// Where the columns are when `fields` are their headings.
StatementTable::Places StatementTable::placesIn(const std::vector<std::string>& fields, const StatementProfile& profile)
{
    Places places;
    places.fill(kNowhere);
    std::vector<std::array<std::string, 2>> keys;
    for (const std::string& field : fields)
        keys.push_back(keysOf(readable(field)));
    const auto takeFirst = [&](std::size_t column, std::string_view key) {
        for (std::size_t form = 0; form < 2 && places[column] == kNowhere; ++form)
            for (std::size_t i = 0; i < keys.size() && places[column] == kNowhere; ++i)
                if (!key.empty() && keys[i][form] == key) {
                    places[column] = i;
                    // A heading that has been given away means nothing else.
                    keys[i] = {};
                }
    };
    // What a person has said comes first, for all columns.
    for (std::size_t i = 0; i < kStatementColumns; ++i)
        if (const auto heading = profile.headingOf(static_cast<StatementColumn>(i)))
            takeFirst(i, wordKey(*heading));
    for (std::size_t i = 0; i < kStatementColumns; ++i)
        if (!profile.headingOf(static_cast<StatementColumn>(i)))
            for (const std::string_view heading : headingsOf(static_cast<StatementColumn>(i)))
                takeFirst(i, heading);
    return places;
}

/// Whether there are all columns that a person has named, and those that every statement has.
bool StatementTable::isHeader(const Places& places, const StatementProfile& profile)
{
    for (std::size_t i = 0; i < kStatementColumns; ++i)
        if (!profile.headingOf(static_cast<StatementColumn>(i)).value_or("").empty() && places[i] == kNowhere)
            return false;
    return places[static_cast<std::size_t>(StatementColumn::kDate)] != kNowhere &&
           places[static_cast<std::size_t>(StatementColumn::kType)] != kNowhere;
}

/// Finds the headings. @return the separator with which they are found.
char StatementTable::findSeparator(const std::string& path, const StatementProfile& profile)
{
    std::pair<std::size_t, std::size_t> most; // columns that were found, and fields with a text
    places_.fill(kNowhere);
    for (const char separator : kSeparators) {
        CsvReader reader(path, separator);
        for (std::size_t n = 0; n < kLongestPreamble && reader.next(); ++n) {
            if (reader.fields().size() > kMostColumns)
                continue;
            const Places places = placesIn(reader.fields(), profile);
            const std::size_t found =
                kStatementColumns - static_cast<std::size_t>(std::ranges::count(places, kNowhere));
            const auto texts = static_cast<std::size_t>(
                std::ranges::count_if(reader.fields(), [](const auto& field) { return !field.empty(); }));
            if (std::pair(found, texts) > most) {
                most = {found, texts};
                places_ = places;
                headings_ = reader.fields();
            }
            if (!isHeader(places, profile))
                continue;
            places_ = places;
            headings_ = reader.fields();
            headerLine_ = reader.line();
            return separator;
        }
    }
    // No line has them; `places_` are those of the line that comes closest.
    failWithout(path, profile);
}

void StatementTable::failWithout(const std::string& path, const StatementProfile& profile) const
{
    std::string missing;
    for (std::size_t i = 0; i < kStatementColumns; ++i) {
        const auto column = static_cast<StatementColumn>(i);
        const std::string told = profile.headingOf(column).value_or("");
        const bool isNeeded = column == StatementColumn::kDate || column == StatementColumn::kType || !told.empty();
        if (isNeeded && !has(column))
            missing +=
                (missing.empty() ? "" : ", ") + std::string(nameOf(column)) + (told.empty() ? "" : " " + shown(told));
    }
    constexpr std::size_t kMostTold = 20;
    std::string headings;
    for (std::size_t i = 0; i < std::min(headings_.size(), kMostTold); ++i)
        headings += (headings.empty() ? "" : ", ") + shown(readable(headings_[i]));
    if (headings_.size() > kMostTold)
        headings += ", ...";
    fail(path,
         std::string("no line has the headings of a statement: ") +
             (missing.empty() ? "they are on no single line" : "there is no column for " + missing),
         (missing.empty() ? "" : ", which --column COLUMN=HEADING can name") +
             (headings.empty() ? "" : "; found were " + headings));
}

/// @param remedy what the command line can do about it, to go on from the reason.
void StatementTable::fail(const std::string& path, const std::string& reason, const std::string& remedy) const
{
    UnfitStatement unfit(path + ": " + reason + remedy);
    unfit.reason = reason;
    std::ranges::transform(headings_, std::back_inserter(unfit.headings), readable);
    for (std::size_t i = 0; i < kStatementColumns; ++i)
        if (places_[i] != kNowhere)
            unfit.columns[i] = withoutBlanks(unfit.headings[places_[i]]);
    throw unfit;
}

void StatementTable::readAll(const std::string& path, char separator)
{
    CsvReader reader(path, separator);
    while (reader.next()) {
        if (reader.line() < headerLine_)
            passedOver_.push_back({reader.line(), textOf(reader.fields()), "before the headings"});
        else if (reader.line() > headerLine_ && (reader.fields().empty() || !textOf(reader.fields()).empty()))
            rows_.push_back({reader.line(), reader.fields()});
        // All of them are held, and a zipped file may have any number.
        if (rows_.size() > kMostRows)
            throw std::runtime_error(path + ": has more than " + std::to_string(kMostRows) +
                                     " lines: this is no statement");
    }
}

/// Text that is not UTF-8 is Windows-1252, all of it.
void StatementTable::decode()
{
    const auto isReadable = [](const Row& row) { return std::ranges::all_of(row.fields, isUtf8); };
    const auto isReadableLine = [](const PassedOver& line) { return isUtf8(line.text); };
    if (std::ranges::all_of(rows_, isReadable) && std::ranges::all_of(headings_, isUtf8) &&
        std::ranges::all_of(passedOver_, isReadableLine))
        return;
    for (Row& row : rows_)
        for (std::string& field : row.fields)
            field = fromWindows1252(field);
    for (std::string& heading : headings_)
        heading = fromWindows1252(heading);
    for (PassedOver& line : passedOver_)
        line.text = fromWindows1252(line.text);
}

/// Sums and remarks stand behind the last line with a date.
void StatementTable::passOverEnd(const std::string& path, const StatementProfile& profile)
{
    // A line that cannot be cut may have had one.
    const auto isDated = [this](const Row& row) {
        return row.fields.empty() || WrittenDate::read(cell(row, StatementColumn::kDate)).has_value();
    };
    if (!rows_.empty() && std::ranges::none_of(rows_, isDated))
        fail(path, "no line has a date in the column " + shown(headingOf(StatementColumn::kDate)), "");
    // One that has a type and numbers for a date is no sum but an operation; its date is refused when it is read.
    const auto isMeant = [&](const Row& row) {
        const bool hasNumbers = cell(row, StatementColumn::kDate).find_first_of("0123456789") != std::string_view::npos;
        return isDated(row) || (hasNumbers && profile.typeOf(std::string(cell(row, StatementColumn::kType))));
    };
    const auto end = std::find_if(rows_.rbegin(), rows_.rend(), isMeant).base();
    for (auto row = end; row != rows_.end(); ++row)
        passedOver_.push_back({row->line, textOf(row->fields), "behind the last line with a date"});
    rows_.erase(end, rows_.end());
}

void StatementTable::settleDates(const std::string& path, const StatementProfile& profile)
{
    isMonthFirst_ = profile.isMonthFirst().value_or(false);
    if (profile.isMonthFirst())
        return;
    // Rows that show it, as a number above 12 does that is no month.
    struct Shown {
        const Row* dayFirst = nullptr;
        const Row* monthFirst = nullptr;
    };
    const auto lookAt = [](const Row& row, std::string_view text, Shown* shown) {
        const auto written = WrittenDate::read(text);
        if (!written || written->isOrderKnown)
            return;
        if (written->date(false).isUndefined() && !written->date(true).isUndefined() && shown->monthFirst == nullptr)
            shown->monthFirst = &row;
        if (written->date(true).isUndefined() && !written->date(false).isUndefined() && shown->dayFirst == nullptr)
            shown->dayFirst = &row;
    };
    Shown dates;
    for (const Row& row : rows_)
        lookAt(row, cell(row, StatementColumn::kDate), &dates);
    if (dates.dayFirst != nullptr && dates.monthFirst != nullptr)
        fail(path,
             lineText(*dates.dayFirst) + " has the day first, " + shown(cell(*dates.dayFirst, StatementColumn::kDate)) +
                 ", and " + lineText(*dates.monthFirst) + " the month, " +
                 shown(cell(*dates.monthFirst, StatementColumn::kDate)),
             ": --dates dmy or --dates mdy says which is meant");
    isMonthFirst_ = dates.monthFirst != nullptr;
    if (dates.dayFirst != nullptr || dates.monthFirst != nullptr)
        return;
    // A bank writes all its dates alike, those of the settlement too.
    for (const Row& row : rows_)
        for (const std::string& field : row.fields)
            lookAt(row, field, &dates);
    isMonthFirst_ = dates.monthFirst != nullptr && dates.dayFirst == nullptr;
}

void StatementTable::settleDecimalMarks(char separator)
{
    // The first number of a column that shows its mark counts for the column; what it does not settle, all other
    // columns do when they agree.
    bool isPoint = false;
    bool isComma = false;
    for (const Row& row : rows_)
        for (std::size_t i = 0; i < kStatementColumns; ++i) {
            const auto column = static_cast<StatementColumn>(i);
            if (column < StatementColumn::kQuantity || column > StatementColumn::kToQuote || decimalMarks_[i] != '\0')
                continue;
            if (const auto number = WrittenNumber::read(cell(row, column)))
                decimalMarks_[i] = number->decimalMark();
            isPoint = isPoint || decimalMarks_[i] == '.';
            isComma = isComma || decimalMarks_[i] == ',';
        }
    // Where nothing shows it, a program that parts fields with commas does not part decimals with them.
    if (!isComma && separator == ',')
        isPoint = true;
    if (isPoint != isComma)
        std::ranges::replace(decimalMarks_, '\0', isPoint ? '.' : ',');
}

bool StatementTable::isNewestFirst() const
{
    const auto dateOf = [this](const Row& row) {
        const auto written = WrittenDate::read(cell(row, StatementColumn::kDate));
        return written ? written->date(isMonthFirst_) : Date();
    };
    const auto isDated = [&](const Row& row) { return !dateOf(row).isUndefined(); };
    const auto first = std::ranges::find_if(rows_, isDated);
    const auto last = std::find_if(rows_.rbegin(), rows_.rend(), isDated);
    return first != rows_.end() && dateOf(*last) < dateOf(*first);
}

std::string StatementTable::headingOf(StatementColumn column) const
{
    return has(column) ? std::string(withoutBlanks(headings_[place(column)])) : std::string();
}

std::string_view StatementTable::cell(const Row& row, StatementColumn column) const
{
    const std::size_t i = place(column);
    return i < row.fields.size() ? withoutBlanks(row.fields[i]) : std::string_view();
}

Date StatementTable::date(const Row& row) const
{
    const std::string_view text = cell(row, StatementColumn::kDate);
    const auto written = WrittenDate::read(text);
    const Date date = written ? written->date(isMonthFirst_) : Date();
    if (text.empty())
        throw UnusableRow("has no date");
    if (date.isUndefined())
        throw UnusableRow(
            shown(text) + " is no date" +
            (written && !written->isOrderKnown ? isMonthFirst_ ? " as MM/DD/YYYY" : " as DD/MM/YYYY" : ""));
    return date;
}

std::optional<StatementTable::Figure> StatementTable::figure(const Row& row, StatementColumn column) const
{
    const std::string_view text = cell(row, column);
    if (WrittenNumber::isNone(text))
        return std::nullopt;
    const auto number = WrittenNumber::read(text);
    const char mark = decimalMarks_[static_cast<std::size_t>(column)];
    if (number && mark == '\0' && number->needsDecimalMark())
        throw UnusableRow(shown(text) + " in the column " + shown(headingOf(column)) +
                          " may be a thousand times too large: no number of the table shows the decimal mark");
    const auto value = number ? number->value(mark) : std::nullopt;
    if (!value)
        throw UnusableRow(shown(text) + " in the column " + shown(headingOf(column)) + " is no number" +
                          (mark != '\0' ? std::string(" with decimal '") + mark + "'" : ""));
    return Figure{*value, number->unit()};
}
