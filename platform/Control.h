#pragma once

#include "platform/Invoker.h"
#include "platform/View.h"

#include <string>

/// A view that a person works with: it has a label, and sends its message when it is used.
class BControl : public BView, public BInvoker {
public:
    const char* Label() const { return label_.c_str(); }
    virtual void SetLabel(const char* label) { label_ = label; }
    virtual void SetValue(int32 value) { value_ = value; }
    int32 Value() const { return value_; }
    /// One that is not enabled shows in grey and is of no use.
    void SetEnabled(bool enabled);
    bool IsEnabled() const;

    /// The target is the window, unless another one was set.
    void AttachedToWindow() override;

protected:
    /// Owns `message`; `widget` is what shows the control, and `label` is what assistive tools call it.
    BControl(BRect frame, const char* name, const char* label, BMessage* message, uint32 resizingMode, uint32 flags,
             QWidget* widget);

private:
    std::string label_;
    int32 value_ = B_CONTROL_OFF;
};
