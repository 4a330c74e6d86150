#pragma once

#include "platform/Handler.h"

/// The address of a handler. It stays harmless when the handler dies: messages then go nowhere.
class BMessenger {
public:
    BMessenger() = default;
    explicit BMessenger(const BHandler* handler) : token_(handler != nullptr ? handler->token() : 0) {}

    bool IsValid() const { return Target() != nullptr; }
    BHandler* Target() const { return token_ != 0 ? BHandler::withToken(token_) : nullptr; }
    /// Queues a copy of the message, which stays the caller's. @return `B_BAD_VALUE` when the handler is gone or stands
    /// in no looper.
    status_t SendMessage(const BMessage* message) const;

private:
    std::uint64_t token_ = 0;
};
