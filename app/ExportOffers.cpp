#include "app/ExportOffers.h"

#include "app/DataFiles.h"
#include "app/PLWindow.h"
#include "app/PlainPortfolio.h"
#include "exchange/ExportFolder.h"
#include "exchange/Journal.h"
#include "exchange/TableText.h"
#include "exchange/UniqueNames.h"
#include "foundation/DateText.h"
#include "foundation/NumberText.h"
#include "foundation/Today.h"
#include "platform/ShortText.h"
#include "portfolio/Wallet.h"
#include "storage/Folders.h"
#include "valuation/State.h"
#include "views/OperationView.h"
#include "views/WalletView.h"

#include <algorithm>
#include <filesystem>
#include <stdexcept>

using namespace export_tables;

namespace {

/// A name for a menu or a notice, whatever bytes a file has in it.
std::string shown(const String& name)
{
    constexpr std::size_t kLongest = 40;
    return shortened(cleanName(name.bytes()), kLongest);
}

/// The same for a part of a file's name.
std::string inFileName(const String& name)
{
    std::string text = shown(name);
    std::ranges::replace(text, '/', '-');
    if (text.starts_with('.') || text.starts_with('-'))
        text.front() = '_'; // else nobody would see the file, or commands would take it for an option
    return text;
}

std::string counted(std::size_t n, const std::string& one, const std::string& many)
{
    return countText(static_cast<int>(n)) + ' ' + (n == 1 ? one : many);
}

std::function<std::string(std::size_t)> counting(const std::string& one, const std::string& many,
                                                 const std::string& of = {})
{
    return [=](std::size_t n) { return counted(n, one, many) + of; };
}

bool isManual(const Operation* operation)
{
    return !operation->isAutomatic();
}

bool hasQuotes(const Market* market)
{
    return std::ranges::any_of(market->companies(), [](const Company* company) { return company->getNbrQuotes() > 0; });
}

/// Removes a folder that was made for nothing.
class NewFolder {
public:
    explicit NewFolder(const std::string& path) : path_(path)
    {
        std::error_code error; // of a place that cannot be looked at, and where nothing can be made either
        isNew_ = !std::filesystem::exists(std::filesystem::symlink_status(path, error));
        if (const std::error_code reason = makeFolders(path))
            throw std::runtime_error(path + ": cannot be made: " + reason.message());
    }
    ~NewFolder()
    {
        std::error_code isFilled;
        if (isNew_)
            std::filesystem::remove(path_, isFilled);
    }
    NewFolder(const NewFolder&) = delete;
    NewFolder& operator=(const NewFolder&) = delete;

private:
    std::string path_;
    bool isNew_;
};

} // namespace

std::vector<ExportOffer> ExportOffers::of(int tab) const
{
    switch (tab) {
    case PLWindow::kCompanyTab:
        return ofCompanies();
    case PLWindow::kCurrencyTab:
        return ofCurrencies();
    case PLWindow::kPortoFolioTab:
        return ofPortfolio();
    case PLWindow::kOperationTab:
        return ofOperations();
    default:
        return ofParameters();
    }
}

ExportOffer ExportOffers::table(const Part& part, const ExportTable& form, bool isPossible, const Fill& fill) const
{
    const auto write = [this, &form, fill, count = part.count](const std::string& path) -> ExportOffer::Written {
        ExportRows rows(window_.catalogue(), window_.getWallet());
        CsvWriter file(path, form.headings, CsvWriter::Foreign::kReplace);
        fill(rows, file);
        file.commit();
        return {count(file.rows()), rows.leftOut()};
    };
    return {part.label, part.name, "csv", false, isPossible, write};
}

ExportOffers::Offers ExportOffers::ofCompanies() const
{
    const Company* company = companies_.GetSelectedCompany();
    const Market* market = companies_.GetSelectedMarket();
    const std::string of = " of " + (company != nullptr ? shown(company->getAbbreviation()) : "a company");
    const std::string ticker = company != nullptr ? inFileName(company->getAbbreviation()) + ' ' : "";
    const std::string ofMarket = " of " + (market != nullptr ? shown(market->getName()) : "a market");
    const std::string place = market != nullptr ? inFileName(market->getName()) + ' ' : "";
    const auto markets = window_.catalogue().getMarkets();
    return {table({"Quotes" + of, ticker + "quotes", counting("quote", "quotes", of)}, kQuotes,
                  company != nullptr && company->getNbrQuotes() > 0,
                  [=](ExportRows& rows, CsvWriter& file) { rows.addQuotes(file, *company); }),
            table({"Events" + of, ticker + "events", counting("event", "events", of)}, kEvents,
                  company != nullptr && company->getNbrEvents() > 0,
                  [=](ExportRows& rows, CsvWriter& file) { rows.addEvents(file, *company); }),
            table({"Companies" + ofMarket, place + "companies", counting("company", "companies", ofMarket)}, kListing,
                  market != nullptr && !market->companies().empty(),
                  [=](ExportRows& rows, CsvWriter& file) { rows.addCompanies(file, *market); }),
            table({"All quotes", "quotes", counting("quote", "quotes")}, kQuotes,
                  std::ranges::any_of(markets, hasQuotes), [=](ExportRows& rows, CsvWriter& file) {
                      for (const Market* each : markets)
                          for (const Company* listed : each->companies())
                              rows.addQuotes(file, *listed);
                  })};
}

ExportOffers::Offers ExportOffers::ofCurrencies() const
{
    const Currency* currency = currencies_.GetSelectedCurrency();
    const std::string of = " of " + (currency != nullptr ? shown(currency->getRepresentation()) : "a currency");
    const std::string symbol = currency != nullptr ? inFileName(currency->getRepresentation()) + ' ' : "";
    const auto& all = window_.catalogue().getCurrencies();
    return {table({"Rates" + of, symbol + "rates", counting("rate", "rates", of)}, kRates,
                  currency != nullptr && currency->getNbrQuotes() > 0,
                  [=](ExportRows& rows, CsvWriter& file) { rows.addRates(file, *currency); }),
            table({"All rates", "rates", counting("rate", "rates")}, kRates,
                  std::ranges::any_of(all, [](const Currency* each) { return each->getNbrQuotes() > 0; }),
                  [&all](ExportRows& rows, CsvWriter& file) {
                      for (const Currency* each : all)
                          rows.addRates(file, *each);
                  }),
            table({"Currencies", "currencies", counting("currency", "currencies")}, kCurrencies, !all.empty(),
                  [](ExportRows& rows, CsvWriter& file) { rows.addCurrencies(file); })};
}

ExportOffers::Offers ExportOffers::ofPortfolio() const
{
    const State* state = window_.getState();
    const std::string at = state != nullptr ? " at " + dateText(state->getDate()) : "";
    const std::string day = state != nullptr ? ' ' + tableDate(state->getDate()) : "";
    const auto holdings = [&](const char* label, bool isPossible, const std::vector<const ShareState*>& written) {
        return table({label + at, "holdings" + day, counting("holding", "holdings", at)}, kHoldings, isPossible,
                     [=](ExportRows& rows, CsvWriter& file) { rows.addHoldings(file, written); });
    };
    Offers offers;
    std::vector<const ShareState*> all;
    if (state != nullptr)
        all.assign(state->shareStates().begin(), state->shareStates().end());
    const auto filtered = portfolio_.shownHoldings();
    if (filtered.size() < all.size())
        offers.push_back(holdings("Holdings shown", !filtered.empty(), filtered));
    offers.push_back(holdings("Holdings", !all.empty(), all));
    offers.push_back(table({"Accounts" + at, "accounts" + day, counting("account", "accounts", at)}, kAccounts,
                           state != nullptr && state->getNbrAccountStates() > 0,
                           [=](ExportRows& rows, CsvWriter& file) { rows.addAccounts(file, *state); }));
    // One that is shown, with all that is in it.
    offers.push_back(table({"Evolution", "evolution" + day, counting("day", "days", " of the evolution")}, kEvolution,
                           state != nullptr && portfolio_.isComputeEvolution() &&
                               window_.getWallet()->getNbrStates() > 1 && window_.getReferenceCurrency() != nullptr,
                           [this](ExportRows& rows, CsvWriter& file) {
                               rows.addEvolution(file, evolutionByDate(*window_.getWallet(), window_.catalogue()));
                           }));
    // Everything, without what is simulated: as if it was saved and loaded again.
    offers.push_back(folder());
    offers.push_back(journal("ledger and hledger", "ledger", ledgerForm()));
    offers.push_back(journal("Beancount", "beancount", beancountForm()));
    return offers;
}

ExportOffers::Offers ExportOffers::ofOperations() const
{
    const auto offer = [this](const char* label, const std::vector<const Operation*>& written) {
        const auto manual = static_cast<std::size_t>(std::ranges::count_if(written, isManual));
        // A table of them is for being imported, and what a valuation makes up would become real by that.
        const std::string left = manual < written.size() ? " (without the automatic ones)" : "";
        return table({label, "operations " + tableDate(today()), counting("operation", "operations", left)},
                     kOperations, manual > 0,
                     [=](ExportRows& rows, CsvWriter& file) { rows.addOperations(file, written); });
    };
    return {offer("Operations shown", operations_.shownOperations()),
            offer("All operations", operationsByDate(*window_.getWallet()))};
}

ExportOffers::Offers ExportOffers::ofParameters() const
{
    return {table({"Parameters", "parameters", counting("parameter", "parameters")}, kParameters, true,
                  [](ExportRows& rows, CsvWriter& file) { rows.addParameters(file); })};
}

bool ExportOffers::hasWhole() const
{
    return window_.getState() != nullptr && window_.catalogue().getNbrCurrencies() > 0;
}

std::string ExportOffers::wholeName() const
{
    const String& path = files_.names().wallet.path;
    if (path.isUndefined())
        return "portfolio";
    return inFileName(String(std::filesystem::path(path.getCharacterArray()).filename().c_str()));
}

ExportOffer ExportOffers::folder() const
{
    const auto write = [this](const std::string& path) -> ExportOffer::Written {
        const Catalogue& catalogue = window_.catalogue();
        PlainPortfolio portfolio(*window_.getWallet(), catalogue, window_.getState()->getDate());
        const std::vector<EvolutionPoint> evolution = portfolio.evolve();
        const NewFolder made(path);
        ExportFolder tables(path, catalogue, &portfolio.wallet());
        tables.addMarketData();
        tables.addPortfolio(portfolio.state(), evolution);
        return {counted(tables.commit().size(), "table", "tables"), tables.remarks()};
    };
    const std::string day = hasWhole() ? ' ' + tableDate(window_.getState()->getDate()) : "";
    return {"All tables into a folder", wholeName() + day, "", true, hasWhole(), write};
}

ExportOffer ExportOffers::journal(const char* readers, const char* ending, const JournalForm& form) const
{
    const auto write = [this, &form](const std::string& path) -> ExportOffer::Written {
        const Catalogue& catalogue = window_.catalogue();
        const PlainPortfolio portfolio(*window_.getWallet(), catalogue, window_.getState()->getDate());
        const Journal journal(catalogue, portfolio.wallet(), portfolio.state(), form);
        AtomicFile file(path, AtomicFile::Existing::kReplace);
        journal.write(file.stream());
        file.commit();
        return {counted(journal.transactions(), "transaction", "transactions") + " and " +
                    counted(journal.prices(), "price", "prices"),
                journal.remarks()};
    };
    return {std::string("Journal for ") + readers, wholeName(), ending, true, hasWhole(), write};
}
