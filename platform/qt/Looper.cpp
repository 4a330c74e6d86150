#include "platform/Looper.h"

#include "platform/Message.h"
#include "platform/qt/MessageQueue.h"

status_t BLooper::PostMessage(const BMessage* message, BHandler* handler)
{
    if (message == nullptr)
        return B_BAD_VALUE;
    // The message is copied, so the caller's may be changed or destroyed before its turn comes.
    MessageQueue::post(*message, *this, handler != nullptr ? *handler : *this);
    return B_OK;
}

status_t BLooper::PostMessage(uint32 what, BHandler* handler)
{
    const BMessage message(what);
    return PostMessage(&message, handler);
}

bool BLooper::IsNextMessage(uint32 what) const
{
    return MessageQueue::isNext(what, *this);
}

void BLooper::DispatchMessage(BMessage* message, BHandler* handler)
{
    // A looper that closes handles nothing any more: what waits in its queue is dropped here.
    if (!Lock())
        return;
    // The message may end the looper, which is then not there to be unlocked.
    const std::uint64_t self = token();
    handler->MessageReceived(message);
    if (BHandler::withToken(self) == this)
        Unlock();
}

bool BLooper::Lock()
{
    // Nobody waits: there is one thread, and all who lock are below one another on its stack.
    if (closing_)
        return false;
    ++locks_;
    return true;
}

void BLooper::Unlock()
{
    // Somebody may unlock who was refused the lock; that changes nothing.
    if (locks_ > 0)
        --locks_;
}
