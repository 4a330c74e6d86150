#pragma once

#include "platform/Control.h"

/// A push button. The space bar and Enter press it, too, once each time, where it is navigable; otherwise a click
/// leaves the keyboard where it is.
class BButton : public BControl {
public:
    BButton(BRect frame, const char* name, const char* label, BMessage* message,
            uint32 flags = B_WILL_DRAW | B_NAVIGABLE);

    void SetLabel(const char* label) override;
    /// One that is set to B_CONTROL_ON looks pressed and is told of as such, until it is set to something else. A click
    /// sends its message and leaves that to whoever gets it.
    void SetValue(int32 value) override;
};
