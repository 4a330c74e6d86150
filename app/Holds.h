#pragma once

#include "app/PLWindow.h"

/// The lock of a looper, for as long as a command runs. It counts: who holds it may take it again.
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

/// While one is alive, `PLWindow::UpdateState` only takes note; the last one to end has it done, once. A command that
/// is made of many others holds the valuation, which would otherwise be done as often.
class StateHold {
public:
    explicit StateHold(PLWindow& window) : window_(window) { ++window_.holds_; }
    ~StateHold()
    {
        if (--window_.holds_ == 0 && window_.isUpdateDue_)
            window_.UpdateState();
    }
    StateHold(const StateHold&) = delete;
    StateHold& operator=(const StateHold&) = delete;

private:
    PLWindow& window_;
};
