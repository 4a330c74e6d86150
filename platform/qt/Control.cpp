#include "platform/Control.h"

#include <QApplication>
#include <QWidget>

status_t get_click_speed(bigtime_t* speed)
{
    *speed = static_cast<bigtime_t>(QApplication::doubleClickInterval()) * 1000;
    return B_OK;
}

void BControl::SetEnabled(bool enabled)
{
    widget()->setEnabled(enabled);
}

bool BControl::IsEnabled() const
{
    return widget()->isEnabled();
}
