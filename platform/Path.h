#pragma once

#include "platform/SupportDefs.h"

#include <string>

/// The text of a path.
class BPath {
public:
    /// @return `B_BAD_VALUE` for an empty path; the object then stands for none.
    status_t SetTo(const char* path);
    /// Null without a path.
    const char* Path() const { return path_.empty() ? nullptr : path_.c_str(); }
    /// Adds a name behind a slash.
    status_t Append(const char* leaf);

private:
    std::string path_;
};
