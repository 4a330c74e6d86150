#include "foundation/Today.h"
#include "tools/Program.h"
#include "tools/Reports.h"
#include "tools/Valuation.h"

#include <cerrno>
#include <cstdio>
#include <cstring>
#include <iostream>
#include <stdexcept>
#include <string>

namespace {

const char* const kPurpose = "Values a Pelorin portfolio on a day.\n"
                             "Example: pelorin-value Companies/Sample PortoFolios/Sample --date 31/12/2024";

const char* const kOutput = R"(The JSON is one object; dates are DD/MM/YYYY, and what has no value is null:
  {"date", "reference", "totalDeposit", "totalValue", "profit", "annualRevenue", "moneyWeightedReturn",
   "timeWeightedReturn", "firstOperationDate",
   "accounts": [{"name", "currency", "cash", "defaultTransfer"}],
   "shares": [{"market", "ticker", "name", "quantity", "buyQuote", "quote", "endDate", "currency",
       "bought", "sold", "costs", "income", "realisedGain", "unrealisedGain",
       "inReference": {the same six}}],
   "operations": [{"account", "type", "kind", "date", "automatic", and by type
       deposit:   "amount"
       transfer:  "recipient", "amount", "rateCost", "cost", "fromCurrencyQuote", "toCurrencyQuote"
       buy, sell: "market", "ticker", "quantity", "quote", "operationCost"}],
   "evolution": [{"date", "totalValue"}]}
A kind is "deposit", "transfer", "buy", "sell", "income" or "charge"; of the last two the type is "transfer".
The totals are in the reference currency, annualRevenue and the returns are fractions per year; reference
and currency are symbols. A return is null when no rate says it, or several do; the tables say which.
What was bought and sold, and the gains, are without the costs, in the currency of the holding and, each
operation at the rate of its day, in the reference currency. Simulated sales are no part of them, nor of
the returns. Transfers that --previsions has suggested are gone again with --evolution.

Exit status: 0, 1 when a file cannot be read or the result not be written, 2 for bad arguments.)";

struct Arguments {
    std::string market;
    std::string portfolio;
    Date date = today();
    Date from;
    bool previsions = false;
    bool evolution = false;
    bool json = false;
};

void describe(Program& program, Arguments& arguments)
{
    program.setFooter(kOutput);
    program.add("MARKET_FILE", arguments.market, "Currencies, markets and companies with their quotes").required();
    program.add("PORTFOLIO_FILE", arguments.portfolio, "Accounts and holdings with their operations").required();
    program.addDate("--date", arguments.date, "Day to value the portfolio on; without it today");
    program.addDate("--from", arguments.from,
                    "Begin the returns and the gains behind this day; without it with the first operation");
    program.addFlag("--previsions", arguments.previsions, "Search the automatic sales that the trend lines suggest");
    program.addFlag("--evolution", arguments.evolution,
                    "Also give the total value of every day since the first operation");
    program.addFlag("--json", arguments.json, "Write JSON instead of tables");
}

void checkOutput()
{
    // A report on a full disk is no report, so that a script must be told.
    if (std::fflush(stdout) != 0 || std::ferror(stdout) != 0)
        throw std::runtime_error(std::string("standard output: ") + std::strerror(errno));
}

void run(const Arguments& arguments)
{
    Valuation valuation(arguments.market, arguments.portfolio);
    valuation.computeReturns(arguments.date, arguments.from, arguments.previsions, arguments.evolution);
    if (arguments.json)
        writeJsonReport(valuation, stdout);
    else
        writeTableReport(valuation, stdout);
    checkOutput();
    if (const std::string doubt = valuation.doubt(); !doubt.empty())
        std::cerr << "pelorin-value: " << doubt << '\n';
}

} // namespace

int main(int argc, char** argv)
{
    Arguments arguments;
    Program program(kPurpose, "pelorin-value");
    describe(program, arguments);
    return program.run(argc, argv, [&] { run(arguments); });
}
