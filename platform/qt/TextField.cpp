#include "platform/qt/TextField.h"

#include "platform/qt/CalendarPopup.h"
#include "platform/qt/CompletionList.h"
#include "platform/qt/FieldButton.h"
#include "platform/qt/Keys.h"

#include <QKeyEvent>

namespace {

constexpr int kButton = 16; // pixels, the icon's

} // namespace

TextField::TextField(BView& view, QWidget& parent) : QLineEdit(&parent), view_(view) {}

void TextField::setCompletions(const std::function<std::vector<Completion>(const std::string&)>& find,
                               const std::function<void(const Completion&)>& choose)
{
    list_ = nullptr;
    // When it is needed: only then the field has its window, and most fields never need it.
    makeList_ = [this, find, choose] {
        if (list_ == nullptr)
            list_ = new CompletionList(*this, find, choose);
    };
    QObject::connect(this, &QLineEdit::textEdited, [this](const QString& typed) {
        makeList_();
        list_->offer(typed.toStdString());
    });
}

void TextField::setCalendar(const std::function<void()>& open)
{
    calendar_ = new FieldButton(*this, calendarIcon(), open);
    calendar_->setObjectName(objectName() + "Calendar");
    calendar_->setAccessibleName("Calendar");
    calendar_->setToolTip("Opens a calendar.  Alt+Down");
    setTextMargins(0, 0, kButton, 0);
}

void TextField::resizeEvent(QResizeEvent* event)
{
    constexpr int kEdge = 3;
    QLineEdit::resizeEvent(event);
    if (calendar_ != nullptr)
        calendar_->setGeometry(width() - kButton - kEdge, (height() - kButton) / 2, kButton, kButton);
}

bool TextField::isListOpen() const
{
    return list_ != nullptr && list_->isOpen();
}

bool TextField::event(QEvent* event)
{
    const bool isKey = event->type() == QEvent::KeyPress || event->type() == QEvent::ShortcutOverride;
    const int key = isKey ? static_cast<QKeyEvent*>(event)->key() : 0;
    // Escape is nobody else's as long as there is a list to close.
    if (event->type() == QEvent::ShortcutOverride && key == Qt::Key_Escape && isListOpen()) {
        event->accept();
        return true;
    }
    // Tab takes what is chosen and goes on.
    if (event->type() == QEvent::KeyPress && key == Qt::Key_Tab && isListOpen())
        list_->takeChosen();
    return isForWindow(*event, isModified(), isRedoAvailable()) || QLineEdit::event(event);
}

void TextField::keyPressEvent(QKeyEvent* event)
{
    const auto modifiers = event->modifiers() & ~Qt::KeypadModifier;
    const bool isDown = event->key() == Qt::Key_Down;
    if (modifiers == Qt::AltModifier && isDown && calendar_ != nullptr)
        return calendar_->press();
    if (modifiers != Qt::NoModifier)
        return QLineEdit::keyPressEvent(event);
    if (list_ != nullptr && list_->takeKey(*event))
        return;
    if (isDown && makeList_ && !isReadOnly()) {
        makeList_();
        list_->offer(text().toStdString());
        if (!list_->isOpen())
            list_->offer({}); // nothing goes on from here: all there is
        return;
    }
    // Enter is the field's: it sends the message, and must not reach a default button.
    if (event->key() == Qt::Key_Up || isDown || event->key() == Qt::Key_PageUp || event->key() == Qt::Key_PageDown) {
        // In a field of one line these keys do nothing by themselves.
        const std::string bytes = keyBytes(*event);
        view_.KeyDown(bytes.c_str(), static_cast<int32>(bytes.size()));
        return;
    }
    QLineEdit::keyPressEvent(event);
}

void TextField::focusOutEvent(QFocusEvent* event)
{
    if (list_ != nullptr)
        list_->hide();
    QLineEdit::focusOutEvent(event);
}
