#include "exchange/FolderImport.h"
#include "foundation/PrintableText.h"
#include "foundation/Today.h"
#include "market/Catalogue.h"
#include "portfolio/Wallet.h"
#include "portfolio/WalletDiagnosis.h"
#include "storage/DurableSave.h"
#include "storage/InputFile.h"
#include "tools/ImportMode.h"

#include <filesystem>
#include <iostream>
#include <optional>
#include <stdexcept>

namespace {

/// What an export has written, back into files.
class ImportFolder : public ImportMode {
public:
    void describe(Program& program) override;
    bool isMeant(const Program& program) const override { return program.isGiven("--from"); }
    void run(const Program& program, const ImportArguments& arguments) override;

private:
    std::string folder_;
};

/// Whether there is something to read: an empty file counts as one that is still to be made.
bool hasContent(const std::string& path)
{
    std::error_code error; // the file is opened then, which tells it
    if (!std::filesystem::exists(std::filesystem::symlink_status(path, error)))
        return false;
    return !std::filesystem::is_regular_file(path, error) || std::filesystem::file_size(path, error) > 0;
}

void read(const std::string& path, Catalogue& catalogue)
{
    const InputFile file(path);
    if (catalogue.rd(file.stream()) != 0)
        throw std::runtime_error(path + ": " + faultOfMarketFile(file.stream(), printable));
}

/// A portfolio that has lost a transfer's recipient is refused: what is behind it was read out of place, and a save
/// would make that last.
void read(const std::string& path, Wallet& wallet, const Catalogue& catalogue, const std::string& marketPath)
{
    const InputFile file(path);
    if (wallet.rd(file.stream(), nullptr) == 0 && !wallet.hasLostRecipient())
        return;
    const WalletDiagnosis diagnosis(file.stream(), catalogue, printable);
    throw std::runtime_error(path + ": " + diagnosis.text("the portfolio", "the market file " + marketPath));
}

/// `former` is the stamp that the file had when it was read, if it was there.
template <class Object>
void save(const std::string& path, const std::optional<FileStamp>& former, const Object& object)
{
    const auto write = [&object](FILE* file) { return object.wrt(file, today()); };
    const auto result = DurableSave(DataFolder()).save(path, write, former);
    if (result.outcome != DurableSave::Outcome::kSaved)
        throw std::runtime_error(result.reason);
}

void tell(const char* what, const ValueCounts& counts)
{
    std::cout << what << ": " << counts.added << " new, " << counts.changed << " changed, " << counts.equal
              << " equal\n";
}

void ImportFolder::describe(Program& program)
{
    program.addText("--from", folder_, "FOLDER", "Read back what pelorin-export --as csv has written there");
}

void ImportFolder::run(const Program& program, const ImportArguments& arguments)
{
    if (arguments.into.empty())
        throw BadArguments::missing("--into");
    for (const char* other : {"OUTPUT", "--quotes", "--rates", "--listing", "--reference", "--rates-are", "--currency",
                              "--market", "--ticker-from-name", "--force"})
        if (program.isGiven(other))
            throw BadArguments::apart("--from", other);
    const auto marketStamp = FileStamp::of(arguments.into);
    const auto portfolioStamp = FileStamp::of(arguments.portfolio);
    Catalogue catalogue;
    Wallet wallet;
    if (hasContent(arguments.into))
        read(arguments.into, catalogue);
    // The portfolio comes before the tables: its names mean what they meant without them.
    wallet.setCatalogue(catalogue);
    const bool hasPortfolio = !arguments.portfolio.empty();
    if (hasPortfolio && hasContent(arguments.portfolio))
        read(arguments.portfolio, wallet, catalogue, arguments.into);

    FolderImport import(folder_);
    import.readMarketData(catalogue);
    if (hasPortfolio)
        import.readPortfolio(wallet, catalogue);
    // Nothing is written before all is read. The portfolio names what the market file has, and so comes behind it.
    if (!arguments.dryRun) {
        save(arguments.into, marketStamp, catalogue);
        if (hasPortfolio)
            save(arguments.portfolio, portfolioStamp, wallet);
    }
    tell("quotes", import.quotes());
    tell("rates", import.rates());
    if (hasPortfolio)
        tell("operations", import.operations());
    std::cout << "refused: 0\n"; // a row that cannot be read ends the import
}

} // namespace

std::unique_ptr<ImportMode> importFolder()
{
    return std::make_unique<ImportFolder>();
}
