#include "platform/Control.h"

#include "platform/Window.h"

#include <QWidget>

BControl::BControl(BRect frame, const char* name, const char* label, BMessage* message, uint32 resizingMode,
                   uint32 flags, QWidget* widget)
    : BView(frame, name, resizingMode, flags, widget), BInvoker(message), label_(label != nullptr ? label : "")
{
    SetAccessibleName(Label());
}

void BControl::AttachedToWindow()
{
    if (!HasTarget())
        SetTarget(Window());
}

void BControl::SetEnabled(bool enabled)
{
    widget()->setEnabled(enabled);
}

bool BControl::IsEnabled() const
{
    return widget()->isEnabled();
}
