#include "platform/Entry.h"

#include "platform/Path.h"

#include <filesystem>

BEntry::BEntry(const entry_ref* ref)
{
    if (ref == nullptr || (ref->directory.empty() && ref->name.empty()))
        return;
    path_ = (std::filesystem::path(ref->directory) / ref->name).string();
}

BEntry::BEntry(const char* path) : path_(path != nullptr ? path : "") {}

status_t BEntry::GetPath(BPath* path) const
{
    return path_.empty() ? B_NO_INIT : path->SetTo(path_.c_str());
}

status_t BEntry::GetRef(entry_ref* ref) const
{
    if (path_.empty())
        return B_NO_INIT;
    const std::filesystem::path path(path_);
    *ref = {path.parent_path().string(), path.filename().string()};
    return B_OK;
}
