#pragma once

#include <cstdio>
#include <string>

/// A file that appears under its name only when it is whole: it is written to a temporary file in the same folder,
/// which then takes the name.
///
/// A crash, a full disk or a pulled plug leaves the former file or the new one, never a part. Whatever fails throws
/// std::runtime_error with one line for the user that names the file and the reason.
class AtomicFile {
public:
    enum class Existing { kKeep, kReplace };

    /// Throws when a file of this name could not be written in the end: it is there already and to be kept, or it is no
    /// ordinary file. A check ahead of long work; the constructor and `commit` make it again.
    static void check(const std::string& path, Existing existing);

    /// Creates the temporary file. A link at `path` stays a link: the file that it points to is the one replaced.
    AtomicFile(const std::string& path, Existing existing);
    /// Removes what was not committed.
    ~AtomicFile();
    AtomicFile(const AtomicFile&) = delete;
    AtomicFile& operator=(const AtomicFile&) = delete;

    /// For writing; stays owned by this object and is closed by `commit`.
    FILE* stream() const { return stream_; }
    /// Brings the contents to the disk and gives them their name, with the permissions of the file that they replace.
    void commit();
    /// Throws with the file's name, `what` and the reason in errno.
    [[noreturn]] void fail(const char* what) const;

private:
    void create();
    void keepPermissions() const;
    void flushAndClose();
    void giveName();

    std::string path_;   // as the user wrote it
    std::string target_; // without links
    std::string temporary_;
    Existing existing_;
    FILE* stream_ = nullptr;
};
