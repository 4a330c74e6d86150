#include "net/QuoteServers.h"
#include "net/Socket.h"
#include "tools/MarketUpdate.h"
#include "tools/Program.h"
#include "tools/QuoteFetches.h"
#include "tools/QuoteFolder.h"
#include "tools/QuoteServer.h"
#include "tools/StopSignals.h"

#include <arpa/inet.h>
#include <cerrno>
#include <cstring>
#include <iostream>
#include <memory>
#include <optional>
#include <stdexcept>
#include <string>

namespace {

const char* const kPurpose =
    "Serves quotes to Pelorin out of a folder of tables, one file TICKER.csv for each ticker, and fetches them from\n"
    "elsewhere into the folder, or into a market file.\n"
    "Example: pelorin-quotes ~/quotes --port 8064\n"
    "         pelorin-quotes ~/quotes --source finance-quote\n"
    "         pelorin-quotes --update Companies/World --source 'command:my-quotes {ticker}'";

const char* const kTables =
    R"(The tables are CSV files with a date and a closing price on each line, or with a header line that names such
columns: Date, Close, among others. Dates are YYYY-MM-DD or DD/MM/YYYY. A line that cannot be used is reported with its
number and skipped. The latest close is that of the last day in the file, and the history goes back three months from
there. A file may change at any time.

The address that the program listens on is printed as one line. It serves until SIGINT, SIGTERM or SIGHUP.

A source tells what the tables do not have:
  finance-quote            the Perl library Finance::Quote (Debian: libfinance-quote-perl), by its method yahoo_json
  finance-quote:METHOD     the same, by another method: alphavantage, asx, ...
  command:PROGRAM ARGUMENTS
                           a program that prints a line date,close or date,close,currency for the ticker that stands in
                           the place of {ticker}; the dates are YYYY-MM-DD. No shell reads it; quotes keep words together.
A ticker is asked for once a day, when a client asks for it, and what comes is added to its table. When the source fails,
or is too slow, the table answers as it is; the reason is told, and the ticker is asked for again after 15 minutes. Only
tickers of letters, digits and .-^=_ that do not begin with '-' or '.' are asked for.

--update asks for the latest quote of every company and the latest rate of every currency of a market file, adds them as
pelorin-import --into does, prints the same figures, and ends. A rate is asked of a command under a ticker like USDEUR=X.
What does not come is told with its reason.

Exit status: 0, 1 when the folder, the port or the file cannot be used or nothing came for --update, 2 for bad
arguments.)";

constexpr unsigned kHighestPort = 65535;
// A window gives up after 30 seconds; before that it is to have the last close of the folder.
constexpr unsigned kUsualLimit = 20;
constexpr unsigned kLongestLimit = 600;
constexpr const char* kUsualSource = "finance-quote"; // of an update

struct Arguments {
    std::string folder;
    unsigned port = quoteServers().port;
    std::string address = "127.0.0.1";
    std::string source;
    std::string market;           // the file of --update
    unsigned limit = kUsualLimit; // of the source, in seconds
};

void describe(Program& program, Arguments& arguments)
{
    program.setFooter(kTables);
    const auto folder = program.addText("FOLDER", arguments.folder, "TEXT", "Folder of the tables");
    program.addText("--source", arguments.source, "SOURCE",
                    "Where quotes come from that the tables do not have; see below. Without it --update asks "
                    "finance-quote");
    program
        .addText("--update", arguments.market, "FILE", "Market file to bring up to date, instead of serving a folder")
        .excludes(folder);
    program.add("--time-limit", arguments.limit, "How long the source may take for a quote")
        .type("SECONDS")
        .between(1, kLongestLimit)
        .showDefault();
    program.add("--port", arguments.port, "TCP port to listen on; 0 lets the system choose one")
        .type("N")
        .between(0, kHighestPort)
        .showDefault();
    program.add("--bind", arguments.address, "IPv4 address to listen on; 0.0.0.0 is open to the whole network")
        .type("ADDRESS")
        .ipv4()
        .showDefault();
}

/// Listens, and tells where on standard output.
void listenOn(Socket& server, const Arguments& arguments)
{
    in_addr local{};
    auto port = static_cast<unsigned short>(arguments.port);
    const std::string where = arguments.address + ':';
    if (inet_pton(AF_INET, arguments.address.c_str(), &local) != 1 || server.serverOn(port, local) != 0)
        throw std::runtime_error(where + std::to_string(port) + ": cannot be listened on: " + std::strerror(errno));
    server.getLocalPort(&port);
    std::cout << where << port << std::endl;
}

/// Throws BadArguments for a source that there is not.
std::unique_ptr<QuoteSource> sourceOf(const std::string& text, std::chrono::seconds limit)
{
    try {
        return quoteSource(text, limit);
    } catch (const std::runtime_error& error) {
        throw BadArguments(std::string("--source: ") + error.what());
    }
}

void serve(const Arguments& arguments, std::chrono::seconds limit)
{
    const auto source = arguments.source.empty() ? nullptr : sourceOf(arguments.source, limit);
    const QuoteFolder folder(arguments.folder, std::cerr);
    // Before the address is told: whoever reads it may send a signal at once.
    const Descriptor stop = stopSignals();
    std::optional<QuoteFetches> fetches;
    if (source != nullptr)
        fetches.emplace(*source, folder, limit, std::cerr);
    Socket server;
    listenOn(server, arguments);
    QuoteServer(server, {folder, fetches ? &*fetches : nullptr}).serve(stop);
}

void update(const Arguments& arguments, std::chrono::seconds limit)
{
    const auto source = sourceOf(arguments.source.empty() ? kUsualSource : arguments.source, limit);
    const Descriptor stop = stopSignals();
    updateMarket(arguments.market, *source, limit, stop);
}

void run(const Arguments& arguments)
{
    if (arguments.folder.empty() == arguments.market.empty())
        throw BadArguments::missing("Either FOLDER or --update");
    const std::chrono::seconds limit(arguments.limit);
    arguments.market.empty() ? serve(arguments, limit) : update(arguments, limit);
}

} // namespace

int main(int argc, char** argv)
{
    Arguments arguments;
    Program program(kPurpose, "pelorin-quotes");
    describe(program, arguments);
    return program.run(argc, argv, [&] { run(arguments); });
}
