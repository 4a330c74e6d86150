#pragma once

#include <string>

/// The folder in which the program keeps its files: "Pelorin" in the user's documents folder.
///
/// The documents folder is the desktop's: XDG_DOCUMENTS_DIR as user-dirs.dirs in the configuration folder has it, else
/// "Documents" in the home folder. Where a file panel opens and where replaced files are kept is told from here.
class DataFolder {
public:
    /// The user's.
    DataFolder();
    explicit DataFolder(const std::string& path) : path_(path) {}

    /// Empty when the user has no home folder.
    const std::string& path() const { return path_; }

    /// Market data files. Each of these makes the folder when it is missing. `*error` becomes one line for the user
    /// when that fails, and empty otherwise; the path is given in either case.
    std::string companies(std::string* error) const { return need(kCompanies, kOpenMode, error); }
    /// Portfolio files. "PortoFolios" is the product's own spelling. Intended: existing data folders rely on it.
    std::string portoFolios(std::string* error) const { return need(kPortoFolios, kOpenMode, error); }
    /// Files that a save has replaced. The user's alone: they may come from folders that nobody else can look into.
    std::string backups(std::string* error) const { return need(kBackups, kPrivateMode, error); }

    /// What was told of the statements of banks.
    std::string profiles(std::string* error) const { return need(kProfiles, kPrivateMode, error); }

    static constexpr const char* kCompanies = "/Companies";
    static constexpr const char* kPortoFolios = "/PortoFolios";
    static constexpr const char* kBackups = "/Backups";
    static constexpr const char* kProfiles = "/Profiles";
    static constexpr const char* kUnsaved = "/Backups/Unsaved"; // copies of unsaved work

private:
    static constexpr unsigned kOpenMode = 0777; // less the user's mask
    static constexpr unsigned kPrivateMode = 0700;

    std::string need(const char* subfolder, unsigned mode, std::string* error) const;

    std::string path_;
};
