#include "platform/Message.h"

#include "platform/Entry.h"

#include <utility>

status_t BMessage::add(const char* name, Value value)
{
    values_[name].push_back(std::move(value));
    return B_OK;
}

template <class T>
status_t BMessage::find(const char* name, int32 index, const T** value) const
{
    const auto found = values_.find(name);
    if (found == values_.end())
        return B_NAME_NOT_FOUND;
    const auto& all = found->second;
    if (index < 0 || static_cast<std::size_t>(index) >= all.size())
        return B_BAD_INDEX;
    *value = std::get_if<T>(&all[static_cast<std::size_t>(index)]);
    return *value != nullptr ? B_OK : B_NAME_NOT_FOUND;
}

status_t BMessage::AddRef(const char* name, const entry_ref* ref)
{
    return add(name, Place{ref->directory, ref->name});
}

status_t BMessage::FindInt32(const char* name, int32 index, int32* value) const
{
    const int32* held = nullptr;
    const status_t status = find(name, index, &held);
    if (status == B_OK)
        *value = *held;
    return status;
}

status_t BMessage::FindString(const char* name, int32 index, const char** value) const
{
    const std::string* held = nullptr;
    const status_t status = find(name, index, &held);
    if (status == B_OK)
        *value = held->c_str();
    return status;
}

status_t BMessage::FindRef(const char* name, int32 index, entry_ref* ref) const
{
    const Place* held = nullptr;
    const status_t status = find(name, index, &held);
    if (status == B_OK)
        *ref = {held->directory, held->name};
    return status;
}
