#include "exchange/ExportFolder.h"
#include "exchange/ExportTables.h"
#include "exchange/Journal.h"
#include "foundation/Today.h"
#include "storage/FileStamp.h"
#include "storage/Folders.h"
#include "storage/Writing.h"
#include "tools/Program.h"
#include "tools/Valuation.h"

#include <iostream>
#include <stdexcept>

namespace {

const char* const kCsv = "csv";
const char* const kLedger = "ledger";
const char* const kBeancount = "beancount";

const char* const kPurpose = "Writes Pelorin's files as tables, or as a journal for plain-text accounting.\n"
                             "Example: pelorin-export Companies/Sample PortoFolios/Sample --to tables";

const char* const kForms =
    R"(--as csv        tables in FOLDER, with commas between the fields, dates as YYYY-MM-DD and figures with nine
                digits: currencies, markets, listing, rates, quotes and events; with a PORTFOLIO_FILE also
                accounts and holdings on the day, operations, parameters, and evolution up to the day.
                pelorin-import --from FOLDER makes files of them that value to the same figures.
--as ledger     portfolio.ledger, which ledger and hledger read: the operations and prices up to the day
--as beancount  portfolio.beancount, likewise
Of the totals on the day DD/MM/YYYY:
  ledger -f portfolio.ledger bal Assets -X EUR
  hledger -f portfolio.ledger bal Assets --value=YYYY-MM-DD,EUR
  bean-query portfolio.beancount "SELECT SUM(CONVERT(POSITION, 'EUR', YYYY-MM-DD)) WHERE account ~ '^Assets'"
Simulated sales are never written. A file of such a name is replaced when it comes from an export, and stays otherwise.

Exit status: 0, 1 when a file cannot be read or written, 2 for bad arguments.)";

struct Arguments {
    std::string market;
    std::string portfolio;
    std::string folder;
    Date date = today();
    std::string form = kCsv;
};

void describe(Program& program, Arguments& arguments)
{
    program.setFooter(kForms);
    program.add("MARKET_FILE", arguments.market, "Currencies, markets and companies with their quotes").required();
    program.add("PORTFOLIO_FILE", arguments.portfolio, "Accounts and holdings with their operations");
    program.addText("--to", arguments.folder, "FOLDER", "Folder to write into; made when it is missing").required();
    program.addDate("--date", arguments.date, "Day of holdings, cash and journal; without it today");
    program.add("--as", arguments.form, "What is written; see below").oneOf({kCsv, kLedger, kBeancount}).showDefault();
}

void remark(const std::vector<std::string>& remarks)
{
    for (const std::string& line : remarks)
        std::cerr << "pelorin-export: " << line << '\n';
}

void writeTables(const Arguments& arguments, Valuation& valuation)
{
    const bool hasPortfolio = !arguments.portfolio.empty();
    ExportFolder folder(arguments.folder, valuation.catalogue(), hasPortfolio ? &valuation.wallet() : nullptr);
    folder.addMarketData();
    if (hasPortfolio)
        folder.addPortfolio(valuation.state(), valuation.evolution());
    for (const auto& made : folder.commit())
        std::cout << made.path << ": " << made.rows << " rows\n";
    remark(folder.remarks());
    if (!hasPortfolio)
        for (const ExportTable* table : export_tables::kOfPortfolio)
            if (const std::string path = arguments.folder + '/' + table->file; FileStamp::of(path))
                remark({path + ": is from before, and of a portfolio that may not go with the other tables"});
}

void writeJournal(const Arguments& arguments, const Valuation& valuation)
{
    const JournalForm& form = arguments.form == kLedger ? ledgerForm() : beancountForm();
    const std::string path = arguments.folder + "/portfolio." + arguments.form;
    const Journal journal(valuation.catalogue(), valuation.wallet(), valuation.state(), form);
    checkReplaceable(path, form.head());
    AtomicFile file(path, AtomicFile::Existing::kReplace);
    fill(file.stream(), path, [&journal](FILE* stream) {
        journal.write(stream);
        return 0;
    });
    file.commit();
    std::cout << path << ": " << journal.transactions() << " transactions, " << journal.prices() << " prices\n";
    remark(journal.remarks());
}

/// With the evolution where tables want one, unless there is none: its reason is told, and the day stands alone.
void compute(const Arguments& arguments, Valuation& valuation)
{
    bool hasEvolution = arguments.form == kCsv && !arguments.portfolio.empty();
    try {
        valuation.compute(arguments.date, false, hasEvolution);
    } catch (const std::runtime_error& error) {
        remark({error.what()});
        valuation.compute(arguments.date, false, false);
    }
}

void run(const Arguments& arguments)
{
    Valuation valuation(arguments.market, arguments.portfolio);
    if (!valuation.doubt().empty())
        remark({valuation.doubt()});
    compute(arguments, valuation);
    if (const std::error_code error = makeFolders(arguments.folder))
        throw std::runtime_error(arguments.folder + ": cannot be made: " + error.message());
    if (arguments.form == kCsv)
        writeTables(arguments, valuation);
    else
        writeJournal(arguments, valuation);
}

} // namespace

int main(int argc, char** argv)
{
    Arguments arguments;
    Program program(kPurpose, "pelorin-export");
    describe(program, arguments);
    return program.run(argc, argv, [&] { run(arguments); });
}
