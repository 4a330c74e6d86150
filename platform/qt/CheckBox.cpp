#include "platform/CheckBox.h"

#include "platform/qt/Labels.h"

#include <QCheckBox>

BCheckBox::BCheckBox(BRect frame, const char* name, const char* label, BMessage* message)
    : BControl(frame, name, label, message, new QCheckBox(labelText(label)))
{
    auto* box = static_cast<QCheckBox*>(widget());
    // `clicked` comes from a person only, so `SetValue` below sends nothing.
    QObject::connect(box, &QCheckBox::clicked, [this](bool on) {
        BControl::SetValue(on ? B_CONTROL_ON : B_CONTROL_OFF);
        Invoke();
    });
}

void BCheckBox::SetValue(int32 value)
{
    BControl::SetValue(value);
    static_cast<QCheckBox*>(widget())->setChecked(value != B_CONTROL_OFF);
}
