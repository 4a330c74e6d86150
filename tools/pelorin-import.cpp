#include "market/Catalogue.h"
#include "storage/AtomicFile.h"
#include "tools/Importer.h"
#include "tools/Program.h"

#include <iostream>
#include <string>
#include <vector>

namespace {

const char* const kUnits = "units-per-reference";
const char* const kValues = "value-in-reference";

const char* const kPurpose = "Makes a Pelorin market file of tables of quotes and exchange rates.\n"
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

Exit status: 0, 1 when a file cannot be read or written, 2 for bad arguments.)";

struct Arguments {
    std::string output;
    std::vector<std::string> quotes;
    std::vector<std::string> rates;
    std::vector<std::string> listings;
    std::string ratesAre;
    bool force = false;
    ImportOptions import;
};

void describe(CLI::App& app, Arguments& arguments)
{
    ImportOptions& import = arguments.import;
    app.footer(kTables);
    app.add_option("OUTPUT", arguments.output, "Market file to write; comes first")->required();
    app.add_option("--quotes", arguments.quotes, "Tables of closing prices")->type_name("FILE");
    app.add_option("--rates", arguments.rates, "Tables of exchange rates")->type_name("FILE");
    app.add_option("--listing", arguments.listings, "Tables that tell market, currency and name of tickers")
        ->type_name("FILE");
    addText(app, "--reference", import.reference, "SYMBOL",
            "Currency that the rates refer to; without it EUR, or when there are no rates the --currency");
    app.add_option("--rates-are", arguments.ratesAre, "How the rates are meant; see below")
        ->check(CLI::IsMember({kUnits, kValues}));
    addText(app, "--currency", import.currency, "SYMBOL", "Currency of the markets that no table tells it of")
        ->capture_default_str();
    addText(app, "--market", import.market, "NAME", "Market of the tickers that no table tells it of")
        ->capture_default_str();
    app.add_flag("--ticker-from-name", import.tickerFromName,
                 "The quotes are of one ticker a file, which the file's name tells (AAPL.csv: date,close)");
    app.add_flag("--force", arguments.force, "Replace OUTPUT when it exists");
}

void run(const CLI::App& app, Arguments& arguments)
{
    if (arguments.quotes.empty() && arguments.rates.empty())
        throw CLI::RequiredError("--quotes or --rates");
    if (app.count("--reference") == 0 && arguments.rates.empty())
        arguments.import.reference = arguments.import.currency;
    if (!arguments.ratesAre.empty())
        arguments.import.ratesAreUnits = arguments.ratesAre == kUnits;
    const auto existing = arguments.force ? AtomicFile::Existing::kReplace : AtomicFile::Existing::kKeep;
    // Before anything is read: the tables may take minutes, and the writing would fail only then.
    AtomicFile::check(arguments.output, existing);

    Catalogue catalogue;
    Importer importer(arguments.import, catalogue, std::cerr);
    // In this order whatever that of the options: listings say where the tickers of the quotes belong, and currencies
    // stand in the file in the order of their first mention.
    for (const std::string& path : arguments.listings)
        importer.addListing(path);
    for (const std::string& path : arguments.rates)
        importer.addRates(path);
    for (const std::string& path : arguments.quotes)
        importer.addQuotes(path);
    // The records bear a date; that of the data makes the same input give the same file on any day.
    const Date stamp = importer.finish();
    AtomicFile file(arguments.output, existing);
    if (catalogue.wrt(file.stream(), stamp) != 0)
        file.fail("cannot be written");
    file.commit();
    const ImportCounts& counts = importer.counts();
    std::cerr << "companies: " << counts.companies << ", quotes: " << counts.quotes
              << ", currencies: " << counts.currencies << ", rates: " << counts.rates
              << ", skipped lines: " << counts.skipped << ", values replaced by a later line: " << counts.replaced
              << '\n';
}

} // namespace

int main(int argc, char** argv)
{
    Arguments arguments;
    CLI::App app(kPurpose, "pelorin-import");
    describe(app, arguments);
    return runProgram(app, argc, argv, [&] { run(app, arguments); });
}
