#pragma once

#include "platform/SupportDefs.h"

#include <string>

/// The text of a path.
class BPath {
public:
    BPath() = default;
    explicit BPath(const char* path, const char* leaf = nullptr) { SetTo(path, leaf); }

    /// @return `B_BAD_VALUE` for an empty path; the object then stands for none.
    status_t SetTo(const char* path, const char* leaf = nullptr);
    status_t InitCheck() const { return path_.empty() ? B_NO_INIT : B_OK; }
    /// Null without a path.
    const char* Path() const { return path_.empty() ? nullptr : path_.c_str(); }
    /// Adds a name behind a slash.
    status_t Append(const char* leaf);

private:
    std::string path_;
};
