#include "tools/CommandSource.h"

#include <algorithm>
#include <stdexcept>
#include <string_view>

namespace {

constexpr std::string_view kPlace = "{ticker}";

/// The words of a command. Throws when a quote is not closed.
std::vector<std::string> wordsOf(const std::string& command)
{
    std::vector<std::string> words;
    char quote = '\0';   // that is open
    bool isWord = false; // the last of `words` goes on
    for (const char c : command) {
        if (quote == '\0' && (c == ' ' || c == '\t')) {
            isWord = false;
            continue;
        }
        // From here on there is a word for `c`, be it an empty one in quotes.
        if (!isWord)
            words.emplace_back();
        isWord = true;
        if (quote == '\0' && (c == '"' || c == '\''))
            quote = c;
        else if (c == quote)
            quote = '\0';
        else
            words.back() += c;
    }
    if (quote != '\0')
        throw std::runtime_error("has a quote that is not closed: " + command);
    return words;
}

bool hasPlace(const std::string& word)
{
    return word.find(kPlace) != word.npos;
}

} // namespace

CommandSource::CommandSource(const std::string& command) : words_(wordsOf(command))
{
    if (words_.empty() || words_.front().empty())
        throw std::runtime_error("names no program behind command:");
    // A client would say which program is run.
    if (hasPlace(words_.front()))
        throw std::runtime_error("has {ticker} in the name of the program: " + command);
    if (std::ranges::none_of(words_, hasPlace))
        throw std::runtime_error("has {ticker} in no argument: " + command);
}

QuoteSource::Run CommandSource::quotesOf(const std::vector<std::string>& tickers) const
{
    return {tickers, argumentsFor(tickers.front()), false};
}

QuoteSource::Run CommandSource::ratesOf(const std::vector<std::string>& currencies, const std::string& reference) const
{
    return {currencies, argumentsFor(currencies.front() + reference + "=X"), false};
}

std::vector<std::string> CommandSource::argumentsFor(const std::string& ticker) const
{
    std::vector<std::string> arguments = words_;
    for (std::string& word : arguments)
        for (std::size_t at = 0; (at = word.find(kPlace, at)) != word.npos; at += ticker.size())
            word.replace(at, kPlace.size(), ticker);
    return arguments;
}
