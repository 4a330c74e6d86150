#pragma once

#include "app/PendingImport.h"
#include "exchange/MarketImport.h"

#include <deque>
#include <optional>
#include <string>
#include <vector>

class CompanyView;
class CurrencyView;

/// The import of closing prices or exchange rates.
class ImportQuotes final : public PendingImport {
public:
    /// `areRates` is what the table is taken for where its headings leave that open. Throws std::runtime_error, with
    /// one line for the user, for a file that cannot be read or has no lines. The pages outlive this.
    ImportQuotes(PLWindow& window, CompanyView& companies, CurrencyView& currencies, const std::string& path,
                 bool areRates);

    ImportSheet sheet() override;
    void choose(const std::string& question, std::size_t item) override;
    void type(const std::string& question, const std::string& text) override;
    void setSkips(bool) override {}
    std::string stepName() const override;
    std::string carryOut() override;

private:
    struct Refused {
        unsigned long line;
        std::string reason;
    };

    void chooseDefaults();
    bool looksLikeRates(bool otherwise) const;
    void read();
    std::string problem() const;
    std::string withoutPath(const std::string& error) const;
    void askForKind(ImportSheet& sheet) const;
    void askForColumns(ImportSheet& sheet) const;
    void askForPlaces(ImportSheet& sheet) const;
    void fillRows(ImportSheet& sheet) const;
    void show(const std::vector<Currency*>& currencies, const std::vector<Market*>& markets,
              const std::vector<Company*>& companies);

    CompanyView& companies_;
    CurrencyView& currencies_;
    std::string path_;
    bool areRates_;
    ImportOptions options_;
    std::vector<std::pair<Column, std::string>> columnsTold_;
    MarketTableHead head_;
    std::optional<MarketPlan> plan_;
    std::string problem_; // why there is no plan
    std::vector<Refused> refused_;
    std::size_t refusedCount_ = 0; // of which the first ones are told
    std::size_t column_ = 0;       // that the menu is about
};
