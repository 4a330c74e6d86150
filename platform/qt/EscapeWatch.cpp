#include "platform/EscapeWatch.h"

#include <QApplication>
#include <QElapsedTimer>
#include <QKeyEvent>
#include <QPointer>
#include <QWindow>

#include <vector>

namespace {

/// What a person does, as it comes from the desktop.
bool isInput(const QEvent& event)
{
    switch (event.type()) {
    case QEvent::KeyPress:
    case QEvent::KeyRelease:
    case QEvent::MouseButtonPress:
    case QEvent::MouseButtonRelease:
    case QEvent::MouseButtonDblClick:
    case QEvent::MouseMove:
    case QEvent::Wheel:
    case QEvent::TouchBegin:
    case QEvent::TouchUpdate:
    case QEvent::TouchEnd:
    case QEvent::TouchCancel:
    case QEvent::ContextMenu:
    case QEvent::Close:
        return true;
    default:
        return false;
    }
}

} // namespace

/// Holds back what comes for the desktop's windows, in front of all that Qt makes of it: shortcuts, clicks, focus.
class EscapeWatch::Filter final : public QObject {
public:
    Filter()
    {
        QCoreApplication::instance()->installEventFilter(this);
        sinceLook_.start();
    }
    ~Filter() override
    {
        QCoreApplication::instance()->removeEventFilter(this);
        for (const auto& [window, event] : held_)
            if (window != nullptr)
                QCoreApplication::postEvent(window, event->clone());
    }

    bool look()
    {
        constexpr qint64 kPause = 50; // milliseconds: a fetch that is quicker costs no look
        if (!isPressed_ && sinceLook_.elapsed() >= kPause) {
            // Sockets wait as well: a signal to end the program comes by one.
            QCoreApplication::processEvents(QEventLoop::ExcludeSocketNotifiers);
            sinceLook_.restart();
        }
        return isPressed_;
    }

protected:
    bool eventFilter(QObject* receiver, QEvent* event) override
    {
        if (!receiver->isWindowType() || !isInput(*event))
            return false;
        const bool isKey = event->type() == QEvent::KeyPress || event->type() == QEvent::KeyRelease;
        const bool isEscape = isKey && static_cast<QKeyEvent*>(event)->key() == Qt::Key_Escape;
        isPressed_ = isPressed_ || isEscape || event->type() == QEvent::Close;
        if (isEscape)
            return true;
        // Of a mouse that moves on and on the last place is enough.
        if (event->type() == QEvent::MouseMove && !held_.empty() && held_.back().second->type() == QEvent::MouseMove)
            held_.pop_back();
        held_.emplace_back(static_cast<QWindow*>(receiver), event->clone());
        event->ignore(); // a window that is asked to close stays for now
        return true;
    }

private:
    bool isPressed_ = false;
    QElapsedTimer sinceLook_;
    std::vector<std::pair<QPointer<QWindow>, std::unique_ptr<QEvent>>> held_;
};

EscapeWatch::EscapeWatch() : filter_(std::make_unique<Filter>()) {}

EscapeWatch::~EscapeWatch() = default;

bool EscapeWatch::IsPressed()
{
    return filter_->look();
}
