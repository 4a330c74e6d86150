#pragma once

#include "platform/Path.h"

#include <string>

/// A file or folder by the folder it lies in and its name there. It need not exist.
struct entry_ref {
    std::string directory;
    std::string name;
};

/// A place in the file system.
class BEntry {
public:
    explicit BEntry(const entry_ref* ref) : path_(std::filesystem::path(ref->directory) / ref->name) {}

    /// @return `B_NO_INIT` when the entry stands for no place.
    status_t GetPath(BPath* path) const
    {
        path->SetTo(path_.string());
        return path_.empty() ? B_NO_INIT : B_OK;
    }

private:
    std::filesystem::path path_;
};
