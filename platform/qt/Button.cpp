#include "platform/Button.h"

#include "platform/qt/Labels.h"

#include <QPushButton>

BButton::BButton(BRect frame, const char* name, const char* label, BMessage* message, uint32 flags)
    : BControl(frame, name, label, message, new QPushButton(labelText(label)), flags)
{
    auto* button = static_cast<QPushButton*>(widget());
    // Enter presses the button that has the keyboard, as the space bar does.
    button->setAutoDefault(true);
    if ((flags & B_NAVIGABLE) == 0)
        button->setFocusPolicy(Qt::NoFocus);
    QObject::connect(button, &QPushButton::clicked, [this] { Invoke(); });
}

void BButton::SetLabel(const char* label)
{
    BControl::SetLabel(label);
    SetAccessibleName(label);
    static_cast<QPushButton*>(widget())->setText(labelText(label));
}
