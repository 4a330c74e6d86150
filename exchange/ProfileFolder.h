#pragma once

#include "exchange/StatementProfile.h"

#include <optional>
#include <string>
#include <vector>

/// A folder of profiles, a file for each kind of statement, which is found again by the headings of its tables.
///
/// The files are those that `StatementProfile::fromFile` reads. In front stands a number made of the headings, which is
/// a remark there.
class ProfileFolder {
public:
    /// `path` need not be there.
    explicit ProfileFolder(std::string path) : path_(std::move(path)) {}

    struct Kept {
        std::string name; // of the file
        StatementProfile profile;
    };
    /// The profile of a table of such headings, which may stand in any of the lines at its beginning. Nothing when none
    /// was kept. Files that are no profiles are passed over. Throws std::runtime_error when the table cannot be read.
    std::optional<Kept> find(const std::string& table) const;
    /// Keeps the profile for all tables of these headings, in place of the one that was kept for them.
    /// @param name that the file gets, unless that of another table has it; without a '/'.
    /// Throws std::runtime_error, with one line for the user, when it cannot be written.
    void keep(const std::string& name, const std::vector<std::string>& headings, const StatementProfile& profile) const;

private:
    std::string path_;
};
