#include "platform/CheckBox.h"

#include "platform/qt/Labels.h"

#include <QCheckBox>

BCheckBox::BCheckBox(BRect frame, const char* name, const char* label, BMessage* message, uint32 resizingMode,
                     uint32 flags)
    : BControl(frame, name, label, message, resizingMode, flags, new QCheckBox(labelText(label)))
{
    auto* box = static_cast<QCheckBox*>(widget());
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
