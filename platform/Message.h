#pragma once

#include "platform/Entry.h"
#include "platform/SupportDefs.h"

#include <map>
#include <string>
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

    status_t FindInt32(const char* name, int32* value) const;
    /// The text belongs to the message.
    status_t FindString(const char* name, const char** value) const;
    status_t FindRef(const char* name, entry_ref* ref) const;

private:
    using Value = std::variant<int32, std::string, entry_ref>;

    status_t add(const char* name, Value value);
    /// Null when there is no value of that name, or one of another type.
    template <class T>
    const T* held(const char* name) const;

    std::map<std::string, Value, std::less<>> values_;
};
