#include "platform/qt/CalendarPopup.h"

#include "platform/qt/Canvas.h"

#include <QCalendarWidget>
#include <QIcon>
#include <QPainter>
#include <QScreen>
#include <QTextCharFormat>
#include <QVBoxLayout>

#include <algorithm>

CalendarPopup::CalendarPopup(QWidget& field, const CalendarDay& shown, Choose choose) : QFrame(&field, Qt::Popup)
{
    setAttribute(Qt::WA_DeleteOnClose);
    setFrameStyle(QFrame::Box | QFrame::Plain);
    setObjectName("Calendar");
    setAccessibleName("Calendar");
    auto* days = new QCalendarWidget(this);
    days->setAccessibleName("Days");
    days->setVerticalHeaderFormat(QCalendarWidget::NoVerticalHeader);
    days->setDateEditEnabled(false); // digits are for the field
    QTextCharFormat weekend;         // the usual red is too light
    weekend.setForeground(toQt(kWarningRed));
    for (const Qt::DayOfWeek free : {Qt::Saturday, Qt::Sunday})
        days->setWeekdayTextFormat(free, weekend);
    const QDate day(shown.year, shown.month, shown.day);
    days->setSelectedDate(day.isValid() ? day : QDate::currentDate());
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(1, 1, 1, 1);
    layout->addWidget(days);
    setFocusProxy(days);
    const auto take = [this, choose = std::move(choose)](const QDate& chosen) {
        if (!isVisible())
            return; // a click may count as both
        close();    // first: the field has the keyboard again when it hears of the day
        choose({chosen.day(), chosen.month(), chosen.year()});
    };
    QObject::connect(days, &QCalendarWidget::clicked, this, take);
    QObject::connect(days, &QCalendarWidget::activated, this, take);
}

void CalendarPopup::open(QWidget& field, const CalendarDay& shown, Choose choose)
{
    auto* popup = new CalendarPopup(field, shown, std::move(choose)); // destroys itself when it closes
    popup->adjustSize();
    // As a list of completions: above the field where there is no room below.
    const QRect screen = field.screen()->availableGeometry();
    QPoint corner = field.mapToGlobal(QPoint(0, field.height()));
    if (corner.y() + popup->height() > screen.bottom())
        corner.setY(std::max(field.mapToGlobal(QPoint(0, 0)).y() - popup->height(), screen.top()));
    corner.setX(std::max(screen.left(), std::min(corner.x(), screen.right() - popup->width())));
    popup->move(corner);
    popup->show();
    popup->setFocus(Qt::PopupFocusReason);
}

QIcon calendarIcon()
{
    constexpr int kSize = 16, kSharp = 2; // twice as fine, for screens of high resolution
    QPixmap leaf(kSize * kSharp, kSize * kSharp);
    leaf.setDevicePixelRatio(kSharp);
    leaf.fill(Qt::transparent);
    QPainter painter(&leaf);
    painter.setPen(toQt(kFaintGrey));
    painter.setBrush(Qt::white);
    painter.drawRect(2, 3, 11, 10);
    painter.fillRect(2, 3, 12, 3, toQt(kSelection));
    for (int day = 0; day < 6; ++day)
        painter.fillRect(4 + day % 3 * 3, 8 + day / 3 * 3, 2, 2, toQt(kFaintGrey));
    painter.end();
    return QIcon(leaf);
}
