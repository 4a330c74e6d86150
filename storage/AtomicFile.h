#pragma once

#include "storage/FileStamp.h"

#include <cstdio>
#include <optional>
#include <stdexcept>
#include <string>

/// A file that appears under its name only when it is whole: it is written to a temporary file in the same folder,
/// which then takes the name.
///
/// A crash, a full disk or a pulled plug leaves the former file or the new one, never a part. What a killed program
/// leaves behind is a temporary file, ".pelorin-4711-0.tmp" with the program's number and one of its own; the next
/// AtomicFile in that folder removes it. One that a living program still writes is locked and stays, and so does a file
/// of any other name.
///
/// Whatever fails throws an OpenError or a WriteError, with one line for the user that names the file and the reason.
class AtomicFile {
public:
    enum class Existing { kKeep, kReplace };

    /// A file of that name cannot be made; nothing was written.
    struct OpenError : std::runtime_error {
        using std::runtime_error::runtime_error;
    };
    /// The contents, or their name, did not get to the disk. A file that was to be replaced is as it was.
    struct WriteError : std::runtime_error {
        using std::runtime_error::runtime_error;
    };

    /// Throws an OpenError when a file of this name could not be written in the end: it is there already and to be
    /// kept, it may not be written to or looked at, or it is no ordinary file. A check ahead of long work; the
    /// constructor makes it again.
    static void check(const std::string& path, Existing existing);

    /// Removes the temporary files in `folder` that killed programs have left. The constructor does so, too.
    static void removeLeftOvers(const std::string& folder);

    /// Creates the temporary file. A link at `path` stays a link: the file that it points to is the one replaced, or
    /// made when there is none.
    AtomicFile(const std::string& path, Existing existing);
    /// Removes what was not committed.
    ~AtomicFile();
    AtomicFile(const AtomicFile&) = delete;
    AtomicFile& operator=(const AtomicFile&) = delete;

    /// For writing; stays owned by this object and is closed by `commit`.
    FILE* stream() const { return stream_; }
    /// The file that is made or replaced: `path` without links, absolute.
    const std::string& target() const { return target_; }
    /// Brings the contents to the disk, with the owner and permissions of the file that they replace as far as the user
    /// may set them. Nothing may be written afterwards. For work that must wait until the contents are safe, and come
    /// before the commit.
    void flush();
    /// What tells the new file from all others, once it is flushed: a rename changes nothing of it. Comes before the
    /// commit, because afterwards another program may have put its own in the place.
    std::optional<FileStamp> stamp() const;
    /// Whether there is a file now that the commit would replace. Throws a WriteError when that cannot be told.
    bool replaces() const;
    /// Flushes unless that is done, and gives the contents their name.
    void commit();
    /// Throws a WriteError with the file's name, `what` and the reason in errno.
    [[noreturn]] void fail(const char* what) const;

private:
    void create();
    void keepPermissions() const;
    void giveName();

    std::string path_; // as the user wrote it
    std::string target_;
    std::string temporary_;
    Existing existing_;
    FILE* stream_ = nullptr;
    bool flushed_ = false;
};
