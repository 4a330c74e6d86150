#pragma once

#include "storage/AtomicFile.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

/// A table that is written: headings, then rows of cells with commas between, quoted where they have to be, as in
/// RFC 4180. The file appears with `commit`.
///
/// Whatever fails throws std::runtime_error with one line for the user.
class CsvWriter {
public:
    /// What becomes of a file of that name that does not begin with the same headings. One that does is from an
    /// earlier export, and replaced.
    enum class Foreign { kKeep, kReplace };

    /// Throws when there is one to be kept.
    CsvWriter(const std::string& path, const std::vector<std::string>& headings, Foreign foreign = Foreign::kKeep);

    /// @return false for a row that a reader would find too long; it is not written.
    bool add(const std::vector<std::string>& cells);
    /// Throws when anything of the table could not be written.
    void commit() { file_.commit(); }

    const std::string& path() const { return path_; }
    std::size_t rows() const { return rows_; }

private:
    void write();

    std::string path_;
    std::size_t rows_ = 0;
    std::string line_;
    AtomicFile file_;
};

/// Whether there may be a new file at `path`: there is none yet, an empty one, or one whose first line is
/// `firstLine`. Throws std::runtime_error otherwise.
void checkReplaceable(const std::string& path, std::string_view firstLine);
