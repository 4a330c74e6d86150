#pragma once

#include "platform/SupportDefs.h"

#include <filesystem>
#include <string>

/// The text of a path.
class BPath {
public:
    void SetTo(const std::string& path) { path_ = path; }
    /// Null without a path.
    const char* Path() const { return path_.empty() ? nullptr : path_.c_str(); }
    /// Adds a name behind a slash. @return `B_BAD_VALUE` without a path or a name.
    status_t Append(const char* leaf)
    {
        if (path_.empty() || leaf == nullptr || *leaf == '\0')
            return B_BAD_VALUE;
        path_ = (std::filesystem::path(path_) / leaf).string();
        return B_OK;
    }

private:
    std::string path_;
};
