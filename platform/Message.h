#pragma once

#include "platform/Entry.h"
#include "platform/SupportDefs.h"

#include <map>
#include <string>
#include <type_traits>
#include <utility>
#include <variant>

/// Codes that the platform sends of itself. Codes are four characters, the first one in the highest byte.
enum : uint32 {
    B_QUIT_REQUESTED = '_QRQ',
    B_REFS_RECEIVED = 'RREF',
    B_SAVE_REQUESTED = 'SAVE',
};

/// A code and, under names, values: one each, the first that was added. Finding gives the value's status; what is not
/// found leaves the out-argument alone.
class BMessage {
public:
    uint32 what = 0;

    BMessage() = default;
    explicit BMessage(uint32 code) : what(code) {}

    status_t AddInt32(const char* name, int32 value) { return add(name, value); }
    status_t AddString(const char* name, const char* value) { return add(name, std::string(value)); }
    status_t AddRef(const char* name, const entry_ref* ref) { return add(name, *ref); }

    status_t FindInt32(const char* name, int32* value) const { return find<int32>(name, value); }
    /// The text belongs to the message.
    status_t FindString(const char* name, const char** value) const { return find<std::string>(name, value); }
    status_t FindRef(const char* name, entry_ref* ref) const { return find<entry_ref>(name, ref); }

private:
    using Value = std::variant<int32, std::string, entry_ref>;

    status_t add(const char* name, Value value)
    {
        values_.emplace(name, std::move(value));
        return B_OK;
    }
    template <class T, class Out>
    status_t find(const char* name, Out* out) const
    {
        const auto found = values_.find(name);
        const T* held = found != values_.end() ? std::get_if<T>(&found->second) : nullptr;
        if (held == nullptr)
            return B_NAME_NOT_FOUND;
        if constexpr (std::is_same_v<T, std::string>)
            *out = held->c_str();
        else
            *out = *held;
        return B_OK;
    }

    std::map<std::string, Value, std::less<>> values_;
};
