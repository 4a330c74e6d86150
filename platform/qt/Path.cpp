#include "platform/Path.h"

#include <filesystem>

status_t BPath::SetTo(const char* path)
{
    path_ = path != nullptr ? path : "";
    return path_.empty() ? B_BAD_VALUE : B_OK;
}

status_t BPath::Append(const char* leaf)
{
    if (path_.empty() || leaf == nullptr || *leaf == '\0')
        return B_BAD_VALUE;
    path_ = (std::filesystem::path(path_) / leaf).string();
    return B_OK;
}
