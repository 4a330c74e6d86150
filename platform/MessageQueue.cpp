#include "platform/MessageQueue.h"

#include "platform/Looper.h"

#include <QCoreApplication>
#include <QEvent>

#include <utility>

namespace {

const QEvent::Type kMessage = static_cast<QEvent::Type>(QEvent::registerEventType());

class MessageEvent final : public QEvent {
public:
    MessageEvent(BMessage message, std::uint64_t looper, std::uint64_t handler)
        : QEvent(kMessage), message_(std::move(message)), looper_(looper), handler_(handler)
    {}

    void deliver()
    {
        auto* looper = dynamic_cast<BLooper*>(BHandler::withToken(looper_));
        BHandler* handler = BHandler::withToken(handler_);
        if (looper != nullptr && handler != nullptr)
            looper->DispatchMessage(&message_, handler);
    }

private:
    BMessage message_;
    std::uint64_t looper_;
    std::uint64_t handler_;
};

} // namespace

void MessageQueue::post(const BMessage& message, BLooper& looper, BHandler& handler)
{
    static MessageQueue queue;
    QCoreApplication::postEvent(&queue, new MessageEvent(message, looper.token(), handler.token()));
}

bool MessageQueue::event(QEvent* event)
{
    if (event->type() != kMessage)
        return QObject::event(event);
    static_cast<MessageEvent*>(event)->deliver();
    return true;
}
