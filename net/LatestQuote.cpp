#include "net/LatestQuote.h"

#include "foundation/Today.h"
#include "market/Company.h"
#include "net/PageText.h"
#include "net/PageTransfer.h"

#include <algorithm>

namespace {

constexpr std::size_t kPageLimit = 5000; // characters

/// Takes the next token off the front of `*text`; empty at its end.
///
/// The delimiters are the characters of the tags between the numbers, so letters are among them.
std::string_view takeToken(std::string_view* text)
{
    constexpr std::string_view kDelimiters = " <sup>/b";
    text->remove_prefix(std::min(text->find_first_not_of(kDelimiters), text->size()));
    const std::string_view token = text->substr(0, text->find_first_of(kDelimiters));
    text->remove_prefix(token.size());
    return token;
}

float singleOf(std::string_view token)
{
    return static_cast<float>(leadingNumber(token));
}

enum class Cut {
    kNone,   // no number has come that has its end
    kLikely, // unless a fraction follows behind the closing tag
    kCertain
};

bool beginsWithClosingTag(std::string_view text)
{
    text.remove_prefix(std::min(text.find_first_not_of(' '), text.size()));
    return text.starts_with("</");
}

/// A token has its end when something stands behind it.
Cut cutPrice(std::string_view page, float* price)
{
    const std::string_view text = page.substr(0, page.find('\0'));
    const std::size_t cell = endOfMarker(text, "<td nowrap><b>");
    if (cell == text.npos)
        return Cut::kNone;
    std::string_view rest = text.substr(cell);
    *price = singleOf(takeToken(&rest));
    if (rest.empty())
        return Cut::kNone;
    const bool isClosed = beginsWithClosingTag(rest);
    const std::string_view numerator = takeToken(&rest);
    if (numerator.starts_with('t')) // "</td>"
        return Cut::kCertain;
    const float denominator = singleOf(takeToken(&rest));
    if (rest.empty())
        return isClosed && singleOf(numerator) == 0 ? Cut::kLikely : Cut::kNone;
    if (denominator != 0)
        *price += singleOf(numerator) / denominator;
    return Cut::kCertain;
}

} // namespace

int parseLatestQuotePage(std::string_view page, float* price)
{
    float found = 0;
    if (cutPrice(page, &found) == Cut::kNone || !isPrice(found))
        return -1;
    *price = found;
    return 0;
}

bool isLatestQuoteCertain(std::string_view beginning)
{
    float price = 0;
    return cutPrice(beginning, &price) == Cut::kCertain;
}

FetchEnd fetchLatestQuote(const Company& company, const String& host, const String& path, const StopCheck& stop,
                          float* value, Date* date)
{
    *date = today();
    // Its destructor closes it: closing it here, too, would close the number twice, which a thread of the user
    // interface may have been given in between.
    Socket socket;
    if (const FetchEnd end = connectToQuotes(&socket, host, stop); end != FetchEnd::kFetched)
        return end;
    *value = 0;
    String request(path);
    request += company.getAbbreviation();
    ReceivedPage page(kPageLimit);
    if (const FetchEnd end = requestPage(&socket, request, isLatestQuoteCertain, &page); end != FetchEnd::kFetched)
        return end;
    return parseLatestQuotePage(page.received(), value) == 0 ? FetchEnd::kFetched : FetchEnd::kNoPrice;
}

int Company::getInternetLastQuote(const String& host, const String& path, float* value, Date* date) const
{
    return fetchLatestQuote(*this, host, path, {}, value, date) == FetchEnd::kFetched ? 0 : -1;
}
