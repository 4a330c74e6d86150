#include "tools/Columns.h"

#include "tools/DateText.h"

#include <algorithm>
#include <iterator>

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

/// The place of the heading that has the foremost of `names`; the number of headings when there is none.
std::size_t findPreferred(const std::vector<std::string>& headings, const std::vector<std::string_view>& names)
{
    for (const std::string_view name : names)
        for (std::size_t i = 0; i < headings.size(); ++i)
            if (isCalled(headings[i], name))
                return i;
    return headings.size();
}

bool isDate(std::string_view field)
{
    return parseDate(trimmed(field)).has_value();
}

const char* describe(Column column)
{
    constexpr const char* kDescriptions[] = {"date", "ticker", "price or rate", "market", "currency", "name"};
    return kDescriptions[static_cast<std::size_t>(column)];
}

} // namespace

Columns::Columns(const TableForm& form, const Record& first)
{
    constexpr std::size_t kFewestNames = 2; // a ticker may look like a heading
    const bool dated = std::any_of(first.begin(), first.end(), isDate);
    const std::size_t named = dated ? 0 : recognize(form, first);
    header_ = named >= kFewestNames || (named > 0 && has(Column::kDate));
    if (!header_) {
        places_.fill(kNowhere);
        valueHeading_.clear();
        for (std::size_t i = 0; i < form.plain.size(); ++i)
            place(form.plain[i]) = i;
        mostFields_ = form.plain.size();
    }
    for (const Column column : form.required) {
        if (has(column))
            fewestFields_ = std::max(fewestFields_, place(column) + 1);
        else if (missing_ == nullptr)
            missing_ = describe(column);
    }
}

/// Finds the columns by their headings. @return how many of them.
std::size_t Columns::recognize(const TableForm& form, const Record& record)
{
    places_.fill(kNowhere);
    std::vector<std::string> headings;
    std::transform(record.begin(), record.end(), std::back_inserter(headings), headingOf);
    std::size_t found = 0;
    for (const ColumnNames& known : form.known) {
        const std::size_t i = findPreferred(headings, known.names);
        if (i == headings.size())
            continue;
        place(known.column) = i;
        if (known.column == Column::kValue)
            valueHeading_ = headings[i];
        ++found;
    }
    return found;
}

std::string Columns::headingOf(std::string_view text)
{
    std::string heading;
    for (const char c : text)
        if (std::string_view(" \t_-.").find(c) == std::string_view::npos)
            heading += c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
    return heading;
}

const char* Columns::misfit(const Record& record) const
{
    if (record.size() < fewestFields_)
        return "has too few fields";
    for (std::size_t i = mostFields_; i < record.size(); ++i)
        if (!record[i].empty())
            return "has too many fields for a table without a header line";
    return nullptr;
}

std::string_view Columns::cell(const Record& record, Column column) const
{
    const std::size_t i = place(column);
    return i < record.size() ? trimmed(record[i]) : std::string_view();
}
