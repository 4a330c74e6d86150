#pragma once

#include "app/PendingImport.h"
#include "exchange/OperationPlan.h"
#include "exchange/ProfileFolder.h"
#include "exchange/StatementTable.h"
#include "storage/DataFolder.h"

#include <array>
#include <memory>
#include <optional>
#include <string>
#include <vector>

/// The import of operations from a statement of a bank.
///
/// What a person tells of columns, words, account and dates is kept in a profile when the import is done, and taken for
/// the next table of the same headings.
class ImportStatement final : public PendingImport {
public:
    /// Throws std::runtime_error, with one line for the user, for a file that cannot be read or has no lines.
    ImportStatement(PLWindow& window, const DataFolder& folder, const std::string& path);

    ImportSheet sheet() override;
    void choose(const std::string& question, std::size_t item) override;
    void type(const std::string&, const std::string&) override {}
    void setSkips(bool skips) override { skips_ = skips; }
    std::string stepName() const override;
    std::string carryOut() override;

private:
    /// All that is known of such tables.
    StatementProfile profile() const;
    void read();
    void readAgain();
    void makePlan();
    std::string problem() const;
    std::string note() const;
    void askForColumns(ImportSheet& sheet) const;
    void askForWords(ImportSheet& sheet) const;
    void askForMissing(ImportSheet& sheet) const;
    void askForAccount(ImportSheet& sheet) const;
    void askForDates(ImportSheet& sheet) const;
    void fillRows(ImportSheet& sheet) const;
    void fillCash(ImportSheet& sheet) const;

    bool needsDates() const;
    bool needsAccount() const;
    std::vector<std::string> unknownWords() const;
    std::vector<std::string> missingAccounts() const;
    std::vector<std::string> symbols() const;
    std::string accountToMake() const;
    void tellWord(std::size_t item);
    void tellMissing(std::size_t item);
    void tellCurrency(const std::string& account, std::size_t item);
    void tellAccount(std::size_t item);
    void tellDates(std::size_t item);
    std::string keepProfile() const;

    std::string path_;
    DataFolder folder_;
    ProfileFolder profiles_;
    std::string knownAs_;      // the profile that was found; empty without one
    StatementProfile profile_; // without the columns that were told here
    std::vector<std::pair<StatementColumn, std::string>> columnsTold_;
    bool isTold_ = false; // something that the profile found does not have
    std::vector<OperationPlan::NewAccount> newAccounts_;
    bool skips_ = false;

    std::unique_ptr<StatementTable> table_; // null while it is not understood
    std::unique_ptr<OperationPlan> plan_;   // null without a table, and when it was carried out
    std::string problem_;                   // why there is no plan
    std::vector<std::string> headings_;
    std::array<std::string, kStatementColumns> columns_; // the heading of each
    // What the menus are about.
    std::size_t column_ = 0;
    std::size_t word_ = 0;
    std::size_t missing_ = 0;
};
