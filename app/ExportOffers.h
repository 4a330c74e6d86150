#pragma once

#include "exchange/ExportRows.h"

#include <cstddef>
#include <functional>
#include <string>
#include <vector>

class CompanyView;
class CurrencyView;
class DataFiles;
class JournalForm;
class OperationView;
class PLWindow;
class WalletView;

/// Something that can be written into a file of its own.
struct ExportOffer {
    struct Written {
        std::string what;                 ///< "612 quotes of ALP"
        std::vector<std::string> remarks; ///< on what is left out, or written otherwise
    };

    std::string label;  ///< "Quotes of ALP"
    std::string name;   ///< proposed for the file, without ending
    std::string ending; ///< "csv"; empty for a folder
    bool isWhole;       ///< more than what a page shows
    bool isPossible;    ///< there is something to write
    /// Replaces what is there. Throws std::runtime_error with one line for the user, and leaves nothing then. To be
    /// called before anything of the model changes.
    std::function<Written(const std::string& path)> write;
};

/// What the pages show, as tables with the headings and figures of an export of everything, and everything itself.
class ExportOffers {
public:
    /// All outlive this.
    ExportOffers(PLWindow& window, const DataFiles& files, const CompanyView& companies, const CurrencyView& currencies,
                 const WalletView& portfolio, const OperationView& operations)
        : window_(window), files_(files), companies_(companies), currencies_(currencies), portfolio_(portfolio),
          operations_(operations)
    {}

    /// Those of the page behind the tab of that number. No two have one label.
    std::vector<ExportOffer> of(int tab) const;

private:
    using Offers = std::vector<ExportOffer>;
    using Fill = std::function<void(ExportRows& rows, CsvWriter& table)>;
    /// What a table of a part of the model is called.
    struct Part {
        std::string label;
        std::string name;
        std::function<std::string(std::size_t rows)> count; // "612 quotes of ALP"
    };

    Offers ofCompanies() const;
    Offers ofCurrencies() const;
    Offers ofPortfolio() const;
    Offers ofOperations() const;
    Offers ofParameters() const;
    ExportOffer table(const Part& part, const ExportTable& form, bool isPossible, const Fill& fill) const;
    ExportOffer folder() const;
    ExportOffer journal(const char* readers, const char* ending, const JournalForm& form) const;
    /// There is a portfolio to be written as a whole.
    bool hasWhole() const;
    /// What a file of everything is called after.
    std::string wholeName() const;

    PLWindow& window_;
    const DataFiles& files_;
    const CompanyView& companies_;
    const CurrencyView& currencies_;
    const WalletView& portfolio_;
    const OperationView& operations_;
};
