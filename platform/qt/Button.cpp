#include "platform/Button.h"

#include "platform/qt/HeldKey.h"
#include "platform/qt/Labels.h"

#include <QPushButton>

namespace {

/// A key that is held presses once.
class PushButton final : public QPushButton {
public:
    using QPushButton::QPushButton;

protected:
    void keyPressEvent(QKeyEvent* event) override
    {
        if (!HeldKey::isRepeating())
            QPushButton::keyPressEvent(event);
    }
};

} // namespace

BButton::BButton(BRect frame, const char* name, const char* label, BMessage* message, uint32 flags)
    : BControl(frame, name, label, message, new PushButton(labelText(label)), flags)
{
    auto* button = static_cast<QPushButton*>(widget());
    HeldKey::watch();
    // Enter presses the button that has the keyboard, as the space bar does.
    button->setAutoDefault(true);
    if ((flags & B_NAVIGABLE) == 0)
        button->setFocusPolicy(Qt::NoFocus);
    QObject::connect(button, &QPushButton::clicked, [this, button] {
        // Qt has turned what can be turned: back to what was set.
        button->setChecked(Value() == B_CONTROL_ON);
        Invoke();
    });
}

void BButton::SetValue(int32 value)
{
    BControl::SetValue(value);
    auto* button = static_cast<QPushButton*>(widget());
    button->setCheckable(true);
    button->setChecked(value == B_CONTROL_ON);
}

void BButton::SetLabel(const char* label)
{
    BControl::SetLabel(label);
    SetAccessibleName(label);
    static_cast<QPushButton*>(widget())->setText(labelText(label));
}
