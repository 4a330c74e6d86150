#include "tools/ImportMode.h"

#include <algorithm>
#include <vector>

namespace {

const char* const kPurpose =
    "Makes a Pelorin market file of tables of quotes and exchange rates, or adds them to one.\n"
    "Adds the operations of a statement to a portfolio file. Makes files of the tables of an export.\n"
    "Example: pelorin-import Companies/World --quotes prices.csv.gz --rates rates.csv.gz\n"
    "         pelorin-import --into Companies/World --quotes today.csv --dry-run\n"
    "         pelorin-import --operations june.csv --portfolio PortoFolios/Mine --market Companies/World\n"
    "         pelorin-import --from tables --into Companies/World --portfolio PortoFolios/Mine";

const char* const kTables = R"(The tables are CSV files, plain or gzipped, with ',', ';' or tab between the fields:
  quotes   date,ticker,close, or a header line that names these columns and perhaps market, currency and
           name, in any order; usual headings are known (Date, Symbol, Close, Price, Exchange, ...);
           or wide, a column a ticker: Date,AAPL,MSFT,...
  rates    date,currency,rate, likewise; or wide, as central banks publish them: Date,USD,JPY,...
  listing  ticker,market,currency,name, likewise; cells may be empty
In a wide table an empty cell, N/A, NA or - is no value. Only ordinary files are read, no pipes. Dates are
YYYY-MM-DD, DD/MM/YYYY, DD.MM.YYYY or 2 January 2026, perhaps with a time behind. Numbers may have a decimal comma where
commas do not separate the fields. Text that is not UTF-8 is Windows-1252.
What a row of the quotes says comes before the listing, the listing before the options. Of two values for the same
day the later line counts. A line that cannot be used is reported with its number and skipped.

--into adds to a file: a day that has a value gets the new one, and all else in the file stays as it is. Companies
are found by market and ticker, or by the ticker alone where no table tells the market and the file has one company
of it. What is new comes behind what is there. The former version is kept in the data folder's Backups, as by a save
of the window. Load the file again in a window that shows it.

Market files hold the price of one unit of a currency in the reference currency. Rates are published the other way
round as a rule, as units of the currency per unit of the reference, and are inverted: so are those under a heading
like units_per_eur, and those of which neither a heading nor --rates-are says anything. The reference currency itself
gets the rate 1. Quotes in a currency that has no rate are refused: they would be worth nothing.

Standard output has what is new, changed and equal, and how many lines were refused; --dry-run stops there.

Statements (--operations) have headings in one of their first lines: Date,Type,Account,To Account,Market,Ticker,
Quantity,Quote,Amount,Cost,Rate Cost,From Quote,To Quote, or Name, Debit, Credit, Currency, in any order; usual headings
and words in English, German and French are known. Either all lines are booked or, when one is refused, none.

Tables that pelorin-export has written (--from) become files that value to the same figures. Into files that are there
they bring what is new and the values of days; what is booked already is passed over.

Exit status: 0, 1 when a file cannot be read, written or added to or a line of a statement is refused, 2 for bad
arguments.)";

void describe(Program& program, ImportArguments& arguments)
{
    program.setFooter(kTables);
    const auto output = program.add("OUTPUT", arguments.output, "Market file to make; comes first");
    program.addText("--into", arguments.into, "FILE", "Market file to add to; with --from it may be missing")
        .excludes(output);
    program.addText(
        "--market", arguments.market, "NAME",
        "Market of the tickers that no table tells it of; without it NYSE. With --operations the market file");
    program.addText("--portfolio", arguments.portfolio, "FILE", "Portfolio file to add to");
    program.addFlag("--dry-run", arguments.dryRun,
                    "Write nothing, only tell what would be new, changed, equal, refused");
    program.addFlag("--force", arguments.force, "Replace OUTPUT when it exists").needs(output);
}

} // namespace

int main(int argc, char** argv)
{
    Program program(kPurpose, "pelorin-import");
    ImportArguments arguments;
    describe(program, arguments);
    // The first that is meant is taken; tables are always meant, and so come last.
    std::vector<std::unique_ptr<ImportMode>> modes;
    modes.push_back(importOperations());
    modes.push_back(importFolder());
    modes.push_back(importTables());
    for (const auto& mode : modes)
        mode->describe(program);
    return program.run(argc, argv, [&] {
        const auto isMeant = [&](const auto& mode) { return mode->isMeant(program); };
        (*std::ranges::find_if(modes, isMeant))->run(program, arguments);
    });
}
