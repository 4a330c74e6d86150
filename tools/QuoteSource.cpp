#include "tools/QuoteSource.h"

#include "foundation/PrintableText.h"
#include "tools/CommandSource.h"
#include "tools/FinanceQuoteSource.h"

#include <algorithm>
#include <stdexcept>

std::unique_ptr<QuoteSource> quoteSource(const std::string& text, std::chrono::seconds limit)
{
    const std::size_t colon = text.find(':');
    const std::string kind = text.substr(0, colon);
    const std::string rest = colon == text.npos ? std::string() : text.substr(colon + 1);
    if (kind == "finance-quote" && colon == text.npos)
        return std::make_unique<FinanceQuoteSource>(FinanceQuoteSource::kUsualMethod, limit);
    if (kind == "finance-quote")
        return std::make_unique<FinanceQuoteSource>(rest, limit);
    if (kind == "command")
        return std::make_unique<CommandSource>(rest);
    throw std::runtime_error("is no source of quotes: " + printable(text) +
                             "; there are finance-quote, finance-quote:METHOD and command:PROGRAM {ticker}");
}

bool isTicker(std::string_view text)
{
    constexpr std::size_t kLongest = 40;
    const auto isOfTicker = [](char c) {
        return (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || (c >= '0' && c <= '9') ||
               std::string_view(".-^=_").find(c) != std::string_view::npos;
    };
    return !text.empty() && text.size() <= kLongest && text.front() != '-' && text.front() != '.' &&
           std::ranges::all_of(text, isOfTicker);
}
