#pragma once

#include "platform/SupportDefs.h"

#include <string>

class BPath;

/// A file or folder by the folder it lies in and its name there. It need not exist.
struct entry_ref {
    std::string directory;
    std::string name;
};

/// A place in the file system, from a reference or a path.
class BEntry {
public:
    explicit BEntry(const entry_ref* ref);
    explicit BEntry(const char* path);

    /// `B_NO_INIT` when the entry stands for no place; the same below.
    status_t GetPath(BPath* path) const;
    status_t GetRef(entry_ref* ref) const;

private:
    std::string path_;
};
