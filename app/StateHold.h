#pragma once

#include "app/PLWindow.h"

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
