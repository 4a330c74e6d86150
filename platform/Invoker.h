#pragma once

#include "platform/Message.h"
#include "platform/Messenger.h"

#include <memory>

/// Something that sends a message of its own to a target when it is used: by way of the target's queue, never directly.
class BInvoker {
public:
    /// Owns `message`, which may be null.
    explicit BInvoker(BMessage* message = nullptr) : message_(message) {}
    virtual ~BInvoker() = default;
    BInvoker(const BInvoker&) = delete;
    BInvoker& operator=(const BInvoker&) = delete;

    /// Takes ownership of `message`; null sends nothing from now on.
    void SetMessage(BMessage* message) { message_.reset(message); }
    BMessage* Message() const { return message_.get(); }
    /// Does not own `target`, which may die before. A view that is told none sends to its window.
    void SetTarget(const BHandler* target) { target_ = BMessenger(target); }
    bool HasTarget() const { return target_.IsValid(); }
    BMessenger Messenger() const { return target_; }

    /// Sends a copy of `message`, or of its own one when that is null, to the target.
    virtual status_t Invoke(const BMessage* message = nullptr)
    {
        const BMessage* sent = message != nullptr ? message : message_.get();
        return sent != nullptr ? target_.SendMessage(sent) : B_BAD_VALUE;
    }

private:
    std::unique_ptr<BMessage> message_;
    BMessenger target_;
};
