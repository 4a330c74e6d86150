// Any bytes as a table of quotes, of rates or of a listing: the readers neither crash nor hang nor hold more than a
// line, a table that ends the import has changed nothing, what was imported is there the next time, and a file that it
// goes into is written as the catalogue is.

#include "exchange/MarketFile.h"
#include "exchange/MarketImport.h"
#include "tests/fuzz/FuzzedPortfolio.h"
#include "tests/fuzz/MemoryTable.h"
#include "tests/fuzz/Require.h"
#include "tests/support/Bytes.h"

#include <cstdint>

namespace {

void readRecords(const std::string& path)
{
    unsigned long last = 0;
    try {
        CsvReader reader(path);
        while (reader.next()) {
            require(reader.line() > last, "lines are counted");
            last = reader.line();
            std::size_t length = 0;
            for (const std::string& field : reader.fields())
                length += field.size();
            require(length <= CsvReader::kLongestLine, "a line has its limit");
        }
    } catch (const std::runtime_error&) {
        // It is no text.
    }
}

/// What the table brings into `catalogue`; `kind` is any byte. Nothing when it ends the import.
std::optional<MarketPlan> planOf(const std::string& path, unsigned kind, const Catalogue& catalogue, Date* day)
{
    ImportOptions options;
    options.reference = catalogue.getReferenceCurrency()->getRepresentation().getCharacterArray();
    options.tickerFromName = (kind & 4U) != 0;
    if ((kind & 8U) != 0)
        options.ratesAreUnits = (kind & 16U) != 0;
    if ((kind & 32U) != 0)
        options.market = "York";
    try {
        MarketImport import(options, catalogue, {});
        if (kind % 4 == 0)
            import.addListing(path);
        if (kind % 4 == 1)
            import.addRates(path);
        else
            import.addQuotes(path);
        MarketPlan plan = import.plan();
        *day = import.latestDay();
        return plan;
    } catch (const std::runtime_error&) {
        return std::nullopt;
    }
}

std::size_t sum(const MarketPlan::Counts& counts)
{
    return counts.added + counts.changed + counts.equal;
}

void import(const std::string& path, unsigned kind)
{
    const FuzzedPortfolio p;
    const std::string before = bytesWritten(p.catalogue, kStart);
    const MemoryTable formerFile(before);
    MarketFile file(formerFile.path());
    Date day;
    std::optional<MarketPlan> plan = planOf(path, kind, file.catalogue(), &day);
    require(bytesWritten(file.catalogue(), kStart) == before, "a plan changes nothing");
    if (!plan)
        return;
    const bool isNew = !plan->newMarkets.empty() || !plan->newCompanies.empty();
    const std::size_t quotes = sum(plan->quoteCounts);
    const MarketPlan::Owners changed = plan->carryOut(file.catalogue());
    const std::string after = bytesWritten(file.catalogue(), day);
    require(written([&](FILE* to) { require(file.write(to, changed, day) == 0, "it is written"); }) == after,
            "the file is written as the catalogue is");
    Catalogue again;
    require(again.rd(BytesFile(after)) == 0 && bytesWritten(again, day) == after, "what was imported is read back");
    // A row without a market may mean another company once there is a second one of its ticker.
    plan = planOf(path, kind, file.catalogue(), &day);
    require(isNew || (plan && plan->isEmpty() && plan->quoteCounts.equal == quotes),
            "all of it is there the next time");
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    if (size == 0)
        return 0;
    const MemoryTable table({reinterpret_cast<const char*>(data) + 1, size - 1});
    readRecords(table.path());
    import(table.path(), data[0]);
    return 0;
}
