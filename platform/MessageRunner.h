#pragma once

#include "platform/Messenger.h"

#include <cstdint>
#include <memory>

class BMessage;
class QTimer;

/// Sends a message over and over, as long as the runner is there.
///
/// Unlike in the kits the message does not wait in the queue of its target's looper: it comes in time also while a
/// command waits for the answer to an alert, and never twice at once. So its target changes nothing that a command may
/// be at work on.
class BMessageRunner {
public:
    /// `message` is copied. The first one comes after `interval`.
    BMessageRunner(const BMessenger& target, const BMessage* message, bigtime_t interval);
    ~BMessageRunner();
    BMessageRunner(const BMessageRunner&) = delete;
    BMessageRunner& operator=(const BMessageRunner&) = delete;

    /// The next message comes after `interval` from now, and so on.
    void SetInterval(bigtime_t interval);

private:
    std::unique_ptr<QTimer> timer_;
};
