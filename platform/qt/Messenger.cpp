#include "platform/Messenger.h"

#include "platform/Looper.h"

status_t BMessenger::SendMessage(const BMessage* message) const
{
    BHandler* target = Target();
    // A view that stands in no window has no looper, and nobody would handle its message.
    BLooper* looper = target != nullptr ? target->Looper() : nullptr;
    return looper != nullptr ? looper->PostMessage(message, target) : B_BAD_VALUE;
}
