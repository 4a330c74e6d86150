#include "platform/Control.h"

#include <QWidget>

void BControl::SetEnabled(bool enabled)
{
    widget()->setEnabled(enabled);
}

bool BControl::IsEnabled() const
{
    return widget()->isEnabled();
}
