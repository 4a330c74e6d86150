#pragma once

#include "platform/SupportDefs.h"

#include <cstdint>
#include <string>

class BLooper;
class BMessage;

/// Something that messages can be sent to.
class BHandler {
public:
    explicit BHandler(const char* name = nullptr);
    virtual ~BHandler();
    BHandler(const BHandler&) = delete;
    BHandler& operator=(const BHandler&) = delete;

    const char* Name() const { return name_.c_str(); }
    /// The looper in whose queue messages to this handler wait; null when there is none yet.
    virtual BLooper* Looper() const { return nullptr; }
    /// Called for each message, in the order of their sending, while its looper is locked; `message` is there as long
    /// as the call. Here, where nobody understood it, it ends.
    virtual void MessageReceived(BMessage* /*message*/) {}

    /// A number that no other handler has or had: a handler that has died is not mistaken for a new one at its place.
    std::uint64_t token() const { return token_; }
    /// The living handler of that number, null when it has died.
    static BHandler* withToken(std::uint64_t token);

private:
    std::string name_;
    std::uint64_t token_;
};
