#include "tools/QuoteFolder.h"

#include "exchange/MarketImport.h"
#include "exchange/Table.h"
#include "net/QuoteServers.h"
#include "tools/QuoteTable.h"

#include <optional>
#include <ostream>
#include <stdexcept>

namespace {

/// What stands between `front` and `back` in `text`; nothing when these do not enclose it.
std::optional<std::string_view> between(std::string_view text, std::string_view front, std::string_view back)
{
    if (text.size() < front.size() + back.size() || !text.starts_with(front) || !text.ends_with(back))
        return std::nullopt;
    return text.substr(front.size(), text.size() - front.size() - back.size());
}

/// A ticker that begins with a dot would be a hidden file, and one with a slash a file of another folder.
bool isFileName(std::string_view ticker)
{
    return !ticker.empty() && ticker.front() != '.' && ticker.find('/') == ticker.npos;
}

/// What a request line asks for.
struct Asked {
    explicit Asked(std::string_view request)
    {
        const std::string_view line = request.substr(0, request.find_first_of("\r\n"));
        const std::string_view path = between(line, "GET ", "").value_or("");
        latest = between(path, QuoteServers::kLatestPath, "");
        history = between(path, QuoteServers::kHistoryPath, QuoteServers::kHistoryPathEnd);
    }
    std::string_view ticker() const { return latest.value_or(history.value_or("")); }

    std::optional<std::string_view> latest;  // the ticker of which the latest close is asked for
    std::optional<std::string_view> history; // that of which the history is
};

} // namespace

QuoteFolder::QuoteFolder(const std::filesystem::path& folder, std::ostream& log) : folder_(folder), log_(log)
{
    std::error_code error;
    if (!std::filesystem::is_directory(folder, error))
        throw std::runtime_error(folder.string() + ": " + (error ? error.message() : "is not a folder"));
}

std::string QuoteFolder::answer(std::string_view request) const
{
    const Asked asked(request);
    // An empty ticker, as that of a request of neither kind, has no file.
    const Closes closes = closesOf(asked.ticker(), log_);
    if (closes.empty())
        return noQuotesPage();
    return asked.latest ? latestQuotePage(closes.rbegin()->second) : historyPage(closes);
}

std::string_view QuoteFolder::tickerOf(std::string_view request)
{
    return Asked(request).ticker();
}

bool QuoteFolder::reaches(std::string_view ticker, const Date& day) const
{
    std::ostream nobody(nullptr); // the answer that follows tells what is wrong with the table
    const Closes closes = closesOf(ticker, nobody);
    return !closes.empty() && closes.rbegin()->first >= day;
}

void QuoteFolder::add(const std::string& ticker, const Closes& closes) const
{
    addToQuoteTable(fileOf(ticker), ticker, closes);
}

std::filesystem::path QuoteFolder::fileOf(std::string_view ticker) const
{
    return folder_ / (std::string(ticker) + ".csv");
}

/// Of two prices of a day the later line counts.
Closes QuoteFolder::closesOf(std::string_view ticker, std::ostream& log) const
{
    constexpr std::size_t kRefusedTold = 20;
    Closes closes;
    std::size_t refused = 0;
    const std::filesystem::path file = fileOf(ticker);
    std::error_code error;
    if (!isFileName(ticker) || !std::filesystem::exists(file, error))
        return closes;
    try {
        Table table(file, kQuotesOfOneTicker);
        TableWatch watch;
        watch.refused = [&](const std::string& path, unsigned long line, const std::string& reason) {
            // At each request anew: the first say enough.
            if (++refused <= kRefusedTold)
                log << path << ", line " << line << ": " << reason << '\n';
        };
        table.forEach([&] { closes.insert_or_assign(table.date(), table.value(false)); }, watch);
        if (refused > kRefusedTold)
            log << file.string() << ": ... and " << refused - kRefusedTold << " more\n";
    } catch (const std::runtime_error& reason) {
        // What stands before the damage is served all the same.
        log << reason.what() << '\n';
    }
    return closes;
}
