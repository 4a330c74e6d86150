#include "exchange/MarketFile.h"
#include "exchange/MarketImport.h"
#include "storage/AtomicFile.h"
#include "tools/ImportMode.h"
#include "tools/ImportReport.h"
#include "tools/ProgressBar.h"

#include <filesystem>
#include <iostream>
#include <vector>

namespace {

const char* const kUnits = "units-per-reference";
const char* const kValues = "value-in-reference";

class ImportTables : public ImportMode {
public:
    void describe(Program& program) override;
    bool isMeant(const Program&) const override { return true; }
    void run(const Program& program, const ImportArguments& arguments) override;

private:
    void runNew(const ImportArguments& arguments);
    void runInto(const ImportArguments& arguments);
    void checkReference(const std::string& path, const std::string& reference);
    MarketPlan plan(const Catalogue& catalogue, Date* latestDay) const;

    std::vector<std::string> quotes_;
    std::vector<std::string> rates_;
    std::vector<std::string> listings_;
    std::string ratesAre_;
    bool hasReference_ = false; // --reference is given
    ImportOptions import_;
};

void ImportTables::describe(Program& program)
{
    program.add("--quotes", quotes_, "Tables of closing prices").type("FILE");
    program.add("--rates", rates_, "Tables of exchange rates").type("FILE");
    program.add("--listing", listings_, "Tables that tell market, currency and name of tickers").type("FILE");
    program.addText(
        "--reference", import_.reference, "SYMBOL",
        "Currency that the rates refer to; without it that of the file of --into, or EUR, or when there are no "
        "rates the --currency");
    program.add("--rates-are", ratesAre_, "How the rates are meant; see below").oneOf({kUnits, kValues});
    program.addText("--currency", import_.currency, "SYMBOL", "Currency of the markets that no table tells it of")
        .showDefault();
    program.addFlag("--ticker-from-name", import_.tickerFromName,
                    "The quotes are of one ticker a file, which the file's name tells (AAPL.csv: date,close)");
}

void ImportTables::run(const Program& program, const ImportArguments& arguments)
{
    if (arguments.output.empty() == arguments.into.empty())
        throw BadArguments::missing("Either OUTPUT or --into");
    if (quotes_.empty() && rates_.empty())
        throw BadArguments::missing("--quotes or --rates");
    hasReference_ = program.isGiven("--reference");
    if (!ratesAre_.empty())
        import_.ratesAreUnits = ratesAre_ == kUnits;
    if (!arguments.market.empty())
        import_.market = arguments.market;
    if (arguments.into.empty())
        runNew(arguments);
    else
        runInto(arguments);
}

void ImportTables::runNew(const ImportArguments& arguments)
{
    if (!hasReference_ && rates_.empty())
        import_.reference = import_.currency;
    const auto existing = arguments.force ? AtomicFile::Existing::kReplace : AtomicFile::Existing::kKeep;
    // Before anything is read: the tables may take minutes, and the writing would fail only then.
    if (!arguments.dryRun)
        AtomicFile::check(arguments.output, existing);
    Catalogue catalogue;
    Date stamp;
    MarketPlan made = plan(catalogue, &stamp);
    const ImportReport report(made);
    if (arguments.dryRun)
        return report.print();
    made.carryOut(catalogue);
    // The records bear a date; that of the data makes the same input give the same file on any day.
    AtomicFile file(arguments.output, existing);
    if (catalogue.wrt(file.stream(), stamp) != 0)
        file.fail("cannot be written");
    file.commit();
    report.print();
}

void ImportTables::runInto(const ImportArguments& arguments)
{
    const std::string& path = arguments.into;
    std::error_code error;
    if (!std::filesystem::exists(path, error) && !error)
        throw std::runtime_error(path + ": is not there, so that nothing can be imported --into it; without --into a "
                                        "new file is made");
    if (!arguments.dryRun)
        AtomicFile::check(path, AtomicFile::Existing::kReplace);
    MarketFile file(path);
    checkReference(path, file.reference());
    Date stamp;
    MarketPlan added = plan(file.catalogue(), &stamp);
    const ImportReport report(added);
    if (arguments.dryRun)
        return report.print();
    if (added.isEmpty()) {
        std::cerr << path << ": has all of it, and is left as it is\n";
        return report.print();
    }
    file.save(added, stamp);
    report.print();
}

/// Makes the file's reference that of the import, or the option's where the file has none.
void ImportTables::checkReference(const std::string& path, const std::string& reference)
{
    if (reference.empty() && !hasReference_)
        throw std::runtime_error(path + ": has no reference currency; --reference tells which it is to be");
    if (reference.empty())
        return;
    if (hasReference_ && import_.reference != reference)
        throw std::runtime_error(path + ": has the reference currency " + shown(reference) + ", and not " +
                                 shown(import_.reference) + " as --reference says");
    import_.reference = reference;
}

MarketPlan ImportTables::plan(const Catalogue& catalogue, Date* latestDay) const
{
    ProgressBar bar(stderr);
    TableWatch watch;
    watch.progress = [&](const std::string& path, double part) { bar.show(path, part); };
    watch.refused = [&](const std::string& path, unsigned long line, const std::string& reason) {
        bar.clear();
        std::cerr << path << ", line " << line << ": " << reason << '\n';
    };
    MarketImport import(import_, catalogue, watch);
    // In this order whatever that of the options: listings say where the tickers of the quotes belong, and currencies
    // stand in the file in the order of their first mention.
    for (const std::string& path : listings_)
        import.addListing(path);
    for (const std::string& path : rates_)
        import.addRates(path);
    for (const std::string& path : quotes_)
        import.addQuotes(path);
    try {
        MarketPlan plan = import.plan();
        *latestDay = import.latestDay();
        return plan;
    } catch (const MissingRate& error) {
        throw std::runtime_error(std::string(error.what()) +
                                 ": add a table with its --rates, or make it the --reference of a new file");
    }
}

} // namespace

std::unique_ptr<ImportMode> importTables()
{
    return std::make_unique<ImportTables>();
}
