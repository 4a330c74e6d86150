#include "tools/ImportMode.h"

#include <algorithm>
#include <vector>

namespace {

const char* const kPurpose =
    "Makes a Pelorin market file of tables of quotes and exchange rates, or adds the operations "
    "of a statement to a portfolio file.\n"
    "Example: pelorin-import Companies/World --quotes prices.csv.gz --rates rates.csv.gz";

const char* const kTables = R"(The tables are CSV files, plain or gzipped, with ',', ';' or tab between the fields:
  quotes   date,ticker,close, or a header line that names these columns and perhaps market, currency and
           name, in any order; usual headings are known (Date, Symbol, Close, Price, Exchange, ...)
  rates    date,currency,rate, likewise
  listing  ticker,market,currency,name, likewise; cells may be empty
Only ordinary files are read, no pipes. Dates are YYYY-MM-DD or DD/MM/YYYY. Numbers may have a decimal comma where
commas do not separate the fields.
What a row of the quotes says comes before the listing, the listing before the options. Of two values for the same
day the later line counts. A line that cannot be used is reported with its number and skipped.

Market files hold the price of one unit of a currency in the reference currency. Rates are published the other way
round as a rule, as units of the currency per unit of the reference, and are inverted: so are those under a heading
like units_per_eur, and those of which neither a heading nor --rates-are says anything. The reference currency itself
gets the rate 1.

Statements (--operations) have headings in one of their first lines: Date,Type,Account,To Account,Market,Ticker,
Quantity,Quote,Amount,Cost,Rate Cost,From Quote,To Quote, or Name, Debit, Credit, Currency, in any order; usual headings
and words in English, German and French are known. Either all lines are booked or, when one is refused, none.

Tables that pelorin-export has written (--from) become files that value to the same figures. Into files that are there
they bring what is new and the values of days; what is booked already is passed over.

Exit status: 0, 1 when a file cannot be read or written or a line of a statement is refused, 2 for bad arguments.)";

void describe(CLI::App& app, ImportArguments& arguments)
{
    app.footer(kTables);
    app.add_option("OUTPUT", arguments.output, "Market file to write; comes first");
    addText(app, "--market", arguments.market, "NAME",
            "Market of the tickers that no table tells it of; without it NYSE. With --operations the market file");
    addText(app, "--into", arguments.into, "MARKET_FILE", "Market file to import into");
    addText(app, "--portfolio", arguments.portfolio, "PORTFOLIO_FILE", "Portfolio file to import into");
    app.add_flag("--dry-run", arguments.dryRun, "Only tell what would be imported; write nothing");
    app.add_flag("--force", arguments.force, "Replace OUTPUT when it exists");
}

} // namespace

int main(int argc, char** argv)
{
    CLI::App app(kPurpose, "pelorin-import");
    ImportArguments arguments;
    describe(app, arguments);
    // The first that is meant is taken; tables are always meant, and so come last.
    std::vector<std::unique_ptr<ImportMode>> modes;
    modes.push_back(importOperations());
    modes.push_back(importFolder());
    modes.push_back(importTables());
    for (const auto& mode : modes)
        mode->describe(app);
    return runProgram(app, argc, argv, [&] {
        const auto isMeant = [&](const auto& mode) { return mode->isMeant(app); };
        (*std::ranges::find_if(modes, isMeant))->run(app, arguments);
    });
}
