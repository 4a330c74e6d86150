#pragma once

#include "app/PLWindow.h"
#include "views/ImportPreview.h"

#include <map>
#include <set>
#include <string>
#include <utility>
#include <vector>

/// A table that is about to be imported: what the window of an import shows, and then carrying it out.
///
/// It refers to the model as that was when it was made. As soon as that is another one, nothing is looked at any more.
class PendingImport : public ImportPreview {
public:
    explicit PendingImport(PLWindow& window) : window_(window), serial_(window.changeSerial()) {}

    /// Whether portfolio or market data have changed since it was made.
    bool isStale() const { return window_.changeSerial() != serial_; }
    /// What the undo calls it: "Import operations from nordbank.csv".
    virtual std::string stepName() const = 0;
    /// Does what the last sheet has shown, and shows it on the pages. Once, and while it is not stale.
    /// @return what was done, for a notice; empty when the sheet had a problem, and nothing was done.
    virtual std::string carryOut() = 0;

protected:
    static constexpr const char* kStale =
        "Portfolio or market data have changed meanwhile: close this window, and import again.";

    PLWindow& window() const { return window_; }

private:
    PLWindow& window_;
    std::uint64_t serial_;
};

/// Adds what a person has told of a column to what was told before, of which it takes the place.
template <class Column>
void tellHeading(std::vector<std::pair<Column, std::string>>& told, Column column, const std::string& heading)
{
    std::erase_if(told, [column](const auto& entry) { return entry.first == column; });
    told.emplace_back(column, heading);
}

/// A heading means one column only: the one that was told last. The others come back as soon as that is told to stand
/// elsewhere, so that one can go through a menu by keys.
template <class Column>
std::map<Column, std::string> headingsTold(const std::vector<std::pair<Column, std::string>>& told)
{
    std::map<Column, std::string> headings;
    std::set<std::string> taken;
    for (auto entry = told.rbegin(); entry != told.rend(); ++entry)
        if (entry->second.empty() || taken.insert(entry->second).second)
            headings.insert(*entry);
    return headings;
}

/// The name of the file, for a line of the window.
std::string importedName(const std::string& path);
/// "1,234 lines", "1 line"
std::string importedCount(std::size_t n, const char* what);
