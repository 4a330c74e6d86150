#include "platform/qt/MessageQueue.h"

#include "platform/Looper.h"

#include <QCoreApplication>
#include <QEvent>

#include <utility>

namespace {

// The next message has its turn.
const QEvent::Type kTurn = static_cast<QEvent::Type>(QEvent::registerEventType());

void deliver(BMessage& message, std::uint64_t looperToken, std::uint64_t handlerToken)
{
    // Either may have died since the message was posted. It is dropped then.
    auto* looper = dynamic_cast<BLooper*>(BHandler::withToken(looperToken));
    BHandler* handler = BHandler::withToken(handlerToken);
    if (looper != nullptr && handler != nullptr)
        looper->DispatchMessage(&message, handler);
}

} // namespace

MessageQueue& MessageQueue::queue()
{
    static MessageQueue queue;
    return queue;
}

void MessageQueue::post(const BMessage& message, BLooper& looper, BHandler& handler)
{
    // A turn of the event loop for each message, and the message in a queue of our own: its order then does not depend
    // on how Qt orders events, and `isNext` can look at it.
    queue().waiting_.push_back({message, looper.token(), handler.token()});
    QCoreApplication::postEvent(&queue(), new QEvent(kTurn));
}

bool MessageQueue::isNext(uint32 what, const BLooper& looper)
{
    const auto& waiting = queue().waiting_;
    return !waiting.empty() && waiting.front().message.what == what && waiting.front().looper == looper.token();
}

bool MessageQueue::event(QEvent* event)
{
    if (event->type() != kTurn)
        return QObject::event(event);
    // Each turn finds a message waiting: both come from one `post`, the message first.
    ++turns_;
    // A message that is being handled runs an event loop of its own, as an alert does. Its successors wait until it is
    // done: the loop below, further out on the stack, makes up for their turns.
    if (std::exchange(isDelivering_, true))
        return true;
    for (; turns_ > 0; --turns_) {
        // Out of the queue before it is handled: what it asks of `isNext` is about those behind it.
        Delivery next = std::move(waiting_.front());
        waiting_.pop_front();
        deliver(next.message, next.looper, next.handler);
    }
    isDelivering_ = false;
    return true;
}
