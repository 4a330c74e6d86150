#include "platform/MessageQueue.h"

#include "platform/Looper.h"

#include <QCoreApplication>
#include <QEvent>

#include <utility>

namespace {

const QEvent::Type kMessage = static_cast<QEvent::Type>(QEvent::registerEventType());

void deliver(BMessage& message, std::uint64_t looperToken, std::uint64_t handlerToken)
{
    auto* looper = dynamic_cast<BLooper*>(BHandler::withToken(looperToken));
    BHandler* handler = BHandler::withToken(handlerToken);
    if (looper != nullptr && handler != nullptr)
        looper->DispatchMessage(&message, handler);
}

} // namespace

class MessageQueue::MessageEvent final : public QEvent {
public:
    explicit MessageEvent(Delivery carried) : QEvent(kMessage), delivery(std::move(carried)) {}

    Delivery delivery;
};

void MessageQueue::post(const BMessage& message, BLooper& looper, BHandler& handler)
{
    static MessageQueue queue;
    QCoreApplication::postEvent(&queue, new MessageEvent({message, looper.token(), handler.token()}));
}

bool MessageQueue::event(QEvent* event)
{
    if (event->type() != kMessage)
        return QObject::event(event);
    waiting_.push_back(std::move(static_cast<MessageEvent*>(event)->delivery));
    if (std::exchange(isDelivering_, true))
        return true;
    while (!waiting_.empty()) {
        Delivery next = std::move(waiting_.front());
        waiting_.pop_front();
        deliver(next.message, next.looper, next.handler);
    }
    isDelivering_ = false;
    return true;
}
