#include "platform/Looper.h"

#include "platform/Message.h"
#include "platform/qt/MessageQueue.h"

status_t BLooper::PostMessage(const BMessage* message, BHandler* handler)
{
    if (message == nullptr)
        return B_BAD_VALUE;
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
    if (closing_)
        return false;
    ++locks_;
    return true;
}

void BLooper::Unlock()
{
    if (locks_ > 0)
        --locks_;
}
