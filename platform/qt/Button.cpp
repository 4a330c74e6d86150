#include "platform/Button.h"

#include "platform/qt/Labels.h"

#include <QPushButton>

BButton::BButton(BRect frame, const char* name, const char* label, BMessage* message, uint32 resizingMode, uint32 flags)
    : BControl(frame, name, label, message, resizingMode, flags, new QPushButton(labelText(label)))
{
    auto* button = static_cast<QPushButton*>(widget());
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
