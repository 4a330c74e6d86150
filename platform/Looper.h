#pragma once

#include "platform/Handler.h"

/// A handler with a queue: messages are posted to it, wait their turn, and are handled one at a time.
///
/// All loopers share the program's one thread, so no call of these kits needs the lock. It is for the program's
/// commands, which take it before they touch the model, and leave off while the window closes.
class BLooper : public BHandler {
public:
    explicit BLooper(const char* name = nullptr) : BHandler(name) {}

    BLooper* Looper() const override { return const_cast<BLooper*>(this); }

    /// Queues a copy of the message, which stays the caller's, for this looper itself or for `handler`. A message whose
    /// receiver dies before its turn is dropped.
    status_t PostMessage(const BMessage* message, BHandler* handler = nullptr);
    status_t PostMessage(uint32 what, BHandler* handler = nullptr);
    /// Whether the message that will be handled after this one is of that code: then a command whose result would not
    /// last can be left to the next one. The kits have no such question.
    bool IsNextMessage(uint32 what) const;
    /// Handles one message, with the looper locked.
    virtual void DispatchMessage(BMessage* message, BHandler* handler);

    /// Counts, so that commands can call one another: each that got the lock gives one back.
    /// @return false, and nothing is to be given back, from when the looper begins to close.
    bool Lock();
    void Unlock();

    /// Asked before the looper ends; false refuses.
    virtual bool QuitRequested() { return true; }

protected:
    /// From now on `Lock` fails.
    void beginClosing() { closing_ = true; }
    bool isClosing() const { return closing_; }

private:
    int32 locks_ = 0;
    bool closing_ = false;
};
