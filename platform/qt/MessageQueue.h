#pragma once

#include "platform/Message.h"

#include <QObject>

#include <cstdint>
#include <deque>

class BHandler;
class BLooper;

/// Carries posted messages through Qt's event loop, in the order in which they were posted and one at a time: a message
/// that comes while another one is handled, as an alert waits for its answer, has to wait as well.
class MessageQueue final : public QObject {
public:
    static void post(const BMessage& message, BLooper& looper, BHandler& handler);
    /// Whether the message that will be handled next is one of that code in that looper's queue.
    static bool isNext(uint32 what, const BLooper& looper);

protected:
    bool event(QEvent* event) override;

private:
    struct Delivery {
        BMessage message;
        std::uint64_t looper; // tokens: either may be gone when the message arrives
        std::uint64_t handler;
    };
    static MessageQueue& queue();

    std::deque<Delivery> waiting_;
    int turns_ = 0; // that the event loop has given, one for each message, and that are not over
    bool isDelivering_ = false;
};
