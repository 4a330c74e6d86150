#include "tools/SourceAnswer.h"

#include "foundation/DateText.h"
#include "foundation/PrintableText.h"
#include "tools/ChildProgram.h"

#include <algorithm>
#include <limits>
#include <optional>
#include <string_view>
#include <vector>

namespace {

std::string_view trimmed(std::string_view text)
{
    constexpr std::string_view kBlanks = " \t\r";
    const std::size_t first = text.find_first_not_of(kBlanks);
    return first == text.npos ? std::string_view() : text.substr(first, text.find_last_not_of(kBlanks) - first + 1);
}

std::vector<std::string_view> fieldsOf(std::string_view line)
{
    std::vector<std::string_view> fields;
    for (std::size_t at = 0; at <= line.size();) {
        const std::size_t end = std::min(line.find(',', at), line.size());
        fields.push_back(trimmed(line.substr(at, end - at)));
        at = end + 1;
    }
    return fields;
}

/// Of the two orders of day and month with slashes a program may mean either.
std::optional<Date> dayOf(std::string_view text)
{
    const std::optional<Date> date = text.find('/') == text.npos ? parseDate(text) : std::nullopt;
    return date && !date->isUndefined() ? date : std::nullopt;
}

std::optional<float> closeOf(std::string_view text)
{
    double number = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    const bool isWhole = error == std::errc() && end == text.data() + text.size();
    if (!isWhole || !(number <= static_cast<double>(std::numeric_limits<float>::max())))
        return std::nullopt;
    const auto close = static_cast<float>(number);
    return close > 0 ? std::optional(close) : std::nullopt;
}

bool isCurrency(std::string_view text)
{
    return !text.empty() &&
           std::ranges::all_of(text, [](char c) { return (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z'); });
}

/// Takes the fields of a line, without the name. @return the reason why they cannot be used, else empty.
std::string take(const std::vector<std::string_view>& fields, const Date& latest, SourceAnswer& answer)
{
    const std::size_t count = fields.size();
    const auto day = dayOf(fields[0]);
    const auto close = count > 1 ? closeOf(fields[1]) : std::nullopt;
    const bool hasCurrency = count > 2 && !fields[2].empty();
    if (!day || !close || count > 3 || (hasCurrency && !isCurrency(fields[2])))
        return "is no date,close";
    if (*day > latest)
        return "is of a day to come";
    answer.closes.insert_or_assign(*day, *close);
    if (hasCurrency)
        answer.currency = fields[2];
    return "";
}

/// "name,,reason": the reason may have commas, and be empty.
std::string refusalIn(std::string_view line)
{
    return toldBy(line.substr(line.find(',', line.find(',') + 1) + 1));
}

class Reading {
public:
    Reading(const QuoteSource::Run& run, const Date& today) : run_(run), latest_(today)
    {
        latest_ + 1;
        for (const std::string& name : run.names)
            answers[name];
    }

    void takeLine(std::string_view line)
    {
        std::vector<std::string_view> fields = fieldsOf(line);
        const bool isFirst = ++number_ == 1;
        if (trimmed(line).empty() || (isFirst && isHeadings(fields)))
            return;
        auto answer = run_.tellsNames ? answers.find(std::string(fields[0])) : answers.begin();
        // A line about something that nobody has asked for.
        if (answer == answers.end())
            return;
        if (run_.tellsNames)
            fields.erase(fields.begin());
        if (fields.empty())
            return;
        const bool isRefusal = run_.tellsNames && fields.size() > 1 && fields[0].empty();
        std::string reason = isRefusal ? refusalIn(line) : take(fields, latest_, answer->second);
        if (!reason.empty() && !isRefusal)
            reason = "line " + std::to_string(number_) + " " + reason + ": \"" + printable(line) + '"';
        // The first says enough.
        if (answer->second.reason.empty())
            answer->second.reason = std::move(reason);
    }

    std::map<std::string, SourceAnswer> answers;

private:
    static bool isHeadings(const std::vector<std::string_view>& fields)
    {
        return fields[0] == "Date" || fields[0] == "date";
    }

    const QuoteSource::Run& run_;
    Date latest_;
    std::size_t number_ = 0;
};

} // namespace

std::map<std::string, SourceAnswer> readAnswer(const std::string& output, const QuoteSource::Run& run,
                                               const Date& today)
{
    Reading reading(run, today);
    std::size_t at = 0;
    for (std::size_t end; (end = output.find('\n', at)) != output.npos; at = end + 1)
        reading.takeLine(std::string_view(output).substr(at, end - at));
    return std::move(reading.answers);
}

std::map<std::string, SourceAnswer> answersOf(const ChildProgram& program, const QuoteSource::Run& run,
                                              const Date& today)
{
    const bool hasFailed = !program.failure().empty();
    std::string output = hasFailed && !run.tellsNames ? std::string() : program.output();
    // Of one that has ended well the last line is whole, with an end or without.
    auto answers = readAnswer(hasFailed ? output : output += '\n', run, today);
    for (auto& [name, answer] : answers)
        if (answer.closes.empty() && answer.reason.empty())
            answer.reason = hasFailed ? program.failure() : "no close came";
    return answers;
}
