#include "platform/Path.h"

#include <filesystem>

status_t BPath::SetTo(const char* path, const char* leaf)
{
    path_ = path != nullptr ? path : "";
    if (path_.empty())
        return B_BAD_VALUE;
    return leaf != nullptr ? Append(leaf) : B_OK;
}

status_t BPath::Append(const char* leaf)
{
    if (path_.empty() || leaf == nullptr || *leaf == '\0')
        return B_BAD_VALUE;
    path_ = (std::filesystem::path(path_) / leaf).string();
    return B_OK;
}
