#pragma once

#include "platform/Looper.h"

/// The lock of a looper, for as long as a command runs.
class WindowLock {
public:
    explicit WindowLock(BLooper& looper) : looper_(looper), isHeld_(looper.Lock()) {}
    ~WindowLock()
    {
        if (isHeld_)
            looper_.Unlock();
    }
    WindowLock(const WindowLock&) = delete;
    WindowLock& operator=(const WindowLock&) = delete;

    /// False while the looper closes: the command then does nothing.
    bool isHeld() const { return isHeld_; }

private:
    BLooper& looper_;
    bool isHeld_;
};
