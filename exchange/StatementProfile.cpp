#include "exchange/StatementProfile.h"

#include "exchange/Table.h"
#include "exchange/TextForms.h"
#include "storage/InputFile.h"

#include <cstdio>
#include <stdexcept>

namespace {

constexpr const char* kDayFirst = "dmy";
constexpr const char* kMonthFirst = "mdy";

/// The names of all columns, or types, for a message.
template <class Thing>
std::string namesOfAll(std::size_t count)
{
    std::string names;
    for (std::size_t i = 0; i < count; ++i)
        names += (i == 0 ? "" : i + 1 < count ? ", " : " or ") + std::string(nameOf(static_cast<Thing>(i)));
    return names;
}

std::string trimmed(const std::string& text)
{
    return std::string(withoutBlanks(text));
}

} // namespace

void StatementProfile::addColumn(const std::string& text)
{
    const std::size_t mark = text.find('=');
    const auto column = columnNamed(text.substr(0, mark));
    if (mark == text.npos || !column)
        throw std::runtime_error(shown(text) + " is no COLUMN=HEADING, where the column is " +
                                 namesOfAll<StatementColumn>(kStatementColumns));
    columns_[*column] = trimmed(text.substr(mark + 1));
}

void StatementProfile::addType(const std::string& text)
{
    // The last '=', because the word may have one.
    const std::size_t mark = text.rfind('=');
    const auto type = mark != text.npos ? typeNamed(text.substr(mark + 1)) : std::nullopt;
    const std::string word = trimmed(text.substr(0, mark));
    if (!type || word.empty())
        throw std::runtime_error(shown(text) + " is no WORD=TYPE, where the type is " +
                                 namesOfAll<StatementType>(static_cast<std::size_t>(StatementType::kCharge) + 1));
    types_[wordKey(word)] = {word, *type};
}

void StatementProfile::setDates(const std::string& text)
{
    if (text != kDayFirst && text != kMonthFirst)
        throw std::runtime_error(shown(text) + " is not " + kDayFirst + " or " + kMonthFirst);
    isMonthFirst_ = text == kMonthFirst;
}

StatementProfile StatementProfile::fromFile(const std::string& path)
{
    StatementProfile profile;
    const InputFile file(path);
    constexpr unsigned kLongest = 4096; // bytes of a line; anything longer is no profile
    char line[kLongest];
    for (unsigned long number = 1; std::fgets(line, sizeof line, file.stream()) != nullptr; ++number)
        try {
            // Editors of Windows put a mark in front of UTF-8.
            std::string text = number == 1 && std::string_view(line).starts_with("\xEF\xBB\xBF") ? line + 3 : line;
            if (text.size() + 1 == sizeof line || !isUtf8(text))
                throw std::runtime_error("is no line of a profile");
            while (text.ends_with('\n') || text.ends_with('\r'))
                text.pop_back();
            profile.take(trimmed(text));
        } catch (const std::runtime_error& error) {
            throw std::runtime_error(path + ", line " + std::to_string(number) + ": " + error.what());
        }
    if (std::ferror(file.stream()) != 0)
        throw std::runtime_error(path + ": cannot be read");
    return profile;
}

void StatementProfile::take(const std::string& line)
{
    if (line.empty() || line.front() == '#')
        return;
    const std::size_t blank = line.find(' ');
    const std::string key = line.substr(0, blank);
    const std::string value = blank != line.npos ? trimmed(line.substr(blank)) : std::string();
    if (key == "column")
        addColumn(value);
    else if (key == "type")
        addType(value);
    else if (key == "dates")
        setDates(value);
    else if (key == "account" && !value.empty())
        setAccount(value);
    else
        throw std::runtime_error(shown(line) + " does not begin with column, type, account or dates");
}

std::string StatementProfile::toText() const
{
    std::string text;
    for (const auto& [column, heading] : columns_)
        text += std::string("column ") + nameOf(column) + '=' + heading + '\n';
    for (const auto& [key, word] : types_)
        text += "type " + word.text + '=' + nameOf(word.type) + '\n';
    if (!account_.empty())
        text += "account " + account_ + '\n';
    if (isMonthFirst_)
        text += std::string("dates ") + (*isMonthFirst_ ? kMonthFirst : kDayFirst) + '\n';
    return text;
}

void StatementProfile::fillFrom(const StatementProfile& other)
{
    // `insert` leaves what is here.
    columns_.insert(other.columns_.begin(), other.columns_.end());
    types_.insert(other.types_.begin(), other.types_.end());
    if (account_.empty())
        account_ = other.account_;
    if (!isMonthFirst_)
        isMonthFirst_ = other.isMonthFirst_;
}

std::optional<std::string> StatementProfile::headingOf(StatementColumn column) const
{
    const auto found = columns_.find(column);
    return found != columns_.end() ? std::optional(found->second) : std::nullopt;
}

std::optional<StatementType> StatementProfile::typeOf(const std::string& word) const
{
    const std::string key = wordKey(word);
    const auto found = types_.find(key);
    return found != types_.end() ? std::optional(found->second.type) : typeOfWord(key);
}
