#include "platform/Message.h"

#include <utility>

status_t BMessage::add(const char* name, Value value)
{
    values_.emplace(name, std::move(value));
    return B_OK;
}

template <class T>
const T* BMessage::held(const char* name) const
{
    const auto found = values_.find(name);
    return found != values_.end() ? std::get_if<T>(&found->second) : nullptr;
}

status_t BMessage::FindInt32(const char* name, int32* value) const
{
    const auto* number = held<int32>(name);
    if (number != nullptr)
        *value = *number;
    return number != nullptr ? B_OK : B_NAME_NOT_FOUND;
}

status_t BMessage::FindString(const char* name, const char** value) const
{
    const auto* text = held<std::string>(name);
    if (text != nullptr)
        *value = text->c_str();
    return text != nullptr ? B_OK : B_NAME_NOT_FOUND;
}

status_t BMessage::FindRef(const char* name, entry_ref* ref) const
{
    const auto* place = held<entry_ref>(name);
    if (place != nullptr)
        *ref = *place;
    return place != nullptr ? B_OK : B_NAME_NOT_FOUND;
}
