#pragma once

#include "platform/Control.h"

/// A box that is on or off: its `Value`.
class BCheckBox : public BControl {
public:
    BCheckBox(BRect frame, const char* name, const char* label, BMessage* message);

    /// Sends no message; only a person does.
    void SetValue(int32 value) override;
};
