#include "net/QuoteServers.h"
#include "net/Socket.h"
#include "tools/Program.h"
#include "tools/QuoteFolder.h"
#include "tools/QuoteServer.h"
#include "tools/StopSignals.h"

#include <arpa/inet.h>
#include <cerrno>
#include <cstring>
#include <iostream>
#include <stdexcept>
#include <string>

namespace {

const char* const kPurpose =
    "Serves quotes to Pelorin out of a folder of tables, one file TICKER.csv for each ticker.\n"
    "Example: pelorin-quotes ~/quotes --port 8064";

const char* const kTables =
    R"(The tables are CSV files with a date and a closing price on each line, or with a header line that names such
columns: Date, Close, among others. Dates are YYYY-MM-DD or DD/MM/YYYY. A line that cannot be used is reported with its
number and skipped. The latest close is that of the last day in the file, and the history goes back three months from
there. A file may change at any time.

The address that the program listens on is printed as one line. It serves until SIGINT or SIGTERM.

Exit status: 0, 1 when the folder or the port cannot be used, 2 for bad arguments.)";

constexpr unsigned kHighestPort = 65535;

struct Arguments {
    std::string folder;
    unsigned port = quoteServers().port;
    std::string address = "127.0.0.1";
};

void describe(CLI::App& app, Arguments& arguments)
{
    app.footer(kTables);
    addText(app, "FOLDER", arguments.folder, "TEXT", "Folder of the tables")->required();
    app.add_option("--port", arguments.port, "TCP port to listen on; 0 lets the system choose one")
        ->type_name("N")
        ->check(CLI::Range(0U, kHighestPort))
        ->capture_default_str();
    app.add_option("--bind", arguments.address, "IPv4 address to listen on; 0.0.0.0 is open to the whole network")
        ->type_name("ADDRESS")
        ->check(CLI::ValidIPV4)
        ->capture_default_str();
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

void run(const Arguments& arguments)
{
    const QuoteFolder folder(arguments.folder, std::cerr);
    // Before the address is told: whoever reads it may send a signal at once.
    const Descriptor stop = stopSignals();
    Socket server;
    listenOn(server, arguments);
    QuoteServer(server, folder).serve(stop);
}

} // namespace

int main(int argc, char** argv)
{
    Arguments arguments;
    CLI::App app(kPurpose, "pelorin-quotes");
    describe(app, arguments);
    return runProgram(app, argc, argv, [&] { run(arguments); });
}
