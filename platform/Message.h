#pragma once

#include "platform/SupportDefs.h"

#include <map>
#include <string>
#include <variant>
#include <vector>

struct entry_ref;

/// Codes that the platform sends of itself. Codes are four characters, the first one in the highest byte.
enum : uint32 {
    B_QUIT_REQUESTED = '_QRQ',
    B_REFS_RECEIVED = 'RREF',
    B_SAVE_REQUESTED = 'SAVE',
    B_CANCEL = 'CNCL',
};

/// A code and, under names, any number of values. Finding gives the value's status; what is not found leaves the
/// out-argument alone.
class BMessage {
public:
    uint32 what = 0;

    BMessage() = default;
    explicit BMessage(uint32 code) : what(code) {}

    status_t AddInt32(const char* name, int32 value) { return add(name, value); }
    status_t AddString(const char* name, const char* value) { return add(name, std::string(value)); }
    status_t AddRef(const char* name, const entry_ref* ref);

    status_t FindInt32(const char* name, int32* value) const { return FindInt32(name, 0, value); }
    status_t FindInt32(const char* name, int32 index, int32* value) const;
    /// The text belongs to the message.
    status_t FindString(const char* name, const char** value) const { return FindString(name, 0, value); }
    status_t FindString(const char* name, int32 index, const char** value) const;
    status_t FindRef(const char* name, entry_ref* ref) const { return FindRef(name, 0, ref); }
    status_t FindRef(const char* name, int32 index, entry_ref* ref) const;

private:
    struct Place { // an entry_ref by value, without its header here
        std::string directory;
        std::string name;
    };
    using Value = std::variant<int32, std::string, Place>;

    status_t add(const char* name, Value value);
    template <class T>
    status_t find(const char* name, int32 index, const T** value) const;

    std::map<std::string, std::vector<Value>, std::less<>> values_;
};
