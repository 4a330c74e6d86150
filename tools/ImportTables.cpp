#include "exchange/Importer.h"
#include "market/Catalogue.h"
#include "storage/AtomicFile.h"
#include "tools/ImportMode.h"

#include <iostream>
#include <vector>

namespace {

const char* const kUnits = "units-per-reference";
const char* const kValues = "value-in-reference";

class ImportTables : public ImportMode {
public:
    void describe(CLI::App& app) override;
    bool isMeant(const CLI::App&) const override { return true; }
    void run(const CLI::App& app, const ImportArguments& arguments) override;

private:
    std::vector<std::string> quotes_;
    std::vector<std::string> rates_;
    std::vector<std::string> listings_;
    std::string ratesAre_;
    ImportOptions import_;
};

void ImportTables::describe(CLI::App& app)
{
    app.add_option("--quotes", quotes_, "Tables of closing prices")->type_name("FILE");
    app.add_option("--rates", rates_, "Tables of exchange rates")->type_name("FILE");
    app.add_option("--listing", listings_, "Tables that tell market, currency and name of tickers")->type_name("FILE");
    addText(app, "--reference", import_.reference, "SYMBOL",
            "Currency that the rates refer to; without it EUR, or when there are no rates the --currency");
    app.add_option("--rates-are", ratesAre_, "How the rates are meant; see below")
        ->check(CLI::IsMember({kUnits, kValues}));
    addText(app, "--currency", import_.currency, "SYMBOL", "Currency of the markets that no table tells it of")
        ->capture_default_str();
    app.add_flag("--ticker-from-name", import_.tickerFromName,
                 "The quotes are of one ticker a file, which the file's name tells (AAPL.csv: date,close)");
}

void ImportTables::run(const CLI::App& app, const ImportArguments& arguments)
{
    if (arguments.output.empty())
        throw CLI::RequiredError("OUTPUT");
    if (quotes_.empty() && rates_.empty())
        throw CLI::RequiredError("--quotes or --rates");
    if (app.count("--reference") == 0 && rates_.empty())
        import_.reference = import_.currency;
    if (!ratesAre_.empty())
        import_.ratesAreUnits = ratesAre_ == kUnits;
    if (!arguments.market.empty())
        import_.market = arguments.market;
    const auto existing = arguments.force ? AtomicFile::Existing::kReplace : AtomicFile::Existing::kKeep;
    // Before anything is read: the tables may take minutes, and the writing would fail only then.
    AtomicFile::check(arguments.output, existing);

    Catalogue catalogue;
    Importer importer(import_, catalogue, std::cerr);
    // In this order whatever that of the options: listings say where the tickers of the quotes belong, and currencies
    // stand in the file in the order of their first mention.
    for (const std::string& path : listings_)
        importer.addListing(path);
    for (const std::string& path : rates_)
        importer.addRates(path);
    for (const std::string& path : quotes_)
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

std::unique_ptr<ImportMode> importTables()
{
    return std::make_unique<ImportTables>();
}
