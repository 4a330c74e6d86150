#pragma once

#include "platform/TextControl.h"

#include <QFrame>

class QWidget;

/// A month's days in a window of their own below a field. Arrows, Page Up and Page Down walk, Enter or a click chooses,
/// Escape or a click elsewhere closes; then it is gone.
class CalendarPopup final : public QFrame {
public:
    using Choose = std::function<void(const CalendarDay&)>;

    /// Shows it, a child of `field`, with `shown` selected; what is no day shows today.
    static void open(QWidget& field, const CalendarDay& shown, Choose choose);

private:
    CalendarPopup(QWidget& field, const CalendarDay& shown, Choose choose);
};

class QIcon;

/// A leaf of a calendar, for a button beside a field.
QIcon calendarIcon();
